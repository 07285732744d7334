#include "linux/probe/web_client.h"

#include <algorithm>
#include <array>
#include <ctime>
#include <memory>

#include "linux/probe/connect_race.h"
#include "linux/probe/http_answer.h"
#include "linux/probe/web_place.h"
#include "linux/probe/web_stream.h"
#include "linux/wait_any.h"
#include "service/plain_text.h"

namespace wp {
namespace {

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

    /// Goes on as far as possible without waiting.
    void advance() {
        while (step_ != Step::ended && turn()) {
        }
    }
    bool ended() const { return step_ == Step::ended; }
    const WebAnswer& answer() const { return answer_; }

    /// What to wait for before it is worth advancing again.
    void addWaits(std::vector<pollfd>& waits, Clock::time_point& wake) const {
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
        else
            read_.close();
        return read_.ended() ? finish(step) : true;
    }

    /// A body that is too long, or breaks off, comes after an answer all the same.
    bool finish(StreamStep last) {
        if (!read_.hasHead()) {
            if (last == StreamStep::failed) return fail(stream_->why());
            return fail(last == StreamStep::closed ? "the connection was closed before an answer"
                                                   : "the answer is none of HTTP/1");
        }
        answer_.status = read_.status();
        answer_.body = read_.body();
        const bool redirects = answer_.status >= 300 && answer_.status <= 399;
        const std::string_view location = read_.header("Location");
        if (redirects && !location.empty())
            answer_.location = plainText(resolveReference(request_.url, location), kLongestUrl);
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
        if (answer_.fault == CertificateFault::none) return fail(stream_->why());
        answer_.why = stream_->why();
        return end(WebAnswer::End::badCertificate);
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
    short events_ = POLLIN;
    Clock::time_point began_, reached_{}, asked_{};
};

using Exchanges = std::vector<std::unique_ptr<Exchange>>;
using Answers = std::vector<std::optional<WebAnswer>>;

/// Advances all and takes in what has ended; whether anything has.
bool collect(const Exchanges& exchanges, Answers& answers) {
    bool any = false;
    for (std::size_t i = 0; i < exchanges.size(); ++i) {
        if (answers[i]) continue;
        exchanges[i]->advance();
        if (!exchanges[i]->ended()) continue;
        answers[i] = exchanges[i]->answer();
        any = true;
    }
    return any;
}

/// Turns all until they are answered, what there is suffices, or time is over.
Wait turnAll(const Exchanges& exchanges, Answers& answers, const Until& until, const Conclusive& conclusive) {
    while (true) {
        if (collect(exchanges, answers) && conclusive && conclusive(answers)) return Wait::ready;
        if (std::ranges::all_of(answers, [](const auto& each) { return each.has_value(); }))
            return Wait::ready;
        Until next = until;
        std::vector<pollfd> waits;
        for (std::size_t i = 0; i < exchanges.size(); ++i)
            if (!answers[i]) exchanges[i]->addWaits(waits, next.deadline);
        const Wait wait = waitAny(waits, next);
        if (wait == Wait::stopped) return wait;
        if (wait == Wait::timeout && Clock::now() >= until.deadline) return wait;
    }
}

WebAnswer failed(const char* why) {
    WebAnswer answer;
    answer.why = why;
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
        else if (addressesOf(request, *place).empty())
            answers.back() = failed("the name of its host has no address");
    }
    const Wait wait = turnAll(exchanges, answers, until, conclusive);
    if (wait == Wait::stopped) return waitFailure(wait, "the web");
    std::vector<WebAnswer> all;
    for (auto& answer : answers) {
        const char* why = wait == Wait::ready ? "not waited for any longer" : "no answer in time";
        all.push_back(answer ? std::move(*answer) : failed(why));
    }
    return all;
}

}  // namespace wp
