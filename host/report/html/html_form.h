#pragma once

#include <string>

#include "host/report/report.h"
#include "host/report/text_form.h"

namespace wp::host {

/// The report as one HTML page that fetches nothing and runs nothing: texts, pictures as SVG, and for each picture a
/// table that says the same. It is well-formed XML too. *Any*.
std::string reportPage(const Report& report, const Evidence& evidence, TextForm::Tests tests,
                       const Texts& texts);

}  // namespace wp::host
