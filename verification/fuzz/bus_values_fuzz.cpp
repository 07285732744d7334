#include <sys/socket.h>
#include <systemd/sd-bus.h>

#include <cstdlib>
#include <cstring>
#include <memory>

#include "linux/dbus/bluez.h"
#include "linux/dbus/connman.h"
#include "linux/dbus/iwd.h"
#include "linux/dbus/message_reader.h"
#include "linux/dbus/network_manager.h"
#include "linux/dbus/resolved.h"
#include "linux/dbus/supplicant.h"
#include "service/bytes.h"

using namespace wp;

namespace {

// A value of the input is a byte for its kind and what belongs to it; texts and bytes have a byte for their length,
// lists and dictionaries one for their count. The names stand for texts, by their place.
const char* const kNames[] = {"802-11-wireless",
                              "802-11-wireless-security",
                              "connection",
                              "ipv4",
                              "ipv6",
                              "proxy",
                              "ssid",
                              "mode",
                              "autoconnect",
                              "hidden",
                              "seen-bssids",
                              "timestamp",
                              "key-mgmt",
                              "proto",
                              "dns",
                              "dns-data",
                              "method",
                              "pac-url",
                              "pac-script",
                              "org.bluez.Adapter1",
                              "org.bluez.Device1",
                              "Powered",
                              "Paired",
                              "Connected",
                              "net.connman.iwd.Device",
                              "net.connman.iwd.KnownNetwork",
                              "Name",
                              "Type",
                              "Hidden",
                              "AutoConnect",
                              "LastConnectedTime",
                              "disabled",
                              "scan_ssid",
                              "key_mgmt",
                              "wep_key0",
                              "/",
                              "psk",
                              "wlan0"};

struct Unref {
    void operator()(sd_bus_message* message) const { sd_bus_message_unref(message); }
};

/// A connection that nobody listens at; messages are made for one.
sd_bus* connection() {
    static sd_bus* const bus = [] {
        int ends[2];
        sd_bus* made = nullptr;
        if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK, 0, ends) != 0 || sd_bus_new(&made) < 0 ||
            sd_bus_set_fd(made, ends[0], ends[0]) < 0 || sd_bus_start(made) < 0)
            std::abort();
        return made;
    }();
    return bus;
}

/// Writes the values of the input into a message.
class Writer {
  public:
    Writer(sd_bus_message* message, Bytes input) : message_(message), input_(input) {}

    bool more() const { return !input_.empty(); }

    /// Each value is a variant, so that lists may hold values of all kinds, as dictionaries of settings do.
    void putVariant(unsigned depth) {
        const unsigned kind = take() % 10;
        static constexpr const char* kTypes[] = {"y", "b", "x", "t", "d", "s", "ay", "av", "a{sv}", "(vv)"};
        // The library bounds how deep a message goes; the reader stops before.
        if (depth > 24 || sd_bus_message_open_container(message_, 'v', kTypes[kind]) < 0) return;
        put(kind, depth);
        sd_bus_message_close_container(message_);
    }

  private:
    unsigned take() {
        if (input_.empty()) return 0;
        const unsigned byte = input_.front();
        input_ = input_.subspan(1);
        return byte;
    }
    Bytes takeBytes(std::size_t count) {
        const Bytes taken = input_.first(std::min(count, input_.size()));
        input_ = input_.subspan(taken.size());
        return taken;
    }
    std::string takeText() {
        const unsigned length = take();
        if (length >= 128) return kNames[length % std::size(kNames)];
        const Bytes bytes = takeBytes(length);
        return {bytes.begin(), bytes.end()};
    }

    void put(unsigned kind, unsigned depth) {
        std::uint64_t number = 0;
        if (kind <= 4) {
            const Bytes bytes = takeBytes(kind <= 1 ? 1 : 8);
            if (!bytes.empty()) std::memcpy(&number, bytes.data(), bytes.size());
        }
        switch (kind) {
            case 0:
                sd_bus_message_append(message_, "y", static_cast<int>(number));
                break;
            case 1:
                sd_bus_message_append(message_, "b", static_cast<int>(number & 1));
                break;
            case 2:
            case 3:
                sd_bus_message_append(message_, kind == 2 ? "x" : "t", number);
                break;
            case 4:
                sd_bus_message_append(message_, "d", static_cast<double>(number));
                break;
            case 5:
                // What is no text becomes one: the message must be complete.
                if (sd_bus_message_append(message_, "s", takeText().c_str()) < 0)
                    sd_bus_message_append(message_, "s", "");
                break;
            case 6: {
                const Bytes bytes = takeBytes(take());
                sd_bus_message_append_array(message_, 'y', bytes.data(), bytes.size());
                break;
            }
            default:
                putMany(kind, depth);
        }
    }

    void putMany(unsigned kind, unsigned depth) {
        if (kind == 9) {
            sd_bus_message_open_container(message_, 'r', "vv");
            putVariantOrZero(depth + 1);
            putVariantOrZero(depth + 1);
        } else {
            sd_bus_message_open_container(message_, 'a', kind == 7 ? "v" : "{sv}");
            for (unsigned count = take(); count > 0 && more(); --count)
                kind == 7 ? putVariant(depth + 1) : putEntry(depth + 1);
        }
        sd_bus_message_close_container(message_);
    }

    void putEntry(unsigned depth) {
        if (depth > 24) return;
        sd_bus_message_open_container(message_, 'e', "sv");
        if (sd_bus_message_append(message_, "s", takeText().c_str()) < 0)
            sd_bus_message_append(message_, "s", "");
        putVariantOrZero(depth);
        sd_bus_message_close_container(message_);
    }

    /// A pair has two members also where the input has ended or is too deep.
    void putVariantOrZero(unsigned depth) {
        if (depth > 24)
            sd_bus_message_append(message_, "v", "y", 0);
        else
            putVariant(depth);
    }

    sd_bus_message* message_;
    Bytes input_;
};

unsigned depthOf(const BusValue& value) {
    unsigned deepest = 0;
    for (const BusValue& each : value.list()) deepest = std::max(deepest, depthOf(each));
    for (const auto& [key, each] : value.map()) deepest = std::max(deepest, depthOf(each));
    return deepest + 1;
}

/// Hands the value to everybody who takes one from a service.
void readAsEverything(const BusValue& value) {
    bluetoothFrom(value);
    connmanLinkIn(value, "wlan0");
    iwdDevice(value, "wlan0");
    iwdNetworks(value);
    manualServers(value);
    proxyOf(value);
    savedFromNetworkManager(value);
    savedFromSupplicant(value, true);
    serversFrom(value);
    deviceServersFrom(value);
}

}  // namespace

/// What a service on the bus may answer: any values in any order, and what is made of them.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    sd_bus_message* raw = nullptr;
    if (sd_bus_message_new_signal(connection(), &raw, "/", "a.b", "C") < 0) std::abort();
    const std::unique_ptr<sd_bus_message, Unref> message(raw);
    Writer writer(raw, {data, size});
    for (int count = 0; writer.more() && count < 64; ++count) writer.putVariant(0);
    if (sd_bus_message_seal(raw, 1, 0) < 0) return 0;
    const Known<BusValue> value = readBody(raw);
    if (!value) return 0;
    if (depthOf(*value) > kDeepestValue + 3) std::abort();
    readAsEverything(*value);
    return 0;
}
