#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "linux/dbus/bus.h"
#include "platform/value.h"
#include "service/saved_networks.h"

namespace wp {

/// A moment given in seconds since 1970-01-01 UTC. *Any* thread.
Date dateFromUnix(std::int64_t seconds);
/// "2026-11-20T18:30:00Z"; nothing for any other form.
std::optional<Date> dateFromText(std::string_view text);

/// The names that a scan calls when it looks for one network and all others: an empty name calls for everybody.
BusByteTexts namesCalled(const NetworkName& named);

/// A name in the supplicant's form: in double quotes as it stands, `P"…"` with escapes, or in hexadecimal.
std::optional<NetworkName> nameFromSupplicant(std::string_view text);
/// What a network of the supplicant has beside its key management.
struct SupplicantSecrets {
    bool wepKey = false;
    bool eapMethods = false;
};
/// The security that the supplicant's key management, protocols and secrets stand for. Unless told otherwise it allows
/// both a passphrase, which it keeps to itself, and a user's own name, which needs methods.
SavedSecurity securityFromSupplicant(std::string_view keyManagement, std::string_view protocols,
                                     SupplicantSecrets secrets = {});

}  // namespace wp
