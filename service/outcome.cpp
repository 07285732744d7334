#include "service/outcome.h"

namespace wp {
namespace {

Finding finding(bool result, bool didPass, Dictionary::Entries info) {
    return {result, didPass, info.empty() ? nullptr : Dictionary::make(std::move(info))};
}

}  // namespace

Outcome problem(bool found, Dictionary::Entries info) {
    return finding(found, !found, std::move(info));
}

Outcome works(bool found, Dictionary::Entries info) {
    return finding(found, found, std::move(info));
}

}  // namespace wp
