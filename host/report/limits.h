#pragma once

#include "host/report/evidence.h"
#include "host/report/texts.h"
#include "platform/value.h"
#include "service/thresholds.h"

namespace wp::host {

/// The service's thresholds, changed by the "thresholds" of a configuration; null: none. The service itself
/// refuses a configuration that is not acceptable; here a value that is no number is left out. *Any*.
Thresholds thresholdsFrom(const DictionaryPointer& configured);

/// The thresholds that the run itself went by, as far as its answers tell (docs/details.md), over the others. *Any*.
Thresholds thresholdsOf(const Evidence& evidence, const Thresholds& others);

/// The numbers of the test's rule, as its text names them; empty where the rule has none. *Any*.
TextValues limitsOf(int testID, const Thresholds& thresholds, const Texts& texts);

}  // namespace wp::host
