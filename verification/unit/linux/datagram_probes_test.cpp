#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>

#include "linux/probe/name_lookup.h"
#include "linux/probe/translation_probes.h"
#include "verification/unit/linux/fakes/refusing_kernel.h"
#include "verification/unit/linux/fakes/udp_server.h"
#include "verification/unit/linux/stop.h"

namespace wp {
namespace {

using namespace std::chrono_literals;
using Message = UdpServer::Message;

bool failedBecause(const Error& error, Reason reason) {
    return error.code == static_cast<int>(reason);
}

std::optional<Message> silence(const Message&) {
    return std::nullopt;
}

/// A thread that raises the signal as soon as the server was asked, so that no time decides.
class StopOnceAsked {
  public:
    StopOnceAsked() : stop(std::make_shared<StopSignal>()) {}
    std::optional<Message> operator()(const Message&) const {
        stop->raise();
        return std::nullopt;
    }
    std::shared_ptr<StopSignal> stop;
};

/// Answers a binding request with 192.0.2.1 and the request's own transaction.
std::optional<Message> stunAnswer(const Message& request) {
    Message answer = {0x01, 0x01, 0x00, 0x0C};
    answer.insert(answer.end(), request.begin() + 4, request.end());
    answer.insert(answer.end(), {0x00, 0x20, 0x00, 0x08, 0x00, 0x01, 0, 0, 0xE1, 0x12, 0xA6, 0x43});
    return answer;
}

TEST(MappedAddress, IsWhatTheServerSees) {
    const UdpServer server(stunAnswer);
    const auto mapped = askMappedAddress(kHere, server.port(), "lo", patience());
    ASSERT_TRUE(mapped) << mapped.error().text();
    EXPECT_EQ(mapped->text(), "192.0.2.1");
}

TEST(MappedAddress, ALostRequestIsSentAgain) {
    std::atomic<int> asked = 0;
    const UdpServer server(
        [&](const Message& request) { return ++asked == 1 ? std::nullopt : stunAnswer(request); });
    EXPECT_TRUE(askMappedAddress(kHere, server.port(), "", patience()));
    EXPECT_GE(asked, 2);
}

TEST(MappedAddress, IsNotBelievedFromAnybodyElse) {
    const UdpServer stranger(stunAnswer, UdpServer::Sender::stranger);
    const auto mapped = askMappedAddress(kHere, stranger.port(), "", patience(100ms));
    ASSERT_FALSE(mapped);
    EXPECT_TRUE(failedBecause(mapped.error(), Reason::timeout));
}

TEST(MappedAddress, SilenceEndsAtTheDeadline) {
    const UdpServer server(silence);
    const auto mapped = askMappedAddress(kHere, server.port(), "", patience(50ms));
    ASSERT_FALSE(mapped);
    EXPECT_TRUE(failedBecause(mapped.error(), Reason::timeout));
}

TEST(MappedAddress, BeingStoppedEndsTheWait) {
    const StopOnceAsked asked;
    const UdpServer server(asked);
    const auto mapped = askMappedAddress(kHere, server.port(), "", patience(20s, asked.stop));
    ASSERT_FALSE(mapped);
    EXPECT_TRUE(failedBecause(mapped.error(), Reason::cancelled));
}

TEST(MappedAddress, AnInterfaceThatIsNotThereIsSaid) {
    const auto mapped = askMappedAddress(kHere, 9, "none0", patience());
    ASSERT_FALSE(mapped);
    EXPECT_TRUE(failedBecause(mapped.error(), Reason::noInterface)) << mapped.error().text();
}

TEST(ExternalAddress, IsToldByTheOlderProtocol) {
    const UdpServer router([](const Message&) { return Message{0, 128, 0, 0, 0, 0, 0, 9, 10, 1, 2, 3}; });
    const auto external = askExternalAddress(kHere, router.port(), kHere, "lo", patience());
    ASSERT_TRUE(external) << external.error().text();
    EXPECT_EQ(external->text(), "10.1.2.3");
}

TEST(ExternalAddress, IsToldByTheYoungerProtocolWhichIsGivenItsMappingBack) {
    std::vector<std::uint32_t> lifetimes;
    std::atomic<int> mappings = 0;
    const UdpServer router([&](const Message& request) {
        if (request[0] != 2) return Message{2, 128, 0, 1, 0, 0, 0, 0};
        lifetimes.push_back(request[7]);
        ++mappings;
        Message answer = request;
        answer[1] = 0x81;
        const std::uint8_t outer[] = {100, 64, 9, 9};
        std::copy(std::begin(outer), std::end(outer), answer.begin() + 56);
        return answer;
    });
    const auto external = askExternalAddress(kHere, router.port(), kHere, "lo", patience());
    ASSERT_TRUE(external) << external.error().text();
    EXPECT_EQ(external->text(), "100.64.9.9");
    while (mappings < 2) std::this_thread::yield();
    EXPECT_EQ(lifetimes.front(), 1U);
    EXPECT_EQ(lifetimes.back(), 0U);
}

TEST(ExternalAddress, IsNotBelievedFromAnybodyElse) {
    const UdpServer stranger([](const Message&) { return Message{0, 128, 0, 0, 0, 0, 0, 9, 10, 1, 2, 3}; },
                             UdpServer::Sender::stranger);
    const auto external = askExternalAddress(kHere, stranger.port(), kHere, "lo", patience(100ms));
    ASSERT_FALSE(external);
    EXPECT_TRUE(failedBecause(external.error(), Reason::timeout));
}

TEST(ExternalAddress, AMappingThatWasNotAskedForIsNone) {
    const UdpServer router([&](const Message& request) {
        if (request[0] != 2) return Message{2, 128, 0, 1, 0, 0, 0, 0};
        Message answer = request;
        answer[1] = 0x81;
        ++answer[24];  // the first byte of what ties it to its request
        answer[59] = 1;
        return answer;
    });
    EXPECT_FALSE(askExternalAddress(kHere, router.port(), kHere, "lo", patience(100ms)));
}

TEST(ExternalAddress, ARefusalIsNoAddress) {
    const UdpServer router([](const Message&) { return Message{0, 128, 0, 2, 0, 0, 0, 9, 0, 0, 0, 0}; });
    const auto external = askExternalAddress(kHere, router.port(), kHere, "lo", patience());
    ASSERT_FALSE(external);
    EXPECT_TRUE(failedBecause(external.error(), Reason::unavailable));
}

TEST(HopList, ListsWhoAnswersAtEachDistance) {
    // Every port that is closed here answers itself, at any distance.
    const auto hops = listHops(kHere, "lo", patience());
    ASSERT_TRUE(hops) << hops.error().text();
    ASSERT_EQ(hops->size(), 4U);
    for (const auto& hop : *hops) EXPECT_EQ(hop, kHere);
}

TEST(HopList, SilenceLeavesAllHopsUnknown) {
    // The loopback interface leads nowhere else; the kernel drops what is sent there.
    const auto hops = listHops(*IPAddress::fromText("192.0.2.1"), "lo", patience(50ms));
    ASSERT_TRUE(hops) << hops.error().text();
    for (const auto& hop : *hops) EXPECT_FALSE(hop);
}

/// Where the question's type stands, behind the name that follows the header.
std::size_t typeAt(const Message& query) {
    std::size_t at = 12;
    while (at < query.size() && query[at] != 0) at += query[at] + 1U;
    return at + 1;
}

/// Answers each question with one record of these bytes, or with an error code.
std::optional<Message> dnsAnswer(const Message& query, const Message& ipv4, const Message& ipv6,
                                 std::uint8_t code = 0) {
    const std::size_t type = typeAt(query);
    const bool asksFour = query[type + 1] == 1;
    const Message& address = asksFour ? ipv4 : ipv6;
    Message answer(query.begin(), query.begin() + static_cast<std::ptrdiff_t>(type) + 4);
    answer[2] = 0x81;
    answer[3] = static_cast<std::uint8_t>(0x80 | code);
    answer[7] = code == 0 && !address.empty() ? 1 : 0;
    answer[8] = answer[9] = answer[10] = answer[11] = 0;
    if (answer[7] == 0) return answer;
    const Message head = {0xC0, 0x0C, 0, static_cast<std::uint8_t>(asksFour ? 1 : 28), 0, 1, 0, 0,
                          0,    60,   0, static_cast<std::uint8_t>(address.size())};
    answer.insert(answer.end(), head.begin(), head.end());
    answer.insert(answer.end(), address.begin(), address.end());
    return answer;
}

NameServerSet serverAt(const UdpServer& server) {
    return {{kHere}, "lo", server.port()};
}

TEST(NameLookup, AsksForBothFamilies) {
    const Message six = {0x20, 1, 0xD, 0xB8, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 7};
    const UdpServer server([&](const Message& query) { return dnsAnswer(query, {203, 0, 113, 7}, six); });
    const auto answer = lookUpName("host.example", serverAt(server), patience());
    ASSERT_TRUE(answer);
    std::vector<std::string> texts;
    for (const IPAddress& each : answer->addresses) texts.push_back(each.text());
    std::sort(texts.begin(), texts.end());
    EXPECT_EQ(texts, (std::vector<std::string>{"2001:db8::7", "203.0.113.7"}));
}

TEST(NameLookup, ANameThatDoesNotExistIsAnAnswer) {
    const UdpServer server([](const Message& query) { return dnsAnswer(query, {}, {}, 3); });
    const auto answer = lookUpName("host.example", serverAt(server), patience());
    ASSERT_TRUE(answer);
    EXPECT_TRUE(answer->addresses.empty());
    EXPECT_EQ(answer->why, "Domain name not found");
    EXPECT_TRUE(answer->heard);
}

TEST(NameLookup, OneFamilyWithoutRecordsIsNoFailure) {
    const UdpServer server([](const Message& query) { return dnsAnswer(query, {203, 0, 113, 7}, {}); });
    const auto answer = lookUpName("host.example", serverAt(server), patience());
    ASSERT_TRUE(answer);
    EXPECT_EQ(answer->addresses.size(), 1U);
    EXPECT_EQ(answer->why, "");
}

TEST(NameLookup, OneFamilyThatStaysSilentDoesNotHoldTheOtherUp) {
    const UdpServer server([](const Message& query) {
        return query[typeAt(query) + 1] == 1 ? dnsAnswer(query, {203, 0, 113, 7}, {}) : std::nullopt;
    });
    const auto answer = lookUpName("host.example", serverAt(server), patience());
    ASSERT_TRUE(answer);
    EXPECT_EQ(answer->addresses.size(), 1U);
}

TEST(NameLookup, AFamilyThatDoesNotLeadOutEndsNoWaitForTheOther) {
    // As behind a translator, which asks for an IPv4 address first and then makes one of IPv6 out of it.
    const Message six = {0x20, 1, 0xD, 0xB8, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 7};
    const UdpServer server([&](const Message& query) {
        if (query[typeAt(query) + 1] != 1) std::this_thread::sleep_for(200ms);
        return dnsAnswer(query, {203, 0, 113, 7}, six);
    });
    NameServerSet overIPv6 = serverAt(server);
    overIPv6.leadsOut.ipv4 = false;
    const auto answer = lookUpName("host.example", overIPv6, patience());
    ASSERT_TRUE(answer);
    EXPECT_EQ(answer->addresses.size(), 2U);
}

TEST(NameLookup, ADeadServerAndNoServerAreAnswersWithoutAddresses) {
    const UdpServer server(silence);
    const auto dead = lookUpName("host.example", serverAt(server), patience(100ms));
    const auto none = lookUpName("host.example", {}, patience());
    ASSERT_TRUE(dead && none);
    EXPECT_TRUE(dead->addresses.empty());
    EXPECT_EQ(dead->why, "no name server answered in time");
    EXPECT_FALSE(dead->heard);
    EXPECT_EQ(none->why, "there is no name server");
}

TEST(NameLookup, GarbageIsNoAnswer) {
    const UdpServer server([](const Message& query) {
        Message garbage(query.begin(), query.begin() + 12);
        garbage[2] = 0x81;
        garbage[7] = 200;
        garbage.insert(garbage.end(), 40, 0xC0);
        return garbage;
    });
    const auto answer = lookUpName("host.example", serverAt(server), patience(200ms));
    ASSERT_TRUE(answer);
    EXPECT_TRUE(answer->addresses.empty());
    EXPECT_NE(answer->why, "");
}

TEST(NameLookup, AnAnswerToAnotherQuestionOrFromAnybodyElseIsNone) {
    const Message four = {203, 0, 113, 7};
    const UdpServer otherNumber([&](const Message& query) {
        auto answer = dnsAnswer(query, four, {});
        ++(*answer)[1];
        return answer;
    });
    const UdpServer otherName([&](const Message& query) {
        auto answer = dnsAnswer(query, four, {});
        (*answer)[13] = 'x';
        return answer;
    });
    const UdpServer stranger([&](const Message& query) { return dnsAnswer(query, four, {}); },
                             UdpServer::Sender::stranger);
    for (const UdpServer* each : {&otherNumber, &otherName, &stranger}) {
        const auto answer = lookUpName("host.example", serverAt(*each), patience(100ms));
        ASSERT_TRUE(answer);
        EXPECT_TRUE(answer->addresses.empty());
    }
}

TEST(NameLookup, AnAnswerThatWasCutIsAskedForOnceMoreOverAConnection) {
    const UdpServer server([](const Message& query) {
        auto answer = dnsAnswer(query, {203, 0, 113, 7}, {});
        (*answer)[2] |= 2;
        return answer;
    });
    const auto answer = lookUpName("host.example", serverAt(server), patience());
    ASSERT_TRUE(answer);
    EXPECT_TRUE(answer->addresses.empty()) << "nobody takes connections there";
    EXPECT_EQ(answer->why, "Could not contact DNS servers");
}

TEST(NameLookup, GoesOverNoOtherInterfaceWhereItsOwnIsGone) {
    const UdpServer server([](const Message& query) { return dnsAnswer(query, {203, 0, 113, 7}, {}); });
    NameServerSet gone = serverAt(server);
    gone.interfaceName = "none0";
    const auto answer = lookUpName("host.example", gone, patience());
    const auto each = askEachServer("host.example", gone, patience());
    ASSERT_FALSE(answer || each);
    for (const Error& why : {answer.error(), each.error()})
        EXPECT_EQ(why.text(), "cannot send over none0: No such device (code 1)");
}

TEST(NameLookup, ThatMayNotGoOverTheInterfaceTellsNothingOfTheNetwork) {
    const UdpServer server([](const Message& query) { return dnsAnswer(query, {203, 0, 113, 7}, {}); });
    NameServerSet bound = serverAt(server);
    bound.interfaceName = "lo";
    const auto answer =
        fakes::whereBindingsAreRefused([&] { return lookUpName("host.example", bound, patience()); });
    ASSERT_FALSE(answer);
    EXPECT_EQ(answer.error().text(), "cannot send over lo: Operation not permitted (code 6)");
}

TEST(NameLookup, ALinkLocalServerIsOneLikeAnyOther) {
    const UdpServer server([](const Message& query) { return dnsAnswer(query, {203, 0, 113, 7}, {}); });
    NameServerSet both = serverAt(server);
    both.servers.insert(both.servers.begin(), *IPAddress::fromText("fe80::1"));  // nothing listens there
    const auto answer = lookUpName("host.example", both, patience());
    const auto each = askEachServer("host.example", both, patience());
    ASSERT_TRUE(answer) << answer.error().message;
    ASSERT_TRUE(each) << each.error().message;
    EXPECT_EQ(answer->addresses.size(), 1U);
    ASSERT_EQ(each->size(), 2U);
    EXPECT_FALSE(each->front().answered);
    EXPECT_TRUE(each->back().answered);
}

TEST(NameLookup, EachServerIsToldApart) {
    const UdpServer server([](const Message& query) { return dnsAnswer(query, {203, 0, 113, 7}, {}); });
    NameServerSet both = serverAt(server);
    both.servers.push_back(*IPAddress::fromText("127.0.0.2"));  // nothing listens there
    const auto answers = askEachServer("host.example", both, patience());
    ASSERT_TRUE(answers);
    ASSERT_EQ(answers->size(), 2U);
    EXPECT_TRUE(answers->at(0).answered);
    EXPECT_EQ(answers->at(0).code, "NOERROR");
    EXPECT_EQ(answers->at(0).server, IPAddress::fromText("127.0.0.1"));
    EXPECT_FALSE(answers->at(1).answered);
    EXPECT_EQ(answers->at(1).code, "unreachable");
}

TEST(NameLookup, AServersOwnWordIsKept) {
    const std::pair<int, const char*> codes[] = {{2, "SERVFAIL"}, {3, "NXDOMAIN"}, {5, "REFUSED"}};
    for (const auto& [code, word] : codes) {
        const UdpServer server(
            [rcode = code](const Message& query) { return dnsAnswer(query, {}, {}, rcode); });
        const auto answers = askEachServer("host.example", serverAt(server), patience());
        ASSERT_TRUE(answers);
        EXPECT_EQ(answers->front().code, word);
        EXPECT_TRUE(answers->front().answered);
    }
    const UdpServer dead(silence);
    const auto answers = askEachServer("host.example", serverAt(dead), patience(100ms));
    ASSERT_TRUE(answers);
    EXPECT_EQ(answers->front().code, "timeout");
    EXPECT_FALSE(answers->front().answered);
}

TEST(NameLookup, BeingStoppedEndsIt) {
    const StopOnceAsked asked;
    const UdpServer server(asked);
    const auto answer = lookUpName("host.example", serverAt(server), patience(20s, asked.stop));
    ASSERT_FALSE(answer);
    EXPECT_TRUE(failedBecause(answer.error(), Reason::cancelled));
}

TEST(NameLookup, AFreshNameIsEightLettersInTheZone) {
    const std::string one = freshName("zone.example"), other = freshName(".zone.example");
    EXPECT_EQ(one.substr(8), ".zone.example");
    EXPECT_EQ(other.substr(8), ".zone.example");
    EXPECT_NE(one, other);
}

}  // namespace
}  // namespace wp
