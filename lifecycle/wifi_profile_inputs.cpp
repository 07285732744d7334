#include "lifecycle/wifi_profile_inputs.h"

#include "lifecycle/network_name.h"
#include "platform/parameter_reader.h"

namespace wp {
namespace {

constexpr std::uint64_t kScanCacheAgeLowerBound = 0;
constexpr std::uint64_t kScanCacheAgeUpperBound = 600;
constexpr std::size_t kNetworkNameMaximumLength = 32;

}  // namespace

bool WiFiProfileInputs::validateAndInitializeParameters(DictionaryPointer parameters) {
    parameters_ = parameters;
    ParameterReader reader(std::move(parameters));
    maxScanCacheAge_ =
        reader.requiredNumber("maxScanCacheAge", kScanCacheAgeLowerBound, kScanCacheAgeUpperBound);
    reprofileWithNetworksListUI_ = reader.requiredBool("reprofileWithUI");
    setSelectedNetworkName(reader.optionalString(kNetworkName, kNetworkNameMaximumLength, std::nullopt));
    failureReason_ = reader.reason();
    return !reader.failed();
}

bool WiFiProfileInputs::setSelectedNetworkNameIfAbsent(const std::optional<std::string>& name) {
    return selectedNetworkName_.update([&name](std::optional<std::string>& selected) {
        if (selected) return false;
        selected = name;
        return name.has_value();
    });
}

}  // namespace wp
