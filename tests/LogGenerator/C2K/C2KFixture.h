#pragma once

#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "app/tree/PallaxModelNode.h"
#include "tests/doubles/C2KLookupNames.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/RecordProperties.h"

#include <algorithm>
#include <string>
#include <vector>

namespace pallax::doubles {

/// A template with one row for each lookup name, with the same name.
inline PropertyList flatTemplate() {
    Dictionary rows;
    for (const std::string& name : kLookupNames) {
        rows.set(name, name);
    }
    return rows;
}

/// The value of all rows at the start of a test.
constexpr const char* kBefore = "what was shown before";

/// A generator with the flat template, which reads packets without prefix.
class C2KFixture {
public:
    C2KFixture() {
        _fixture.resources.add("C2KTemplate", flatTemplate());
        (void)generator.getDisplayFromState(state);
        (void)_log.take();
    }

    /// Feeds a packet without prefix and keeps the lines that reading it logs, without the two
    /// framing lines of every packet.
    void feed(const ByteBuffer& bytes) {
        generator.updateState(state, bytes);
        (void)generator.display(state);
        lines = _log.take();
        std::erase_if(lines, [](const RecordingLog::Line& line) {
            return line.text.starts_with("Log Header ") ||
                   line.text.starts_with("Returning buffer without modifications ");
        });
    }
    void feed(const Record& record) { feed(record.bytes()); }

    /// Marks all rows, to detect which are written.
    void mark() {
        for (const std::string& name : kLookupNames) {
            display()->set(name, kBefore);
        }
    }
    /// The rows written since they were marked, by name.
    Dictionary written() {
        Dictionary rows;
        for (const std::string& name : kLookupNames) {
            if (const PropertyList& value = *display()->find(name);
                !(value == PropertyList(kBefore))) {
                rows.set(name, value);
            }
        }
        return rows;
    }
    /// The marked rows that a packet writes.
    Dictionary writtenBy(const Record& record) {
        mark();
        feed(record);
        return written();
    }

    DictionaryRef display() { return state.find("Display")->dictionary(); }
    const PropertyList& value(std::string_view name) { return *display()->find(name); }
    std::string text(std::string_view name) { return value(name).string().value_or("(no text)"); }
    DictionaryRef extraInfo() { return state.find("ExtraInfo")->dictionary(); }
    /// An integer of the state, or -1.
    std::int64_t kept(std::string_view key) {
        const PropertyList* found = state.find(key);
        return found != nullptr ? found->integer().value_or(-1) : -1;
    }

private:
    GeneratorFixture _fixture;
    RecordingLog _log;

public:
    C2KLogGenerator generator{_fixture.environment()};
    Dictionary state;
    std::vector<RecordingLog::Line> lines; ///< logged by reading the last packet
};

/// A list by pilot as the display tree shows it, "(name: value, name: value)", or "(no list)" if
/// there is no branch.
inline std::string shownList(const PropertyList& list) {
    PathDictionary paths;
    const NodeRef root = PallaxModelNode::makeTreeFromObject(Dictionary{{"List", list}}, paths);
    const auto* children = paths.at("/List")->childNodes();
    if (children == nullptr) {
        return "(no list)";
    }
    std::string text;
    for (const NodeRef& child : *children) {
        text += text.empty() ? "" : ", ";
        text += child->displayName() + ": " + child->value()->string().value_or("(no text)");
    }
    return "(" + text + ")";
}

/// Feeds a packet cut at every length to a fixture; below `minimum` it must write nothing. Each cut
/// is a separate buffer, so that a sanitizer detects a read outside.
inline void cutPacketAtEveryLength(const Record& record, std::size_t minimum) {
    C2KFixture fixture;
    for (std::size_t length = 0; length < record.bytes().size(); ++length) {
        fixture.mark();
        fixture.feed(ByteBuffer(record.bytes().begin(),
                                record.bytes().begin() + static_cast<std::ptrdiff_t>(length)));
        if (length < minimum) {
            EXPECT_EQ(PropertyList(fixture.written()), PropertyList(Dictionary()))
                << "cut at " << length;
        }
        (void)PropertyList(fixture.written()).description();
    }
}

/// A header of that code with random bytes, small ones in half of the cases. The length of the
/// packet is one of `lengths`, or any up to the largest.
inline Record anyPacket(LogCode code, const std::vector<std::size_t>& lengths) {
    constexpr unsigned kSmall = 5;
    constexpr unsigned kAny = 256;
    const std::size_t largest = *std::max_element(lengths.begin(), lengths.end());
    const auto length = any::boolean() ? any::elementOf(lengths)
                                       : LogRecord::kHeaderLength +
                                             any::index(largest + 1 - LogRecord::kHeaderLength);
    const unsigned bound = any::boolean() ? kSmall : kAny;
    const ByteBuffer payload = any::bytesBelow(bound, length - LogRecord::kHeaderLength);
    return Record(code).append(Bytes(payload));
}

/// Checks that packets of random bytes write no other rows; formats every text once.
inline void anyPacketWritesOnly(LogCode code, const std::vector<std::string>& names,
                                const std::vector<std::size_t>& lengths) {
    EXPECT_TRUE(doubles::holds([&names, code, &lengths] {
        C2KFixture fixture;
        fixture.mark();
        for (int count = any::between(1, 4); count > 0; --count) {
            fixture.feed(anyPacket(code, lengths));
        }
        for (const Dictionary::Entry& row : fixture.written()) {
            RC_ASSERT(std::find(names.begin(), names.end(), row.key.string()) != names.end());
            (void)row.value.description();
        }
    }));
}

} // namespace pallax::doubles
