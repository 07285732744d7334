#pragma once

#include <string>
#include <string_view>

namespace wp {

/// A text from outside as it may stand in a document or a log: valid UTF-8 as it is, any other byte as `\xNN`,
/// control characters left out, blanks around it too, and at most `longest` bytes of it read. *Any* thread.
std::string plainText(std::string_view bytes, std::size_t longest = 128);

}  // namespace wp
