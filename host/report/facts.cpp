#include "host/report/facts.h"

#include "host/report/measured.h"
#include "platform/ui/display_text.h"

namespace wp::host {
namespace {

// Signal to noise in the steps of television boxes; without a noise, the signal that planners aim at.
constexpr double kFairAboveNoise = 25, kGoodAboveNoise = 40;  // dB
constexpr double kGoodSignal = -67, kExcellentSignal = -55;   // dBm

// Echo times: a desktop system calls an average above 1500 ms a problem; what is above 100 ms is felt.
struct Latency {
    double slow, verySlow;  // ms; above them
};
constexpr Latency kEchoLatency{100, 1500};

// A desktop system's own checks of name servers and of a secure connection.
constexpr Latency kNameLatency{kSlowName.count(), kVerySlowName.count()};
constexpr Latency kServiceLatency{500, 1000};

constexpr int kHighest2GHzChannel = 14, kHighest5GHzChannel = 177;

/// Collects the facts of one part.
class Collector {
  public:
    Collector(const ReportInput& input, Part part, std::vector<ReportedFact>& facts)
        : input_(input),
          texts_(input.texts),
          part_(part),
          section_(sectionOf(input.evidence, part)),
          facts_(facts) {}

    void collect() {
        addKind();
        addSignal();
        if (std::optional<std::string> security = textIn(section_, "security"))
            add("FACT_SECURITY", securityText(*security, texts_));
        addChannel();
        addText("FACT_MODES", "supportedPHYModes");
        addText("FACT_COUNTRY", "adoptedCountryCode");
        addPing("FACT_ROUTER", "pingLANResult");
        addPing("FACT_OUTSIDE", "pingWANResult");
        addTime("FACT_NAMES", 7, {"time"}, kNameLatency);
        addTime("FACT_SERVICE", 9, {"connectTime", "secureTime"}, kServiceLatency);
        // They are those of the surroundings, the same for both networks.
        if (part_ == Part::joined || !wasTested(input_.evidence, Part::joined)) addQuietest();
    }

  private:
    void add(const char* label, std::string value) {
        facts_.push_back({part_, texts_.text(label), std::move(value)});
    }
    void addText(const char* label, const char* key) {
        if (std::optional<std::string> text = textIn(section_, key)) add(label, ui::displayForm(*text));
    }
    /// Properties that are no findings.
    void addKind() {
        for (int testID : {44, 45, 33}) {
            if (!input_.checks.yes(testID, part_)) continue;
            std::string value =
                texts_.text(testKey(testID, "FOUND")) + " " + texts_.text(testKey(testID, "MEANS"));
            add("FACT_KIND", std::move(value));
        }
        addText("FACT_MODEL", "marlixModelName");
    }
    void addSignal();
    void addChannel();
    void addPing(const char* label, const char* key);
    void addTime(const char* label, int testID, std::initializer_list<const char*> keys,
                 const Latency& latency);
    void addQuietest();

