#include "lifecycle/wifi_profile_view_controller.h"

namespace wp {

// clang-format off
void WiFiProfileViewController::runSelectedNetworkLongBeaconInterval()         { runCurrentNetworkLongBeaconIntervalWithConfiguration          (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkNoSecurity()                 { runCurrentNetworkNoSecurityWithConfiguration                  (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkLegacySecurityWEP()          { runCurrentNetworkLegacySecurityWEPWithConfiguration           (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkLegacySecurityWPA()          { runCurrentNetworkLegacySecurityWPAWithConfiguration           (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkLegacyRates11b()             { runCurrentNetworkLegacyRates11bWithConfiguration              (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkAmbiguousNetworkName()       { runCurrentNetworkAmbiguousNetworkNameWithConfiguration        (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkHiddenNetwork()              { runCurrentNetworkHiddenNetworkWithConfiguration               (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkPyloPersonalHotspot()        { runCurrentNetworkPyloPersonalHotspotWithConfiguration         (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkCaptivePortal()              { runCurrentNetworkCaptivePortalWithConfiguration               (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkPasspoint()                  { runCurrentNetworkPasspointWithConfiguration                   (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkConflictingPHYMode11AC()     { runCurrentNetworkConflictingPHYMode11ACWithConfiguration      (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkConflictingPHYMode11N()      { runCurrentNetworkConflictingPHYMode11NWithConfiguration       (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkMarlixBaseStation()          { runCurrentNetworkMarlixBaseStationWithConfiguration           (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkCongestedChannel()           { runCurrentNetworkCongestedChannelWithConfiguration            (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkConflictingCountryCode()     { runCurrentNetworkConflictingCountryCodeWithConfiguration      (configuration_, selectedNetworkData_); }
void WiFiProfileViewController::runSelectedNetworkPoorSignal()                 { runCurrentNetworkPoorSignalWithConfiguration                  (configuration_, selectedNetworkData_); }
// clang-format on

}  // namespace wp
