#pragma once

#include <gtest/gtest.h>
#include <sys/socket.h>

#include <optional>
#include <string>
#include <thread>

#include "linux/session.h"

namespace wp {

/// A session on a thread of its own, and the host's end of its wire.
class Conversation {
  public:
    Conversation() : Conversation(PowerSwitch()) {}
    explicit Conversation(PowerSwitch given) {
        int ends[2];
        EXPECT_EQ(0, socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, ends));
        host_.emplace(Descriptor(ends[0]));
        service_ = std::thread([end = ends[1], power = std::move(given)]() mutable {
            LineSocket wire{Descriptor(end)};
            Sources sources;
            // No machine has an interface of this name: what is asked here ends with an error at once or soon.
            sources.interfaceName = "no-such-wifi";
            Session(wire, sources, power).run();
        });
    }
    ~Conversation() {
        host_.reset();
        service_.join();
    }

    void say(std::string_view line) { host_->send(line); }

    /// The next line that the service says.
    std::string hear() {
        for (;;) {
            if (std::optional<std::string> line = host_->nextLine()) return *line;
            if (!host_->receive()) return "closed";
        }
    }

    /// The answer to the request of this number.
    WireAnswer answer(std::uint64_t id) {
        for (;;) {
            const WireMessage message = readMessage(hear());
            const auto* answer = std::get_if<WireAnswer>(&message);
            if (answer != nullptr && answer->id == id) return *answer;
        }
    }

  private:
    std::optional<LineSocket> host_;
    std::thread service_;
};

}  // namespace wp
