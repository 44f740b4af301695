#pragma once

#include "plist/PropertyList.h"
#include "text/NumberFormat.h"

#include <optional>
#include <string_view>
#include <variant>

namespace pallax {

/// A text with a number, or a number and its unit: "62", "-96.0 dBm".
struct NumberText {
    std::string_view text;
    double number;
    std::string_view unit; ///< part of the text; may be empty
};

/// The number in a text, with its unit if it has one; nothing for other texts.
std::optional<NumberText> numberTextIn(std::string_view text);

/// The value of a field: a number with its format, a label from a table, a text, or an object of a
/// property list. Texts and objects that are not from a table are valid until the sample is taken.
class SampleValue {
public:
    SampleValue(const DisplayNumber& number) : _value(number) {}
    /// A text with static storage duration.
    static SampleValue label(std::string_view text) { return SampleValue(Value(Label{text})); }
    /// A text made for this sample.
    static SampleValue text(std::string_view text) { return SampleValue(Value(text)); }
    static SampleValue text(const NumberText& text) { return SampleValue(Value(&text)); }
    static SampleValue object(const PropertyList& object) { return SampleValue(Value(&object)); }

    /// Null for all other values; the same applies to the functions below.
    const DisplayNumber* number() const { return std::get_if<DisplayNumber>(&_value); }
    const PropertyList* object() const {
        const auto* object = std::get_if<const PropertyList*>(&_value);
        return object != nullptr ? *object : nullptr;
    }
    /// The number in a text, if one was read from it.
    const NumberText* numberText() const {
        const auto* text = std::get_if<const NumberText*>(&_value);
        return text != nullptr ? *text : nullptr;
    }
    /// The text of a label or text; empty for all other values.
    std::string_view words() const {
        if (const auto* label = std::get_if<Label>(&_value)) {
            return label->text;
        }
        if (const NumberText* read = numberText()) {
            return read->text;
        }
        const auto* text = std::get_if<std::string_view>(&_value);
        return text != nullptr ? *text : std::string_view();
    }

    /// Stores the display value in `target`.
    void showIn(PropertyList& target) const {
        if (const DisplayNumber* display = number()) {
            target.assign(*display);
        } else if (const auto* label = std::get_if<Label>(&_value)) {
            target.assign(Text::fixed(label->text));
        } else if (const PropertyList* whole = object()) {
            target = *whole;
        } else if (const Text* held = target.text(); held == nullptr || held->view() != words()) {
            target.assign(Text(words())); // most texts repeat
        }
    }

private:
    struct Label {
        std::string_view text;
    };
    using Value = std::variant<DisplayNumber, Label, std::string_view, const NumberText*,
                               const PropertyList*>;
    explicit SampleValue(Value value) : _value(value) {}

    Value _value;
};

} // namespace pallax
