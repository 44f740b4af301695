#pragma once

#include "monitor/Arrivals.h"
#include "overview/Status.h"
#include "packets/StampSequence.h"
#include "timeline/Curve.h"
#include "timeline/Event.h"
#include "timeline/EventFinder.h"
#include "timeline/LeafField.h"
#include "timeline/Moment.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Resources;

/// What is known about the radio at one time, for a screen.
struct Overview {
    Status status;
    std::vector<Event> events;     ///< the latest last
    std::chrono::seconds ahead{0}; ///< local time minus UTC
    /// The curves of levels over one time.
    struct LevelCurve {
        LeafName leaf;
        Curve curve;
    };
    std::vector<LevelCurve> curves = {};
    Time curvesFrom = {};
    Time curvesTo = {};
    bool knowsAges = true; ///< false if nothing tells when the values were read
};

/// What was known at an instant of a timeline.
Overview overviewAt(const Moment& moment, const NetworkNames& names, const QualityProfile& profile);

/// Takes the samples of a live model, so that the status can be asked for at any time.
class StatusWatch final : public SampleSink, private CurrentValues::Listener {
public:
    /// Earlier events are forgotten.
    static constexpr std::size_t kMostEvents = 32;

    /// `resources` must outlive the watch.
    explicit StatusWatch(const Resources& resources) : _resources(resources) {}
    StatusWatch(const StatusWatch&) = delete;
    StatusWatch& operator=(const StatusWatch&) = delete;

    /// Forgets everything. The samples that follow are of the technology with this identifier
    /// ("Zorell_LTE"); of an unknown technology, they are dropped. Not during a packet.
    void begin(std::string_view technology);

    /// Whether a field of a list is part of the identity of its entries, and whether it tells which
    /// cell an entry is, by its path in the display: "/Neighbor Cells List/*/Physical Cell ID".
    bool identifies(const std::string& path) const;
    bool namesCell(const std::string& path) const;
    /// The current values; null without a technology. Valid until the next `begin`.
    const CurrentValues* values() const { return _known ? &_known->values : nullptr; }
    /// Adds an event that the samples do not tell. Nothing happens without a technology.
    void add(Event event);

    Overview overview(Time time, const NetworkNames& names, const QualityProfile& profile) const;

    void beginPacket(const SamplePacket& packet) override;
    void endPacket() override;
    void beginSection(std::string_view section) override {
        give([&](CurrentValues& to) { to.beginSection(section); });
    }
    void sample(const Sample& sample) override {
        give([&](CurrentValues& to) { to.sample(sample); });
    }
    void keyRemoved(std::string_view key) override {
        give([&](CurrentValues& to) { to.keyRemoved(key); });
    }
    void beginList(const SampleList& list) override {
        give([&](CurrentValues& to) { to.beginList(list); });
    }
    void endList() override {
        give([](CurrentValues& to) { to.endList(); });
    }
    void beginEntry(std::size_t index, std::int64_t name) override {
        give([&](CurrentValues& to) { to.beginEntry(index, name); });
    }
    void endEntry() override {
        give([](CurrentValues& to) { to.endEntry(); });
    }

private:
    /// What is known since the technology began.
    struct Known {
        Known(const RecordedTechnology& technology, const Resources& resources);

        FieldTable fields;
        EntryTable entries;
        CurrentValues values;
        EventFinder finder;
        StampSequence stamps;
        SamplePacket packet;            ///< the current one
        std::vector<Arrivals> arrivals; ///< by field; of fields that are not in a list
        std::vector<Event> events;
    };

    template <class Give>
    void give(const Give& samples) {
        if (_known) {
            samples(_known->values);
        }
    }
    void valueRead(FieldIndex field, EntryId entry, const FieldValue& value) override;
    void forgetEarlyEvents();
    /// Adds how long the value may be missing.
    void addPatience(StatusValue& value) const;
    void valueRemoved(FieldIndex field) override { _known->finder.valueRemoved(field); }
    void listReplaced(ListId list) override { _known->finder.listReplaced(list); }

    const Resources& _resources;
    std::unique_ptr<Known> _known; ///< null without a technology
};

} // namespace pallax
