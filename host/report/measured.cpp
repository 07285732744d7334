#include "host/report/measured.h"

#include "platform/records.h"
#include "platform/ui/display_text.h"

namespace wp::host {
namespace {

std::string signalValue(const DictionaryPointer& section, const Texts& texts) {
    std::optional<double> signal = numberIn(section, "RSSI"), noise = numberIn(section, "noise");
    if (!signal) return "";
    if (!noise) return texts.text("T32_VALUE", {{"value", texts.number(*signal, 0)}});
    return texts.text("T32_VALUE_NOISE",
                      {{"value", texts.number(*signal, 0)}, {"above", texts.number(*signal - *noise, 0)}});
}

std::shared_ptr<const PingStatistics> pingOf(const Answer* answer) {
    std::optional<Value> value = answer && answer->info ? answer->info->value("PingResult") : std::nullopt;
    return value ? value->asRecord<PingStatistics>() : nullptr;
}

/// From the answers, since the result keeps the numbers of a ping only when it was answered.
std::string pingValue(const Check& check, const Texts& texts) {
    std::shared_ptr<const PingStatistics> ping = pingOf(check.answer);
    if (!ping || !(ping->packetLoss >= 0 && ping->packetLoss <= 1)) return "";
    double answered = static_cast<double>(ping->count) * (1 - ping->packetLoss);
    return texts.text("PING_VALUE",
                      {{"answered", texts.number(answered, 0)}, {"count", std::to_string(ping->count)}});
}

/// How full the channel is, by what its test was judged.
std::string channelValue(const Evidence& evidence, const Check& check, const Texts& texts) {
    std::optional<double> channel = numberIn(sectionOf(evidence, check.part), "currentChannel");
    if (!channel) return "";
    DictionaryPointer details = detailsOf(evidence, check.part, 24);
    std::optional<std::string> judgedBy = textIn(details, "judgedBy");
    std::optional<double> value = numberIn(details, "value");
    TextValues values = {{"value", texts.number(*channel, 0)}};
    if (!judgedBy || !value) return texts.text("T24_VALUE", values);
    if (judgedBy == "overlap") {
        values.emplace_back("weight", texts.number(*value, 1));
        return texts.text("T24_VALUE_OVERLAP", values);
    }
    values.emplace_back("share", texts.number(100 * *value, 0));
    return texts.text(judgedBy == "measuredLoad" ? "T24_VALUE_MEASURED" : "T24_VALUE_ADVERTISED", values);
}

/// The address of a sign-in page.
std::string portalValue(const Evidence& evidence, const Check& check, const Texts& texts) {
    std::optional<std::string> address = textIn(detailsOf(evidence, check.part, 46), "url");
    return address ? texts.text("T46_VALUE", {{"value", ui::displayForm(*address)}}) : "";
}

std::string plainValue(const DictionaryPointer& section, const char* key, const Texts& texts) {
    if (std::optional<double> number = numberIn(section, key)) return texts.number(*number, 0);
    std::optional<std::string> text = textIn(section, key);
    return text ? ui::displayForm(*text) : "";
}

}  // namespace

std::string securityText(const std::string& security, const Texts& texts) {
    if (security == "Open") return texts.text("SECURITY_OPEN");
    if (security == "OWE") return texts.text("SECURITY_OWE");
    if (security == "OWE Transition") return texts.text("SECURITY_OWE_TRANSITION");
    if (security == "WEP") return texts.text("SECURITY_WEP");
    for (auto [kind, key] :
         {std::pair{" Personal", "SECURITY_PERSONAL"}, {" Enterprise", "SECURITY_ENTERPRISE"}})
        if (security.ends_with(kind)) {
            std::string protocol = security.substr(0, security.size() - std::string_view(kind).size());
            return texts.text(key, {{"protocol", ui::displayForm(protocol)}});
        }
    return texts.text("SECURITY_UNKNOWN");
}

std::string networkText(const std::optional<std::string>& name, const Texts& texts) {
    if (!name) return "";
    return texts.text("QUOTED_NETWORK", {{"name", ui::displayForm(*name)}});
}

std::string measuredText(const Evidence& evidence, const Check& check, const Texts& texts) {
    const DictionaryPointer& section = sectionOf(evidence, check.part);
    int testID = check.test->testID;
    if (testID == 32) return signalValue(section, texts);
    if (testID == 3 || testID == 6) return pingValue(check, texts);
    if (testID == 24) return channelValue(evidence, check, texts);
    if (testID == 46) return portalValue(evidence, check, texts);
    if (!check.test->valueKey) return "";
    std::string value = plainValue(section, check.test->valueKey, texts);
    if (value.empty()) return "";
    if (testID == 38 || testID == 39 || testID == 40) value = securityText(value, texts);
    return texts.text(testKey(testID, "VALUE"), {{"value", value}});
}

}  // namespace wp::host
