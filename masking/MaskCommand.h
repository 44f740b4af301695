#pragma once

#include "console/ExitStatus.h"
#include "host/CapturePieces.h"
#include "host/Recording.h"
#include "masking/MaskPlan.h"
#include "masking/MaskReport.h"
#include "masking/PacketMask.h"
#include "text/Result.h"

#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Resources;

/// `pallax mask`: recordings and snapshots without what identifies a person.
struct MaskOptions {
    std::vector<std::string> files = {};
    std::string output = {}; ///< a file or, for several files, a folder
    bool check = false;      ///< look for identities instead
    MaskChoice choice = {};
    std::string keyFile = {}; ///< for pseudonyms; empty: zeros
};

class MaskCommand {
public:
    struct Environment {
        const Resources& resources;
        std::function<void(std::string_view sentence)> report;
    };

    MaskCommand(MaskOptions options, const Environment& environment)
        : _options(std::move(options)), _environment(environment) {}

    ExitStatus run();

private:
    /// Why it cannot begin; nothing if it can.
    std::optional<std::string> prepare();
    std::optional<std::string> outputOf(const std::string& file, std::string& output) const;
    std::optional<std::string> mask(const std::string& file);
    std::optional<std::string> maskCapture(CapturePieces& pieces, const std::string& output,
                                           MaskReport& report);
    void maskPiece(CapturePiece& piece, MaskReport& report);
    void maskPacket(CapturePiece& piece, MaskReport& report);
    /// Null for an unknown technology.
    const MaskPlan* planOf(std::int64_t linkType);
    std::optional<std::string> maskSnapshotFile(ByteBuffer content, const std::string& file,
                                                const std::string& output, MaskReport& report);

    MaskOptions _options;
    Environment _environment;
    Replacements _replacements;
    std::map<std::int64_t, MaskPlan> _plans; ///< by link type
    std::map<const MaskPlan*, PacketMask> _masks;
};

/// `pallax mask`, wired to this machine.
ExitStatus runMask(const MaskOptions& options);

} // namespace pallax
