#include "masking/MaskCommand.h"

#include "decoding/Preconditions.h"
#include "decoding/RequiredTemplates.h"
#include "host/Complaint.h"
#include "host/DirectoryResources.h"
#include "host/EmbeddedDigests.h"
#include "host/FileIdentity.h"
#include "host/NewFile.h"
#include "host/Snapshot.h"
#include "masking/CheckCommand.h"
#include "masking/KeyFile.h"
#include "masking/SnapshotMask.h"
#include "text/Format.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <system_error>

namespace pallax {

namespace {

std::string unwritable(const std::string& output) {
    return formatText("%@ cannot be written: %@.", {output, std::strerror(errno)});
}

} // namespace

ExitStatus MaskCommand::run() {
    if (const auto unknown = MaskPlan::unknownName(_options.choice, _environment.resources)) {
        _environment.report(
            formatText("No field is named \"%@\" (see pallax fields).", {*unknown}));
        return kExitWrongUsage;
    }
    if (const auto failure = prepare()) {
        _environment.report(*failure);
        return kExitFailure;
    }
    ExitStatus status = kExitSuccess;
    for (const std::string& file : _options.files) {
        if (const auto failure = mask(file)) {
            _environment.report(*failure);
            status = kExitFailure;
        }
    }
    return status;
}

std::optional<std::string> MaskCommand::prepare() {
    if (!_options.keyFile.empty()) {
        auto key = readKeyFile(_options.keyFile);
        if (!key) {
            return key.error().sentence;
        }
        _replacements.identities = Replacement(*key);
        _replacements.places = Replacement(*key);
        return std::nullopt;
    }
    auto key = randomKey();
    if (!key) {
        return key.error().sentence;
    }
    _replacements.places = Replacement(*key);
    return std::nullopt;
}

/// Where the masked file goes, or why it cannot.
std::optional<std::string> MaskCommand::outputOf(const std::string& file,
                                                 std::string& output) const {
    std::error_code ignored;
    output = _options.output;
    const bool isFolder = std::filesystem::is_directory(output, ignored);
    if (_options.files.size() > 1 && !isFolder) {
        return formatText("%@ is not a folder, which several files need.", {output});
    }
    if (isFolder) {
        output = (std::filesystem::path(output) / std::filesystem::path(file).filename()).string();
    }
    if (std::filesystem::exists(output, ignored) &&
        !std::filesystem::is_regular_file(output, ignored)) {
        return formatText("%@ is not a file.", {output});
    }
    if (recordingAmong(_options.files, regularFile(output))) {
        return formatText("%@ would be replaced by its masked copy.", {output});
    }
    return std::nullopt;
}

std::optional<std::string> MaskCommand::mask(const std::string& file) {
    std::string output;
    if (auto refusal = outputOf(file, output)) {
        return refusal;
    }
    const std::string name = file == "-" ? "standard input" : file;
    auto opened = openRecordingContent({file, {}, _environment.report}, name);
    if (!opened) {
        return opened.error().sentence;
    }
    RecordingContent content = std::move(opened).value();
    MaskReport report;
    std::optional<std::string> failure;
    if (mayBeSnapshot(content.first)) {
        auto bytes = restOf(content.content);
        const bool isWhole = bytes && std::ferror(content.content) == 0 &&
                             content.ending() == DecompressedFile::Ending::Whole;
        (void)std::fclose(content.content);
        failure = isWhole ? maskSnapshotFile(std::move(*bytes), name, output, report)
                          : formatText("%@ is not a snapshot that can be read.", {name});
    } else {
        CapturePieces pieces(std::move(content), name);
        failure = maskCapture(pieces, output, report);
    }
    if (!failure) {
        _environment.report(
            formatText("%@: %@.", {output, report.text(_options.choice.keepUnknown)}));
    }
    return failure;
}

std::optional<std::string> MaskCommand::maskCapture(CapturePieces& pieces,
                                                    const std::string& output, MaskReport& report) {
    const auto file = NewFile::create(output);
    if (!file) {
        return unwritable(output);
    }
    EmbeddedDigests before;
    EmbeddedDigests after;
    bool hasChanged = false;
    while (auto piece = pieces.next()) {
        if (piece->isSection()) {
            before.beginSection();
            after.beginSection();
        }
        const bool isPacket = piece->kind == CapturePiece::Kind::Packet;
        if (const auto block = before.take(*piece)) {
            const bool isRight = block->isRight && block->packets == before.packets();
            piece->bytes = isRight ? after.block(block->isLast, piece->isBigEndian)
                                   : after.wrongBlock(block->isLast, piece->isBigEndian);
            hasChanged = hasChanged || !isRight;
        } else {
            before.add(piece->bytes, isPacket);
            maskPiece(*piece, report);
            after.add(piece->bytes, isPacket);
        }
        if (!file->write(piece->bytes)) {
            return unwritable(output);
        }
    }
    if (pieces.error()) {
        return pieces.error()->sentence;
    }
    if (hasChanged) {
        _environment.report(formatText("%@ has changed since it was recorded; pallax verify will "
                                       "say so of %@, too.",
                                       {pieces.name(), output}));
    }
    return file->finish() ? std::nullopt : std::optional(unwritable(output));
}

void MaskCommand::maskPiece(CapturePiece& piece, MaskReport& report) {
    for (const CapturePiece::Remark& remark : piece.remarks) {
        const auto begin = piece.bytes.begin() + static_cast<std::ptrdiff_t>(remark.offset);
        const auto end = begin + static_cast<std::ptrdiff_t>(remark.length);
        if (std::all_of(begin, end, [](std::uint8_t byte) { return byte == 0; })) {
            continue;
        }
        ++report.unknownParts;
        if (!_options.choice.keepUnknown) {
            std::fill(begin, end, std::uint8_t{0});
        }
    }
    if (piece.kind == CapturePiece::Kind::Packet) {
        maskPacket(piece, report);
    }
}

void MaskCommand::maskPacket(CapturePiece& piece, MaskReport& report) {
    const Bytes packet = piece.packet();
    ByteBuffer masked(packet.begin(), packet.end());
    if (const MaskPlan* plan = planOf(piece.linkType)) {
        _masks.try_emplace(plan, *plan, _replacements).first->second.mask(masked, report);
    } else {
        ++report.packets;
        ++report.unknownPackets;
        if (!_options.choice.keepUnknown) {
            std::fill(masked.begin(), masked.end(), std::uint8_t{0});
        }
    }
    piece.setPacket(masked);
}

const MaskPlan* MaskCommand::planOf(std::int64_t linkType) {
    const RecordedTechnology* technology = technologyOfLinkType(static_cast<int>(linkType));
    if (technology == nullptr) {
        return nullptr;
    }
    const auto found = _plans.find(linkType);
    return found != _plans.end()
               ? &found->second
               : &_plans
                      .emplace(linkType,
                               MaskPlan(*technology, _environment.resources, _options.choice))
                      .first->second;
}

std::optional<std::string> MaskCommand::maskSnapshotFile(ByteBuffer content,
                                                         const std::string& file,
                                                         const std::string& output,
                                                         MaskReport& report) {
    const auto snapshot = snapshotIn(content);
    std::vector<MaskPlan> plans;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        plans.emplace_back(technology, _environment.resources, _options.choice);
    }
    if (!snapshot || !maskSnapshot(content, plans, _replacements, report)) {
        return formatText("%@ is neither a recording nor a snapshot.", {file});
    }
    report.packets = snapshot->displays.size();
    const auto written = NewFile::create(output);
    return written && written->write(content) && written->finish()
               ? std::nullopt
               : std::optional(unwritable(output));
}

ExitStatus runMask(const MaskOptions& options) {
    const RequiredTemplates resources(DirectoryResources::programFolder());
    if (options.check) {
        return runCheck(options.files, resources);
    }
    return MaskCommand(options, {resources, complain}).run();
}

} // namespace pallax
