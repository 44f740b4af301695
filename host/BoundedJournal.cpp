#include "host/BoundedJournal.h"

#include "text/Format.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

constexpr std::size_t kTimeSize = sizeof(std::int64_t);
constexpr std::size_t kHeadSize = kTimeSize + sizeof(std::uint32_t);

void append(ByteBuffer& chunk, Time time, Bytes data) {
    const std::int64_t stamp = time.time_since_epoch().count();
    const auto length = static_cast<std::uint32_t>(data.size());
    const std::size_t start = chunk.size();
    chunk.resize(start + kHeadSize + data.size());
    std::memcpy(chunk.data() + start, &stamp, sizeof(stamp));
    std::memcpy(chunk.data() + start + kTimeSize, &length, sizeof(length));
    std::copy(data.begin(), data.end(),
              chunk.begin() + static_cast<std::ptrdiff_t>(start + kHeadSize));
}

} // namespace

/// Reads a chunk at a time, of which it keeps a copy if it comes from the file.
class BoundedJournal::Reader final : public PacketReader {
public:
    Reader(BoundedJournal& journal, std::uint64_t from) : _journal(journal), _from(from) {}

    std::optional<JournalPacket> next() override {
        for (;;) {
            if (!find()) {
                return std::nullopt;
            }
            const ByteBuffer& bytes = *_content;
            std::int64_t stamp = 0;
            std::uint32_t length = 0;
            std::memcpy(&stamp, bytes.data() + _position, sizeof(stamp));
            std::memcpy(&length, bytes.data() + _position + kTimeSize, sizeof(length));
            const std::uint64_t number = _number++;
            const std::size_t start = _position + kHeadSize;
            _position = start + length;
            if (number >= _from) {
                _from = number + 1;
                const Bytes all(bytes);
                _packet.assign(all.begin() + static_cast<std::ptrdiff_t>(start),
                               all.begin() + static_cast<std::ptrdiff_t>(_position));
                return JournalPacket{number, Time(std::chrono::nanoseconds(stamp)), _packet};
            }
        }
    }

private:
    /// Whether there is a packet at the position, after looking for the chunk that has it.
    bool find() {
        const auto& chunks = _journal._chunks;
        const std::uint64_t wanted = std::max(_from, _journal.first());
        const auto after = std::upper_bound(
            chunks.begin(), chunks.end(), wanted,
            [](std::uint64_t number, const Chunk& chunk) { return number < chunk.first; });
        if (after == chunks.begin()) {
            return false;
        }
        const Chunk& chunk = *std::prev(after);
        if (wanted >= chunk.first + chunk.count) {
            return false;
        }
        if (_content == nullptr || _chunk != chunk.first) {
            _content = _journal.content(chunk);
            _chunk = chunk.first;
            _number = chunk.first;
            _position = 0;
        }
        return _content != nullptr && _position < _content->size();
    }

    BoundedJournal& _journal;
    std::uint64_t _from;
    std::uint64_t _chunk = 0;
    std::shared_ptr<const ByteBuffer> _content;
    std::uint64_t _number = 0;
    std::size_t _position = 0;
    ByteBuffer _packet;
};

std::string BoundedJournal::stateFolder() {
    const char* state = std::getenv("XDG_STATE_HOME"); // NOLINT(concurrency-mt-unsafe)
    if (state != nullptr && *state == '/') {
        return std::string(state) + "/pallax";
    }
    const char* home = std::getenv("HOME"); // NOLINT(concurrency-mt-unsafe)
    return home != nullptr && *home == '/' ? std::string(home) + "/.local/state/pallax"
                                           : std::string();
}

