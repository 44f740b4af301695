#include "LogGenerator/ZORLogGenerator.h"

#include "LogGenerator/DlfVersionReport.h"
#include "platform/Bundle.h"
#include "platform/Clock.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

DlfTime dlfTimeOf(const Clock& clock) {
    constexpr int kSecondsPerMinute = 60;
    const Time now = clock.now();
    const Clock::Zone zone = clock.zone(now);
    return {static_cast<std::uint32_t>(dateOf(now).time_since_epoch().count()),
            static_cast<std::int16_t>(zone.offset.count() / kSecondsPerMinute),
            static_cast<std::uint8_t>(zone.daylightSaving ? 1 : 0)};
}

} // namespace

std::optional<ByteBuffer> dlfHeader(std::size_t size, const GeneratorEnvironment& environment) {
    constexpr std::uint16_t kVersionNumber = 1;
    const auto version = environment.bundle.version();
    const std::string application = version ? formatText("Pallax %@", {*version}) : "(none)";
    ByteBuffer buffer(size);
    std::uint32_t written = 0;
    const DlfResult result = ETLDLFAddVersionReport(
        buffer, written, kVersionNumber, kVersionNumber, application, "EXECUTABLE_NAME",
        environment.bundle.buildDate(), dlfTimeOf(environment.clock));
    if (result != DlfResult::Success) {
        systemLog(LogPriority::DlfFailure, "Could not write DLF header (result=%d)",
                  static_cast<int>(result));
        return std::nullopt;
    }
    return buffer;
}

ZORLogGenerator::ZORLogGenerator(const GeneratorEnvironment& environment)
    : LogGenerator(environment), _binData(std::make_shared<ByteBuffer>()) {}

void ZORLogGenerator::capture(Bytes packet) {
    _binData->insert(_binData->end(), packet.begin(), packet.end());
}

void ZORLogGenerator::handOverCapture(Dictionary& state) {
    const std::size_t captured = _binData->size();
    state.setFixed("DisplayState", SharedBytes(std::move(_binData)));
    _binData = std::make_shared<ByteBuffer>();
    _binData->reserve(captured); // the next capture will have about the same size
}

std::optional<ByteBuffer> ZORLogGenerator::generateDlfFromState(const Dictionary& state) const {
    // Only the first byte of the whole capture is dropped, not the first byte of each packet.
    constexpr std::size_t kSkipped = 1;
    auto log = dlfHeader(kDlfVersionReportSize, environment());
    if (!log) {
        return std::nullopt;
    }
    for (const PropertyList& entry : historyOf(state)) {
        const DictionaryRef fields = entry.dictionary();
        const PropertyList* captured = fields != nullptr ? fields->find("DisplayState") : nullptr;
        if (captured == nullptr) {
            continue;
        }
        const SharedBytes data = captured->data();
        if (data == nullptr) {
            systemLog(LogPriority::DlfFailure,
                      "Got wrong class writing history to DLF; aborting writing the DLF file");
            return std::nullopt;
        }
        if (data->size() > kSkipped) {
            log->insert(log->end(), data->begin() + kSkipped, data->end());
        }
    }
    return log;
}

PropertyList ZORLogGenerator::getSaveContentsFromState(const Dictionary& state) const {
    if (_binData == nullptr) {
        return {};
    }
    Array contents = historyOf(state);
    if (auto log = generateDlfFromState(state)) {
        Dictionary entry;
        entry.setFixed("Description", formatText("DLF binary (%d bytes)", {log->size()}));
        entry.setFixed("DLF", PropertyList::data(std::move(*log)));
        contents.emplace_back(std::move(entry));
    }
    return contents;
}

} // namespace pallax
