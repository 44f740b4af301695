// Compares files of another codec with their content, which is beside them as tagged JSON.

#include "tests/doubles/Files.h"
#include "tests/plist/PropertyListSupport.h"
#include "text/Base64.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <filesystem>
#include <fstream>

namespace pallax {
namespace {

using doubles::contentOf;

PropertyList fromTagged(const nlohmann::ordered_json& tagged);

PropertyList dictionaryFrom(const nlohmann::ordered_json& pairs) {
    Dictionary entries;
    for (const auto& pair : pairs) {
        entries.set(pair.at(0).get<std::string>(), fromTagged(pair.at(1)));
    }
    return entries;
}

PropertyList arrayFrom(const nlohmann::ordered_json& values) {
    Array elements;
    for (const auto& value : values) {
        elements.push_back(fromTagged(value));
    }
    return elements;
}

PropertyList fromTagged(const nlohmann::ordered_json& tagged) {
    const std::string tag = tagged.begin().key();
    const auto& value = tagged.begin().value();
    if (tag == "dictionary") {
        return dictionaryFrom(value);
    }
    if (tag == "array") {
        return arrayFrom(value);
    }
    if (tag == "boolean") {
        return PropertyList::boolean(value.get<bool>());
    }
    const auto text = value.get<std::string>();
    if (tag == "string") {
        return text;
    }
    if (tag == "integer") {
        return PropertyList::integer(std::stoll(text));
    }
    if (tag == "real") {
        return PropertyList::real(std::stod(text));
    }
    if (tag == "data") {
        return PropertyList::data(parseBase64(text).value());
    }
    EXPECT_EQ(tag, "date");
    return parseIsoDate(text).value();
}

bool sameOrderAtEveryDepth(const PropertyList& a, const PropertyList& b) {
    if (const ArrayRef array = a.array()) {
        return std::equal(array->begin(), array->end(), b.array()->begin(), sameOrderAtEveryDepth);
    }
    if (const DictionaryRef dictionary = a.dictionary()) {
        return std::equal(dictionary->begin(), dictionary->end(), b.dictionary()->begin(),
                          [](const Dictionary::Entry& left, const Dictionary::Entry& right) {
                              return left.key == right.key &&
                                     sameOrderAtEveryDepth(left.value, right.value);
                          });
    }
    return true;
}

class PropertyListFiles : public testing::TestWithParam<std::string> {
protected:
    static std::string path(const std::string& extension) {
        return PALLAX_SOURCE_DIR "/tests/data/plists/" + GetParam() + extension;
    }
};

TEST_P(PropertyListFiles, HoldsItsContent) {
    std::ifstream json(path(".json"));
    const PropertyList expected = fromTagged(nlohmann::ordered_json::parse(json));
    const PropertyList list = valueOf(parsePropertyList(bytesOf(contentOf(path(".bplist")))));
    ASSERT_EQ(list, expected);
    EXPECT_TRUE(sameOrderAtEveryDepth(list, expected));
    EXPECT_EQ(valueOf(parsePropertyList(*serializeBinary(list))), list);
    EXPECT_EQ(valueOf(parsePropertyList(bytesOf(*serializeXml(list)))), list);
}

TEST_P(PropertyListFiles, ACopyTruncatedAtAnyLengthIsRefused) {
    const ByteBuffer bytes = bytesOf(contentOf(path(".bplist")));
    for (std::size_t length = 0; length < bytes.size(); ++length) {
        // A separate copy, so that a sanitizer detects a read past the cut.
        const ByteBuffer cut(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length));
        EXPECT_FALSE(parseBinaryPropertyList(cut)) << length << " bytes";
    }
}

std::vector<std::string> names() {
    std::vector<std::string> found;
    for (const auto& entry :
         std::filesystem::directory_iterator(PALLAX_SOURCE_DIR "/tests/data/plists")) {
        if (entry.path().extension() == ".bplist") {
            found.push_back(entry.path().stem().string());
        }
    }
    std::sort(found.begin(), found.end());
    return found;
}

// A name of letters and digits only, as GoogleTest requires.
std::string testName(const testing::TestParamInfo<std::string>& info) {
    std::string name;
    std::copy_if(info.param.begin(), info.param.end(), std::back_inserter(name),
                 [](char letter) { return letter != '-'; });
    return name;
}

INSTANTIATE_TEST_SUITE_P(AnotherCodec, PropertyListFiles, testing::ValuesIn(names()), testName);

} // namespace
} // namespace pallax
