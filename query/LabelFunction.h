#pragma once

#include <vector>

namespace pallax {

class Database;
class FieldTable;

/// Adds label(field, raw): the label of a raw number; NULL for a number that is shown itself. The
/// fields, of at least one technology, must outlive the database.
void addLabelFunction(Database& database, std::vector<const FieldTable*> technologies);

} // namespace pallax