void BoundedJournal::add(Time time, Bytes data) {
    const std::uint64_t size = kHeadSize + data.size();
    if (_chunks.empty() || _chunks.back().bytes == nullptr ||
        _chunks.back().size + size > kChunkSize) {
        Chunk chunk;
        chunk.first = _next;
        chunk.latest = time;
        chunk.bytes = std::make_shared<ByteBuffer>();
        _chunks.push_back(std::move(chunk));
    }
    Chunk& chunk = _chunks.back();
    append(*chunk.bytes, time, data);
    ++_next;
    ++chunk.count;
    chunk.size += size;
    chunk.latest = std::max(chunk.latest, time);
    _bytes += size;
    _inMemory += size;
    while (_inMemory > _limits.memory && _chunks.size() > 1 && !_trouble) {
        moveToFile();
    }
    const std::uint64_t most = _trouble ? _limits.memory : _limits.bytes;
    while (_chunks.size() > 1 && (_bytes > most || _chunks.front().latest < time - _limits.age)) {
        dropOldest();
    }
}

std::uint64_t BoundedJournal::first() const {
    return _chunks.empty() ? 1 : _chunks.front().first;
}

std::unique_ptr<PacketReader> BoundedJournal::reader(std::uint64_t from) {
    return std::make_unique<Reader>(*this, from);
}

/// The oldest chunk in memory; sets `_trouble` if it cannot be written.
void BoundedJournal::moveToFile() {
    const auto chunk = std::find_if(_chunks.begin(), _chunks.end(), [](const Chunk& each) {
        return each.bytes != nullptr && each.size <= kChunkSize;
    });
    if (chunk == _chunks.end() || &*chunk == &_chunks.back()) {
        _inMemory = 0; // only chunks of one large packet: they stay, and the bytes limit them
        return;
    }
    errno = 0;
    if (!hasFile() || !write(*chunk)) {
        _trouble = formatText("Packets cannot be kept in %@ (%@); only the latest are, in memory.",
                              {_folder.empty() ? std::string("a file") : _folder,
                               std::string(std::strerror(errno))}); // NOLINT(concurrency-mt-unsafe)
        return;
    }
    _inMemory -= std::min(_inMemory, chunk->size);
    chunk->bytes = nullptr;
}

bool BoundedJournal::hasFile() {
    if (_file) {
        return true;
    }
    if (_folder.empty()) {
        errno = ENOENT;
        return false;
    }
    std::error_code failed; // the file cannot be made then
    std::string path = _folder + "/journal-XXXXXX";
    const mode_t before = ::umask(S_IRWXG | S_IRWXO);
    std::filesystem::create_directories(_folder, failed);
    _file = Descriptor(::mkostemp(path.data(), O_CLOEXEC));
    (void)::umask(before);
    if (_file) {
        (void)::unlink(path.c_str());
    }
    return static_cast<bool>(_file);
}

bool BoundedJournal::write(Chunk& chunk) {
    std::size_t slot = _slots;
    if (!_freeSlots.empty()) {
        slot = _freeSlots.back();
    }
    std::size_t written = 0;
    while (written < chunk.bytes->size()) {
        const ssize_t count =
            ::pwrite(_file.number(), chunk.bytes->data() + written, chunk.bytes->size() - written,
                     static_cast<off_t>(slot * kChunkSize + written));
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count <= 0) {
            return false;
        }
        written += static_cast<std::size_t>(count);
    }
    if (slot == _slots) {
        ++_slots;
    } else {
        _freeSlots.pop_back();
    }
    chunk.slot = slot;
    return true;
}

void BoundedJournal::dropOldest() {
    const Chunk& oldest = _chunks.front();
    _bytes -= oldest.size;
    if (oldest.bytes == nullptr) {
        _freeSlots.push_back(oldest.slot);
    } else {
        _inMemory -= std::min(_inMemory, oldest.size);
    }
    _chunks.pop_front();
}

std::shared_ptr<const ByteBuffer> BoundedJournal::content(const Chunk& chunk) {
    if (chunk.bytes != nullptr) {
        return chunk.bytes;
    }
    auto content = std::make_shared<ByteBuffer>(chunk.size);
    std::size_t read = 0;
    while (read < content->size()) {
        const ssize_t count =
            ::pread(_file.number(), content->data() + read, content->size() - read,
                    static_cast<off_t>(chunk.slot * kChunkSize + read));
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count <= 0) {
            _trouble = "The file in which packets are kept cannot be read.";
            return nullptr;
        }
        read += static_cast<std::size_t>(count);
    }
    return content;
}

} // namespace pallax
