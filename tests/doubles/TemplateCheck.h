#pragma once

#include "LogGenerator/Records/ClassIndex.h"
#include "plist/PropertyListCodec.h"
#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <map>
#include <string>

namespace pallax::doubles {

/// The property list in a file of the source tree; null, with a failed expectation, if there is
/// none.
inline PropertyList propertyListFile(const std::string& path) {
    const std::string content = contentOf(path);
    const PropertyListResult parsed = parsePropertyList(ByteBuffer(content.begin(), content.end()));
    EXPECT_TRUE(parsed) << path;
    return parsed ? *parsed : PropertyList();
}

/// Every key of a template, at any depth, with its value.
inline void collectKeys(const PropertyList& object, std::map<std::string, PropertyList>& keys) {
    if (const DictionaryRef entries = object.dictionary()) {
        for (const Dictionary::Entry& entry : *entries) {
            keys[entry.key.string()] = entry.value;
            collectKeys(entry.value, keys);
        }
    }
}

/// Compares a template with a class index: every record has its section, of the right kind and
/// empty at the start, and every section has its record.
inline void expectTemplateMatches(const PropertyList& templateObject, const ClassIndex& index) {
    std::map<std::string, PropertyList> keys;
    collectKeys(templateObject, keys);
    EXPECT_EQ(index.records().size(), index.classes().size());
    for (const auto& [record, firstRow] : index.records()) {
        const std::string name(record->getSectionName());
        ASSERT_TRUE(keys.contains(name)) << name << " is missing in the template";
        const PropertyList& section = keys.at(name);
        if (record->sectionKind() == SectionKind::List) {
            EXPECT_EQ(section, PropertyList(Array())) << name << " is a list";
        } else {
            EXPECT_EQ(section, PropertyList(Dictionary())) << name << " holds keys";
        }
    }
    for (const auto& [name, value] : keys) {
        EXPECT_NE(index.getClass(name), nullptr) << name << " has no record";
    }
}

} // namespace pallax::doubles
