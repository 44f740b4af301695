#pragma once

#include "LogGenerator/Records/Sample.h"
#include "fields/FieldRegistry.h"
#include "text/Date.h"

#include <cmath>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// All readings of packets, written down one by one: what a timeline must come to.
class PlainReadings final : public SampleSink {
public:
    struct Reading {
        std::uint64_t packet;
        Time time;
        std::string text;
        double number;
    };
    /// By field name and, after a blank, the entry's identity.
    std::map<std::string, std::vector<Reading>> series;

    explicit PlainReadings(const FieldRegistry& registry) : _registry(registry) {}

    void beginPacket(const SamplePacket& packet) override { _packet = packet; }
    void sample(const Sample& sample) override {
        Reading reading{_packet.number, _packet.time, {}, NAN};
        PropertyList value;
        sample.value.showIn(value);
        reading.text = value.string().value_or(value.description());
        if (const DisplayNumber* number = sample.value.number()) {
            reading.number =
                number->isReal() ? number->real() : static_cast<double>(number->integer());
        }
        for (const FieldInfo& field : _registry.fields()) {
            if (std::find(field.rows.begin(), field.rows.end(), sample.id) != field.rows.end()) {
                if (_lists.empty()) {
                    series[field.name].push_back(reading);
                } else {
                    _lists.back().entry.emplace_back(&field, reading);
                }
            }
        }
    }
    void keyRemoved(std::string_view /*key*/) override {}
    void beginList(const SampleList& /*list*/) override { _lists.emplace_back(); }
    void endList() override { _lists.pop_back(); }
    void beginEntry(std::size_t index, std::int64_t name) override {
        _lists.back().index = index;
        _lists.back().name = name;
        _lists.back().entry.clear();
    }
    void endEntry() override {
        List& list = _lists.back();
        std::string identity;
        for (const auto& [field, reading] : list.entry) {
            if (field->identifies) {
                identity += (identity.empty() ? "" : ", ") + field->key +
                            (field->key.empty() ? "" : " ") + reading.text;
            } else if (!field->identity.empty() && field->identity.front() == kEntryName) {
                identity = "PN " + std::to_string(list.name);
            }
        }
        identity = identity.empty() ? "#" + std::to_string(list.index + 1) : identity;
        const std::size_t time = ++list.times[identity];
        if (time > 1) {
            identity += " (" + std::to_string(time) + ")";
        }
        for (const auto& [field, reading] : list.entry) {
            series[field->name + " " + around() + identity].push_back(reading);
        }
        list.identity = identity;
    }

private:
    struct List {
        std::vector<std::pair<const FieldInfo*, Reading>> entry;
        std::map<std::string, std::size_t> times;
        std::size_t index = 0;
        std::int64_t name = 0;
        std::string identity;
    };

    /// Of a list in a list: the fields of the outer entry come before the inner list.
    std::string around() const {
        std::string words;
        for (std::size_t depth = 0; depth + 1 < _lists.size(); ++depth) {
            std::string identity;
            for (const auto& [field, reading] : _lists[depth].entry) {
                if (field->identifies) {
                    identity += (identity.empty() ? "" : ", ") + field->key + " " + reading.text;
                }
            }
            words += identity + ", ";
        }
        return words;
    }

    const FieldRegistry& _registry;
    SamplePacket _packet;
    std::vector<List> _lists;
};

} // namespace pallax
