#include "linux/dbus/bus.h"

#include <systemd/sd-bus.h>

#include <cstdlib>
#include <cstring>

#include "linux/dbus/message_reader.h"

namespace wp {
namespace {

using namespace std::chrono_literals;

constexpr auto kReplyTime = 2s;

struct Unref {
    void operator()(sd_bus_message* message) const { sd_bus_message_unref(message); }
    void operator()(sd_bus_slot* slot) const { sd_bus_slot_unref(slot); }
};
using Message = std::unique_ptr<sd_bus_message, Unref>;
using Slot = std::unique_ptr<sd_bus_slot, Unref>;

Error lost(const std::string& service, int number) {
    const Reason reason = number == -EACCES || number == -EPERM ? Reason::notPermitted : Reason::unavailable;
    return failure(reason, service + " cannot be asked over the message bus: " + std::strerror(-number));
}

Reason reasonOf(const std::string& name) {
    const auto is = [&name](std::string_view last) { return name.ends_with(last); };
    if (is(".AccessDenied") || is(".AuthFailed") || is(".PermissionDenied")) return Reason::notPermitted;
    if (is(".NoReply") || is(".Timeout") || is(".TimedOut")) return Reason::timeout;
    if (is(".UnknownObject") || is(".UnknownMethod") || is(".UnknownInterface") || is(".UnknownProperty") ||
        is(".UnknownDevice") || is(".InterfaceUnknown") || is(".NoSuchLink"))
        return Reason::notFound;
    return Reason::unavailable;
}

Error errorOf(const std::string& service, sd_bus_message* reply) {
    const sd_bus_error* error = sd_bus_message_get_error(reply);
    const std::string name = error->name != nullptr ? error->name : "";
    const std::string text = error->message != nullptr ? error->message : name;
    return failure(reasonOf(name), service + " answered: " + text.substr(0, 200));
}

int appendByteTexts(sd_bus_message* message, const BusByteTexts& texts) {
    int result = sd_bus_message_open_container(message, 'v', "aay");
    if (result >= 0) result = sd_bus_message_open_container(message, 'a', "ay");
    for (const auto& text : texts)
        if (result >= 0) result = sd_bus_message_append_array(message, 'y', text.data(), text.size());
    if (result >= 0) result = sd_bus_message_close_container(message);
    return result < 0 ? result : sd_bus_message_close_container(message);
}

int appendOption(sd_bus_message* message, const std::string& key, const BusOption& value) {
    int result = sd_bus_message_open_container(message, 'e', "sv");
    if (result >= 0) result = sd_bus_message_append(message, "s", key.c_str());
    if (result < 0) return result;
    const auto* text = std::get_if<std::string>(&value);
    result = text != nullptr ? sd_bus_message_append(message, "v", "s", text->c_str())
                             : appendByteTexts(message, std::get<BusByteTexts>(value));
    return result < 0 ? result : sd_bus_message_close_container(message);
}

int appendOptions(sd_bus_message* message, const BusOptions& options) {
    int result = sd_bus_message_open_container(message, 'a', "{sv}");
    for (const auto& [key, value] : options) {
        if (result < 0) return result;
        result = appendOption(message, key, value);
    }
    return result < 0 ? result : sd_bus_message_close_container(message);
}

int append(sd_bus_message* message, const BusArgument& argument) {
    if (const auto* text = std::get_if<std::string>(&argument))
        return sd_bus_message_append(message, "s", text->c_str());
    if (const auto* number = std::get_if<std::int32_t>(&argument))
        return sd_bus_message_append(message, "i", *number);
    if (const auto* path = std::get_if<BusPath>(&argument))
        return sd_bus_message_append(message, "o", path->path.c_str());
    if (const auto* flag = std::get_if<BusFlagVariant>(&argument))
        return sd_bus_message_append(message, "v", "b", static_cast<int>(flag->flag));
    return appendOptions(message, std::get<BusOptions>(argument));
}

int keepReply(sd_bus_message* reply, void* place, sd_bus_error*) {
    static_cast<Message*>(place)->reset(sd_bus_message_ref(reply));
    return 1;
}

/// Turns the connection until the reply is there; waiting is the caller's own, so that it can be cancelled.
Wait turnUntil(sd_bus* bus, const Message& reply, const Until& until, int& broken) {
    while (true) {
        const int progress = sd_bus_process(bus, nullptr);
        if (progress < 0) return broken = progress, Wait::ready;
        if (reply) return Wait::ready;
        if (progress > 0) continue;
        const int events = sd_bus_get_events(bus), fd = sd_bus_get_fd(bus);
        if (events < 0 || fd < 0) return broken = events < 0 ? events : fd, Wait::ready;
        pollfd descriptor{fd, static_cast<short>(events), 0};
        const Wait wake = waitAny({&descriptor, 1}, until);
        if (wake != Wait::ready) return wake;
    }
}

}  // namespace

void Bus::Close::operator()(sd_bus* bus) const {
    sd_bus_close_unref(bus);
}

Known<Bus> Bus::system() {
    const char* address = std::getenv("DBUS_SYSTEM_BUS_ADDRESS");
    return at(address != nullptr ? address : "unix:path=/run/dbus/system_bus_socket");
}

Known<Bus> Bus::at(const std::string& address) {
    sd_bus* raw = nullptr;
    int result = sd_bus_new(&raw);
    Bus bus(raw);
    if (result >= 0) result = sd_bus_set_address(raw, address.c_str());
    if (result >= 0) result = sd_bus_set_bus_client(raw, 1);
    if (result >= 0) result = sd_bus_start(raw);
    if (result < 0) return failure(Reason::unavailable, "there is no message bus");
    return bus;
}

Known<BusValue> Bus::call(const BusObject& object, const std::string& interface, const std::string& method,
                          const std::vector<BusArgument>& arguments, const Until& until) {
    sd_bus_message* raw = nullptr;
    int result = sd_bus_message_new_method_call(bus_.get(), &raw, object.service.c_str(), object.path.c_str(),
                                                interface.c_str(), method.c_str());
    const Message message(raw);
    if (result >= 0) result = sd_bus_message_set_auto_start(raw, 0);
    for (const BusArgument& argument : arguments)
        if (result >= 0) result = append(raw, argument);
    if (result < 0) return lost(object.service, result);

    Message reply;
    sd_bus_slot* rawSlot = nullptr;
    // The connection's own timeout stays behind ours, which can also be cancelled.
    const auto patience = std::chrono::microseconds(2 * kReplyTime);
    result = sd_bus_call_async(bus_.get(), &rawSlot, raw, keepReply, &reply,
                               static_cast<std::uint64_t>(patience.count()));
    const Slot slot(rawSlot);
    if (result < 0) return lost(object.service, result);
    int broken = 0;
    const Wait wake = turnUntil(bus_.get(), reply, until.within(kReplyTime), broken);
    if (wake != Wait::ready) return waitFailure(wake, object.service);
    if (broken < 0) return lost(object.service, broken);
    if (sd_bus_message_is_method_error(reply.get(), nullptr) > 0) return errorOf(object.service, reply.get());
    return readBody(reply.get());
}

Known<BusValue> Bus::properties(const BusObject& object, const std::string& interface, const Until& until) {
    return call(object, "org.freedesktop.DBus.Properties", "GetAll", {interface}, until);
}

Known<BusValue> Bus::property(const BusObject& object, const std::string& interface, const std::string& name,
                              const Until& until) {
    return call(object, "org.freedesktop.DBus.Properties", "Get", {interface, name}, until);
}

Known<BusValue> Bus::managedObjects(const BusObject& object, const Until& until) {
    return call(object, "org.freedesktop.DBus.ObjectManager", "GetManagedObjects", {}, until);
}

}  // namespace wp
