#include "linux/probe/web_client.h"

#include <algorithm>
#include <array>
#include <ctime>
#include <memory>

#include "linux/probe/connect_race.h"
#include "linux/probe/http_answer.h"
#include "linux/probe/ip_socket.h"
#include "linux/probe/web_place.h"
#include "linux/probe/web_stream.h"
#include "linux/wait_any.h"
#include "service/plain_text.h"

namespace wp {
namespace {

/// The one status whose body is read.
constexpr int kWithBody = 200;
/// How many steps, each with up to 4 KiB, an exchange takes at a stretch.
constexpr int kMostTurns = 32;

double millisecondsBetween(Clock::time_point from, Clock::time_point to) {
    return std::chrono::duration<double, std::milli>(to - from).count();
}

/// The request as it goes over the wire. A server that closes the connection leaves no doubt where its answer ends.
std::string textOf(const WebRequest& request, const WebPlace& place) {
    std::string text = (request.post ? "POST " : "GET ") + place.path +
                       " HTTP/1.1\r\nHost: " + place.authority() +
                       "\r\nUser-Agent: wifi-profile\r\nConnection: close\r\n";
    const auto isAccept = [](const std::string& each) { return each.starts_with("Accept:"); };
    if (std::ranges::none_of(request.headers, isAccept)) text += "Accept: */*\r\n";
    for (const std::string& header : request.headers) text += header + "\r\n";
    if (request.post) text += "Content-Length: " + std::to_string(request.post->size()) + "\r\n";
    return text + "\r\n" + request.post.value_or("");
}

/// The addresses that are tried: what the URL holds itself, else what came with the request. No name is looked up
/// here, since that would go over any interface.
std::vector<IPAddress> addressesOf(const WebRequest& request, const WebPlace& place) {
    if (const auto address = IPAddress::fromText(place.host)) return {*address};
    return request.addresses;
}

/// Where a redirect leads, as far as it leads to the web at all.
std::string targetOf(const std::string& url, std::string_view location) {
    const std::string whole = resolveReference(url, location);
    return webPlace(whole) ? plainText(whole, kLongestUrl) : std::string();
}

/// One request under way.
class Exchange {
  public:
    Exchange(const WebRequest& request, const WebPlace& place)
        : request_(request),
          place_(place),
          text_(textOf(request, place)),
          unsent_(text_),
          race_(addressesOf(request, place), place.port, request.interfaceName),
          read_(request.longestBody),
          began_(Clock::now()) {}
    Exchange(const Exchange&) = delete;

    /// Goes on without waiting, but not for ever: others, the deadline and the stop signal have their turns too.
    void advance() {
        goesOn_ = true;
        for (int i = 0; i < kMostTurns && goesOn_ && step_ != Step::ended; ++i) goesOn_ = turn();
    }
    /// Ends before its time; at the deadline with what has come by then.
    void giveUp(bool isDeadline) {
        if (!isDeadline)
            fail("not waited for any longer");
        else if (step_ == Step::connecting)
            fail("no connection in time");
        else if (step_ == Step::securing)
            fail("no secure connection in time");
        else
            conclude("no answer in time");
    }
    bool ended() const { return step_ == Step::ended; }
    const WebAnswer& answer() const { return answer_; }

    /// What to wait for before it is worth advancing again.
    void addWaits(std::vector<pollfd>& waits, Clock::time_point& wake) const {
        if (goesOn_) wake = {};
        if (step_ == Step::connecting)
            race_.addWaits(waits, wake);
        else if (stream_)
            waits.push_back({stream_->descriptor(), events_, 0});
    }

  private:
    enum class Step { connecting, securing, sending, receiving, ended };

    /// One turn of the present step; whether the next is worth trying at once.
    bool turn() {
        switch (step_) {
            case Step::connecting:
                return connect();
            case Step::securing:
                return secure();
            case Step::sending:
                return send();
            case Step::receiving:
                return receive();
            case Step::ended:
                break;
        }
        return false;
    }

    bool connect() {
        race_.advance(Clock::now());
        if (race_.failed()) return fail(race_.why());
        if (!race_.connected()) return false;
        stream_ = std::make_unique<WebStream>(race_.take());
        answer_.server = race_.address();
        reached_ = Clock::now();
        answer_.steps.connect = millisecondsBetween(began_, reached_);
        step_ = Step::securing;
        return true;
    }

    bool secure() {
        if (place_.secure) {
            const StreamStep step = stream_->secure(place_.host, request_.authorities);
            if (step != StreamStep::done) return waits(step);
            answer_.steps.secure = millisecondsBetween(reached_, Clock::now());
        }
        if (request_.connectOnly) return end(WebAnswer::End::answered);
        asked_ = Clock::now();
        step_ = Step::sending;
        return true;
    }

    bool send() {
        const StreamStep step = stream_->write(unsent_);
        // A server may answer, and close, before it has read all.
        if (step == StreamStep::failed)
            unsent_ = {};
        else if (step != StreamStep::done)
            return waits(step);
        if (unsent_.empty()) step_ = Step::receiving;
        return true;
    }

