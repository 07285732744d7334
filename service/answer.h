#pragma once

#include "platform/diagnostics.h"
#include "service/catalogue.h"

namespace wp {

/// The answer to one request: the test's verdict, and what was measured beyond it in its information under
/// "Details" (docs/details.md), which no key of the result document is made of. Where the test cannot tell, what
/// was measured all the same stands in a result beside the error, together with the error's "reason". *Any*
/// thread.
DiagnosticsTestResponse answerOf(const NumberedTest& test, const Facts& facts);

/// The answer of a request that failed before anything was measured.
DiagnosticsTestResponse answerOf(const Error& error);

}  // namespace wp
