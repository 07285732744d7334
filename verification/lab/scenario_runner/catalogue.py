"""The numbered tests as the scenarios judge them: which result key says what, and what counts as a finding."""

from dataclasses import dataclass


@dataclass(frozen=True)
class Test:
    number: int
    key: str
    name: str  # as the log calls it when the service answers with an error
    finding: bool | None  # the value that is a finding; None: neither is
    values: tuple[str, ...] = ()  # what else the test writes


DEVICE = (
    Test(14, "isUsingCustomIPv4", "Custom IPv4", True, ("IPv4ConfigMethod",)),
    Test(15, "isUsingCustomIPv6", "Custom IPv6", True, ("IPv6ConfigMethod",)),
    Test(16, "isUsingCustomDNS", "Custom DNS", True),
    Test(17, "isUsingCustomWebProxy", "Custom Web Proxy", True),
    Test(22, "isHalvoInRealTimeMode", "Halvo Real Time Mode", True),
    Test(19, "isLargeConnectedBT", "Bluetooth Connected", True, ("bluetoothConnectedCount",)),
    Test(18, "isLargePairedBT", "Bluetooth Paired", True, ("bluetoothPairedCount",)),
    Test(20, "isHYBRIDBTCoexistenceMode", "Bluetooth Coex", True),
    Test(47, "isLargePNL", "Large PNL", True, ("preferredNetworkListCount",)),
    Test(48, "doesPNLContainHiddenNetworks", "PNL Contains Hidden", True),
    Test(29, "doesPNLContainConflictingSecurityType", "Conflicting Security Type in PNL", True),
)

_CHANNELS = ("2GHzChannel", "5GHzChannel", "5GHz40MHzChannel", "5GHzNonDFSChannel")

NETWORK = (
    Test(8, "hasDoubleNATConfiguration", "Detect Double NAT", True),
    Test(34, "isBeaconIntervalLong", "Long Beacon Interval", True, ("beaconInterval",)),
    Test(35, "isDTIMIntervalLong", "Long DTIM Interval", True, ("DTIMInterval",)),
    Test(38, "isUsingOpenSecurity", "No Security", True, ("security",)),
    Test(39, "isUsingWEPSecurity", "Legacy Security: WEP", True),
    Test(40, "isUsingWPASecurity", "Legacy Security: WPA", True),
    Test(41, "isUsingLegacyRates", "Legacy Rates (802.11b)", True),
    Test(42, "isUsingAmbiguousNetworkName", "Ambiguous Network Name", True, ("networkName",)),
    Test(43, "isHiddenNetwork", "Hidden Network", True),
    Test(44, "isPyloPersonalHotspot", "Pylo Personal Hotspot", None),
    Test(46, "isCaptive", "Captive Portal", True, ("preferredNetwork",)),
    Test(45, "isPasspointNetwork", "Passpoint", None),
    Test(36, "hasConflictingPHYMode11AC", "Conflicting PHY Mode (11AC)", True, ("supportedPHYModes",)),
    Test(37, "hasConflictingPHYMode11N", "Conflicting PHY Mode (11N)", True),
    Test(33, "isHostedByMarlixBaseStation", "Marlix Base Station", None, ("marlixModelName",)),
    Test(3, "pingedLAN", "Ping LAN", False, ("pingLANResult",)),
    Test(6, "pingedWAN", "Ping WAN", False, ("pingWANResult",)),
    Test(12, "isIPv4Assigned", "IPv4 Assigned", False),
    Test(13, "isIPv6Assigned", "IPv6 Assigned", False),
    Test(7, "resolvedDNS", "Resolve DNS", False),
    Test(9, "reachedVantor", "Reach Vantor", False),
    Test(11, "retrievedVantor", "Retrieve Vantor", False),
    Test(24, "isChannelCongested", "Congested Channel", True, ("currentChannel", *_CHANNELS)),
    Test(25, "is2GHzCongested", "Congested 2.4GHz", True),
    Test(26, "is5GHzCongested", "Congested 5GHz", True),
    Test(27, "hasHT40Channel", "HT 40 Channel", True),
    Test(28, "foundConflictingCountryCode", "Conflicting Country Code", True, ("adoptedCountryCode",)),
    Test(32, "hasPoorSignal", "Poor Signal", True, ("RSSI", "noise")),
    Test(30, "foundHiddenNetworks", "Hidden Scan Results", True, ("hiddenNetworkCount",)),
    Test(31, "foundScanResults", "No Scan Results", 0),
)

SECTIONS = {"device": DEVICE, "current": NETWORK, "selected": NETWORK}
# How the result document calls the sections.
DOCUMENT_NAMES = {"device": "device", "current": "currentNetwork", "selected": "selectedNetwork"}

_BY_KEY = {section: {key: test for test in tests for key in (test.key, *test.values)} for section, tests in SECTIONS.items()}


def test_of(section: str, key: str) -> Test | None:
    """The test that writes a key, which may name a place inside a dictionary ("pingLANResult.count")."""
    return _BY_KEY[section].get(key.split(".")[0])
