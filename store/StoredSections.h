#pragma once

#include <string>

namespace pallax {

class Database;
class FieldTable;

/// Adds a table for each section of a technology and for each list in it, under the names that
/// `addTimelineTables` gives them: of every device and recording in the store `file`, a row for
/// each time in which no value of the section, or of an entry of the list, changes. Rows come by
/// recording, entry and time. The fields must outlive the database.
void addStoredSections(Database& database, const std::string& file, const FieldTable& fields);

} // namespace pallax
