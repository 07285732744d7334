#include "linux/files/dhcpcd_settings.h"
#include "linux/files/dnsmasq.h"
#include "linux/files/interfaces_file.h"
#include "linux/files/leases.h"
#include "linux/files/networkd.h"
#include "linux/files/proxy_settings.h"

using namespace wp;

/// What other programs leave in files.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    const std::vector<IPAddress> assigned{*IPAddress::fromText("192.168.1.20"),
                                          *IPAddress::fromText("2001:db8::7")};
    readDhclientLeases(text, "wlan0", assigned, 1'795'199'400);
    readDhclient6Leases(text, "wlan0", assigned, 1'795'199'400);
    serversFromResolverFile(text);
    InterfacesFile interfaces;
    readInterfaces(text, interfaces);
    planIn(interfaces, "wlan0");
    readDhcpcdSettings(text, "wlan0", "Northlight");
    DnsmasqSettings resolver;
    readDnsmasqFile(text, resolver);
    readDnsmasqCommand(wordsOf(text), resolver);
    UnitFile settings;
    readUnitFile(text, settings);
    methodsFromNetworkd(settings);
    proxyVariables(readAssignments(text), "file");
    proxyModeInSettingsDatabase(text);
    return 0;
}
