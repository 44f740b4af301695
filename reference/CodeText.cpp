#include "reference/CodeText.h"

#include "reference/Phrases.h"

namespace pallax {

namespace {

/// Gathers the tables of one log code.
class Tables {
public:
    Tables(const TechnologyReference& technology, const SectionReference& section)
        : _technology(technology), _section(section) {}

    void add(const std::string& heading, const std::string& sentence,
             const std::vector<FieldDescription>& fields,
             const std::vector<ListDescription>& lists) {
        ReferenceTable table{heading, sentence, {}};
        for (const FieldDescription& field : fields) {
            table.rows.push_back(rowOf(field));
        }
        if (!table.rows.empty() || !sentence.empty()) {
            _tables.push_back(std::move(table));
        }
        for (const ListDescription& list : lists) {
            add(headingOf(list), sentenceOf(list), list.fields, list.lists);
        }
    }

    std::vector<ReferenceTable> taken() { return std::move(_tables); }

private:
    ReferenceRow rowOf(const FieldDescription& field) const {
        return {placeOf(field), bitsOf(field),
                field.key,      shownOf(field),
                unitOf(field),  field.key.empty() ? std::string() : meaning(field.key)};
    }

    std::string meaning(std::string_view key) const {
        return std::string(_technology.meaningOf(_section.name, key));
    }

    static std::string headingOf(const ListDescription& list) {
        return list.key.empty() ? "Entries" : "Entries of \"" + list.key + "\"";
    }

    std::string sentenceOf(const ListDescription& list) const {
        return (list.key.empty() ? "" : meaning(list.key) + " ") + layoutOf(list);
    }

    const TechnologyReference& _technology;
    const SectionReference& _section;
    std::vector<ReferenceTable> _tables;
};

} // namespace

CodeText textOf(const TechnologyReference& technology, const SectionReference& section,
                const CodeDescription& code) {
    Tables tables(technology, section);
    if (!code.showsElements()) {
        tables.add("", "", code.fields, code.lists);
    }
    for (const SubpacketDescription& subpacket : code.subpackets) {
        tables.add("Subpacket " + std::to_string(subpacket.id), "", subpacket.fields,
                   subpacket.lists);
    }
    return {hexadecimal(code.logCode) + ", " + std::string(technology.nameOf(code.logCode)),
            demandsOf(code), tables.taken()};
}

ReferenceTable objectTable(const SectionReference& section) {
    ReferenceTable table;
    for (const ObjectKey& key : section.objectKeys) {
        table.rows.push_back({"", "", key.name, "", "", std::string(key.meaning)});
    }
    return table;
}

} // namespace pallax
