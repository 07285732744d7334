#include "linux/line_socket.h"

#include <poll.h>
#include <sys/socket.h>

#include <array>
#include <cerrno>

#include "exchange/wire.h"

namespace wp {

LineSocket::LineSocket(Descriptor descriptor) : descriptor_(std::move(descriptor)) {}

bool LineSocket::receive() {
    std::array<char, 4096> bytes;
    const ssize_t size = recv(descriptor_.number(), bytes.data(), bytes.size(), MSG_DONTWAIT);
    if (size < 0) return errno == EAGAIN || errno == EINTR;
    received_.append(bytes.data(), static_cast<std::size_t>(size));
    return size > 0 && received_.size() <= kLongestLine;
}

std::optional<std::string> LineSocket::nextLine() {
    const std::size_t end = received_.find('\n', searched_);
    if (end == std::string::npos) {
        searched_ = received_.size();
        return std::nullopt;
    }
    std::string line = received_.substr(0, end);
    received_.erase(0, end + 1);
    searched_ = 0;
    return line;
}

bool LineSocket::send(std::string_view line) {
    while (!line.empty()) {
        const ssize_t sent = ::send(descriptor_.number(), line.data(), line.size(), MSG_NOSIGNAL);
        if (sent < 0 && errno == EAGAIN) {
            pollfd writable{descriptor_.number(), POLLOUT, 0};
            poll(&writable, 1, -1);
        } else if (sent < 0 && errno != EINTR) {
            return false;
        } else if (sent > 0) {
            line.remove_prefix(static_cast<std::size_t>(sent));
        }
    }
    return true;
}

}  // namespace wp
