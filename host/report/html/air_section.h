#pragma once

#include "host/report/evidence.h"
#include "host/report/html/markup.h"
#include "host/report/texts.h"

namespace wp::host {

/// The page's pictures, each with its table: the channels of each band on which something was heard, and the times of
/// the pings. Nothing where the evidence has neither. *Any*.
void writeAir(const Evidence& evidence, const Texts& texts, Markup& markup);

}  // namespace wp::host
