#include "platform/localization.h"

namespace wp {

std::string formatted(std::string_view format, std::string_view argument) {
    constexpr std::string_view kPlaceholder = "%@";
    std::size_t place = format.find(kPlaceholder);
    if (place == std::string_view::npos) return std::string(format);
    std::string text(format.substr(0, place));
    text += argument;
    text += format.substr(place + kPlaceholder.size());
    return text;
}

}  // namespace wp
