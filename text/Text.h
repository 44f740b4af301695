#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <utility>

namespace pallax {

/// An immutable UTF-8 text that is cheap to copy: a view of a text that lives as long as the
/// program (a label or key from a constexpr table), or a shared owned string.
class Text {
public:
    Text() = default;
    Text(std::string owned)
        : _owner(std::make_shared<const std::string>(std::move(owned))), _view(*_owner) {}
    Text(const char* copied) : Text(std::string(copied)) {}
    explicit Text(std::string_view copied) : Text(std::string(copied)) {}

    /// A text with static storage duration; allocates nothing.
    static Text fixed(std::string_view staticText) {
        Text text;
        text._view = staticText;
        return text;
    }

    std::string_view view() const { return _view; }
    std::string string() const { return std::string(_view); }
    /// The text as a string that outlives this object: the owned string, or a copy of a fixed text.
    std::shared_ptr<const std::string> sharedString() const {
        return _owner ? _owner : std::make_shared<const std::string>(_view);
    }

    friend bool operator==(const Text& a, const Text& b) { return a._view == b._view; }

private:
    std::shared_ptr<const std::string> _owner;
    std::string_view _view;
};

} // namespace pallax
