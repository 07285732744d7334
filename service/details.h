#pragma once

#include "service/facts.h"

namespace wp {

// What was measured beyond the verdict, one function for each test that has more to tell, under the keys of
// docs/details.md. None of it decides anything, and what is not known is left out. Pure functions; *any* thread.

/// Entries of one answer's "Details".
using Details = Dictionary::Entries;

// The device's own configuration.
Details ipv4MethodDetails(const Facts& facts);     ///< 14
Details ipv6MethodDetails(const Facts& facts);     ///< 15
Details nameServerDetails(const Facts& facts);     ///< 16
Details webProxyDetails(const Facts& facts);       ///< 17
Details pairedDetails(const Facts& facts);         ///< 18
Details connectedDetails(const Facts& facts);      ///< 19
Details sharedAirtimeDetails(const Facts& facts);  ///< 20
Details peerLinkDetails(const Facts& facts);       ///< 22
Details savedConflictDetails(const Facts& facts);  ///< 29
Details savedCountDetails(const Facts& facts);     ///< 47
Details savedHiddenDetails(const Facts& facts);    ///< 48

// How far the joined network reaches.
Details gatewayDetails(const Facts& facts);        ///< 3
Details outsideDetails(const Facts& facts);        ///< 6
Details nameDetails(const Facts& facts);           ///< 7
Details translationDetails(const Facts& facts);    ///< 8
Details vendorReachDetails(const Facts& facts);    ///< 9
Details vendorContentDetails(const Facts& facts);  ///< 11
Details ipv4Details(const Facts& facts);           ///< 12
Details ipv6Details(const Facts& facts);           ///< 13
Details portalDetails(const Facts& facts);         ///< 46

// A network's own properties.
Details baseStationDetails(const Facts& facts);     ///< 33
Details beaconDetails(const Facts& facts);          ///< 34
Details dtimDetails(const Facts& facts);            ///< 35
Details modes11ACDetails(const Facts& facts);       ///< 36
Details modes11NDetails(const Facts& facts);        ///< 37
Details securityDetails(const Facts& facts);        ///< 38, 39, 40
Details rateDetails(const Facts& facts);            ///< 41
Details ambiguousNameDetails(const Facts& facts);   ///< 42
Details hiddenNameDetails(const Facts& facts);      ///< 43
Details hotspotDetails(const Facts& facts);         ///< 44
Details hotspotElementDetails(const Facts& facts);  ///< 45

// The air.
Details channelDetails(const Facts& facts);        ///< 24: the networks and the channels of all bands
Details band2Details(const Facts& facts);          ///< 25
Details band5Details(const Facts& facts);          ///< 26
Details widthDetails(const Facts& facts);          ///< 27
Details countryDetails(const Facts& facts);        ///< 28
Details hiddenNetworkDetails(const Facts& facts);  ///< 30
Details scanDetails(const Facts& facts);           ///< 31
Details signalDetails(const Facts& facts);         ///< 32

}  // namespace wp
