#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace wp {

/// Bounds of a document; a device's description is a few kilobytes.
inline constexpr std::size_t kLongestXml = 64U << 10, kDeepestXml = 16, kLongestXmlText = 512;

/// Walks over a document and calls `leaf(path, text)` at the end of each element that holds text and no
/// elements: the path's parts are the names without prefix, the text is trimmed and has the five predefined
/// entities and the numbers below 128 replaced; what it declares itself stays as it stands, unread. Returns
/// whether the whole document was read; it ends at the first fault or bound. *Any* thread.
bool walkXml(
    std::string_view xml,
    const std::function<void(const std::vector<std::string_view>& path, const std::string& text)>& leaf);

}  // namespace wp
