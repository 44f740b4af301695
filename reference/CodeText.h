#pragma once

#include "fields/Reference.h"

#include <string>
#include <vector>

/// The texts and rows of a section's documentation, shared by the manual page and docs/records,
/// without the markup of either.
namespace pallax {

struct ReferenceRow {
    std::string place; ///< bytes, or the key of a property list
    std::string bits;
    std::string key; ///< empty for a list of plain values
    std::string shown;
    std::string unit;
    std::string meaning;
};

/// The fields of a record, of the entries of a list, or of a subpacket.
struct ReferenceTable {
    std::string heading;  ///< empty for the record itself
    std::string sentence; ///< the layout of the entries; may be empty
    std::vector<ReferenceRow> rows;
};

struct CodeText {
    std::string title; ///< "0xB17F, Idle-mode measurement of the serving cell"
    std::string demands;
    std::vector<ReferenceTable> tables;
};

CodeText textOf(const TechnologyReference& technology, const SectionReference& section,
                const CodeDescription& code);

/// For IFX: the keys and their meanings.
ReferenceTable objectTable(const SectionReference& section);

} // namespace pallax
