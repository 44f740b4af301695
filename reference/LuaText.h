#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace pallax {

/// A text as a Lua literal.
std::string luaText(std::string_view text);

/// Builds one Lua table, on one line: { key = value, … }.
class LuaTable {
public:
    LuaTable& text(std::string_view key, std::string_view value);
    LuaTable& number(std::string_view key, double value);
    LuaTable& integer(std::string_view key, std::int64_t value);
    LuaTable& truth(std::string_view key, bool value);
    /// `value` must be Lua code.
    LuaTable& raw(std::string_view key, std::string_view value);
    /// An element without a key.
    LuaTable& element(std::string_view value);

    std::string str() const { return "{ " + _body + " }"; }
    bool empty() const { return _body.empty(); }

private:
    std::string _body;
};

} // namespace pallax
