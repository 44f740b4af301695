#pragma once

#include "console/Output.h"
#include "plist/PropertyList.h"
#include "text/Date.h"

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// How often a recording's display is shown.
enum class Every { End, Tick, Packet };

/// When a display was as it is shown.
struct DisplayMoment {
    std::uint64_t number = 0; ///< of the tick or packet, from 1
    Time time;
};

/// Where the displays of recordings go, one recording after the other.
class DisplayOutput {
public:
    virtual ~DisplayOutput() = default;
    virtual void beginRecording() = 0;
    /// `display` is null when there is none yet.
    virtual void show(const DisplayMoment& moment, const PropertyList& display) = 0;
};

/// One JSON object a line: the display itself with Every::End, else
/// {"tick":1,"time":"2023-11-14T22:13:20.000Z","display":{…}}, "packet" instead of "tick".
class JsonOutput final : public DisplayOutput {
public:
    JsonOutput(Output& output, Every every) : _output(output), _every(every) {}

    void beginRecording() override {}
    void show(const DisplayMoment& moment, const PropertyList& display) override;

private:
    Output& _output;
    Every _every;
};

/// A table "time,path,value,number,unit" (RFC 4180, lines end in "\n"; the header once): a row
/// when the value at a path of the display tree is not what it was in the recording's previous
/// display. The rows of one display come in display order; then, by path, those of the paths that
/// are gone, whose value, number and unit are empty. A value that is no string is written as in
/// JSON. `number` is the bare decimal number of a value that is one, empty for any other (and for
/// one that is not finite).
class CsvOutput final : public DisplayOutput {
public:
    /// Without its header the table goes on after another one.
    explicit CsvOutput(Output& output, bool withHeader = true);

    void beginRecording() override {
        _before.clear();
        _order.clear();
        _shown.clear();
    }
    void show(const DisplayMoment& moment, const PropertyList& display) override;

private:
    struct Shown {
        PropertyList value;
        std::string pathCell; ///< the path as written
        std::string cells;    ///< "value,number,unit" as written
        std::uint64_t display = 0;
    };
    /// By path and count of earlier nodes of the same path in the display.
    using Rows = std::map<std::pair<std::string, int>, Shown>;

    /// The value at `_path`.
    void showValue(const PropertyList& value);
    void showChild(std::string_view name, const PropertyList& value);
    void showLeaf(const PropertyList& value);
    Rows::iterator rowOfPath();
    void writeRow(const Shown& shown, std::string_view cells);

    Output& _output;
    Rows _shown;
    /// The rows of the previous display and of this one in their order: the next row is mostly the
    /// one that came next before, and need not be searched.
    std::vector<Rows::iterator> _before;
    std::vector<Rows::iterator> _order;
    std::uint64_t _display = 0;
    std::string _time;
    std::string _path; ///< of the value that is being shown
};

} // namespace pallax
