#include "decoding/DecodeProgress.h"

#include <filesystem>
#include <memory>
#include <numeric>
#include <sys/mman.h>
#include <system_error>
#include <utility>

namespace pallax {

namespace {

/// Nothing without a size; 0 for a missing file, which will not be decoded.
std::optional<std::uint64_t> sizeOf(const std::string& path) {
    if (path == "-") {
        return std::nullopt;
    }
    std::error_code error;
    if (!std::filesystem::exists(std::filesystem::status(path, error))) {
        return 0;
    }
    const std::uint64_t size = std::filesystem::file_size(path, error);
    return error ? std::nullopt : std::optional(size);
}

} // namespace

void DecodeProgress::Unmap::operator()(Tally* tallies) const {
    (void)::munmap(tallies, size);
}

DecodeProgress::DecodeProgress(const std::vector<std::string>& recordings, TerminalLine line,
                               const Clock& clock)
    : _line(std::move(line)), _pace(clock) {
    static_assert(std::atomic<std::uint64_t>::is_always_lock_free, "processes share them");
    if (!_line.isPossible()) {
        return;
    }
    for (const std::string& path : recordings) {
        const auto size = sizeOf(path);
        _areSizesKnown = _areSizesKnown && size;
        _sizes.push_back(size.value_or(0));
    }
    const std::size_t size = recordings.size() * sizeof(Tally);
    void* memory = ::mmap(nullptr, size, PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0);
    if (memory != MAP_FAILED) {
        auto* tallies = static_cast<Tally*>(memory);
        std::uninitialized_value_construct_n(tallies, recordings.size());
        _tallies = std::unique_ptr<Tally[], Unmap>(tallies, Unmap{size});
    }
}

DecodeProgress::~DecodeProgress() {
    wipe();
}

void DecodeProgress::wipe() {
    if (!_isWorker) { // a worker may be forked while a line is shown
        _line.wipe();
    }
}

void DecodeProgress::packetDone(std::size_t recording, const Recording& source,
                                std::uint64_t packets) {
    _packets = packets;
    if (_tallies && _pace.isDue()) {
        Tally& tally = _tallies[recording];
        tally.bytes = source.position().value_or(0);
        tally.packets = packets;
        show();
    }
}

void DecodeProgress::recordingDone(std::size_t recording) {
    const std::uint64_t packets = std::exchange(_packets, 0);
    if (_tallies) {
        Tally& tally = _tallies[recording];
        tally.bytes = _sizes[recording];
        tally.packets = packets;
    }
}

void DecodeProgress::look() {
    if (_tallies && _pace.isDue()) {
        show();
    }
}

void DecodeProgress::show() {
    if (_isWorker) {
        return;
    }
    std::uint64_t bytes = 0;
    std::uint64_t packets = 0;
    for (std::size_t recording = 0; recording < _sizes.size(); ++recording) {
        bytes += _tallies[recording].bytes;
        packets += _tallies[recording].packets;
    }
    const std::uint64_t size = std::accumulate(_sizes.begin(), _sizes.end(), std::uint64_t{0});
    _line.show(_areSizesKnown && size > 0
                   ? progressBar(static_cast<double>(bytes) / static_cast<double>(size))
                   : packetCount(packets));
}

} // namespace pallax
