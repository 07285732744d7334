#include "exchange/service_connection.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <sys/socket.h>

#include <array>
#include <cerrno>
#include <cstring>

namespace wp {
namespace {

using Clock = std::chrono::steady_clock;
using std::chrono::milliseconds;

constexpr int kUnavailable = 4;
constexpr int kTimeout = 7;
constexpr int kMalformed = 10;

/// How long a service whose connection was closed may take to end by itself.
constexpr milliseconds kPatience(500);

std::string inSeconds(milliseconds duration) {
    return duration.count() % 1000 == 0 ? std::to_string(duration.count() / 1000) + " s"
                                        : std::to_string(duration.count()) + " ms";
}

void clearWakeup(int descriptor) {
    std::uint64_t count = 0;
    [[maybe_unused]] ssize_t got = ::read(descriptor, &count, sizeof count);
}

std::string nameOf(const WireRequest& request) {
    switch (request.kind) {
        case WireRequest::Kind::test:
            return "test " + std::to_string(request.test);
        case WireRequest::Kind::status:
            return "the status query";
        default:
            return "the Wi-Fi query";
    }
}

}  // namespace

ServiceConnection::ServiceConnection(ServiceProcess process, Handlers handlers)
    : handlers_(std::move(handlers)),
      process_(std::move(process)),
      wakeup_(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {
    thread_ = std::thread([this] { carry(); });
}

ServiceConnection::~ServiceConnection() {
    cancel();
    {
        std::lock_guard lock(mutex_);
        isStopping_ = true;
    }
    wake();
    thread_.join();
}

std::optional<Error> ServiceConnection::failure() const {
    std::lock_guard lock(mutex_);
    return failure_;
}

std::variant<std::uint64_t, Error> ServiceConnection::post(WireRequest& request, PendingPointer pending) {
    bool endsWithRun = request.kind == WireRequest::Kind::test || request.kind == WireRequest::Kind::status;
    std::lock_guard lock(mutex_);
    if (isCancelled_ && endsWithRun) return cancelledError();
    if (failure_) return *failure_;
    request.id = ++lastID_;
    pending_.emplace(request.id, std::move(pending));
    outgoing_ += requestLine(request);
    return request.id;
}

ServiceConnection::Outcome ServiceConnection::ask(WireRequest request, Duration deadline,
                                                  std::function<void(const WireAnswer&)> arrived) {
    auto pending = std::make_shared<Pending>();
    pending->arrived = std::move(arrived);
    auto posted = post(request, pending);
    if (auto* error = std::get_if<Error>(&posted)) return *error;
    wake();
    std::unique_lock lock(mutex_);
    if (answered_.wait_for(lock, deadline, [&] { return pending->outcome.has_value(); }))
        return *pending->outcome;
    pending_.erase(std::get<std::uint64_t>(posted));
    lock.unlock();
    Error error{kTimeout, "wifi-profile-service gave no answer to " + nameOf(request) + " within " +
                              inSeconds(deadline)};
    giveUp(error);
    return error;
}

void ServiceConnection::tell(WireRequest request, std::function<void(const WireAnswer&)> arrived) {
    auto pending = std::make_shared<Pending>();
    pending->arrived = std::move(arrived);
    if (std::holds_alternative<std::uint64_t>(post(request, pending))) wake();
}

void ServiceConnection::cancel() {
    {
        std::lock_guard lock(mutex_);
        isCancelled_ = true;
        for (auto& [id, pending] : pending_) pending->outcome = cancelledError();
        pending_.clear();
        WireRequest request;
        request.kind = WireRequest::Kind::cancel;
        if (!failure_) outgoing_ += requestLine(request);
    }
    answered_.notify_all();
    wake();
}

void ServiceConnection::giveUp(Error error) {
    {
        std::lock_guard lock(mutex_);
        if (failure_ || isStopping_) return;
        failure_ = error;
        outgoing_.clear();
    }
    if (handlers_.note) handlers_.note(error.message);  // the reason stands before its consequences
    {
        std::lock_guard lock(mutex_);
        for (auto& [id, pending] : pending_) pending->outcome = error;
        pending_.clear();
    }
    answered_.notify_all();
    wake();
}

void ServiceConnection::wake() {
    std::uint64_t one = 1;
    [[maybe_unused]] ssize_t written = ::write(wakeup_.number(), &one, sizeof one);  // full is awake too
}

void ServiceConnection::carry() {
    while (exchangeOnce()) {
    }
    bool isGivenUp = failure().has_value();
    process_.end(isGivenUp ? milliseconds(0) : kPatience);
}

/// Waits for something to do and does it; false when the conversation is over.
bool ServiceConnection::exchangeOnce() {
    bool hasOutgoing = false;
    {
        std::lock_guard lock(mutex_);
        if (failure_) return false;
        hasOutgoing = !outgoing_.empty();
    }
    auto events = static_cast<short>(hasOutgoing ? POLLIN | POLLOUT : POLLIN);
    std::array<pollfd, 2> watched{{{process_.socket(), events, 0}, {wakeup_.number(), POLLIN, 0}}};
    ::poll(watched.data(), watched.size(), -1);
    if (watched[1].revents) clearWakeup(wakeup_.number());
    send();
    {
        std::lock_guard lock(mutex_);
        if (isStopping_) return false;
    }
    return !watched[0].revents || receive();
}

void ServiceConnection::send() {
    std::lock_guard lock(mutex_);
    while (!outgoing_.empty()) {
        ssize_t sent = ::send(process_.socket(), outgoing_.data(), outgoing_.size(), MSG_NOSIGNAL);
        if (sent < 0 && errno == EINTR) continue;
        if (sent < 0) return;  // full, or closed: then receiving tells why
        outgoing_.erase(0, static_cast<std::size_t>(sent));
    }
}

bool ServiceConnection::receive() {
    std::array<char, 65536> buffer;
    ssize_t got = ::recv(process_.socket(), buffer.data(), buffer.size(), 0);
    if (got < 0 && (errno == EAGAIN || errno == EINTR)) return true;
    if (got <= 0) {
        giveUp(endOfService());
        return false;
    }
    incoming_.append(buffer.data(), static_cast<std::size_t>(got));
    return takeLines();
}

Error ServiceConnection::endOfService() {
    constexpr milliseconds untilEnded(1000);
    std::optional<std::string> how = process_.waitForEnd(untilEnded);
    return {kUnavailable,
            how ? "wifi-profile-service ended (" + *how + ")" : "wifi-profile-service closed the connection"};
}

bool ServiceConnection::takeLines() {
    std::size_t begin = 0;
    for (;;) {
        std::size_t end = incoming_.find('\n', std::max(begin, searched_));
        if (end == std::string::npos) break;
        if (!takeMessage(std::string_view(incoming_).substr(begin, end - begin))) return false;
        begin = end + 1;
    }
    incoming_.erase(0, begin);
    searched_ = incoming_.size();
    if (incoming_.size() <= kLongestLine) return true;
    giveUp({kMalformed,
            "wifi-profile-service sent a line longer than " + std::to_string(kLongestLine) + " bytes"});
    return false;
}

bool ServiceConnection::takeMessage(std::string_view line) {
    WireMessage message = readMessage(line);
    if (auto* answer = std::get_if<WireAnswer>(&message)) return takeAnswer(std::move(*answer));
    if (auto* event = std::get_if<PowerEvent>(&message)) {
        if (handlers_.powerChanged) handlers_.powerChanged(event->power);
    } else if (auto* note = std::get_if<Note>(&message)) {
        if (handlers_.note) handlers_.note(note->text);
    } else {
        giveUp({kMalformed,
                "wifi-profile-service sent what is no message: " + std::get<Refusal>(message).text()});
        return false;
    }
    return true;
}

bool ServiceConnection::takeAnswer(WireAnswer answer) {
    PendingPointer pending;
    bool isKnown = false;
    {
        std::lock_guard lock(mutex_);
        isKnown = answer.id >= 1 && answer.id <= lastID_;  // an earlier one was cancelled meanwhile
        auto found = pending_.find(answer.id);
        if (found != pending_.end()) {
            pending = found->second;
            pending_.erase(found);
        }
    }
    if (!isKnown) {
        giveUp({kMalformed,
                "wifi-profile-service answered a request that was never made: " + std::to_string(answer.id)});
        return false;
    }
    if (!pending) return true;
    if (pending->arrived) pending->arrived(answer);
    {
        std::lock_guard lock(mutex_);
        if (!pending->outcome) pending->outcome = std::move(answer);
    }
    answered_.notify_all();
    return true;
}

}  // namespace wp
