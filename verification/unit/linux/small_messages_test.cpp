#include <gtest/gtest.h>
#include <linux/rfkill.h>

#include <cstring>

#include "linux/echo_message.h"
#include "linux/power_switch.h"
#include "linux/scanner.h"

namespace wp {
namespace {

using Packet = std::vector<std::uint8_t>;

/// What the other end makes of a request.
Packet replyTo(Packet request, std::uint8_t type) {
    request[0] = type;
    return request;
}

TEST(EchoMessage, OfIPv4SumsUpToAllOnes) {
    const Packet request = echoRequest(Address::Family::ipv4, {0x1234, 7});

    std::uint32_t sum = 0;
    for (std::size_t i = 0; i < request.size(); i += 2)
        sum += std::uint32_t{request[i]} << 8 | request[i + 1];
    EXPECT_EQ(0xFFFFU, (sum & 0xFFFF) + (sum >> 16));
}

TEST(EchoMessage, ComesBackWithItsTag) {
    const EchoTag tag{0xBEEF, 3};

    const Packet reply4 = replyTo(echoRequest(Address::Family::ipv4, tag), 0);
    const Packet reply6 = replyTo(echoRequest(Address::Family::ipv6, tag), 129);

    EXPECT_EQ(tag, readEchoReply(Address::Family::ipv4, EchoFraming::bare, reply4));
    EXPECT_EQ(tag, readEchoReply(Address::Family::ipv6, EchoFraming::bare, reply6));
    EXPECT_FALSE(readEchoReply(Address::Family::ipv6, EchoFraming::bare, reply4));
}

TEST(EchoMessage, IsFoundBehindAnIPv4HeaderOfAnyLength) {
    const EchoTag tag{1, 2};
    const Packet reply = replyTo(echoRequest(Address::Family::ipv4, tag), 0);
    for (const std::uint8_t words : {5, 6, 15}) {
        Packet packet(std::size_t{4} * words, 0);
        packet[0] = static_cast<std::uint8_t>(0x40 | words);
        packet.insert(packet.end(), reply.begin(), reply.end());
        EXPECT_EQ(tag, readEchoReply(Address::Family::ipv4, EchoFraming::behindIPv4Header, packet));
    }
}

TEST(EchoMessage, IsNoReplyWhenItIsCutOrTheRequestItself) {
    const Packet request = echoRequest(Address::Family::ipv4, {1, 2});

    EXPECT_FALSE(readEchoReply(Address::Family::ipv4, EchoFraming::bare, request));
    EXPECT_FALSE(readEchoReply(Address::Family::ipv4, EchoFraming::bare, Packet{0, 0, 0, 0, 0, 1, 0}));
    EXPECT_FALSE(readEchoReply(Address::Family::ipv4, EchoFraming::behindIPv4Header, {}));
    EXPECT_FALSE(readEchoReply(Address::Family::ipv4, EchoFraming::behindIPv4Header, Packet(19, 0x44)));
    EXPECT_FALSE(readEchoReply(Address::Family::ipv4, EchoFraming::behindIPv4Header, Packet(22, 0x4F)));
}

Packet bytesOf(const rfkill_event& event, std::size_t more = 0) {
    Packet bytes(sizeof event + more);
    std::memcpy(bytes.data(), &event, sizeof event);
    return bytes;
}

TEST(SwitchEvent, IsBlockedByEitherBlock) {
    const auto blocked = [](std::uint8_t soft, std::uint8_t hard) {
        return readSwitchEvent(bytesOf({4, RFKILL_TYPE_WLAN, RFKILL_OP_CHANGE, soft, hard}))->blocked;
    };

    EXPECT_FALSE(blocked(0, 0));
    EXPECT_TRUE(blocked(1, 0));
    EXPECT_TRUE(blocked(0, 1));
}

TEST(SwitchEvent, TellsABlockThatSoftwareCannotLift) {
    EXPECT_TRUE(readSwitchEvent(bytesOf({4, RFKILL_TYPE_WLAN, RFKILL_OP_ADD, 1, 1}))->byHardware);
    EXPECT_FALSE(readSwitchEvent(bytesOf({4, RFKILL_TYPE_WLAN, RFKILL_OP_ADD, 1, 0}))->byHardware);
}

TEST(SwitchEvent, IsReadInItsLaterLongerForm) {
    const auto event = readSwitchEvent(bytesOf({4, RFKILL_TYPE_WLAN, RFKILL_OP_DEL, 0, 0}, 1));

    ASSERT_TRUE(event);
    EXPECT_EQ(4U, event->index);
    EXPECT_TRUE(event->isWiFi);
    EXPECT_EQ(SwitchEvent::Kind::removed, event->kind);
}

TEST(SwitchEvent, TellsOtherRadiosFromWiFi) {
    EXPECT_FALSE(readSwitchEvent(bytesOf({0, RFKILL_TYPE_BLUETOOTH, RFKILL_OP_ADD, 1, 0}))->isWiFi);
}

TEST(SwitchEvent, IsNoneWhenItIsCut) {
    EXPECT_FALSE(readSwitchEvent(Packet(7)));
}

TEST(ScanMemory, KeepsAScanOverWhatWasHeardWithoutOne) {
    ScanMemory memory;
    ScanWish wish;
    wish.interfaceIndex = 3;
    wish.freshSince = 500;
    EXPECT_EQ(memory.serving(wish), nullptr);
    memory.keep(3, {{}, 1000});
    memory.keep(3, {std::vector<AccessPoint>(2), std::nullopt});

    ASSERT_NE(memory.serving(wish), nullptr);
    EXPECT_EQ(memory.serving(wish)->completedAt, 1000);
    wish.freshSince = 1001;
    EXPECT_EQ(memory.serving(wish), nullptr);
    wish = {};
    wish.interfaceIndex = 4;
    EXPECT_EQ(memory.serving(wish), nullptr);
}

TEST(AddForgotten, KeepsTheNameOfAnAccessPointWhoseBeaconHidesIt) {
    const auto heard = [](std::uint8_t last, std::string_view name) {
        AccessPoint each;
        each.address = {2, 0, 0, 0, 0, last};
        each.frequency = 2412;
        each.says.name = NetworkName({reinterpret_cast<const std::uint8_t*>(name.data()), name.size()});
        return each;
    };
    std::vector<AccessPoint> found = {heard(1, ""), heard(2, "Northlight")};
    found[1].signal = -50;

    addForgotten(found, {heard(1, ""), heard(1, "Blue Kite"), heard(2, "Northlight"), heard(3, "Cafe")});

    ASSERT_EQ(4U, found.size());
    EXPECT_EQ(-50, found[1].signal);
    EXPECT_EQ("Blue Kite", textFromName(found[2].says.name));
    EXPECT_EQ("Cafe", textFromName(found[3].says.name));
}

}  // namespace
}  // namespace wp
