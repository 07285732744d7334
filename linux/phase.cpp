#include "linux/phase.h"

#include <algorithm>

#include "linux/fact_table.h"

namespace wp {

namespace {

// What the network answers within a second is timed, and nothing better is known of a network that takes longer. Where it
// is asked late because the device's own set-up was slow to tell, what answers at all answers in half a second.
constexpr std::chrono::milliseconds kAtFirst{1000};
constexpr std::chrono::milliseconds kExchange{500};

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
    : topic_(topic),
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
    if (rowOf(*meant).home == HomeUse::needed)
        stay(*meant) = std::make_shared<HomeChannel::Stay>(sources_.home);
    else if (rowOf(*meant).home == HomeUse::neededAtFirst)
        stay(*meant) = std::make_shared<HomeChannel::Stay>(sources_.home, kAtFirst);
    for (const Fact need : rowOf(*meant).needs) want(need);
}

bool Phase::isAbout(const NumberedTest& test) const {
    if (topic_.isJoined()) return test.subject != Subject::scan;
    return test.subject == topic_.subject;
}

void Phase::begin() {
    for (const NumberedTest& test : numberedTests()) {
        if (!isAbout(test)) continue;
        for (const Fact fact : test.needs) want(fact);
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
    for (const FactRow& row : factRows()) {
        if (state(row.fact) != State::wanted) continue;
        const auto isDone = [&](Fact other) { return state(other) == State::done; };
        const auto isOver = [&](Fact other) { return isDone(other) || state(other) == State::idle; };
        if (std::ranges::all_of(row.needs, isDone) && std::ranges::all_of(row.after, isOver)) launch(row);
    }
}

void Phase::trace(const FactRow& row, Clock::time_point begin, Clock::duration waited) const {
    const auto inMilliseconds = [](Clock::duration time) {
        return std::to_string(std::chrono::duration_cast<std::chrono::milliseconds>(time).count()) + " ms";
    };
    const char* const kind = topic_.subject == Subject::device ? "device" : topic_.named ? "named" : "joined";
    std::string text = std::string("trace: ") + kind + " " + row.name + " began at " +
                       inMilliseconds(begin - traceStart_) + ", took " + inMilliseconds(Clock::now() - begin);
    if (row.home == HomeUse::left) text += ", waited " + inMilliseconds(waited) + " of it for the channel";
    sources_.notes.once(text);
}

void Phase::launch(const FactRow& row) {
    state(row.fact) = State::running;
    workers_.start([self = shared_from_this(), &row,
                    stay = std::move(stay(row.fact))]() mutable -> Workers::Publication {
        const Clock::time_point begin = Clock::now();
        const Clock::duration waited = self->sources_.home.timeWaited();
        const Until until{self->stop_, begin + row.most};
        if (row.home == HomeUse::neededAtFirst) {
            stay->prolong(kExchange);
            stay->begin(until.within(kExchange));
        }
        Store store = row.gather(
            {self->facts_, self->topic_, self->startedAt_, self->sources_, until, row.loss, stay.get()});
        stay.reset();
        if (self->sources_.traced) self->trace(row, begin, self->sources_.home.timeWaited() - waited);
        return [self, &row, store = std::move(store)] {
            store(self->facts_);
            self->state(row.fact) = State::done;
            self->launchWhatCan();
            self->onProgress_();
        };
    });
}

}  // namespace wp
