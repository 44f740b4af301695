#pragma once

#include "console/ExitStatus.h"
#include "decoding/ConditionedOutput.h"
#include "decoding/DecodeWindow.h"
#include "decoding/RecordingDecoder.h"
#include "host/Recording.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// What is written of a recording.
enum class DecodeView { Displays, Samples, Wide, Table };

struct DecodeOptions {
    std::vector<std::string> recordings;
    /// The technology of every recording, overriding its link type.
    const RecordedTechnology* technology = nullptr;
    DecodeView view = DecodeView::Displays;
    /// If missing: the last display or, for CSV, which shows changes, every tick.
    std::optional<Every> every;
    std::optional<DecodeFormat> format = {}; ///< if missing: CSV where there is no other, else JSON
    std::optional<std::string> systemLog;    ///< path of a text file
    std::string table = {};                  ///< the section to write as a table
    bool strict = false;
    /// How many recordings are decoded at once; if missing, one per core.
    std::optional<unsigned> jobs;
    DecodeWindow::Texts window = {};       ///< of the displays to write
    std::optional<TimeText> at = {};       ///< the only display to write, in place of these
    std::vector<std::string> select = {};  ///< names of fields; if empty, all
    bool typed = false;                    ///< JSON: numbers as objects
    bool recordingColumn = false;          ///< CSV
    bool join = false;                     ///< the recordings are one
    std::optional<std::string> where = {}; ///< condition on the displays to write

    DecodeWindow::Texts chosenWindow() const {
        return at ? DecodeWindow::Texts{std::nullopt, at} : window;
    }
    DecodeFormat chosenFormat() const {
        return format.value_or(view == DecodeView::Wide ? DecodeFormat::Csv : DecodeFormat::Json);
    }
    Every chosenEvery() const {
        const bool isSeries = chosenFormat() == DecodeFormat::Csv || view == DecodeView::Samples;
        return at ? Every::End : every.value_or(isSeries ? Every::Tick : Every::End);
    }
};

/// Receives the progress of decoding; recordings are identified by their position on the command
/// line.
class DecodeWatcher {
public:
    virtual ~DecodeWatcher() = default;
    /// Called after each packet; `source` has delivered this many.
    virtual void packetDone(std::size_t recording, const Recording& source,
                            std::uint64_t packets) = 0;
    /// Called at its end, even if it could not be opened or read further.
    virtual void recordingDone(std::size_t recording) = 0;
};

/// `pallax decode`: recordings to JSON or CSV, in the order of the command line, each with its own
/// generator and state, or all as one. A recording that cannot be read does not stop the others.
class DecodeCommand {
public:
    using Open = std::function<Recording::OpenResult(const std::string& path)>;
    /// Receives one sentence for the user.
    using Report = std::function<void(std::string_view sentence)>;

    /// The watcher, if any, must outlive the command.
    DecodeCommand(const DecodeOptions& options, const DecoderEnvironment& environment, Open open,
                  Report report, DecodeWatcher* watcher = nullptr, ZoneRule zone = utc)
        : _options(options), _environment(environment), _open(std::move(open)),
          _report(std::move(report)), _watcher(watcher), _zone(std::move(zone)) {}

    /// Writes to `output`. Exceptions of `output` and TemplateFailure propagate. Displays of a pipe
    /// are written without delay, those of a file in blocks.
    ExitStatus run(Output& output);
    /// The same for one of the recordings, by position; only the first writes the head of the whole
    /// output.
    ExitStatus runOne(std::size_t recording, Output& output);

private:
    struct Destination {
        Output& output;
        DisplayOutput* displays;       // which writes to it; null if each recording has its own
        SampleSink* samples = nullptr; // gets the samples, too
    };

    static std::chrono::seconds utc(Time /*time*/) { return {}; }

    /// Null if each recording has its own.
    std::unique_ptr<DisplayOutput> displayOutput(Output& output, bool withHeader) const;
    ExitStatus decodeNext(std::size_t place, const Destination& destination);
    ExitStatus decodeOpened(const Recording::OpenResult& recording, const Destination& destination);
    ExitStatus decode(Recording& recording, const Destination& destination);
    ExitStatus decodeSamples(Recording& recording, const RecordedTechnology& technology,
                             Output& output);
    ExitStatus decodeView(Recording& recording, const RecordedTechnology& technology,
                          Output& output);
    ExitStatus decodeTable(Recording& recording, const RecordedTechnology& technology,
                           Output& output);
    ExitStatus decodeWide(Recording& recording, const RecordedTechnology& technology,
                          Output& output);
    ExitStatus decodeWith(Recording& recording, const RecordedTechnology& technology,
                          const Destination& destination);
    /// Reports what is wrong with the condition.
    Result<std::unique_ptr<ConditionedOutput>, ExitStatus>
    conditioned(const Recording& recording, const RecordedTechnology& technology,
                DisplayOutput& displays);
    /// The span of a recording whose end or stretches matter; nothing if it is not needed or not to
    /// be known.
    std::optional<TimeSpan> spanBefore(const Recording& recording) const;
    Recording::OpenResult openWhole(std::size_t place) const;
    ExitStatus decodePackets(Recording& recording, RecordingDecoder& decoder, DecodeWindow& window,
                             Output& output);
    /// Reports what is odd about the latest packet; true if it ends the program.
    bool tellPacket(const Recording& recording, const RecordingDecoder& decoder,
                    const RecordedPacket& packet, const std::optional<std::string>& reason);
    ExitStatus failed(std::string_view sentence) const {
        _report(sentence);
        return kExitFailure;
    }

    DecodeOptions _options;
    DecoderEnvironment _environment;
    Open _open;
    Report _report;
    DecodeWatcher* _watcher;
    ZoneRule _zone;
    std::size_t _place = 0; // of the current recording
    bool _toldOutOfRange = false;
};

} // namespace pallax
