#include "linux/dbus/message_reader.h"

#include <systemd/sd-bus.h>

namespace wp {
namespace {

class Reader {
  public:
    explicit Reader(sd_bus_message* message) : message_(message) {}

    bool readAll(BusValue::List& into, unsigned depth) {
        while (true) {
            const int at = sd_bus_message_at_end(message_, 0);
            if (at < 0) return false;
            if (at > 0) return true;
            if (!readOne(into.emplace_back(), depth)) return false;
        }
    }

  private:
    bool readOne(BusValue& into, unsigned depth) {
        char type = 0;
        const char* contents = nullptr;
        if (depth > kDeepestValue || ++values_ > kMostValues) return false;
        if (sd_bus_message_peek_type(message_, &type, &contents) <= 0) return false;
        switch (type) {
            case SD_BUS_TYPE_VARIANT:
                return readVariant(into, contents, depth);
            case SD_BUS_TYPE_ARRAY:
                return readArray(into, contents, depth);
            case SD_BUS_TYPE_STRUCT:
                return readStruct(into, contents, depth);
            default:
                return readBasic(into, type);
        }
    }

    bool readVariant(BusValue& into, const char* contents, unsigned depth) {
        return sd_bus_message_enter_container(message_, SD_BUS_TYPE_VARIANT, contents) > 0 &&
               readOne(into, depth + 1) && sd_bus_message_exit_container(message_) >= 0;
    }

    bool readStruct(BusValue& into, const char* contents, unsigned depth) {
        BusValue::List members;
        if (sd_bus_message_enter_container(message_, SD_BUS_TYPE_STRUCT, contents) <= 0 ||
            !readAll(members, depth + 1) || sd_bus_message_exit_container(message_) < 0)
            return false;
        into = BusValue(std::move(members));
        return true;
    }

    bool readArray(BusValue& into, const char* contents, unsigned depth) {
        if (contents[0] == SD_BUS_TYPE_BYTE) return readBytes(into);
        if (contents[0] == SD_BUS_TYPE_DICT_ENTRY_BEGIN) return readMap(into, contents, depth);
        BusValue::List elements;
        if (sd_bus_message_enter_container(message_, SD_BUS_TYPE_ARRAY, contents) < 0 ||
            !readAll(elements, depth + 1) || sd_bus_message_exit_container(message_) < 0)
            return false;
        into = BusValue(std::move(elements));
        return true;
    }

    bool readBytes(BusValue& into) {
        const void* data = nullptr;
        std::size_t size = 0;
        if (sd_bus_message_read_array(message_, SD_BUS_TYPE_BYTE, &data, &size) < 0 || !spend(size))
            return false;
        const auto* first = static_cast<const std::uint8_t*>(data);
        into = BusValue(size == 0 ? BusValue::Bytes() : BusValue::Bytes(first, first + size));
        return true;
    }

    bool readMap(BusValue& into, const char* contents, unsigned depth) {
        const std::string entry(contents + 1,
                                contents[0] != '\0' ? std::char_traits<char>::length(contents) - 2 : 0);
        BusValue::Map entries;
        if (sd_bus_message_enter_container(message_, SD_BUS_TYPE_ARRAY, contents) < 0) return false;
        while (sd_bus_message_at_end(message_, 0) == 0) {
            BusValue key, value;
            if (sd_bus_message_enter_container(message_, SD_BUS_TYPE_DICT_ENTRY, entry.c_str()) <= 0 ||
                !readOne(key, depth + 1) || !readOne(value, depth + 1) ||
                sd_bus_message_exit_container(message_) < 0)
                return false;
            const auto number = key.number();
            entries.insert_or_assign(number ? std::to_string(*number) : key.text(), std::move(value));
        }
        into = BusValue(std::move(entries));
        return sd_bus_message_exit_container(message_) >= 0;
    }

    template <class Raw, class Wide>
    bool readAs(BusValue& into, char type) {
        Raw raw{};
        if (sd_bus_message_read_basic(message_, type, &raw) <= 0) return false;
        into = BusValue(static_cast<Wide>(raw));
        return true;
    }

    bool readText(BusValue& into, char type) {
        const char* text = nullptr;
        if (sd_bus_message_read_basic(message_, type, &text) <= 0) return false;
        into = BusValue(std::string(text));
        return spend(into.as<std::string>()->size());
    }

    bool readBasic(BusValue& into, char type) {
        switch (type) {
            case SD_BUS_TYPE_BYTE:
                return readAs<std::uint8_t, std::uint64_t>(into, type);
            case SD_BUS_TYPE_BOOLEAN:
                return readAs<int, bool>(into, type);
            case SD_BUS_TYPE_INT16:
                return readAs<std::int16_t, std::int64_t>(into, type);
            case SD_BUS_TYPE_UINT16:
                return readAs<std::uint16_t, std::uint64_t>(into, type);
            case SD_BUS_TYPE_INT32:
                return readAs<std::int32_t, std::int64_t>(into, type);
            case SD_BUS_TYPE_UINT32:
                return readAs<std::uint32_t, std::uint64_t>(into, type);
            case SD_BUS_TYPE_INT64:
                return readAs<std::int64_t, std::int64_t>(into, type);
            case SD_BUS_TYPE_UINT64:
                return readAs<std::uint64_t, std::uint64_t>(into, type);
            case SD_BUS_TYPE_DOUBLE:
                return readAs<double, double>(into, type);
            case SD_BUS_TYPE_STRING:
            case SD_BUS_TYPE_OBJECT_PATH:
            case SD_BUS_TYPE_SIGNATURE:
                return readText(into, type);
            default:
                return false;  // descriptors are of no use here
        }
    }

    bool spend(std::size_t bytes) { return (bytes_ += bytes) <= kMostBytes; }

    sd_bus_message* message_;
    unsigned values_ = 0;
    std::size_t bytes_ = 0;
};

}  // namespace

Known<BusValue> readBody(sd_bus_message* message) {
    BusValue::List values;
    if (sd_bus_message_rewind(message, 1) < 0 || !Reader(message).readAll(values, 0))
        return failure(Reason::malformed, "a reply on the message bus has an unexpected form or size");
    if (values.size() == 1) return std::move(values.front());
    return BusValue(std::move(values));
}

}  // namespace wp
