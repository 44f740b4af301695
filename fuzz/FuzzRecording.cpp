// A recording of any bytes, pcap or pcapng, perhaps compressed: it is opened or refused with one
// sentence, every packet is in readable memory, and a recording that ends early says so.

#include "host/Recording.h"

#include <cstdint>
#include <cstdlib>
#include <string>
#include <sys/mman.h>
#include <unistd.h>

namespace {

using namespace pallax;

/// A file in memory with a name that can be opened.
class MemoryFile {
public:
    explicit MemoryFile(Bytes content) : _descriptor(::memfd_create("recording", MFD_CLOEXEC)) {
        if (::write(_descriptor, content.data(), content.size()) !=
            static_cast<ssize_t>(content.size())) {
            std::abort();
        }
    }
    ~MemoryFile() { ::close(_descriptor); }
    MemoryFile(const MemoryFile&) = delete;
    MemoryFile& operator=(const MemoryFile&) = delete;

    std::string path() const { return "/proc/self/fd/" + std::to_string(_descriptor); }

private:
    int _descriptor;
};

void expectSentence(const RecordingError& error, const std::string& path) {
    if (!error.sentence.starts_with(path) || error.sentence.back() != '.') {
        std::abort();
    }
}

void readAll(Recording& recording, const std::string& path) {
    unsigned sum = 0;
    while (const auto packet = recording.next()) {
        for (const std::uint8_t byte : packet->data) {
            sum += byte;
        }
        if (packet->time < Time{}) {
            std::abort();
        }
    }
    if (recording.error()) {
        expectSentence(*recording.error(), path);
    }
    if (recording.next()) { // the end is the end
        std::abort();
    }
    volatile unsigned read = sum;
    (void)read;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const MemoryFile file(Bytes(data, size));
    const std::string path = file.path();
    const auto recording = Recording::open(path);
    if (!recording) {
        expectSentence(recording.error(), path);
        return 0;
    }
    if ((*recording)->technology() == nullptr) {
        expectSentence((*recording)->foreignLinkType(), path);
    }
    readAll(**recording, path);
    return 0;
}
