#pragma once

#include "timeline/Timeline.h"

namespace pallax {

/// A sink that keeps the current values. A subclass gets each reading, as their listener.
class ValueReader : public SampleSink, protected CurrentValues::Listener {
public:
    explicit ValueReader(Timeline& timeline)
        : _values(timeline.fieldTable(), timeline.entryTable()) {
        _values.setListener(this);
    }
    ValueReader(const ValueReader&) = delete;
    ValueReader& operator=(const ValueReader&) = delete;

    void beginPacket(const SamplePacket& packet) override {
        _packet = packet;
        _values.beginPacket(packet);
    }
    void beginSection(std::string_view section) override { _values.beginSection(section); }
    void sample(const Sample& sample) override { _values.sample(sample); }
    void keyRemoved(std::string_view key) override { _values.keyRemoved(key); }
    void beginList(const SampleList& list) override { _values.beginList(list); }
    void endList() override { _values.endList(); }
    void beginEntry(std::size_t index, std::int64_t name) override {
        _values.beginEntry(index, name);
    }
    void endEntry() override { _values.endEntry(); }

protected:
    const SamplePacket& packet() const { return _packet; }
    void valueRemoved(FieldIndex /*field*/) override {}
    void listReplaced(ListId /*list*/) override {}

private:
    CurrentValues _values;
    SamplePacket _packet;
};

} // namespace pallax
