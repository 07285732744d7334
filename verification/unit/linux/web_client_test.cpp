#include "linux/probe/web_client.h"

#include <gtest/gtest.h>
#include <stdlib.h>

#include <filesystem>
#include <fstream>

#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/linux/fakes/refusing_kernel.h"
#include "verification/unit/linux/fakes/restless_server.h"
#include "verification/unit/linux/fakes/web_server.h"
#include "verification/unit/linux/stop.h"

namespace wp {
namespace {

using namespace std::chrono_literals;
using End = WebAnswer::End;
using Body = WebAnswer::Body;

/// A server on loopback for all tests of this kind.
class WebClient : public ::testing::Test {
  protected:
    static void SetUpTestSuite() { server_ = new WebServer; }
    static void TearDownTestSuite() { delete server_; }

    static WebRequest plain(const std::string& path) {
        WebRequest request;
        request.url = server_->plain(path);
        request.interfaceName = "lo";
        return request;
    }
    static WebRequest secure(const std::string& path, const std::string& host = "host.example") {
        WebRequest request;
        request.url = server_->secure(path, host);
        request.addresses = {*IPAddress::fromText("127.0.0.1")};
        request.authorities = server_->certificate();
        return request;
    }
    static WebAnswer ask(const WebRequest& request) {
        const auto answers = runWebRequests({request}, patience());
        EXPECT_TRUE(answers);
        return answers ? answers->front() : WebAnswer();
    }

