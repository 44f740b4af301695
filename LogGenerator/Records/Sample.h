#pragma once

#include "LogGenerator/Records/Layout.h"
#include "LogGenerator/Records/SampleValue.h"
#include "text/Date.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>

namespace pallax {

/// The number of a row in a technology's registry of fields: its layouts' rows in the order of
/// registration. An object stream numbers its paths in the order of arrival.
using FieldId = std::uint32_t;

/// One field read from one packet. Valid during the sink's call.
struct Sample {
    FieldId id;
    const Field& field;
    /// The number of the value in the record. Nothing for a computed value, a text of an object
    /// stream, and a value of a property list that is not a number.
    std::optional<std::int64_t> raw;
    const SampleValue& value;
};

/// The packet of the samples that follow.
struct SamplePacket {
    std::uint64_t number = 0; ///< in its source, from 1; 0 if unknown
    Time time = {};
};

/// A list that a packet replaces. `layout` is null if the list comes from a property list.
struct SampleList {
    std::string_view key; ///< empty: the section is the list
    const ListLayout* layout = nullptr;
    std::size_t count = 0; ///< the greatest number of entries that may follow
};

/// Takes samples. Calls between the begin and the end of a packet, list or entry belong to it. An
/// emptied list begins and ends without entries.
class SampleSink {
public:
    /// Whether it also gets values that are read but not shown.
    static constexpr bool kTakesHidden = true;

    virtual ~SampleSink() = default;
    virtual void beginPacket(const SamplePacket& /*packet*/) {}
    virtual void endPacket() {}
    /// The samples that follow belong to that section. Technologies without sections do not call
    /// it.
    virtual void beginSection(std::string_view /*section*/) {}

    virtual void sample(const Sample& sample) = 0;
    virtual void keyRemoved(std::string_view key) = 0;
    virtual void beginList(const SampleList& list) = 0;
    virtual void endList() = 0;
    /// `name` is the PN offset in a list by pilot, else 0.
    virtual void beginEntry(std::size_t index, std::int64_t name) = 0;
    virtual void endEntry() = 0;
};

} // namespace pallax
