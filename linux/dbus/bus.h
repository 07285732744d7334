#pragma once

#include <memory>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "linux/dbus/bus_value.h"
#include "linux/wait_any.h"
#include "service/known.h"

struct sd_bus;

namespace wp {

/// Where a call goes: an object of a service on the bus.
struct BusObject {
    std::string service;
    std::string path;
};

/// A call's argument.
struct BusPath {
    std::string path;
};
struct BusFlagVariant {
    bool flag;
};
/// Texts that need not be UTF-8, each a row of bytes.
using BusByteTexts = std::vector<std::vector<std::uint8_t>>;
using BusOption = std::variant<std::string, BusByteTexts>;
using BusOptions = std::vector<std::pair<std::string, BusOption>>;
using BusArgument = std::variant<std::string, std::int32_t, BusPath, BusFlagVariant, BusOptions>;

/// A connection to the system's message bus. Each call waits for its reply, at most two seconds, and ends at
/// once when it is stopped. No service is started by asking it. One thread at a time.
class Bus {
  public:
    /// Connects to the bus that `DBUS_SYSTEM_BUS_ADDRESS` names, by default the system's own. Fails as
    /// `unavailable` where there is no bus.
    static Known<Bus> system();
    /// The same for a bus at an address of the form "unix:path=…".
    static Known<Bus> at(const std::string& address);

    /// Calls a method and returns its reply's only value, or the list of them. Errors: `unavailable` where
    /// nobody has the service's name, `notFound` where the object or method is not there, `notPermitted`,
    /// `timeout`, `cancelled`, `malformed`.
    Known<BusValue> call(const BusObject& object, const std::string& interface, const std::string& method,
                         const std::vector<BusArgument>& arguments, const Until& until);

    /// All properties of one interface of the object, a dictionary.
    Known<BusValue> properties(const BusObject& object, const std::string& interface, const Until& until);
    /// One property.
    Known<BusValue> property(const BusObject& object, const std::string& interface, const std::string& name,
                             const Until& until);
    /// All objects of a service that lists them: path, then interface, then property.
    Known<BusValue> managedObjects(const BusObject& object, const Until& until);

  private:
    struct Close {
        void operator()(sd_bus* bus) const;
    };
    explicit Bus(sd_bus* bus) : bus_(bus) {}

    std::unique_ptr<sd_bus, Close> bus_;
};

}  // namespace wp
