#pragma once

#include "console/ExitStatus.h"
#include "decoding/RecordingDecoder.h"
#include "host/BoundedJournal.h"
#include "host/RecordingParts.h"
#include "knowledge/Networks.h"
#include "knowledge/Quality.h"
#include "plist/PropertyList.h"
#include "report/Track.h"
#include "text/TimeText.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Clock;
class Output;
class ReportBuilder;
class Timeline;
struct RecordedTechnology;
struct ReportHead;

/// `pallax report`: a recording as a page, two of them to compare, or a device of a store.
struct ReportOptions {
    std::vector<std::string> recordings = {};
    std::string output = {}; ///< the page; "-" is standard output
    bool json = false;       ///< the figures alone, to `output` or else standard output
    const RecordedTechnology* technology = nullptr; ///< overrides the link type
    std::string profile{kDefaultProfile};
    std::optional<TimeText> from = {};
    std::optional<TimeText> to = {};
    std::optional<std::string> where = {}; ///< only the ticks for which it holds
    std::string title = {};
    std::vector<std::string> labels = {}; ///< of the devices, in the order of the recordings
    bool withIdentities = false;
    std::string track = {};                 ///< a GPX file
    std::string store = {};                 ///< the file of a store; empty: recordings
    std::optional<std::string> device = {}; ///< of the store; nothing: the only one
};

class ReportCommand {
public:
    /// The most recordings that a page compares.
    static constexpr std::size_t kMostRecordings = 2;

    struct Environment {
        const DecoderEnvironment& decoder;
        const NetworkNames& names;
        const QualityProfile& profile;
        const Clock& zone; ///< for times of the command line
        std::function<void(const std::string& sentence)> report;
        std::function<void(std::string_view doing, std::uint64_t packets)> progress = {};
        BoundedJournal::Limits journal = {}; ///< for recordings that are kept
    };

    ReportCommand(const ReportOptions& options, const Environment& environment)
        : _options(options), _environment(environment) {}

    /// What to write to the output; nothing if there is none. `status` is then why, and otherwise
    /// tells whether something is missing.
    std::optional<std::string> make(ExitStatus& status);

private:
    struct Part {
        std::string page = {};
        std::string json = {};
        std::vector<Time> ticks;
    };

    std::optional<Part> makePart(const PartPaths& paths, std::size_t place, ExitStatus& status);
    std::optional<Part> makeStoredPart(ExitStatus& status);
    void showProgress(std::string_view doing, std::uint64_t packets) const;
    /// False after a complaint about the options.
    bool gather(Timeline& timeline, const std::string& name, ReportBuilder& report,
                std::vector<struct Event>& events, ExitStatus& status);
    ReportHead headOf(const PartPaths& paths, std::size_t place, const Timeline& timeline) const;
    /// Empty without one. Nothing after a complaint.
    std::optional<Track> readTrack(ExitStatus& status) const;
    void complainOfTrack(const std::string& reason, ExitStatus& status) const;

    const ReportOptions& _options;
    const Environment& _environment;
};

/// `ReportCommand`, wired to this machine. TemplateFailure, OutputClosed and OutputFailure leave.
ExitStatus runReport(const ReportOptions& options);

} // namespace pallax
