// Nanoseconds per packet for each log code of each record, read for the display at once, without a
// log sink. The packets are made from the layouts: eight entries in each list, zeros elsewhere, and
// property lists with every key.

#include "LogGenerator/LTE/LTEClassIndex.h"
#include "LogGenerator/UTRAN/UTRANClassIndex.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMClassIndex.h"
#include "platform/TelephonyConstants.h"
#include "plist/PropertyListCodec.h"
#include "tests/doubles/FakeStandardOutput.h"
#include "tests/doubles/RecordBuilder.h"
#include "text/Bytes.h"
#include "text/Format.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <string>

namespace pallax {
namespace {

constexpr std::int64_t kEntries = 8;
/// Enough for eight entries of any list.
constexpr std::size_t kLength = 2048;

/// Writes the number, or the largest that the position has bits for.
void put(ByteBuffer& bytes, const Position& position, std::int64_t number) {
    const std::uint64_t largest = (std::uint64_t{1} << position.width) - 1;
    std::uint64_t bits = std::min(static_cast<std::uint64_t>(number), largest) << position.bit;
    for (std::size_t offset = position.byte; bits != 0; ++offset, bits >>= kByteBits) {
        bytes[offset] = static_cast<std::uint8_t>(bytes[offset] | bits);
    }
}

/// A cell that the layout looks for.
Dictionary cellOf(const ListPart& part, std::span<const Field> fields) {
    Dictionary cell;
    cell.setFixed(kHXCellMonitorCellRadioAccessTechnology, Text::fixed(part.technologies.front()));
    cell.setFixed(kHXCellMonitorCellType, Text::fixed(part.cellType));
    for (const Field& field : fields) {
        cell.setFixed(field.listKey, PropertyList::integer(42));
    }
    return cell;
}

PropertyList propertyListFor(const ListPart& part, std::span<const Field> fields) {
    if (part.kind == ListPart::Kind::Keys) {
        Dictionary keys;
        for (const Field& field : fields) {
            keys.setFixed(field.listKey, "89490200001234567890");
        }
        return keys;
    }
    Array elements;
    for (std::int64_t entry = 0; entry < kEntries; ++entry) {
        elements.emplace_back(part.kind == ListPart::Kind::Elements
                                  ? Dictionary{{"APN", "internet"}, {"State", "Active"}}
                                  : cellOf(part, fields));
    }
    return elements;
}

ByteBuffer packetFor(const CodeLayout& code) {
    if (code.listPart != nullptr) {
        const auto list = serializeBinary(propertyListFor(*code.listPart, code.fields));
        return doubles::Record(code.logCode).append(Bytes(*list)).bytes();
    }
    ByteBuffer bytes = doubles::Record(code.logCode)
                           .padTo(code.exactLength ? code.minimumLength : kLength)
                           .bytes();
    if (code.condition != nullptr) {
        put(bytes, code.condition->position, code.condition->least);
    }
    for (const ListLayout& list : code.lists) {
        if (list.count) {
            put(bytes, *list.count, kEntries);
        }
    }
    return bytes;
}

void measure(benchmark::State& state, LayoutRecord& record, const CodeLayout& code) {
    const bool isList = record.sectionKind() == SectionKind::List;
    record.display().setLate(false);
    record.updateSectionRef(isList ? PropertyList(Array()) : PropertyList(Dictionary()));
    for (const CodeLayout& each : record.layout().codes) {
        const ByteBuffer bytes = packetFor(each); // of which the record may remember something
        record.updateWithData(LogRecord(bytes), each.logCode);
    }
    const ByteBuffer bytes = packetFor(code);
    const LogRecord packet(bytes);
    for ([[maybe_unused]] const auto iteration : state) {
        record.updateWithData(packet, code.logCode);
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations());
}

/// The index lives as long as the program.
template <class Index>
void registerRecords(const std::string& technology) {
    static doubles::FakeStandardOutput output;
    static const Index index(output);
    for (const ClassIndex::Numbered& each : index.records()) {
        for (const CodeLayout& code : each.record->layout().codes) {
            const std::string name = technology + "/" + std::string(each.record->getSectionName()) +
                                     formatText("/0x%X", {code.logCode});
            benchmark::RegisterBenchmark(name.c_str(), [&each, &code](benchmark::State& state) {
                measure(state, *each.record, code);
            });
        }
    }
}

[[maybe_unused]] const bool kIsRegistered = [] {
    registerRecords<ZOR_GSMClassIndex>("gsm");
    registerRecords<LTEClassIndex>("lte");
    registerRecords<UTRANClassIndex>("utran");
    return true;
}();

} // namespace
} // namespace pallax
