#include "timeline/Reading.h"

#include "timeline/Curve.h"

#include <algorithm>

namespace pallax {

namespace {

/// Keeps the latest sample of a field.
class RowFinder final : public SampleSink {
public:
    RowFinder(FieldTable& fields, FieldIndex field) : _fields(fields), _field(field) {}

    const std::optional<Reading>& found() const { return _found; }

    void beginPacket(const SamplePacket& packet) override { _packet = packet.number; }
    void sample(const Sample& sample) override {
        const auto fields = _fields.of(sample);
        if (std::find(fields.begin(), fields.end(), _field) != fields.end()) {
            _found = Reading{_packet, sample.id, sample.field};
            _found->layout.key = {}; // of an object stream, it does not live so long
        }
    }
    void keyRemoved(std::string_view /*key*/) override {}
    void beginList(const SampleList& /*list*/) override {}
    void endList() override {}
    void beginEntry(std::size_t /*index*/, std::int64_t /*name*/) override {}
    void endEntry() override {}

private:
    FieldTable& _fields;
    FieldIndex _field;
    std::uint64_t _packet = 0;
    std::optional<Reading> _found;
};

} // namespace

std::optional<Reading> readingAt(Timeline& timeline, FieldIndex field, Time time,
                                 std::uint64_t instant) {
    const Stretch* stretch = stretchWith(timeline, instant);
    if (stretch == nullptr) {
        return std::nullopt;
    }
    const std::uint64_t before = timeline.instantIn(*stretch, time - std::chrono::nanoseconds(1));
    const std::uint64_t last = std::min(timeline.instantIn(*stretch, time), instant);
    RowFinder finder(timeline.fieldTable(), field);
    (void)timeline.read(std::max(before, stretch->firstPacket), last, finder);
    return finder.found();
}

} // namespace pallax
