#pragma once

#include "LogGenerator/LogPacket.h"
#include "LogGenerator/Records/Base.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

namespace pallax::doubles {

/// A record class with a section of its own, fed with records and read back.
template <class RecordClass>
class RecordFixture {
public:
    RecordFixture() {
        _record.initWithDict(_classDict, _codeDict);
        if (_record.sectionKind() == SectionKind::List) {
            _section = Array();
        } else {
            _section = Dictionary();
        }
        _record.updateSectionRef(_section);
        (void)_log.take();
    }

    /// Feeds a record under the code in its header; the lines that it logs are kept.
    void feed(const ByteBuffer& bytes) { feed(bytes, LogPacketGetLogCode(LogRecord(bytes))); }
    void feed(const Record& record) { feed(record.bytes()); }
    void feed(const ByteBuffer& bytes, LogCode logCode) {
        _record.updateWithData(LogRecord(bytes), logCode);
        lines = _log.take();
    }

    Dictionary& keys() { return *_section.dictionary(); }
    Array& list() { return *_section.array(); }
    const PropertyList& section() const { return _section; }
    /// The section as it is now, detached from later changes.
    PropertyList snapshot() const { return _section.shallowCopy(); }
    /// The text under a key; "(absent)" without it.
    std::string text(std::string_view key) {
        const PropertyList* value = keys().find(key);
        return value != nullptr ? value->string().value_or("(no text)") : "(absent)";
    }
    RecordClass& record() { return _record; }
    /// The codes that the record class wants, in its order.
    std::vector<LogCode> subscriptions() const {
        const auto codes = _record.getLogCodeArray();
        return {codes.begin(), codes.end()};
    }

    /// What the last record logged.
    std::vector<RecordingLog::Line> lines;

private:
    RecordingLog _log;
    ClassDict _classDict;
    CodeDict _codeDict;
    RecordClass _record;
    PropertyList _section;
};

/// The section of a fresh record after one log record.
template <class RecordClass>
PropertyList sectionAfter(const Record& record) {
    RecordFixture<RecordClass> fixture;
    fixture.feed(record);
    return fixture.section();
}

/// Feeds a record cut at every length below `minimum` to a fixture and asserts that its section
/// stays as it was, then cut at every further length, which must neither throw nor read outside
/// (each cut is a buffer of its own, so that a sanitizer sees it).
template <class RecordClass>
void cutAtEveryLength(const Record& record, std::size_t minimum) {
    RecordFixture<RecordClass> fixture;
    const PropertyList before = fixture.snapshot();
    const LogCode logCode = LogPacketGetLogCode(LogRecord(record.bytes()));
    for (std::size_t length = 0; length < record.bytes().size(); ++length) {
        const ByteBuffer cut(record.bytes().begin(),
                             record.bytes().begin() + static_cast<std::ptrdiff_t>(length));
        fixture.feed(cut, logCode);
        if (length < minimum) {
            EXPECT_EQ(fixture.section(), before) << "cut at " << length;
        }
    }
}

/// Compares dictionaries with their order, printing both on failure.
inline void expectInOrder(const PropertyList& actual, const Dictionary& expected) {
    ASSERT_NE(actual.dictionary(), nullptr) << actual.description();
    EXPECT_TRUE(sameInOrder(*actual.dictionary(), expected))
        << "actual:   " << actual.description()
        << "\nexpected: " << PropertyList(expected).description();
}

} // namespace pallax::doubles

namespace pallax {

inline void PrintTo(const PropertyList& object, std::ostream* out) { // NOLINT: gtest's name
    *out << object.description();
}

} // namespace pallax
