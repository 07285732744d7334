#include <cstdlib>

#include "linux/config.h"
#include "linux/dbus/network_records.h"
#include "linux/probe/portal_api.h"
#include "platform/json_writer.h"

using namespace wp;

namespace {

std::string told(const Config& config) {
    return jsonText(toldOf(config), JSONStyle::compact);
}

}  // namespace

/// Texts that set something: a configuration, a portal's answer, a supplicant's name. A refusal changes nothing,
/// and what is taken over can be shown and read again.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    static const std::string kDefaults = told(Config::defaults());
    Config config = Config::defaults();
    const auto refusal = applyConfig(text, config);
    const std::string shown = told(config);
    if (refusal && shown != kDefaults) std::abort();
    Config again = Config::defaults();
    if (applyConfig(shown, again) || told(again) != shown) std::abort();
    portalFromApi(text);
    nameFromSupplicant(text);
    dateFromText(text);
    return 0;
}
