#include "linux/netlink_reader.h"

#include <gtest/gtest.h>
#include <linux/netlink.h>

#include <cerrno>
#include <cstring>

#include "linux/netlink_socket.h"
#include "verification/unit/linux/captured.h"

namespace wp {
namespace {

using Buffer = std::vector<std::uint8_t>;

TEST(NetlinkReader, ReadsNumbersOfTheRightSizeOnly) {
    const Buffer buffer{8, 0, 1, 0, 0x2A, 0, 0, 0, 6, 0, 2, 0, 7, 0, 0, 0, 5, 0, 3, 0, 9, 0, 0, 0};
    const Attributes attributes{Bytes(buffer)};

    EXPECT_EQ(42U, attributes.number<std::uint32_t>(1));
    EXPECT_EQ(std::nullopt, attributes.number<std::uint16_t>(1));
    EXPECT_EQ(std::uint16_t{7}, attributes.number<std::uint16_t>(2));
    EXPECT_EQ(std::uint8_t{9}, attributes.number<std::uint8_t>(3));
    EXPECT_FALSE(attributes.has(4));
}

TEST(NetlinkReader, IgnoresTheFlagsOfAnAttributesType) {
    const Buffer nested{12, 0, 1, 0x80, 8, 0, 2, 0, 5, 0, 0, 0};

    EXPECT_EQ(5U, Attributes{Bytes(nested)}.nested(1).number<std::uint32_t>(2));
}

TEST(NetlinkReader, EndsBeforeAnAttributeThatBreaksOff) {
    for (const Buffer& broken :
         {Buffer{5, 0, 1, 0, 1, 0, 0, 0, 9, 0, 2, 0, 1}, Buffer{5, 0, 1, 0, 1, 0, 0, 0, 3, 0, 2, 0},
          Buffer{5, 0, 1, 0, 1, 0, 0, 0, 4, 0, 2}}) {
        const Attributes attributes{Bytes(broken)};
        int count = 0;
        attributes.forEach([&](std::uint16_t, Bytes) { ++count; });
        EXPECT_EQ(1, count);
        EXPECT_FALSE(attributes.has(2));
    }
}

TEST(NetlinkReader, TakesAnAttributeWithoutItsLastPadding) {
    const Buffer buffer{5, 0, 1, 0, 7};

    EXPECT_EQ(std::uint8_t{7}, Attributes{Bytes(buffer)}.number<std::uint8_t>(1));
}

TEST(NetlinkReader, ReadsATextUpToItsZero) {
    const Buffer buffer{7, 0, 1, 0, 'U', 'S', 0, 0};

    EXPECT_EQ("US", Attributes{Bytes(buffer)}.text(1));
}

/// A message of an answer; its content is one number.
Buffer part(std::uint16_t type, std::uint32_t sequence, std::uint16_t flags, std::int32_t number) {
    const nlmsghdr header{sizeof header + sizeof number, type, flags, sequence, 0};
    Buffer bytes(header.nlmsg_len);
    std::memcpy(bytes.data(), &header, sizeof header);
    std::memcpy(bytes.data() + sizeof header, &number, sizeof number);
    return bytes;
}

constexpr std::uint16_t kContent = 0x1C;

TEST(GatheredAnswer, IsCompleteWithItsEnd) {
    GatheredAnswer gathered(7);

    EXPECT_FALSE(gathered.take(part(kContent, 7, NLM_F_MULTI, 1)));
    EXPECT_FALSE(gathered.take(part(NLMSG_DONE, 6, NLM_F_MULTI, 0)));
    EXPECT_TRUE(gathered.take(part(NLMSG_DONE, 7, NLM_F_MULTI, 0)));
    EXPECT_EQ(part(kContent, 7, NLM_F_MULTI, 1), gathered.answer().messages);
    EXPECT_EQ(0, gathered.answer().error);
    EXPECT_FALSE(gathered.changed());
}

TEST(GatheredAnswer, OfAListThatChangedMeanwhileSaysSoAndHoldsWhatCame) {
    GatheredAnswer gathered(7);
    gathered.take(part(kContent, 7, NLM_F_MULTI | NLM_F_DUMP_INTR, 1));

    EXPECT_TRUE(gathered.take(part(NLMSG_DONE, 7, NLM_F_MULTI, 0)));
    EXPECT_TRUE(gathered.changed());
    EXPECT_EQ(0, gathered.answer().error);
    EXPECT_FALSE(gathered.answer().messages.empty());
}

TEST(GatheredAnswer, TellsADriverThatIsBusyFromAListThatChanged) {
    GatheredAnswer gathered(7);

    EXPECT_TRUE(gathered.take(part(NLMSG_ERROR, 7, 0, -EAGAIN)));
    EXPECT_EQ(EAGAIN, gathered.answer().error);
    EXPECT_FALSE(gathered.changed());
}

TEST(NetlinkReader, EndsAtAMessageThatBreaksOff) {
    const Buffer dump = captured("good-home-scan");
    for (std::size_t size = 0; size < dump.size(); ++size) {
        const Buffer prefix(dump.begin(), dump.begin() + static_cast<std::ptrdiff_t>(size));
        Bytes rest = prefix;
        std::size_t taken = 0;
        while (const auto message = takeNetlinkMessage(rest)) taken += message->payload.size();
        EXPECT_LE(taken, size);
    }
}

}  // namespace
}  // namespace wp
