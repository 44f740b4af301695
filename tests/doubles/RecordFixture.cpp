#include "tests/doubles/RecordFixture.h"

#include "LogGenerator/LogPacket.h"
#include "tests/doubles/InOrder.h"

#include <gtest/gtest.h>

#include <ostream>

namespace pallax::doubles {

void SectionFixture::begin(LayoutRecord& record) {
    _base = &record;
    record.initWithDict(_classDict, _codeDict);
    if (record.sectionKind() == SectionKind::List) {
        _section = Array();
    } else {
        _section = Dictionary();
    }
    record.updateSectionRef(_section);
    (void)_log.take();
}

void SectionFixture::feed(const ByteBuffer& bytes) {
    feed(bytes, LogPacketGetLogCode(LogRecord(bytes)));
}

void SectionFixture::feed(const Record& record) {
    feed(record.bytes());
}

void SectionFixture::feed(const ByteBuffer& bytes, LogCode logCode) {
    _base->updateWithData(LogRecord(bytes), logCode);
    lines = _log.take();
}

PropertyList SectionFixture::snapshot() const {
    return _section.shallowCopy();
}

std::string SectionFixture::text(std::string_view key) {
    const PropertyList* value = keys().find(key);
    return value != nullptr ? value->string().value_or("(no text)") : "(absent)";
}

std::vector<LogCode> SectionFixture::subscriptions() const {
    const auto codes = _base->getLogCodeArray();
    return {codes.begin(), codes.end()};
}

void cutAtEveryLength(SectionFixture& fixture, const Record& record, std::size_t minimum) {
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

void expectInOrder(const PropertyList& actual, const Dictionary& expected) {
    ASSERT_NE(actual.dictionary(), nullptr) << actual.description();
    EXPECT_TRUE(sameInOrder(*actual.dictionary(), expected))
        << "actual:   " << actual.description()
        << "\nexpected: " << PropertyList(expected).description();
}

} // namespace pallax::doubles

namespace pallax {

void PrintTo(const PropertyList& object, std::ostream* out) { // NOLINT: gtest's name
    *out << object.description();
}

} // namespace pallax