    inline static WebServer* server_ = nullptr;
};

TEST_F(WebClient, TellsStatusBodyAndWhoAnswered) {
    const WebAnswer nothing = ask(plain("/204")), page = ask(plain("/page"));
    EXPECT_EQ(nothing.end, End::answered);
    EXPECT_EQ(nothing.status, 204);
    EXPECT_EQ(nothing.server, IPAddress::fromText("127.0.0.1"));
    EXPECT_EQ(page.status, 200);
    EXPECT_EQ(page.body, "<html>please log in</html>");
}

TEST_F(WebClient, FollowsNoRedirectAndTellsWhereItWouldLead) {
    EXPECT_EQ(ask(plain("/redirect")).status, 302);
    EXPECT_EQ(ask(plain("/redirect")).location, server_->plain("/login"));
    EXPECT_EQ(ask(plain("/nowhere")).status, 302);
    EXPECT_EQ(ask(plain("/nowhere")).location, "");
}

TEST_F(WebClient, TellsNoRedirectThatLeadsElsewhereThanToTheWeb) {
    for (const char* target : {"file:///etc/passwd", "javascript:alert(1)", "ftp://h/", "http://bank@thief/",
                               "http://h:0/", "//", "http:h"}) {
        const WebAnswer answer = ask(plain("/redirect-to/" + std::string(target)));
        EXPECT_EQ(answer.status, 302) << target;
        EXPECT_EQ(answer.location, "") << target;
    }
    EXPECT_EQ(ask(plain("/redirect-to///[fe80::1%25wlan0]:8/x")).location, "http://[fe80::1%wlan0]:8/x");
}

TEST_F(WebClient, AnAnswerOfWhichNoBodyIsWantedEndsWithItsHead) {
    const WebAnswer answer = ask(plain("/redirect-and-hang"));
    EXPECT_EQ(answer.status, 302);
    EXPECT_EQ(answer.location, server_->plain("/login"));
}

TEST_F(WebClient, AtTheDeadlineAPageCountsAsFarAsItCame) {
    WebAnswer answer;
    for (auto time = 50ms; answer.end == End::failed && time < 20s; time *= 2)
        answer = runWebRequests({plain("/page-and-hang")}, patience(time))->front();
    EXPECT_EQ(answer.status, 200);
    EXPECT_EQ(answer.body, "<html>");
    EXPECT_EQ(answer.bodyCame, Body::late);
    EXPECT_EQ(answer.why, "no answer in time");
}

TEST_F(WebClient, APageThatNeverCameIsNotAnEmptyOne) {
    const WebAnswer announced = ask(plain("/page-that-never-comes")),
                    unknown = ask(plain("/chunks-that-never-come")), empty = ask(plain("/empty"));
    EXPECT_EQ(announced.body, "");
    EXPECT_EQ(announced.bodyCame, Body::cutOff);
    EXPECT_EQ(unknown.body, "");
    EXPECT_EQ(unknown.bodyCame, Body::cutOff);
    EXPECT_EQ(unknown.why, "the connection was closed before the answer's end");
    EXPECT_EQ(empty.end, End::answered);
    EXPECT_EQ(empty.body, "");
    EXPECT_EQ(empty.bodyCame, Body::whole);
}

TEST_F(WebClient, ABodyWithoutALengthIsWholeOnlyWhereTheConnectionEndsInOrder) {
    for (const char* body : {"", "x", "<html>"}) {
        const std::string path = std::string("/until-reset/") + body, cut = std::string("/until-cut/") + body;
        for (const WebRequest& request : {plain(path), secure(path), secure(cut)}) {
            const WebAnswer answer = ask(request);
            EXPECT_EQ(answer.end, End::answered) << request.url << ": " << answer.why;
            EXPECT_EQ(answer.body, body) << request.url;
            EXPECT_EQ(answer.bodyCame, Body::cutOff) << request.url;
            EXPECT_NE(answer.why, "") << request.url;
        }
        EXPECT_EQ(ask(plain(cut)).bodyCame, Body::whole);
    }
    EXPECT_EQ(ask(plain("/until-reset/x")).why, "Connection reset by peer");
    EXPECT_EQ(ask(secure("/until-cut/x")).why, "the connection was closed");
}

TEST_F(WebClient, ABodyWithALengthIsWholeHoweverItsConnectionEnds) {
    const WebAnswer answer = ask(secure("/page-and-cut"));
    EXPECT_EQ(answer.body, "<html>please log in</html>");
    EXPECT_EQ(answer.bodyCame, Body::whole);
}

TEST_F(WebClient, AServerThatNeverPausesIsNotHeardBeyondTheDeadline) {
    for (WebRequest request : {plain("/endless"), secure("/endless")}) {
        request.longestBody = 1U << 30;
        const auto answers = runWebRequests({request}, patience(100ms));
        ASSERT_TRUE(answers);
        EXPECT_LT(answers->front().body.size(), request.longestBody);
    }
}

TEST_F(WebClient, ASecureServerThatOnlyChangesItsKeysIsNotHeardBeyondTheDeadline) {
    const RestlessServer restless(server_->certificate(), server_->key());
    WebRequest request = secure("/204");
    request.url = "https://host.example:" + std::to_string(restless.port()) + "/";
    const auto answers = runWebRequests({request}, patience(200ms));
    ASSERT_TRUE(answers);
    EXPECT_EQ(answers->front().end, End::failed);
    EXPECT_TRUE(answers->front().why.ends_with(" in time")) << answers->front().why;
}

TEST_F(WebClient, NoExchangeLeavesADescriptorBehind) {
    const auto open = [] {
        const std::filesystem::directory_iterator all("/proc/self/fd");
        return std::distance(begin(all), end(all));
    };
    ask(plain("/204"));
    const auto before = open();
    WebRequest refused = plain("/204");
    refused.url = "http://127.0.0.1:1/";
    for (int i = 0; i < 20; ++i)
        for (const WebRequest& each :
             {plain("/drop"), plain("/page"), secure("/drop"), refused, secure("/204", "other.example")})
            ask(each);
    EXPECT_EQ(open(), before);
}

TEST_F(WebClient, ABodyIsCutAtItsBound) {
    WebRequest request = plain("/big");
    request.longestBody = 1000;
    const WebAnswer answer = ask(request);
    EXPECT_EQ(answer.end, End::answered);
    EXPECT_EQ(answer.status, 200);
    EXPECT_EQ(answer.body.size(), 1000U);
}

TEST_F(WebClient, ABodyMayComeInChunksOrLastUntilTheConnectionEnds) {
    for (const WebRequest& request :
         {plain("/chunks"), plain("/until-closed"), secure("/chunks"), secure("/until-closed")}) {
        const WebAnswer answer = ask(request);
        EXPECT_EQ(answer.end, End::answered) << request.url;
        EXPECT_EQ(answer.body, "<html>please log in</html>") << request.url;
        EXPECT_EQ(answer.bodyCame, Body::whole) << request.url;
    }
}

TEST_F(WebClient, SendsHeadersAndTheNameOfItsHost) {
    WebRequest request = plain("/echo");
    request.url = server_->plain("/echo", "host.example");
    request.addresses = {*IPAddress::fromText("127.0.0.1")};
    request.headers = {"Accept: application/captive+json"};
    EXPECT_EQ(ask(request).body, "application/captive+json|host.example:" + server_->plainPort());
}

TEST_F(WebClient, GoesThroughNoProxy) {
    setenv("http_proxy", "http://127.0.0.1:1", 1);
    const WebAnswer answer = ask(plain("/204"));
    unsetenv("http_proxy");
    EXPECT_EQ(answer.status, 204);
}

TEST_F(WebClient, AnAnswerThatBreaksOffOrNeverComesHasFailed) {
    EXPECT_EQ(ask(plain("/drop")).end, End::failed);
    WebRequest refused = plain("/204");
    refused.url = "http://127.0.0.1:1/";
    EXPECT_EQ(ask(refused).end, End::failed);
    EXPECT_NE(ask(refused).why, "");
    const auto late = runWebRequests({plain("/hang")}, patience(100ms));
    ASSERT_TRUE(late);
    EXPECT_EQ(late->front().end, End::failed);
    EXPECT_EQ(late->front().why, "no answer in time");
}

TEST_F(WebClient, WhatWasReachedByTheDeadlineIsTold) {
    WebAnswer answer;
    for (auto time = 50ms; !answer.server && time < 20s; time *= 2)
        answer = runWebRequests({plain("/hang")}, patience(time))->front();
    EXPECT_EQ(answer.end, End::failed);
    EXPECT_EQ(answer.server, IPAddress::fromText("127.0.0.1"));
    EXPECT_TRUE(answer.steps.connect);
}

TEST_F(WebClient, AServerThatSpeaksAnotherProtocolHasFailed) {
    EXPECT_EQ(ask(plain("/other-protocol")).end, End::failed);
    EXPECT_EQ(ask(plain("/other-protocol")).why, "the answer is none of HTTP/1");
    WebRequest secureToPlain = secure("/204");
    secureToPlain.url = "https://host.example:" + server_->plainPort() + "/204";
    EXPECT_EQ(ask(secureToPlain).end, End::failed);
    EXPECT_EQ(ask(secureToPlain).fault, CertificateFault::none);
}

TEST_F(WebClient, TriesTheNextAddressWhereOneFails) {
    WebRequest request = plain("/204");
    request.interfaceName.clear();
    request.url = server_->plain("/204", "host.example");
    // Nobody listens at the first two, and the third takes longer than the patience of the test to fail.
    for (const char* address : {"::1", "127.0.0.9", "240.0.0.1", "127.0.0.1"})
        request.addresses.push_back(*IPAddress::fromText(address));
    EXPECT_EQ(ask(request).server, IPAddress::fromText("127.0.0.1"));
    request.addresses.pop_back();
    EXPECT_EQ(ask(request).end, End::failed);
    EXPECT_TRUE(ask(request).why.starts_with("no connection to 240.0.0.1: ")) << ask(request).why;
}

TEST_F(WebClient, ThatMayNotGoOverTheInterfaceTellsNothingOfTheNetwork) {
    const auto answers =
        fakes::whereBindingsAreRefused([] { return runWebRequests({plain("/204")}, patience()); });
    ASSERT_FALSE(answers);
    EXPECT_EQ(answers.error().text(), "cannot send over lo: Operation not permitted (code 6)");
}

TEST_F(WebClient, ASecureConnectionNeedsACertificateOfTheHost) {
    EXPECT_EQ(ask(secure("/204")).status, 204);
    EXPECT_EQ(ask(secure("/204", "other.example")).end, End::badCertificate);
    EXPECT_EQ(ask(secure("/204", "wildcard.host.example")).end, End::badCertificate);
    WebRequest stranger = secure("/204");
    stranger.authorities.clear();
    EXPECT_EQ(ask(stranger).end, End::badCertificate);
}

TEST_F(WebClient, TellsWhatIsWrongWithACertificate) {
    EXPECT_EQ(ask(secure("/204")).fault, CertificateFault::none);
    EXPECT_EQ(ask(secure("/204", "other.example")).fault, CertificateFault::wrongHost);
    WebRequest stranger = secure("/204");
    stranger.authorities.clear();
    EXPECT_EQ(ask(stranger).fault, CertificateFault::selfSigned);
}

TEST_F(WebClient, WithoutAuthoritiesNoCertificateIsJudged) {
    const fakes::TemporaryFolder temporary;
    const std::string& folder = temporary.path();
    WebRequest request = secure("/204");
    for (const std::string& place : {folder, folder + "/none.pem"}) {
        request.authorities = place;
        const WebAnswer answer = ask(request);
        EXPECT_EQ(answer.end, End::noAuthorities) << place;
        EXPECT_EQ(answer.why, "no certificates of authorities in " + place);
    }
    std::ofstream(folder + "/broken.pem") << "no certificate";
    request.authorities = folder + "/broken.pem";
    EXPECT_EQ(ask(request).end, End::noAuthorities);
    EXPECT_TRUE(ask(request).why.starts_with("no certificates of authorities in " + request.authorities));
    std::filesystem::copy(server_->certificate(), folder + "/good.pem");
    EXPECT_EQ(std::system(("openssl rehash " + folder + " 2>/dev/null").c_str()), 0);
    request.authorities = folder;
    EXPECT_EQ(ask(request).status, 204);
}

TEST_F(WebClient, TellsACertificateOfAnotherTimeFromOneThatNobodyVouchesFor) {
    constexpr long kDay = 86400;
    const WebServer expired(WebServer::Validity{-2 * kDay, -kDay}),
        early(WebServer::Validity{kDay, 2 * kDay});
    const auto faultOf = [](const WebServer& server) {
        WebRequest request = secure("/204");
        request.url = server.secure("/204", "host.example");
        request.authorities = server.certificate();
        return ask(request).fault;
    };
    EXPECT_EQ(faultOf(expired), CertificateFault::expired);
    EXPECT_EQ(faultOf(early), CertificateFault::notYetValid);
}

TEST_F(WebClient, ACertificateMayBeForAnAddress) {
    WebRequest request = secure("/204", "127.0.0.1");
    EXPECT_EQ(ask(request).status, 204);
    request.url = "https://127.0.0.2" + request.url.substr(request.url.rfind(':'));
    EXPECT_EQ(ask(request).end, End::failed);  // nobody listens there
}

TEST_F(WebClient, TellsTheStepsOfARequestAndTheServersClock) {
    const WebAnswer answer = ask(secure("/page")), open = ask(plain("/204"));
    WebRequest connecting = secure("/hang");
    connecting.connectOnly = true;
    const WebAnswer connected = ask(connecting);

    EXPECT_TRUE(answer.steps.connect && answer.steps.secure && answer.steps.firstByte);
    EXPECT_TRUE(open.steps.connect && !open.steps.secure);
    EXPECT_TRUE(connected.steps.secure && !connected.steps.firstByte);
    ASSERT_TRUE(open.clockOffset);
    EXPECT_LE(std::abs(*open.clockOffset), 60);
    EXPECT_EQ(ask(plain("/yesterday")).clockOffset.value_or(0) / 3600, 24);
    EXPECT_FALSE(connected.clockOffset);
}

TEST_F(WebClient, ConnectingAloneAsksForNothing) {
    WebRequest request = secure("/hang");
    request.connectOnly = true;
    EXPECT_EQ(ask(request).end, End::answered);
    request = secure("/hang", "other.example");
    request.connectOnly = true;
    EXPECT_EQ(ask(request).end, End::badCertificate);
}

TEST_F(WebClient, NeverLooksANameUpItself) {
    WebRequest request = plain("/204");
    request.url = server_->plain("/204", "localhost");
    EXPECT_EQ(ask(request).why, "the name of its host has no address");
}

TEST_F(WebClient, OtherSchemesAreRefused) {
    WebRequest request;
    request.url = "file:///etc/hostname";
    EXPECT_EQ(ask(request).end, End::failed);
    EXPECT_EQ(ask(request).body, "");
}

TEST_F(WebClient, AConclusiveAnswerEndsTheOthers) {
    const auto answers = runWebRequests({plain("/hang"), plain("/511")}, patience(),
                                        [](const auto& all) { return all[1].has_value(); });
    ASSERT_TRUE(answers);
    EXPECT_EQ((*answers)[0].why, "not waited for any longer");
    EXPECT_EQ((*answers)[1].status, 511);
}

TEST_F(WebClient, BeingStoppedEndsAll) {
    const auto stop = std::make_shared<StopSignal>();
    const auto answers =
        runWebRequests({plain("/hang"), plain("/204")}, patience(20s, stop), [&](const auto&) {
            stop->raise();
            return false;
        });
    ASSERT_FALSE(answers);
    EXPECT_EQ(answers.error().code, static_cast<int>(Reason::cancelled));
}

}  // namespace
}  // namespace wp
