#pragma once

#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/Records/ReadTimes.h"
#include "LogGenerator/Records/Sample.h"
#include "plist/PropertyList.h"

#include <span>
#include <string>
#include <vector>

namespace pallax {

/// The display sink of CDMA: stores each value in every place that the lookup table has for its
/// name. A list by pilot becomes a dictionary that is shown sorted, whose key "INDEX;PN" gives each
/// entry its place by the index (as text: 10 comes before 2) and its name, the pilot's PN offset.
///
/// Between two looks at the display a modem sends many packets of one code, each of which replaces
/// all that the one before has shown. Such a packet is kept, and read when the display is looked
/// at; the layout tells which may be.
class LookupDisplay final : public SampleSink {
public:
    static constexpr bool kTakesHidden = false;

    /// The layouts live as long as the program.
    explicit LookupDisplay(std::span<const CodeLayout* const> codes);

    /// Gives the samples of later packets to `sink`, too, each when it arrives. Null: to the
    /// display alone. The sink outlives the display, or is taken away.
    void setSink(SampleSink* sink) { _sink = sink; }

    /// Of the packet that is taken next.
    void setPacketTime(Time time) { _packetTime = time; }
    /// Takes an accepted packet of the code that is the `index`th. Without a lookup table (null) no
    /// value has a place.
    void take(std::size_t index, const LogRecord& packet, const DictionaryRef& lookup,
              Dictionary& state);
    /// Reads the packets that are kept.
    void bringUpToDate();

    /// When what is shown in a place was last read.
    struct PlaceRead {
        LookupPlace place;
        Time time;
    };
    std::vector<PlaceRead> placesRead() const;

    void sample(const Sample& sample) override;
    void keyRemoved(std::string_view /*key*/) override {} // a value stays until the next
    void beginList(const SampleList& list) override;
    void endList() override;
    void beginEntry(std::size_t index, std::int64_t name) override;
    void endEntry() override {}

private:
    struct Code {
        const CodeLayout* layout;
        FieldId firstRow;
        bool isReadLate;
        // The latest packet that waits, and the table for it; null: none.
        DictionaryRef lookup = nullptr;
        ByteBuffer packet = {};
        Time time = {};
    };

    void readNow(const Code& code, const LogRecord& packet, const DictionaryRef& lookup,
                 Dictionary& state);
    void usePlacesOf(const DictionaryRef& lookup);
    void findPlaces(const DictionaryRef& lookup);

    std::vector<Code> _codes;
    RecordMemory _memory;
    SampleSink* _sink = nullptr;
    Time _packetTime{};
    ReadTimes _times;
    /// The table that the places are of. Looking each value up in it took a quarter of the time of
    /// decoding a CDMA drive.
    DictionaryRef _lookup;
    std::vector<std::vector<LookupPlace>> _places; ///< by row
    DictionaryRef _pilots;                         ///< of the list that has begun and not ended
    const ListLayout* _list = nullptr;
    std::string _pilot; ///< the key of its entry
};

} // namespace pallax
