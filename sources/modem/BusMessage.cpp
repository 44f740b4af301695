#include "sources/modem/BusMessage.h"

#include <string>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

/// Reads values one after the other. At the first that cannot be read, all that follows is null.
class Reader {
public:
    explicit Reader(sd_bus_message* message) : _message(message) {}

    Array all() {
        Array values;
        while (hasMore()) {
            values.push_back(next());
        }
        return values;
    }

private:
    bool hasMore() { return _left > 0 && sd_bus_message_at_end(_message, 0) == 0; }

    PropertyList next() {
        --_left;
        char type = 0;
        const char* contents = nullptr;
        if (sd_bus_message_peek_type(_message, &type, &contents) <= 0) {
            _left = 0;
            return {};
        }
        switch (type) {
        case SD_BUS_TYPE_ARRAY:
            return contents[0] == SD_BUS_TYPE_DICT_ENTRY_BEGIN ? dictionary(contents)
                                                               : array(type, contents);
        case SD_BUS_TYPE_STRUCT:
            return array(type, contents);
        case SD_BUS_TYPE_VARIANT:
            return variant(contents);
        case SD_BUS_TYPE_STRING:
        case SD_BUS_TYPE_OBJECT_PATH:
        case SD_BUS_TYPE_SIGNATURE: {
            const auto text = basic<const char*>(type);
            const std::string_view whole = text != nullptr ? text : "";
            return std::string(whole.substr(0, kLongestBusText));
        }
        case SD_BUS_TYPE_DOUBLE:
            return PropertyList::real(basic<double>(type));
        case SD_BUS_TYPE_BOOLEAN:
            return PropertyList::boolean(basic<int>(type) != 0);
        default:
            return integer(type);
        }
    }

    template <class Value>
    Value basic(char type) {
        Value value{};
        if (sd_bus_message_read_basic(_message, type, &value) <= 0) {
            _left = 0;
            return Value{};
        }
        return value;
    }

    PropertyList integer(char type) {
        switch (type) {
        case SD_BUS_TYPE_BYTE:
            return PropertyList::integer(basic<std::uint8_t>(type));
        case SD_BUS_TYPE_INT16:
            return PropertyList::integer(basic<std::int16_t>(type));
        case SD_BUS_TYPE_UINT16:
            return PropertyList::integer(basic<std::uint16_t>(type));
        case SD_BUS_TYPE_INT32:
            return PropertyList::integer(basic<std::int32_t>(type));
        case SD_BUS_TYPE_UINT32:
            return PropertyList::integer(basic<std::uint32_t>(type));
        case SD_BUS_TYPE_INT64:
            return PropertyList::integer(basic<std::int64_t>(type));
        case SD_BUS_TYPE_UINT64:
            return PropertyList::unsignedInteger(basic<std::uint64_t>(type));
        default: // a file descriptor
            (void)sd_bus_message_skip(_message, nullptr);
            return {};
        }
    }

    bool enter(char type, const char* contents) {
        const bool isInside = sd_bus_message_enter_container(_message, type, contents) > 0;
        _left = isInside ? _left : 0;
        return isInside;
    }
    /// What is left over is skipped, with all that follows.
    void leave() {
        if (_left > 0 && sd_bus_message_exit_container(_message) < 0) {
            _left = 0;
        }
    }

    PropertyList variant(const char* contents) {
        if (!enter(SD_BUS_TYPE_VARIANT, contents)) {
            return {};
        }
        PropertyList value = hasMore() ? next() : PropertyList();
        leave();
        return value;
    }

    PropertyList array(char type, const char* contents) {
        Array elements;
        if (enter(type, contents)) {
            elements = all();
            leave();
        }
        return elements;
    }

    PropertyList dictionary(const char* contents) {
        Dictionary entries;
        if (!enter(SD_BUS_TYPE_ARRAY, contents)) {
            return entries;
        }
        // The signature of an entry is that of the array without its braces.
        const std::string_view braced = contents;
        const std::string entry(braced.substr(1, braced.size() - 2));
        while (hasMore() && enter(SD_BUS_TYPE_DICT_ENTRY, entry.c_str())) {
            const PropertyList key = next();
            PropertyList value = hasMore() ? next() : PropertyList();
            leave();
            const auto number = key.integer();
            entries.set(Text(number ? std::to_string(*number) : key.string().value_or("")),
                        std::move(value));
        }
        leave();
        return entries;
    }

    sd_bus_message* _message;
    std::size_t _left = kMostBusValues;
};

} // namespace

Array argumentsOf(sd_bus_message* message) {
    return Reader(message).all();
}

BusReply replyOf(sd_bus_message* message) {
    if (const sd_bus_error* error = sd_bus_message_get_error(message)) {
        return BusError{error->name != nullptr ? error->name : "",
                        error->message != nullptr ? error->message : ""};
    }
    Array arguments = argumentsOf(message);
    return arguments.empty() ? PropertyList() : std::move(arguments.front());
}

} // namespace pallax
