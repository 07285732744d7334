#include <gtest/gtest.h>
#include <poll.h>

#include "linux/probe/ssdp_probe.h"
#include "verification/unit/linux/fakes/loopback_socket.h"
#include "verification/unit/linux/fakes/udp_server.h"
#include "verification/unit/linux/fakes/web_server.h"
#include "verification/unit/linux/stop.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

UdpServer::Message answerWith(const std::string& location) {
    const std::string text = "HTTP/1.1 200 OK\r\nLOCATION: " + location + "\r\n\r\n";
    return {text.begin(), text.end()};
}

RouterPlace routerAt(const UdpServer& server) {
    return {kHere, "lo", kHere, server.port()};
}

/// A router that is searched for on loopback; its description lies on a web server there.
class RouterProbe : public ::testing::Test {
  protected:
    static void SetUpTestSuite() { web_ = new WebServer; }
    static void TearDownTestSuite() { delete web_; }

    inline static WebServer* web_ = nullptr;
};

TEST_F(RouterProbe, TellsMakerModelAndOuterAddress) {
    const UdpServer server([](const auto&) { return answerWith(web_->plain("/description.xml")); });
    const auto router = askRouter(routerAt(server), patience());
    ASSERT_TRUE(router) << router.error().text();
    EXPECT_EQ(router->description.manufacturer, "Example Networks");
    EXPECT_EQ(router->description.modelName, "Base 5");
    EXPECT_EQ(router->external, IPAddress::fromText("10.20.30.40"));
}

TEST_F(RouterProbe, AnOuterAddressIsAskedForOnlyWhereADescriptionNamesIt) {
    const UdpServer server([](const auto&) { return answerWith(web_->plain("/page")); });
    const auto router = askRouter(routerAt(server), patience());
    ASSERT_TRUE(router);
    EXPECT_EQ(router->description.modelName, "");
    EXPECT_FALSE(router->external);
}

TEST_F(RouterProbe, NothingIsFetchedThatLiesElsewhereThanOnTheRouter) {
    for (const char* elsewhere :
         {"http://127.0.0.2:1/d.xml", "http://host.example/d.xml", "ftp://127.0.0.1/d.xml", "nonsense"}) {
        const UdpServer server([&](const auto&) { return answerWith(elsewhere); });
        const auto router = askRouter(routerAt(server), patience(100ms));
        ASSERT_FALSE(router) << elsewhere;
        EXPECT_EQ(router.error().code, static_cast<int>(Reason::timeout)) << elsewhere;
    }
}

TEST_F(RouterProbe, ADescriptionLeadsNowhereElse) {
    const LoopbackSocket elsewhere = LoopbackSocket::listening("127.0.0.2");
    const std::string control = "http://127.0.0.2:" + std::to_string(elsewhere.port()) + "/control";

    const UdpServer server([&](const auto&) { return answerWith(web_->plain("/control-at/" + control)); });
    const auto router = askRouter(routerAt(server), patience());
    ASSERT_TRUE(router);
    EXPECT_EQ(router->description.modelName, "Base 5");
    EXPECT_FALSE(router->external);
    pollfd entry{elsewhere.number(), POLLIN, 0};
    EXPECT_EQ(::poll(&entry, 1, 0), 0) << "somebody asked there";
}

TEST_F(RouterProbe, OnlyTheRouterItselfIsBelieved) {
    const UdpServer server([](const auto&) { return answerWith(web_->plain("/description.xml")); });
    RouterPlace other = routerAt(server);
    other.address = *IPAddress::fromText("127.0.0.2");
    EXPECT_FALSE(askRouter(other, patience(100ms)));
}

TEST_F(RouterProbe, BeingStoppedEndsTheSearch) {
    const auto stop = std::make_shared<StopSignal>();
    const UdpServer server([stop](const auto&) {
        stop->raise();
        return std::nullopt;
    });
    const auto router = askRouter(routerAt(server), patience(5min, stop));
    ASSERT_FALSE(router);
    EXPECT_EQ(router.error().code, static_cast<int>(Reason::cancelled));
}

}  // namespace
}  // namespace wp
