#pragma once

#include <utility>
#include <variant>

namespace pallax {

/// A value or an error. Their types must differ.
template <class Value, class Error>
class [[nodiscard]] Result {
public:
    Result(Value value) : _content(std::in_place_index<0>, std::move(value)) {}
    Result(Error error) : _content(std::in_place_index<1>, std::move(error)) {}

    explicit operator bool() const { return _content.index() == 0; }

    /// Only if the result is true.
    const Value& value() const& { return std::get<0>(_content); }
    Value&& value() && { return std::get<0>(std::move(_content)); }
    const Value& operator*() const& { return value(); }
    const Value* operator->() const { return &value(); }

    /// Only if the result is false.
    const Error& error() const { return std::get<1>(_content); }

private:
    std::variant<Value, Error> _content;
};

} // namespace pallax
