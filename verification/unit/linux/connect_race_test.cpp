#include "linux/probe/connect_race.h"

#include <gtest/gtest.h>

#include "verification/unit/linux/fakes/loopback_socket.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

IPAddress at(const char* text) {
    return *IPAddress::fromText(text);
}

/// On loopback: connections are taken in, or, once its queue is full, are left without an answer.
class Listener {
  public:
    explicit Listener(const char* address, std::uint16_t port = 0)
        : socket_(LoopbackSocket::listening(address, port, 0)) {}
    std::uint16_t port() const { return socket_.port(); }
    /// Fills the queue, so that whoever comes next hears nothing.
    void fill() {
        while (true) {
            Descriptor guest(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
            const bool isIn = ::connect(guest.number(), socket_.place().raw(), socket_.place().size) == 0;
            pollfd entry{guest.number(), POLLOUT, 0};
            const bool isSoonIn = isIn || ::poll(&entry, 1, 100) > 0;
            guests_.push_back(std::move(guest));
            if (!isSoonIn) return;
        }
    }

  private:
    LoopbackSocket socket_;
    std::vector<Descriptor> guests_;
};

constexpr int kOften = 5000, kSeldom = 20;

/// Advances at one and the same moment, as often as it is said; whether there is a connection.
bool advanceAt(ConnectRace& race, Clock::time_point moment, int times = kOften) {
    for (int i = 0; i < times && !race.connected() && !race.failed(); ++i) {
        race.advance(moment);
        std::vector<pollfd> waits;
        Clock::time_point wake = moment;
        race.addWaits(waits, wake);
        ::poll(waits.data(), waits.size(), 1);
    }
    return race.connected();
}

TEST(ConnectRace, TheNextAddressHasItsTurnAQuarterOfASecondLater) {
    Listener silent("127.0.0.1");
    const Listener good("127.0.0.2", silent.port());
    silent.fill();
    ConnectRace race({at("127.0.0.1"), at("127.0.0.2")}, silent.port(), "");
    const auto begin = Clock::now();
    EXPECT_FALSE(advanceAt(race, begin, kSeldom));
    EXPECT_FALSE(advanceAt(race, begin + 249ms, kSeldom));
    EXPECT_TRUE(advanceAt(race, begin + 250ms));
    EXPECT_EQ(race.address(), at("127.0.0.2"));
}

TEST(ConnectRace, TheNextAddressHasItsTurnAtOnceWhereOneFailsBesideAnotherThatIsSilent) {
    Listener silent("127.0.0.1");
    const Listener good("127.0.0.4", silent.port());
    silent.fill();
    // Nobody listens at the second and third.
    ConnectRace race({at("127.0.0.1"), at("127.0.0.2"), at("127.0.0.3"), at("127.0.0.4")}, silent.port(), "");
    const auto begin = Clock::now();
    EXPECT_FALSE(advanceAt(race, begin, kSeldom));
    EXPECT_TRUE(advanceAt(race, begin + 250ms));
    EXPECT_EQ(race.address(), at("127.0.0.4"));
}

TEST(ConnectRace, FamiliesHaveTheirTurnsOneAfterTheOther) {
    const Listener good("127.0.0.1");
    // Nobody listens on IPv6; with the families in turns the third attempt is the first on IPv4 that can succeed.
    ConnectRace race({at("::1"), at("::1"), at("127.0.0.1")}, good.port(), "");
    EXPECT_TRUE(advanceAt(race, Clock::now()));
    EXPECT_EQ(race.address(), at("127.0.0.1"));
}

TEST(ConnectRace, WithoutAnyAddressItHasFailed) {
    const ConnectRace race({}, 80, "");
    EXPECT_TRUE(race.failed());
}

TEST(ConnectRace, AnInterfaceThatIsNotThereIsTheReason) {
    ConnectRace race({at("127.0.0.1"), at("::1")}, 80, "none0");
    EXPECT_FALSE(advanceAt(race, Clock::now()));
    EXPECT_TRUE(race.failed());
    EXPECT_TRUE(race.why().starts_with("cannot send over none0: ")) << race.why();
}

}  // namespace
}  // namespace wp
