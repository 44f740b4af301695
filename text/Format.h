#pragma once

#include <concepts>
#include <cstdint>
#include <initializer_list>
#include <string>
#include <string_view>
#include <type_traits>
#include <variant>

namespace pallax {

class Text;

/// One argument of `formatText`; converts from every type that log lines use.
class FormatArgument {
public:
    template <std::integral Integer>
    FormatArgument(Integer number) : _value(static_cast<std::int64_t>(number)) {}
    FormatArgument(double number) : _value(number) {}
    FormatArgument(std::string_view text) : _value(text) {}
    FormatArgument(const std::string& text) : _value(std::string_view(text)) {}
    FormatArgument(const char* text) : _value(std::string_view(text)) {}
    FormatArgument(const void* address) : _value(address) {}
    FormatArgument(const Text& text);
    /// An object's printed form, for %@; made only when needed.
    template <class Described>
    requires requires(const Described& object) {
        { object.description() } -> std::same_as<std::string>;
    }
    FormatArgument(const Described& object)
        : _value(Object{&object, [](const void* described) {
                            return static_cast<const Described*>(described)->description();
                        }}) {}

    /// An object and its printing function.
    struct Object {
        const void* object;
        std::string (*description)(const void* object);
    };
    using Value = std::variant<std::int64_t, double, std::string_view, const void*, Object>;
    const Value& value() const { return _value; }

private:
    Value _value;
};

/// printf in the C locale, with two additions of the system's vocabulary: %@ takes any text or
/// object, and arguments carry their type (a conversion that does not fit its argument prints the
/// argument by its own type). A missing argument prints nothing.
std::string formatText(std::string_view format, std::initializer_list<FormatArgument> arguments);

/// "<01000000 1641>": a dump of raw bytes, in groups of four.
std::string dumpOf(const std::uint8_t* data, std::size_t size);

} // namespace pallax
