#include "linux/probe/web_client.h"

#include <gtest/gtest.h>
#include <stdlib.h>

#include <filesystem>
#include <sstream>

#include "verification/unit/linux/fakes/child_process.h"
#include "verification/unit/linux/stop.h"

namespace wp {
namespace {

using namespace std::chrono_literals;
using End = WebAnswer::End;

/// A server on loopback for all tests of this kind, with a certificate for "host.example" of its own.
class WebClient : public ::testing::Test {
  protected:
    static void SetUpTestSuite() {
        std::string pattern = ::testing::TempDir() + "/wpXXXXXX";
        folder_ = mkdtemp(pattern.data());
        const std::string make =
            "openssl req -x509 -newkey rsa:2048 -nodes -days 2 -subj /CN=host.example -addext "
            "subjectAltName=DNS:host.example -keyout " +
            folder_ + "/key.pem -out " + certificate() + " 2>/dev/null";
        ASSERT_EQ(std::system(make.c_str()), 0);
        server_ = new ChildProcess({"python3", WP_SOURCE_DIR "/verification/unit/linux/fakes/web_server.py",
                                    certificate(), folder_ + "/key.pem"});
        std::istringstream(server_->firstLine()) >> plain_ >> secure_;
    }
    static void TearDownTestSuite() {
        delete server_;
        std::filesystem::remove_all(folder_);
    }

    static std::string certificate() { return folder_ + "/certificate.pem"; }

    static WebRequest plain(const std::string& path) {
        WebRequest request;
        request.url = "http://127.0.0.1:" + plain_ + path;
        request.interfaceName = "lo";
        return request;
    }
    static WebRequest secure(const std::string& path, const std::string& host = "host.example") {
        WebRequest request;
        request.url = "https://" + host + ":" + secure_ + path;
        request.addresses = {*IPAddress::fromText("127.0.0.1")};
        request.authorities = certificate();
        return request;
    }
    static WebAnswer ask(const WebRequest& request) {
        const auto answers = runWebRequests({request}, patience());
        EXPECT_TRUE(answers);
        return answers ? answers->front() : WebAnswer();
    }

    inline static std::string folder_, plain_, secure_;
    inline static ChildProcess* server_ = nullptr;
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
    EXPECT_EQ(ask(plain("/redirect")).location, "http://127.0.0.1:" + plain_ + "/login");
    EXPECT_EQ(ask(plain("/nowhere")).status, 302);
    EXPECT_EQ(ask(plain("/nowhere")).location, "");
}

TEST_F(WebClient, ABodyIsCutAtItsBound) {
    WebRequest request = plain("/big");
    request.longestBody = 1000;
    const WebAnswer answer = ask(request);
    EXPECT_EQ(answer.end, End::answered);
    EXPECT_EQ(answer.status, 200);
    EXPECT_EQ(answer.body.size(), 1000U);
}

TEST_F(WebClient, SendsHeadersAndTheNameOfItsHost) {
    WebRequest request = plain("/echo");
    request.url = "http://host.example:" + plain_ + "/echo";
    request.addresses = {*IPAddress::fromText("127.0.0.1")};
    request.headers = {"Accept: application/captive+json"};
    EXPECT_EQ(ask(request).body, "application/captive+json|host.example:" + plain_);
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

TEST_F(WebClient, ASecureConnectionNeedsACertificateOfTheHost) {
    EXPECT_EQ(ask(secure("/204")).status, 204);
    EXPECT_EQ(ask(secure("/204", "other.example")).end, End::badCertificate);
    WebRequest stranger = secure("/204");
    stranger.authorities.clear();
    EXPECT_EQ(ask(stranger).end, End::badCertificate);
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
    request.url = "http://localhost:" + plain_ + "/204";
    EXPECT_EQ(ask(request).why, "the name of its host has no address");
}

TEST_F(WebClient, OtherSchemesAreRefused) {
    WebRequest request;
    request.url = "file:///etc/hostname";
    EXPECT_EQ(ask(request).end, End::failed);
    EXPECT_EQ(ask(request).body, "");
    EXPECT_EQ(hostOf("file://host/x"), "");
    EXPECT_EQ(hostOf("https://[::1]:8443/x"), "::1");
    EXPECT_EQ(hostOf("no url"), "");
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
