#pragma once

#include "console/Output.h"
#include "decoding/DisplayDifference.h"
#include "decoding/DisplayJson.h"
#include "plist/PropertyList.h"
#include "text/Date.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace pallax {

enum class DecodeFormat { Json, Csv };

/// How often a recording's display is shown.
enum class Every { End, Tick, Packet };

/// The time of a display.
struct DisplayMoment {
    std::uint64_t number = 0; ///< of the tick or packet, from 1
    Time time;
    std::uint64_t packet = 0; ///< the latest before it
};

/// The output of displays, one recording after the other.
class DisplayOutput {
public:
    virtual ~DisplayOutput() = default;
    /// Called before `beginRecording` where the output may name its recordings.
    virtual void nameRecording(std::string_view /*name*/) {}
    virtual void beginRecording() = 0;
    /// `display` is null if there is none yet.
    virtual void show(const DisplayMoment& moment, const PropertyList& display) = 0;
    /// A packet has been read completely; called before the next `show`.
    virtual void packetDone(const DisplayMoment& /*moment*/) {}
};

/// A value as the text of one cell: containers as JSON.
std::string textOfValue(const PropertyList& value);

/// One JSON object per line: the display itself with Every::End, otherwise
/// {"tick":1,"time":"2023-11-14T22:13:20.000Z","display":{…}}, with "packet" instead of "tick" for
/// packets.
class JsonOutput final : public DisplayOutput {
public:
    JsonOutput(Output& output, Every every, JsonNumbers numbers = JsonNumbers::AsTexts)
        : _output(output), _every(every), _numbers(numbers) {}

    void beginRecording() override {}
    void show(const DisplayMoment& moment, const PropertyList& display) override;

private:
    Output& _output;
    Every _every;
    JsonNumbers _numbers;
};

/// A table "time,path,value,number,unit" (RFC 4180, lines end in LF; the header once), with a row
/// for each path of the display tree whose value differs from the recording's previous display. The
/// rows of one display are in display order, followed by those of removed paths, by path, with
/// empty value, number and unit. A value that is not a string is written as in JSON. `number` is
/// the decimal number of a numeric value, and empty for any other (and if not finite). The name of
/// the recording is a column before the others on request.
class CsvOutput final : public DisplayOutput, private DisplayDifference::Listener {
public:
    enum class Names { Left, Column };

    /// Without its header the table continues another one.
    explicit CsvOutput(Output& output, bool withHeader = true, Names names = Names::Left);

    void nameRecording(std::string_view name) override;
    void beginRecording() override { _difference.clear(); }
    void show(const DisplayMoment& moment, const PropertyList& display) override;

private:
    void changed(std::string_view path, DisplayDifference::Leaf& leaf,
                 const PropertyList& value) override;
    void removed(std::string_view path, DisplayDifference::Leaf& leaf) override;
    void writeRow(std::string_view path, std::string_view cells);

    Output& _output;
    DisplayDifference _difference;
    Names _names;
    std::string _start; ///< the cells before the path
    std::string _name;  ///< a cell with its comma, or empty
};

} // namespace pallax
