#pragma once

#include "service/bluetooth.h"
#include "service/congestion.h"
#include "service/maker.h"
#include "service/reachability.h"
#include "service/saved_networks.h"
#include "service/thresholds.h"

namespace wp {

/// What the verdicts go by besides the facts.
struct Settings {
    Thresholds thresholds;
    Vendors vendors;
    ExpectedContent vendorContent;
};

}  // namespace wp
