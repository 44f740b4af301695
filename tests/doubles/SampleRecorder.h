#pragma once

#include "LogGenerator/Records/Sample.h"
#include "tests/doubles/SampleChecksum.h"

#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

namespace pallax::doubles {

/// Keeps all calls of a sink.
class SampleRecorder final : public SampleSink {
public:
    struct KeptSample {
        FieldId id;
        std::string key;
        std::optional<std::int64_t> raw;
        PropertyList value;                          ///< the display value
        std::optional<double> number = std::nullopt; ///< the number in the text of an object
        std::string unit = {};
    };
    struct Begin {
        SamplePacket packet;
    };
    struct Section {
        std::string name;
    };
    struct List {
        std::string key;
        std::size_t count;
    };
    struct Entry {
        std::size_t index;
        std::int64_t name;
    };
    struct Removed {
        std::string key;
    };
    enum class End { Packet, List, Entry };
    using Event = std::variant<KeptSample, Begin, Section, List, Entry, Removed, End>;

    std::vector<Event> events;

    void beginPacket(const SamplePacket& packet) override { events.emplace_back(Begin{packet}); }
    void endPacket() override { events.emplace_back(End::Packet); }
    void beginSection(std::string_view section) override {
        events.emplace_back(Section{std::string(section)});
    }
    void sample(const Sample& sample) override {
        KeptSample kept{sample.id, std::string(sample.field.key), sample.raw, {}};
        sample.value.showIn(kept.value);
        if (const NumberText* read = sample.value.numberText()) {
            kept.number = read->number;
            kept.unit = read->unit;
        }
        events.emplace_back(std::move(kept));
    }
    void keyRemoved(std::string_view key) override {
        events.emplace_back(Removed{std::string(key)});
    }
    void beginList(const SampleList& list) override {
        events.emplace_back(List{std::string(list.key), list.count});
    }
    void endList() override { events.emplace_back(End::List); }
    void beginEntry(std::size_t index, std::int64_t name) override {
        events.emplace_back(Entry{index, name});
    }
    void endEntry() override { events.emplace_back(End::Entry); }

    /// Returns a line for each event and removes the events.
    std::vector<std::string> takeLines() {
        std::vector<std::string> lines;
        for (const Event& event : std::exchange(events, {})) {
            lines.push_back(std::visit([](const auto& each) { return lineOf(each); }, event));
        }
        return lines;
    }
    /// Adds the events to the checksum and removes them.
    void takeInto(SampleChecksum& checksum) {
        for (const Event& event : std::exchange(events, {})) {
            std::visit([&](const auto& each) { add(each, checksum); }, event);
        }
    }

private:
    // "12 Channel: 62", "7 Power: -94.5 dBm (raw 182)", "3 /Cell/Level: -96 dBm (number -96.00 in
    // dBm)"
    static std::string lineOf(const KeptSample& sample) {
        std::string line = std::to_string(sample.id) + " " + sample.key + ": " +
                           sample.value.string().value_or(sample.value.description());
        if (sample.raw) {
            line += " (raw " + std::to_string(*sample.raw) + ")";
        }
        if (sample.number) {
            static constexpr NumberFormat kNumber{"%.2f"};
            line += " (number " + DisplayNumber(*sample.number, kNumber).text() +
                    (sample.unit.empty() ? "" : " in ") + sample.unit + ")";
        }
        return line;
    }
    static std::string lineOf(const Begin& begin) {
        return "packet " + std::to_string(begin.packet.number);
    }
    static std::string lineOf(const Section& section) { return "section " + section.name; }
    static std::string lineOf(const List& list) {
        return "list " + list.key + " of " + std::to_string(list.count);
    }
    static std::string lineOf(const Entry& entry) {
        return "entry " + std::to_string(entry.index) +
               (entry.name != 0 ? " named " + std::to_string(entry.name) : "");
    }
    static std::string lineOf(const Removed& removed) { return "removed " + removed.key; }
    static std::string lineOf(End end) {
        return end == End::Packet ? "end of packet" : end == End::List ? "end of list" : "end";
    }

    static std::uint64_t checksumOf(const KeptSample& sample) {
        if (const DisplayNumber* number = sample.value.displayNumber()) {
            return SampleChecksum::of(*number);
        }
        const std::string text = sample.value.string().value_or(sample.value.description());
        return sample.number ? SampleChecksum::of(text, *sample.number) : SampleChecksum::of(text);
    }
    static void add(const KeptSample& sample, SampleChecksum& checksum) {
        checksum.sample(sample.id, sample.raw, checksumOf(sample));
    }
    static void add(const List& list, SampleChecksum& checksum) { checksum.key(list.key); }
    static void add(const Entry& entry, SampleChecksum& checksum) {
        checksum.entry(entry.index, entry.name);
    }
    static void add(const Removed& removed, SampleChecksum& checksum) { checksum.key(removed.key); }
    template <class Other>
    static void add(const Other& /*other*/, SampleChecksum& /*checksum*/) {}
};

} // namespace pallax::doubles
