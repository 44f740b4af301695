#pragma once

#include "query/QueryTable.h"

#include <memory>

namespace pallax {

class FieldTable;

/// `field`: a row for each field, with what the registry says about it.
std::unique_ptr<QueryTable> fieldListTable(const FieldTable& fields);

} // namespace pallax
