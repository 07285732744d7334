#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "exchange/descriptor.h"

namespace wp {

/// The service's end of the wire: whole lines, both ways. Owner's thread.
class LineSocket {
  public:
    explicit LineSocket(Descriptor descriptor);

    int descriptor() const { return descriptor_.number(); }

    /// Takes in what has arrived. False once the other end is closed, or has sent a line that is too long.
    bool receive();
    /// The next whole line without its end, nothing while there is none.
    std::optional<std::string> nextLine();
    /// Sends a line, which brings its own end. False when the other end is closed.
    bool send(std::string_view line);

  private:
    Descriptor descriptor_;
    std::string received_;
    std::size_t searched_ = 0;  ///< how much of it holds no line's end
};

}  // namespace wp
