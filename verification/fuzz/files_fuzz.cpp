#include "linux/files/leases.h"
#include "linux/files/networkd.h"
#include "linux/files/proxy_settings.h"

using namespace wp;

/// What other programs leave in files.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    readDhclientLeases(text, "wlan0", 1'795'199'400);
    readDhclient6Leases(text, "wlan0", {*IPAddress::fromText("2001:db8::7")}, 1'795'199'400);
    serversFromResolverFile(text);
    UnitFile settings;
    readUnitFile(text, settings);
    methodsFromNetworkd(settings);
    proxyVariables(readAssignments(text), "file");
    proxyModeInSettingsDatabase(text);
    return 0;
}
