#pragma once

#include <string>

namespace wp {

/// The checkout, and the folder that it is built in, for tests that read files of theirs. A function of a source of its
/// own, so that no other object depends on the checkout's place and a compiler's cache serves every one.
std::string sourceFolder();
std::string buildFolder();

}  // namespace wp
