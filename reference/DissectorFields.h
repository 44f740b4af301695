#pragma once

#include "fields/Reference.h"

#include <string>
#include <vector>

/// The parts of a description as Lua tables, without default values.
namespace pallax {

std::string luaPosition(const Position& position);
std::string luaCondition(const Condition& condition);
/// `filter` is the field's name in filters.
std::string luaField(const FieldDescription& field, const std::string& filter);
/// Which part of a property list a record shows.
std::string luaListPart(const ListPart& part);
/// How a list lies and what goes for its entries, without its fields and lists.
std::string luaLayout(const ListDescription& list);

} // namespace pallax
