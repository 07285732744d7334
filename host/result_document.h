#pragma once

#include <string>

#include "platform/diagnostic.h"

namespace wp::host {

/// The finished run's result as it is printed: an object of "statusCode" and "data", indented, with a final
/// newline. *Main*, when no queue writes to its dictionaries any more.
std::string resultDocument(const DiagnosticResult& result);

/// The exit status of a run that finished with the status code. *Any*.
int exitStatusOf(std::int64_t statusCode);

}  // namespace wp::host
