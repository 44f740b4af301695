#pragma once

#include "LogGenerator/Records/Sample.h"

#include <algorithm>
#include <cstddef>
#include <vector>

namespace pallax {

/// Passes samples on to any number of sinks, in the order in which they were added.
class SampleFanOut final : public SampleSink {
public:
    /// The sink must outlive the fan-out or be removed first. Not during a packet.
    void add(SampleSink& sink) { _sinks.push_back(&sink); }
    void remove(const SampleSink& sink) {
        _sinks.erase(std::remove(_sinks.begin(), _sinks.end(), &sink), _sinks.end());
    }
    /// The sink to give samples to: null without sinks, a single one itself.
    SampleSink* sink() {
        if (_sinks.empty()) {
            return nullptr;
        }
        return _sinks.size() == 1 ? _sinks.front() : this;
    }

    void beginPacket(const SamplePacket& packet) override {
        each([&](SampleSink& to) { to.beginPacket(packet); });
    }
    void endPacket() override {
        each([](SampleSink& to) { to.endPacket(); });
    }
    void beginSection(std::string_view section) override {
        each([&](SampleSink& to) { to.beginSection(section); });
    }
    void sample(const Sample& sample) override {
        each([&](SampleSink& to) { to.sample(sample); });
    }
    void keyRemoved(std::string_view key) override {
        each([&](SampleSink& to) { to.keyRemoved(key); });
    }
    void beginList(const SampleList& list) override {
        each([&](SampleSink& to) { to.beginList(list); });
    }
    void endList() override {
        each([](SampleSink& to) { to.endList(); });
    }
    void beginEntry(std::size_t index, std::int64_t name) override {
        each([&](SampleSink& to) { to.beginEntry(index, name); });
    }
    void endEntry() override {
        each([](SampleSink& to) { to.endEntry(); });
    }

private:
    template <class Give>
    void each(const Give& give) {
        for (SampleSink* sink : _sinks) {
            give(*sink);
        }
    }

    std::vector<SampleSink*> _sinks;
};

} // namespace pallax
