#include "inspecting/DiffCommand.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "console/Output.h"
#include "decoding/DroppedNotices.h"
#include "decoding/FieldSelection.h"
#include "decoding/RequiredTemplates.h"
#include "fields/StatusFields.h"
#include "host/BuildBundle.h"
#include "host/Complaint.h"
#include "host/Snapshot.h"
#include "host/WallClock.h"
#include "inspecting/DiffText.h"
#include "overview/DifferenceText.h"
#include "text/Format.h"
#include "text/Printable.h"

#include <algorithm>
#include <exception>
#include <filesystem>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

bool isSameFile(const std::string& one, const std::string& other) {
    std::error_code ignored;
    return one == other || std::filesystem::equivalent(one, other, ignored);
}

} // namespace

/// A file whose name contains "@" is found before a time is looked for.
DiffCommand::Side DiffCommand::sideOf(const std::string& argument) {
    std::error_code ignored;
    const std::size_t at = argument.rfind('@');
    if (at == std::string::npos || std::filesystem::exists(argument, ignored)) {
        return {argument, {}};
    }
    return {argument.substr(0, at), argument.substr(at + 1)};
}

ExitStatus DiffCommand::refuse(const std::string& sentence, ExitStatus status) const {
    _environment.report(status == kExitWrongUsage ? sentence + " (see pallax diff --help)"
                                                  : sentence);
    return status;
}

ExitStatus DiffCommand::run(Output& output) {
    const Side sides[] = {sideOf(_options.before), sideOf(_options.after)};
    std::optional<TimeText> times[2];
    for (std::size_t side = 0; side < 2; ++side) {
        if (!sides[side].time) {
            continue;
        }
        const auto time = TimeText::parse(*sides[side].time);
        if (!time) {
            std::string sentence = time.error().sentence;
            sentence.pop_back(); // the full stop
            return refuse(sentence, kExitWrongUsage);
        }
        times[side] = *time;
    }
    const auto before = ViewedFile::open(sides[0].path, _options.technology, _environment.decoder);
    if (!before) {
        return refuse(before.error().sentence);
    }
    if (isSameFile(sides[0].path, sides[1].path)) {
        return compare(**before, times[0], **before, times[1], output);
    }
    const auto after = ViewedFile::open(sides[1].path, _options.technology, _environment.decoder);
    if (!after) {
        return refuse(after.error().sentence);
    }
    return compare(**before, times[0], **after, times[1], output);
}

ExitStatus DiffCommand::compare(ViewedFile& before, const std::optional<TimeText>& from,
                                ViewedFile& after, const std::optional<TimeText>& to,
                                Output& output) {
    if (&before.technology() != &after.technology()) {
        return refuse(formatText("%@ is of %@ and %@ of %@: they have no fields in common.",
                                 {before.name(), before.technology().commandName, after.name(),
                                  after.technology().commandName}));
    }
    const Clock& zone = _environment.zone;
    const auto ahead = [&zone](Time time) { return zone.zone(time).offset; };
    const auto one = before.at(from, ahead);
    const auto other = after.at(to, ahead);
    std::vector<std::string> notes = before.notes();
    if (&before != &after) {
        const std::vector<std::string> more = after.notes();
        notes.insert(notes.end(), more.begin(), more.end());
    }
    for (const std::string& note : notes) {
        _environment.report(note);
    }
    if (!one || !other) {
        return refuse(one ? other.error().sentence : one.error().sentence);
    }
    const bool mayBeLater = one->mayBeLater || other->mayBeLater;
    if (mayBeLater) {
        _environment.report(std::string(kSharedSections));
    }
    if (const auto name = unknownField(one->values, other->values)) {
        return refuse(formatText("no field is named \"%@\"", {*name}), kExitWrongUsage);
    }
    std::vector<Difference> differences = differencesBetween(one->values, other->values);
    std::erase_if(differences, [this](const Difference& each) { return !isChosen(*each.field); });
    if (_options.json) {
        appendDifferencesJson(output.text(), differences);
    } else if (!differences.empty()) {
        const auto momentOf = [&](const ViewedFile& file, const ViewedMoment& moment) {
            return formatText(
                "%@, %@", {printable(file.name()), localDateText(moment.time, ahead(moment.time))});
        };
        output.text() += "before  " + momentOf(before, *one) + "\n";
        output.text() += "after   " + momentOf(after, *other) + "\n";
        appendDifferencesText(output.text(), differences);
    }
    output.flush();
    const bool areOfOneSnapshot = mayBeLater && &before == &after && one->time != other->time;
    return !notes.empty() || areOfOneSnapshot ? kExitCouldNotTell
           : differences.empty()              ? kExitSuccess
                                              : kExitFailure;
}

/// A chosen name that no field has.
std::optional<std::string> DiffCommand::unknownField(const CurrentValues& one,
                                                     const CurrentValues& other) const {
    const auto isIn = [](const FieldTable& fields, const std::string& name) {
        for (FieldIndex field = 0; field < fields.size(); ++field) {
            if (isNamed(fields[field].name, name)) {
                return true;
            }
        }
        return false;
    };
    for (const std::string& name : _options.select) {
        if (!isIn(one.fields(), name) && !isIn(other.fields(), name)) {
            return name;
        }
    }
    return std::nullopt;
}

bool DiffCommand::isChosen(const FieldInfo& field) const {
    const bool isSelected =
        std::any_of(_options.select.begin(), _options.select.end(),
                    [&field](const std::string& name) { return isNamed(field.name, name); });
    return _options.select.empty() ? _options.all || (field.isShown && !isRunning(field.name))
                                   : isSelected;
}

ExitStatus runDiff(const DiffOptions& options) {
    try {
        const RequiredTemplates resources(DirectoryResources::programFolder());
        const BuildBundle bundle;
        DroppedNotices notices;
        const WallClock zone;
        const DecoderEnvironment decoder{resources, bundle, notices, technologies()};
        const DiffCommand::Environment environment{
            decoder, zone, [](const std::string& sentence) { complain(sentence); }};
        Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
        return DiffCommand(options, environment).run(output);
    } catch (const OutputClosed&) {
        return kExitFailure; // only differences are written
    } catch (const std::exception& error) {
        complain(error.what());
        return kExitCouldNotTell;
    }
}

} // namespace pallax
