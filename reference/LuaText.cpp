#include "reference/LuaText.h"

#include "reference/Phrases.h"

namespace pallax {

std::string luaText(std::string_view text) {
    std::string result("\"");
    for (const char character : text) {
        if (character == '"' || character == '\\') {
            result.push_back('\\');
        }
        result.push_back(character);
    }
    return result.append("\"");
}

LuaTable& LuaTable::text(std::string_view key, std::string_view value) {
    return raw(key, luaText(value));
}

LuaTable& LuaTable::number(std::string_view key, double value) {
    return raw(key, decimal(value));
}

LuaTable& LuaTable::integer(std::string_view key, std::int64_t value) {
    return raw(key, std::to_string(value));
}

LuaTable& LuaTable::truth(std::string_view key, bool value) {
    return raw(key, value ? "true" : "false");
}

LuaTable& LuaTable::raw(std::string_view key, std::string_view value) {
    return element(std::string(key).append(" = ").append(value));
}

LuaTable& LuaTable::element(std::string_view value) {
    _body.append(_body.empty() ? "" : ", ").append(value);
    return *this;
}

} // namespace pallax
