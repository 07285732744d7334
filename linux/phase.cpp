#include "linux/phase.h"

#include <algorithm>

#include "linux/fact_table.h"

namespace wp {

namespace {

bool isAboutLink(Fact fact) {
    switch (fact) {
        case Fact::station:
        case Fact::gatewayEcho:
        case Fact::setup:
        case Fact::outsideEcho:
        case Fact::nameAnswer:
        case Fact::portal:
        case Fact::vendorService:
        case Fact::router:
        case Fact::translation:
            return true;
        default:
            return false;
    }
}

}  // namespace

Phase::Phase(PhaseTopic topic, Sources& sources, Workers& workers, std::shared_ptr<const StopSignal> stop,
             std::function<void()> onProgress)
    : topic_(std::move(topic)),
      sources_(sources),
      workers_(workers),
      stop_(std::move(stop)),
      onProgress_(std::move(onProgress)) {
    facts_.named = topic_.named;
    facts_.settings = sources_.config.settings();
}

std::optional<Fact> Phase::resolved(Fact fact) const {
    if (fact == Fact::judged) return topic_.named ? Fact::nearby : Fact::link;
    // The link says nothing about a network that is not joined.
    if (topic_.named && isAboutLink(fact)) return std::nullopt;
    return fact;
}

void Phase::want(Fact fact) {
    const std::optional<Fact> meant = resolved(fact);
    if (!meant || state(*meant) != State::idle) return;
    state(*meant) = State::wanted;
    for (const Fact need : rowOf(*meant).needs) want(need);
}

void Phase::prepare(const NumberedTest& test) {
    for (const Fact fact : test.needs) want(fact);
    const bool aboutNetwork = test.subject == Subject::network || test.subject == Subject::joined;
    for (const NumberedTest& other : numberedTests()) {
        // The device's own tests come in a row too, and none of their facts is about a network.
        if (test.subject == Subject::device && other.subject == Subject::device) {
            for (const Fact fact : other.needs) want(fact);
        }
        if (!aboutNetwork || other.subject == Subject::device || other.subject == Subject::scan) continue;
        if (other.subject == Subject::joined && topic_.named) continue;
        for (const Fact fact : other.needs) want(fact);
    }
    launchWhatCan();
}

bool Phase::isReady(const NumberedTest& test) const {
    return std::ranges::all_of(test.needs, [&](Fact fact) {
        const std::optional<Fact> meant = resolved(fact);
        return !meant || state(*meant) == State::done;
    });
}

void Phase::launchWhatCan() {
    for (std::size_t i = 0; i < states_.size(); ++i) {
        const Fact fact = static_cast<Fact>(i);
        if (state(fact) != State::wanted) continue;
        const FactRow& row = rowOf(fact);
        const auto isDone = [&](Fact other) { return state(other) == State::done; };
        const auto isOver = [&](Fact other) {
            const State of = state(other);
            return of == State::done || of == State::idle || of == State::yielding;
        };
        if (std::ranges::all_of(row.needs, isDone) && std::ranges::all_of(row.after, isOver)) launch(fact);
    }
}

void Phase::yield(Fact fact) {
    if (state(fact) != State::running) return;
    state(fact) = State::yielding;
    launchWhatCan();
}

void Phase::trace(const char* fact, Clock::time_point begin) const {
    const auto since = [](Clock::time_point from, Clock::time_point to) {
        return std::to_string(std::chrono::duration_cast<std::chrono::milliseconds>(to - from).count());
    };
    const char* const kind = topic_.subject == Subject::device ? "device" : topic_.named ? "named" : "joined";
    sources_.notes.once(std::string("trace: ") + kind + " " + fact + " began at " +
                        since(traceStart_, begin) + " ms, took " + since(begin, Clock::now()) + " ms");
}

void Phase::launch(Fact fact) {
    state(fact) = State::running;
    const FactRow& row = rowOf(fact);
    workers_.start([self = shared_from_this(), &row]() -> Workers::Publication {
        const Clock::time_point begin = Clock::now();
        const Until until{self->stop_, begin + row.most};
        const auto yield = [self, &row] { self->workers_.post([self, &row] { self->yield(row.fact); }); };
        Store store = row.gather(
            {self->facts_, self->topic_, self->startedAt_, self->sources_, until, row.loss, yield});
        if (self->sources_.traced) self->trace(row.name, begin);
        return [self, &row, store = std::move(store)] {
            store(self->facts_);
            self->state(row.fact) = State::done;
            self->launchWhatCan();
            self->onProgress_();
        };
    });
}

}  // namespace wp
