#pragma once

#include "fields/FieldRegistry.h"
#include "plist/PropertyList.h"

#include <string>
#include <string_view>

/// What the registry knows about a field, as words and as JSON.
namespace pallax {

/// "-140..-12.25"; empty without a range.
std::string rangeWord(const FieldInfo& field);
/// "identity,hidden"; empty without marks.
std::string marksWord(const FieldInfo& field);

/// The field as the dictionary that `pallax fields --json` prints.
Dictionary fieldObject(std::string_view technology, const FieldInfo& field);

} // namespace pallax
