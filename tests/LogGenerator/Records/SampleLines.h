#pragma once

#include "LogGenerator/Records/LayoutReader.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A line for each call: "ID KEY VALUE" of a sample, with " raw N" where it has a raw number;
/// "- KEY" of a removed key; "[KEY COUNT" and "]" around a list, "{INDEX NAME" and "}" around an
/// entry.
class SampleLines final : public SampleSink {
public:
    void sample(const Sample& sample) override {
        PropertyList value;
        sample.value.showIn(value);
        std::string line = std::to_string(sample.id) + " " + std::string(sample.field.key) + " " +
                           value.string().value_or(value.description());
        if (sample.raw) {
            line += " raw " + std::to_string(*sample.raw);
        }
        lines.push_back(std::move(line));
    }
    void keyRemoved(std::string_view key) override { lines.push_back("- " + std::string(key)); }
    void beginList(const SampleList& list) override {
        lines.push_back("[" + std::string(list.key) + " " + std::to_string(list.count));
    }
    void endList() override { lines.emplace_back("]"); }
    void beginEntry(std::size_t index, std::int64_t name) override {
        lines.push_back("{" + std::to_string(index) + " " + std::to_string(name));
    }
    void endEntry() override { lines.emplace_back("}"); }

    std::vector<std::string> lines;
};

/// What a reader gives of a record; rows are numbered from 10 on.
inline std::vector<std::string> samplesOf(const CodeLayout& code, const ByteBuffer& bytes,
                                          RecordMemory memory = {}) {
    SampleLines samples;
    LayoutReader(samples, memory, 10).read(code, LogRecord(bytes));
    return samples.lines;
}

} // namespace pallax
