#include "linux/link_master.h"
#include "linux/radio_messages.h"
#include "linux/route_messages.h"

using namespace wp;

/// A buffer as a socket hands it over, to every reader.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const Bytes buffer(data, size);
    readFamily(buffer);
    readInterfaces(buffer);
    readAccessPoints(buffer, 1000);
    readStation(buffer);
    readSurvey(buffer);
    readRegulation(buffer, 0);
    readAbilities(buffer, 0);
    readScanEvents(buffer);
    readAddresses(buffer, 3);
    readRoute(buffer);
    leadsElsewhere(buffer, 3);
    hasAdvertisedRoute(buffer, 3);
    readMaster(buffer, 3);
    return 0;
}
