#pragma once

#include "LogGenerator/Records/LayoutRecord.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/RecordingLog.h"

#include <iosfwd>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::doubles {

/// A section for a record class, which is fed with log records and read back.
class SectionFixture {
public:
    virtual ~SectionFixture() = default;
    SectionFixture(const SectionFixture&) = delete;
    SectionFixture& operator=(const SectionFixture&) = delete;

    /// Feeds a log record under the code in its header and keeps the lines that it logs.
    void feed(const ByteBuffer& bytes);
    void feed(const Record& record);
    void feed(const ByteBuffer& bytes, LogCode logCode);

    Dictionary& keys() { return *_section.dictionary(); }
    Array& list() { return *_section.array(); }
    const PropertyList& section() const { return _section; }
    /// A copy of the section, detached from later changes.
    PropertyList snapshot() const;
    /// The text under a key; "(absent)" if missing.
    std::string text(std::string_view key);
    /// The codes of the record class, in its order.
    std::vector<LogCode> subscriptions() const;

    /// The lines of the last log record.
    std::vector<RecordingLog::Line> lines;

protected:
    SectionFixture() = default;
    /// Gives the record its section; it must live as long as the fixture.
    void begin(LayoutRecord& record);

private:
    RecordingLog _log;
    ClassDict _classDict;
    CodeDict _codeDict;
    Base* _base = nullptr;
    PropertyList _section;
};

/// A record of a class with its section.
template <class RecordClass>
class RecordFixture : public SectionFixture {
public:
    RecordFixture() { begin(_record); }

    RecordClass& record() { return _record; }

private:
    RecordClass _record;
};

/// The section of a fresh record after one log record.
template <class RecordClass>
PropertyList sectionAfter(const Record& record) {
    RecordFixture<RecordClass> fixture;
    fixture.feed(record);
    return fixture.section();
}

/// Feeds a log record cut at every length to a fixture. Below `minimum` the section must not
/// change; from there on, reading must neither throw nor read outside the record (each cut is a
/// separate buffer, so that a sanitizer detects this).
void cutAtEveryLength(SectionFixture& fixture, const Record& record, std::size_t minimum);

template <class RecordClass>
void cutAtEveryLength(const Record& record, std::size_t minimum) {
    RecordFixture<RecordClass> fixture;
    cutAtEveryLength(fixture, record, minimum);
}

/// Compares dictionaries including their order; prints both on failure.
void expectInOrder(const PropertyList& actual, const Dictionary& expected);

} // namespace pallax::doubles

namespace pallax {

void PrintTo(const PropertyList& object, std::ostream* out); // NOLINT: gtest's name

} // namespace pallax
