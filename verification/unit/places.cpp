#include "verification/unit/places.h"

namespace wp {

std::string sourceFolder() {
    return WP_SOURCE_DIR;
}

std::string buildFolder() {
    return WP_BINARY_DIR;
}

}  // namespace wp
