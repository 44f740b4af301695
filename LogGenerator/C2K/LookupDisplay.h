#pragma once

#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/Records/ReadTimes.h"
#include "LogGenerator/Records/Sample.h"
#include "plist/PropertyList.h"

#include <span>
#include <string>
#include <vector>

namespace pallax {

/// The display sink of CDMA: stores each value in all places that the lookup table has for its
/// name. A list by pilot becomes a sorted dictionary with the keys "INDEX;PN": the index (as text:
/// 10 comes before 2) gives the order, and the pilot's PN offset is the shown name.
///
/// Between two ticks a modem sends many packets of one code, and each replaces everything that the
/// one before has shown. This sink keeps the latest and reads it when the display is needed. The
/// layout tells which packets may wait.
class LookupDisplay final : public SampleSink {
public:
    static constexpr bool kTakesHidden = false;

    /// The layouts must live as long as the program.
    explicit LookupDisplay(std::span<const CodeLayout* const> codes);

    /// Also gives the samples of later packets to `sink`, each when it arrives; null stops it. The
    /// sink must outlive the display or be removed first.
    void setSink(SampleSink* sink) { _sink = sink; }

    /// Uses the places of this lookup table.
    void usePlacesOf(const DictionaryRef& lookup);
    /// Sets the time of the next packet.
    void setPacketTime(Time time) { _packetTime = time; }
    /// Takes an accepted packet of the code number `index`. Without a lookup table (null) values
    /// have no places.
    void take(std::size_t index, const LogRecord& packet, const DictionaryRef& lookup,
              Dictionary& state);
    /// Reads the kept packets.
    void bringUpToDate();

    /// When the values were last read.
    ReadTimes& times() { return _times; }
    RecordMemory& memory() { return _memory; }

    /// The time at which a place was last read.
    struct PlaceRead {
        LookupPlace place;
        Time time;
    };
    std::vector<PlaceRead> placesRead() const;

    void sample(const Sample& sample) override;
    void keyRemoved(std::string_view /*key*/) override {} // a value stays until the next one
    void beginList(const SampleList& list) override;
    void endList() override;
    void beginEntry(std::size_t index, std::int64_t name) override;
    void endEntry() override {}

private:
    struct Code {
        const CodeLayout* layout;
        FieldId firstRow;
        bool isReadLate;
        // The latest packet that waits, and its lookup table; null: none.
        DictionaryRef lookup = nullptr;
        ByteBuffer packet = {};
        Time time = {};
    };

    void readNow(const Code& code, const LogRecord& packet, const DictionaryRef& lookup,
                 Dictionary& state);
    void findPlaces(const DictionaryRef& lookup);

    std::vector<Code> _codes;
    RecordMemory _memory;
    SampleSink* _sink = nullptr;
    Time _packetTime{};
    ReadTimes _times;
    /// The lookup table of the cached places. Looking up each value took a quarter of the time of
    /// decoding a CDMA drive.
    DictionaryRef _lookup;
    std::vector<std::vector<LookupPlace>> _places; ///< by row
    DictionaryRef _pilots;                         ///< of the current list
    const ListLayout* _list = nullptr;
    std::string _pilot; ///< the key of the current entry
};

} // namespace pallax