    bool receive() {
        std::array<char, 4096> buffer;
        std::size_t size = 0;
        const StreamStep step = stream_->read(buffer, size);
        if (step == StreamStep::needsRead || step == StreamStep::needsWrite) return waits(step);
        if (step == StreamStep::done && !answer_.steps.firstByte)
            answer_.steps.firstByte = millisecondsBetween(asked_, Clock::now());
        if (step == StreamStep::done)
            read_.take({buffer.data(), size});
        else if (step == StreamStep::closed)
            read_.close();
        else
            read_.breakOff();
        if (!read_.ended() && (!read_.hasHead() || read_.status() == kWithBody)) return true;
        return conclude(step == StreamStep::failed   ? stream_->why()
                        : step == StreamStep::closed ? "the connection was closed before the answer's end"
                                                     : "the answer is none of HTTP/1");
    }

    /// A body that is too long, or breaks off, comes after an answer all the same. \param missing why there is no
    /// answer, or no more of it, if that is so
    bool conclude(const std::string& missing) {
        if (!read_.hasHead()) return fail(missing);
        answer_.status = read_.status();
        if (answer_.status == kWithBody && !read_.isWhole()) {
            answer_.bodyCame = read_.ended() ? WebAnswer::Body::cutOff : WebAnswer::Body::late;
            answer_.why = missing;
        }
        answer_.body = read_.body();
        const bool redirects = answer_.status >= 300 && answer_.status <= 399;
        const std::string_view location = read_.header("Location");
        if (redirects && !location.empty()) answer_.location = targetOf(request_.url, location);
        if (const auto date = httpDate(read_.header("Date")))
            answer_.clockOffset = std::int64_t{std::time(nullptr)} - *date;
        return end(WebAnswer::End::answered);
    }

    /// What a step on the stream that is not `done` leads to.
    bool waits(StreamStep step) {
        events_ = step == StreamStep::needsWrite ? POLLOUT : POLLIN;
        if (step == StreamStep::needsRead || step == StreamStep::needsWrite) return false;
        if (step == StreamStep::closed) return fail("the connection was closed");
        answer_.fault = stream_->fault();
        answer_.why = stream_->why();
        if (stream_->lacksAuthorities()) return end(WebAnswer::End::noAuthorities);
        const bool isJudged = answer_.fault != CertificateFault::none;
        return end(isJudged ? WebAnswer::End::badCertificate : WebAnswer::End::failed);
    }

    bool fail(const std::string& why) {
        answer_.why = why;
        return end(WebAnswer::End::failed);
    }

    bool end(WebAnswer::End how) {
        answer_.end = how;
        stream_.reset();
        step_ = Step::ended;
        return false;
    }

    const WebRequest& request_;
    const WebPlace place_;
    const std::string text_;
    std::string_view unsent_;
    ConnectRace race_;
    std::unique_ptr<WebStream> stream_;
    HttpAnswer read_;
    WebAnswer answer_;
    Step step_ = Step::connecting;
    bool goesOn_ = false;
    short events_ = POLLIN;
    Clock::time_point began_, reached_{}, asked_{};
};

using Exchanges = std::vector<std::unique_ptr<Exchange>>;
using Answers = std::vector<std::optional<WebAnswer>>;

/// Takes in what has ended; whether anything has.
bool collect(const Exchanges& exchanges, Answers& answers) {
    bool any = false;
    for (std::size_t i = 0; i < exchanges.size(); ++i) {
        if (answers[i] || !exchanges[i]->ended()) continue;
        answers[i] = exchanges[i]->answer();
        any = true;
    }
    return any;
}

/// Turns all until they are answered, what there is suffices, or time is over.
Wait turnAll(const Exchanges& exchanges, Answers& answers, const Until& until, const Conclusive& conclusive) {
    while (true) {
        for (std::size_t i = 0; i < exchanges.size(); ++i)
            if (!answers[i]) exchanges[i]->advance();
        if (collect(exchanges, answers) && conclusive && conclusive(answers)) return Wait::ready;
        if (std::ranges::all_of(answers, [](const auto& each) { return each.has_value(); }))
            return Wait::ready;
        // A server that never pauses would otherwise keep us beyond the deadline.
        if (Clock::now() >= until.deadline) return Wait::timeout;
        Until next = until;
        std::vector<pollfd> waits;
        for (std::size_t i = 0; i < exchanges.size(); ++i)
            if (!answers[i]) exchanges[i]->addWaits(waits, next.deadline);
        if (waitAny(waits, next) == Wait::stopped) return Wait::stopped;
    }
}

WebAnswer failed(std::string why) {
    WebAnswer answer;
    answer.why = std::move(why);
    return answer;
}

}  // namespace

Known<std::vector<WebAnswer>> runWebRequests(const std::vector<WebRequest>& requests, const Until& until,
                                             const Conclusive& conclusive) {
    Exchanges exchanges;
    Answers answers;
    for (const WebRequest& request : requests) {
        const auto place = webPlace(request.url);
        exchanges.push_back(place ? std::make_unique<Exchange>(request, *place) : nullptr);
        answers.push_back(std::nullopt);
        if (!place)
            answers.back() = failed("its URL is none of http or https");
        else if (const auto refusal = refusalOf(request.interfaceName))
            return *refusal;
        else if (addressesOf(request, *place).empty())
            answers.back() = failed(request.whyNoAddress);
    }
    const Wait wait = turnAll(exchanges, answers, until, conclusive);
    if (wait == Wait::stopped) return waitFailure(wait, "the web");
    for (std::size_t i = 0; i < exchanges.size(); ++i)
        if (!answers[i]) exchanges[i]->giveUp(wait == Wait::timeout);
    collect(exchanges, answers);
    std::vector<WebAnswer> all;
    for (auto& answer : answers) all.push_back(std::move(*answer));
    return all;
}

}  // namespace wp
