#pragma once

#include <string>

namespace wp {

/// What went wrong in a service: an integer code and a sentence for people. Code 0 counts as success.
struct Error {
    int code = 0;
    std::string message;

    /// The form in which a log line carries the error: "MESSAGE (code N)". *Any* thread.
    std::string text() const { return message + " (code " + std::to_string(code) + ")"; }

    friend bool operator==(const Error&, const Error&) = default;
};

}  // namespace wp
