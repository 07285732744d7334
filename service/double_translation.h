#pragma once

#include <optional>
#include <string>
#include <vector>

#include "service/ip_address.h"
#include "service/outcome.h"

namespace wp {

/// An IPv4 address of the interface with the length of its network's prefix.
struct OwnAddress {
    IPAddress address;
    unsigned prefixLength = 24;
};

/// What gives away how often addresses are translated on the way out.
struct TranslationEvidence {
    std::vector<OwnAddress> own;               ///< IPv4 addresses of the interface
    std::optional<IPAddress> gatewayExternal;  ///< the address that the router says it has outside
    std::optional<IPAddress> mapped;           ///< the address that a server outside sees
    /// Who answered for each distance, the first router first; absent where nobody did.
    std::vector<std::optional<IPAddress>> hops;
};

/// What decided about the translation.
enum class TranslationBasis {
    noInnerAddress,
    routerInside,
    routerShared,  ///< the router has an address that providers share out
    twoOuterAddresses,
    routerOutside,
    hops,
    sharedHop
};

/// How sure the verdict is, and by what.
struct TranslationVerdict {
    bool twice = false;
    TranslationBasis basis = TranslationBasis::hops;
    std::string why;
};

/// The router's own word and that of a server outside decide; the hops between only where those are silent,
/// because providers number routers privately without translating. Shared addresses (100.64.0.0/10) count:
/// then the provider translates a second time.
Known<TranslationVerdict> judgeTranslation(const TranslationEvidence& evidence);

/// Test 8: whether addresses are translated twice.
Outcome hasDoubleTranslation(const Known<TranslationEvidence>& evidence);

}  // namespace wp
