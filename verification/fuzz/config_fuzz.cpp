#include <cstdlib>

#include "linux/config.h"
#include "linux/dbus/network_records.h"
#include "linux/probe/portal_api.h"

using namespace wp;

/// Texts that set something: a configuration, a portal's answer, a supplicant's name. A refusal changes nothing,
/// and what is taken over can be shown and read again.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    static const std::string kDefaults = endpointsAsJson(Config::defaults());
    Config config = Config::defaults();
    const auto refusal = applyConfig(text, config);
    const std::string shown = endpointsAsJson(config);
    if (refusal && shown != kDefaults) std::abort();
    Config again = Config::defaults();
    if (applyConfig(shown, again) || endpointsAsJson(again) != shown) std::abort();
    portalFromApi(text);
    nameFromSupplicant(text);
    dateFromText(text);
    return 0;
}
