#pragma once

#include "service/bluetooth.h"
#include "service/congestion.h"
#include "service/maker.h"
#include "service/reachability.h"
#include "service/saved_networks.h"

namespace wp {

/// From when on something is a finding, as far as a configuration may say so.
struct Thresholds {
    BluetoothLimits bluetooth;
    SavedNetworkLimits saved;
    CongestionLimits congestion;
};

/// What the verdicts go by besides the facts.
struct Settings {
    Thresholds thresholds;
    Vendors vendors;
    ExpectedContent vendorContent;
};

}  // namespace wp
