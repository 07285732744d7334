#include "linux/session.h"

#include <poll.h>

#include <cmath>
#include <filesystem>

#include "linux/dbus/network_manager.h"
#include "platform/records.h"

namespace wp {
namespace {

constexpr std::chrono::seconds kLookAround{3};

std::optional<double> numberIn(const Value& value) {
    if (const auto* number = value.as<double>()) return *number;
    if (const auto* number = value.as<std::int64_t>()) return static_cast<double>(*number);
    if (const auto* number = value.as<std::uint64_t>()) return static_cast<double>(*number);
    return std::nullopt;
}

Known<std::chrono::milliseconds> oldestScanIn(const DictionaryPointer& configuration) {
    constexpr double kMost = 1e9;
    const std::optional<Value> value = configuration ? configuration->value("MaxScanCacheAge") : std::nullopt;
    if (!value || value->isNull()) return std::chrono::milliseconds(0);
    const std::optional<double> seconds = numberIn(*value);
    if (!seconds || !(*seconds >= 0 && *seconds <= kMost)) {
        return failure(Reason::badConfiguration, "MaxScanCacheAge: must be a number of seconds from 0");
    }
    return std::chrono::milliseconds(static_cast<std::int64_t>(*seconds * 1000));
}

/// The name asked about; an empty one stands for the joined network.
Known<std::optional<NetworkName>> nameIn(const DictionaryPointer& configuration) {
    const std::optional<Value> value = configuration ? configuration->value("NetworkName") : std::nullopt;
    if (!value || value->isNull()) return std::optional<NetworkName>();
    const auto* text = value->as<std::string>();
    if (text == nullptr) return failure(Reason::badConfiguration, "NetworkName: must be a text");
    const std::optional<NetworkName> name = nameFromText(*text);
    if (!name) return failure(Reason::badConfiguration, "NetworkName: a network's name has at most 32 bytes");
    if (name->absent()) return failure(Reason::badConfiguration, "NetworkName: must not be empty");
    if (optsOutOfTests(*name)) {
        return failure(Reason::badConfiguration, "NetworkName: the name asks not to be looked at (_nomap)");
    }
    return std::optional(*name);
}

bool hasRadio() {
    std::error_code error;
    return std::filesystem::directory_iterator("/sys/class/ieee80211", error) !=
           std::filesystem::directory_iterator();
}

bool isSameConnection(const Known<Link>& before, const Known<Link>& now) {
    return before && now && before->joined && now->joined && before->interfaceIndex == now->interfaceIndex &&
           before->master == now->master && before->joined->peer() == now->joined->peer();
}

/// It is the one reason of this kind that a link has.
bool asksNotToBeLookedAt(const Known<Link>& link) {
    return !link && link.error().code == static_cast<int>(Reason::badConfiguration);
}

/// The reason of whoever was asked first, with the other's.
Error refusedBoth(Error denied, const Error& byManager) {
    denied.message += ", and " + byManager.message;
    return denied;
}

}  // namespace

Known<PhaseTopic> topicOf(const NumberedTest& test, const DictionaryPointer& configuration) {
    PhaseTopic topic;
    topic.subject = test.subject == Subject::joined ? Subject::network : test.subject;
    const Known<std::chrono::milliseconds> oldest = oldestScanIn(configuration);
    if (!oldest) return oldest.error();
    if (test.subject != Subject::scan) topic.oldestScan = *oldest;
    if (test.subject != Subject::network) return topic;
    const Known<std::optional<NetworkName>> name = nameIn(configuration);
    if (!name) return name.error();
    topic.named = *name;
    return topic;
}

Session::Session(LineSocket& wire, Sources& sources, PowerSwitch& power)
    : wire_(wire), sources_(sources), power_(power), stop_(std::make_shared<StopSignal>()), workers_(inbox_) {
    sources_.notes.setTeller([this](const std::string& text) { inbox_.post([this, text] { note(text); }); });
}

Session::~Session() {
    stop_->raise();
}

void Session::note(const std::string& text) {
    wire_.send(noteLine(text));
}

void Session::run() {
    for (;;) {
        pollfd entries[] = {{wire_.descriptor(), POLLIN, 0},
                            {inbox_.descriptor(), POLLIN, 0},
                            {power_.descriptor(), POLLIN, 0}};
        if (poll(entries, std::size(entries), -1) < 0) continue;
        if (entries[2].revents != 0) reportPower();
        if (entries[1].revents != 0) inbox_.run();
        if (entries[0].revents == 0) continue;
        if (!wire_.receive()) return;
        while (const std::optional<std::string> line = wire_.nextLine()) handle(*line);
    }
}

void Session::handle(const std::string& line) {
    const std::variant<WireRequest, Refusal> read = readRequest(line);
    const auto* request = std::get_if<WireRequest>(&read);
    if (request == nullptr) return note("a request was not understood: " + std::get<Refusal>(read).text());
    switch (request->kind) {
        case WireRequest::Kind::test:
            return handleTest(*request);
        case WireRequest::Kind::status:
            return handleStatus(request->id);
        case WireRequest::Kind::wifi:
            return handleDescription(request->id);
        case WireRequest::Kind::setPower:
            return handleSetPower(*request);
        case WireRequest::Kind::cancel:
            return cancel();
    }
}

void Session::handleTest(const WireRequest& request) {
    const NumberedTest* const test = findTest(request.test);
    if (test == nullptr) {
        return answerTest(request.id, answerOf(failure(Reason::badConfiguration,
                                                       "no test " + std::to_string(request.test))));
    }
    const Known<PhaseTopic> topic = topicOf(*test, request.configuration);
    if (!topic) return answerTest(request.id, answerOf(topic.error()));
    const std::shared_ptr<Phase> phase = phaseFor(*topic);
    const bool isHeld = phase == ahead_ && topic->subject != Subject::device;
    waiting_[request.id] = WaitingTest{test, phase, isHeld};
    if (isHeld) lookAgain(phase);
    answerReadyTests();
}

/// A phase is a row of requests with the same configuration; each request for the list of networks begins one of
/// its own, because it wants a new scan. From the device a run goes on to the network of which it was told: both are one
/// phase, whose slowest facts are begun with the device's.
std::shared_ptr<Phase> Session::phaseFor(PhaseTopic topic) {
    const bool isAhead = topic.subject == Subject::device && toldOfNetwork_;
    if (isAhead) topic.subject = Subject::network;
    // A scan for the list may have come in between.
    if (ahead_ && ahead_->topic() == topic) return phase_ = ahead_;
    if (!phase_ || phase_->topic() != topic || topic.subject == Subject::scan) {
        phase_ = begun(topic);
        if (isAhead) ahead_ = phase_;
    }
    return phase_;
}

std::shared_ptr<Phase> Session::begun(const PhaseTopic& topic) {
    auto phase = std::make_shared<Phase>(topic, sources_, workers_, stop_, [this] { answerReadyTests(); });
    phase->begin();
    return phase;
}

/// What was begun ahead holds as long as the device has stayed where it was.
void Session::lookAgain(const std::shared_ptr<Phase>& phase) {
    workers_.start([this, phase, stop = stop_]() -> Workers::Publication {
        const Until until{stop, Clock::now() + kLookAround};
        return [this, phase, stop, link = gatherLink(sources_.interfaceName, until)] {
            if (!stop->raised()) release(phase, link);
        };
    });
}

void Session::release(const std::shared_ptr<Phase>& phase, const Known<Link>& link) {
    if (ahead_ == phase) ahead_.reset();
    std::shared_ptr<Phase> valid;
    for (auto& [id, waiting] : waiting_) {
        auto* const test = std::get_if<WaitingTest>(&waiting);
        if (test == nullptr || test->phase != phase || !std::exchange(test->isHeld, false)) continue;
        if (!valid) valid = isSameConnection(phase->facts().link, link) ? phase : begun(phase->topic());
        test->phase = valid;
    }
    if (valid && phase_ == phase) phase_ = valid;
    answerReadyTests();
}

/// That the network asks not to be looked at is no answer about the device itself, whose phase then is one of its own.
bool Session::becomesReady(WaitingTest& waiting) {
    if (waiting.isHeld || !waiting.phase->isReady(*waiting.test)) return false;
    PhaseTopic topic = waiting.phase->topic();
    if (waiting.test->subject != Subject::device || !topic.isJoined() ||
        !asksNotToBeLookedAt(waiting.phase->facts().link))
        return true;
    topic.subject = Subject::device;
    toldOfNetwork_ = false;
    ahead_.reset();
    waiting.phase = phaseFor(topic);
    return waiting.phase->isReady(*waiting.test);
}

void Session::answerReadyTests() {
    for (auto each = waiting_.begin(); each != waiting_.end();) {
        auto* const waiting = std::get_if<WaitingTest>(&each->second);
        if (waiting == nullptr || !becomesReady(*waiting)) {
            ++each;
            continue;
        }
        answerTest(each->first, answerOf(*waiting->test, waiting->phase->facts()));
        each = waiting_.erase(each);
    }
}

void Session::answerTest(std::uint64_t id, const DiagnosticsTestResponse& response) {
    wire_.send(testAnswerLine(id, response));
}

bool Session::take(std::uint64_t id) {
    return waiting_.erase(id) > 0;
}

void Session::handleStatus(std::uint64_t id) {
    waiting_[id] = WaitingStatus{};
    workers_.start([this, id, stop = stop_]() -> Workers::Publication {
        const Until until{stop, Clock::now() + kLookAround};
        return [this, id, stop, link = gatherLink(sources_.interfaceName, until)] {
            if (!stop->raised()) finishStatus(id, link);
        };
    });
}

void Session::finishStatus(std::uint64_t id, const Known<Link>& link) {
    if (!take(id)) return;
    toldOfNetwork_ =
        link && link->joined && !link->joined->says.name.absent() && !optsOutOfTests(link->joined->says.name);
    DiagnosticsStatusResponse response;
    if (!link) {
        response.error = link.error();
    } else {
        auto status = std::make_shared<WiFiStatus>();
        if (link->joined) {
            if (!link->joined->says.name.absent()) status->ssid = textFromName(link->joined->says.name);
            status->bssid = textOf(link->joined->address);
        }
        response.status = std::move(status);
    }
    wire_.send(statusAnswerLine(id, response));
}

void Session::handleDescription(std::uint64_t id) {
    waiting_[id] = WaitingDescription{};
    workers_.start([this, id, stop = stop_]() -> Workers::Publication {
        const Until until{stop, Clock::now() + kLookAround};
        return [this, id, stop, interfaces = gatherStationInterfaces(until)] {
            if (!stop->raised()) finishDescription(id, interfaces);
        };
    });
}

void Session::finishDescription(std::uint64_t id, const Known<std::vector<RadioInterface>>& interfaces) {
    if (!take(id)) return;
    WiFiDescription wifi;
    wifi.radio = hasRadio();
    wifi.client = bool(interfaces);
    wifi.devices.clear();
    wifi.power = false;
    if (interfaces) {
        for (const RadioInterface& each : *interfaces) {
            if (sources_.interfaceName && *sources_.interfaceName != each.name) continue;
            if (wifi.devices.empty()) describedRadio_ = each.radio;
            wifi.devices.push_back(each.name);
        }
    }
    if (!wifi.devices.empty()) wifi.power = toldPower_ = power_.isOn(*describedRadio_);
    WiFiResponse response;
    response.wifi = std::move(wifi);
    wire_.send(wifiAnswerLine(id, response));
}

void Session::handleSetPower(const WireRequest& request) {
    const std::optional<Error> error = power_.set(request.power);
    if (!error || error->code != static_cast<int>(Reason::notPermitted))
        return answerSetPower(request, error);
    // NetworkManager lets whoever sits at the device do it.
    workers_.start([this, request, denied = *error, stop = stop_]() -> Workers::Publication {
        Known<Bus> bus = Bus::system();
        const Until until{stop, Clock::now() + kLookAround};
        const Known<bool> done = bus ? setNetworkManagerPower(*bus, request.power, until) : bus.error();
        std::optional<Error> left;
        if (!done) left = bus ? refusedBoth(denied, done.error()) : denied;
        return [this, request, left] { answerSetPower(request, left); };
    });
}

void Session::answerSetPower(const WireRequest& request, std::optional<Error> error) {
    // The kernel tells at once what no wish can change; what it was wished for counts when the switch is moved.
    if (!error && request.power && power_.isHeldOff(describedRadio_))
        error = failure(Reason::unavailable, "a switch on the device itself keeps it off");
    wire_.send(setPowerAnswerLine(request.id, error));
}

void Session::reportPower() {
    power_.update();
    if (!describedRadio_) return;
    const bool power = power_.isOn(*describedRadio_);
    if (std::exchange(toldPower_, power) != power) wire_.send(powerEventLine(power));
}

void Session::cancel() {
    // What is still being gathered ends soon by itself; nobody waits for it any more.
    stop_->raise();
    stop_ = std::make_shared<StopSignal>();
    phase_.reset();
    ahead_.reset();
    for (const auto& [id, waiting] : std::exchange(waiting_, {})) answerCancelled(id, waiting);
}

void Session::answerCancelled(std::uint64_t id, const Waiting& waiting) {
    if (std::holds_alternative<WaitingTest>(waiting)) return answerTest(id, answerOf(cancelledError()));
    if (std::holds_alternative<WaitingStatus>(waiting)) {
        wire_.send(statusAnswerLine(id, DiagnosticsStatusResponse{nullptr, cancelledError()}));
    } else {
        wire_.send(wifiAnswerLine(id, WiFiResponse{std::nullopt, cancelledError()}));
    }
}

}  // namespace wp
