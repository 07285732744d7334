#pragma once

#include <string_view>

namespace wp {

/// The host's diagnostics log: error lines by numbered category. *Any* thread.
class Log {
  public:
    virtual ~Log() = default;

    /// Whether error lines of the category are kept; callers format a line only then.
    virtual bool isErrorEnabled(int category) const = 0;

    /// Writes one error line of the category.
    virtual void error(int category, std::string_view message) = 0;
};

}  // namespace wp
