#pragma once

#include <stdexcept>
#include <string>

namespace wp::host {

/// What the program's exit status says to whoever started it.
namespace exit_status {
inline constexpr int ok = 0;
inline constexpr int failure = 1;
inline constexpr int unusable = 2;    ///< arguments, request, recording, configuration or file not acceptable
inline constexpr int leftByUser = 3;  ///< `back` on the list or on the progress screen
inline constexpr int statusCodeBase = 10;  ///< plus n for a run that finished with status code -n
inline constexpr int signalBase = 128;     ///< plus the number of the signal
}  // namespace exit_status

/// Ends the program with one line on standard error: the line says what was wrong, where, and what to change.
/// It is thrown and caught inside this folder only and never passes through a frame of the extension.
class Exit : public std::runtime_error {
  public:
    Exit(int status, const std::string& line) : std::runtime_error(line), status_(status) {}
    int status() const { return status_; }

  private:
    int status_;
};

/// What the person who called can mend: arguments and files that are not acceptable.
[[noreturn]] inline void refuse(const std::string& line) {
    throw Exit(exit_status::unusable, line);
}

/// What went wrong while the program worked.
[[noreturn]] inline void fail(const std::string& line) {
    throw Exit(exit_status::failure, line);
}

}  // namespace wp::host
