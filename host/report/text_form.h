#pragma once

#include <string>

#include "host/report/report.h"

namespace wp::host {

/// How a report is written as text.
struct TextForm {
    enum class Tests { withFindings, all };
    enum class Style { plain, terminal };

    Tests tests = Tests::withFindings;
    Style style = Style::plain;  ///< `terminal`: headings and findings stand out by bold type
};

/// The report as lines of at most 80 columns, with a final newline. *Any*.
std::string reportText(const Report& report, const Evidence& evidence, const TextForm& form,
                       const Texts& texts);

}  // namespace wp::host