    const ReportInput& input_;
    const Texts& texts_;
    Part part_;
    const DictionaryPointer& section_;
    std::vector<ReportedFact>& facts_;
};

const char* latencyWord(double time, const Latency& latency) {
    return time > latency.verySlow ? "LATENCY_VERY_SLOW"
           : time > latency.slow   ? "LATENCY_SLOW"
                                   : "LATENCY_QUICK";
}

const char* signalWord(bool isPoor, double signal, std::optional<double> noise) {
    if (isPoor) return "SIGNAL_WEAK";
    double fair = noise ? kFairAboveNoise : kGoodSignal, good = noise ? kGoodAboveNoise : kExcellentSignal;
    double value = noise ? signal - *noise : signal;
    return value < fair ? "SIGNAL_FAIR" : value < good ? "SIGNAL_GOOD" : "SIGNAL_EXCELLENT";
}

void Collector::addSignal() {
    std::optional<double> signal = numberIn(section_, "RSSI"), noise = numberIn(section_, "noise");
    if (!signal) return;
    bool isPoor = input_.checks.yes(32, part_);
    TextValues values = {{"word", texts_.text(signalWord(isPoor, *signal, noise))},
                         {"value", texts_.number(*signal, 0)}};
    if (noise) values.emplace_back("noise", texts_.number(*noise, 0));
    add("FACT_SIGNAL", texts_.text(noise ? "FACT_SIGNAL_NOISE_VALUE" : "FACT_SIGNAL_VALUE", values));
}

/// The joined network among those that were heard.
DictionaryPointer joinedIn(const DictionaryPointer& details) {
    std::optional<Value> networks = details ? details->value("networks") : std::nullopt;
    const ArrayPointer* heard = networks ? networks->as<ArrayPointer>() : nullptr;
    if (!heard) return nullptr;
    for (const Value& network : **heard) {
        const DictionaryPointer* entry = network.as<DictionaryPointer>();
        if (entry && flagIn(*entry, "joined") == true) return *entry;
    }
    return nullptr;
}

void Collector::addChannel() {
    std::optional<double> channel = numberIn(section_, "currentChannel");
    if (!channel) return;
    const char* band = *channel <= kHighest2GHzChannel ? "BAND_2" : "BAND_5";
    // A channel's number alone does not tell 5 and 6 GHz apart, but where only the latter has one so high.
    if (*channel > kHighest5GHzChannel ||
        textIn(joinedIn(detailsOf(input_.evidence, part_, 24)), "band") == "6GHz")
        band = "BAND_6";
    add("FACT_CHANNEL", texts_.text("FACT_CHANNEL_VALUE",
                                    {{"channel", texts_.number(*channel, 0)}, {"band", texts_.text(band)}}));
}

/// An average in ms; none is said to be nothing.
std::string echoTime(double time, const Texts& texts) {
    constexpr double kShortest = 0.1;
    if (time < kShortest) return "<" + texts.number(kShortest, 1);
    return texts.number(time, time < 10 ? 1 : 0);
}

void Collector::addPing(const char* label, const char* key) {
    DictionaryPointer ping = dictionaryIn(section_, key);
    std::optional<double> time = numberIn(ping, "avg"), loss = numberIn(ping, "packetLoss"),
                          count = numberIn(ping, "count");
    if (!time || !loss || !count || !(*loss >= 0 && *loss <= 1)) return;
    const char* word = latencyWord(*time, kEchoLatency);
    add(label, texts_.text("FACT_PING_VALUE", {{"time", echoTime(*time, texts_)},
                                               {"word", texts_.text(word)},
                                               {"lost", texts_.number(*loss * *count, 0)},
                                               {"count", texts_.number(*count, 0)}}));
}

/// The sum of the times, where all of them were measured and the test succeeded.
void Collector::addTime(const char* label, int testID, std::initializer_list<const char*> keys,
                        const Latency& latency) {
    DictionaryPointer details = detailsOf(input_.evidence, part_, testID);
    double sum = 0;
    for (const char* key : keys) {
        std::optional<double> time = numberIn(details, key);
        if (!time) return;
        sum += *time;
    }
    if (!input_.checks.yes(testID, part_)) return;
    add(label, texts_.text("FACT_TIME_VALUE", {{"time", texts_.number(sum, 0)},
                                               {"word", texts_.text(latencyWord(sum, latency))}}));
}

void Collector::addQuietest() {
    std::string all;
    for (auto [key, text] : {std::pair{"2GHzChannel", "FACT_QUIETEST_2"},
                             {"5GHzChannel", "FACT_QUIETEST_5"},
                             {"5GHzNonDFSChannel", "FACT_QUIETEST_5_NO_RADAR"},
                             {"5GHz40MHzChannel", "FACT_QUIETEST_5_WIDE"}}) {
        std::optional<double> channel = numberIn(section_, key);
        if (!channel) continue;
        all += (all.empty() ? "" : "; ") + texts_.text(text, {{"channel", texts_.number(*channel, 0)}});
    }
    if (!all.empty()) add("FACT_QUIETEST", all);
}

ReportedFact remarkOf(const ReportedFinding& finding, const Texts& texts) {
    std::string value = finding.what + texts.space() + finding.means;
    if (finding.doer != Doer::nobody) value += texts.space() + finding.advice;
    return {finding.parts.front(), texts.text(testKey(finding.testID, "NAME")),
            value + texts.aside(finding.measured)};
}

}  // namespace

std::vector<ReportedFact> factsOf(const ReportInput& input, std::span<const ReportedFinding> remarks) {
    std::vector<ReportedFact> facts;
    for (Part part : {Part::device, Part::joined, Part::selected}) {
        if (part != Part::device && wasTested(input.evidence, part)) Collector(input, part, facts).collect();
        for (const ReportedFinding& remark : remarks)
            if (remark.parts.front() == part) facts.push_back(remarkOf(remark, input.texts));
    }
    return facts;
}

}  // namespace wp::host
