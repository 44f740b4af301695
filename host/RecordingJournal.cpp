#include "host/RecordingJournal.h"

#include "host/CaptureFormat.h"
#include "host/Decompression.h"
#include "host/EmbeddedDigests.h"
#include "host/PcapNgWriter.h"
#include "host/RecordingFile.h"
#include "text/Format.h"

#include <algorithm>
#include <fstream>
#include <functional>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

std::size_t digestOf(Bytes data) {
    return std::hash<std::string_view>()(
        {reinterpret_cast<const char*>(data.data()), data.size()}); // NOLINT: bytes as characters
}

} // namespace

/// Reads on where the journal has noted a place, and notes further places.
class RecordingJournal::Reader final : public PacketReader {
public:
    Reader(RecordingJournal& journal, std::uint64_t from) : _journal(journal), _from(from) {
        start();
    }

    std::optional<JournalPacket> next() override {
        for (;;) {
            auto packet = readOne();
            if (!packet || packet->number >= _from) {
                return packet;
            }
        }
    }

private:
    void start() {
        _recording.reset();
        if (!_journal._watch.isSameFile() || _journal.isRewritten()) {
            return;
        }
        auto opened = Recording::open(_journal._path);
        if (!opened) {
            _journal._error = opened.error().sentence;
            return;
        }
        _recording = std::move(opened).value();
        _next = 1;
        const auto& places = _journal._places;
        const std::uint64_t from = std::max(_from, _continueAt);
        const auto after = std::upper_bound(
            places.begin(), places.end(), from,
            [](std::uint64_t number, const Place& place) { return number < place.packet; });
        if (_journal._canSeek && after != places.begin() && std::prev(after)->packet > 1) {
            const Place& place = *std::prev(after);
            if (_recording->seek(place.position)) {
                _next = place.packet;
            }
        }
        _position = _recording->position().value_or(0);
        _asPcap = 0;
        _asPcapNg = 0;
    }

    /// The next packet, wanted or not.
    std::optional<JournalPacket> readOne() {
        const bool hasMore = _recording == nullptr && _continueAt != 0 && hasGrown();
        if (hasMore) {
            _from = std::max(_from, _continueAt);
            start();
        }
        if (_recording == nullptr) {
            return std::nullopt;
        }
        const auto packet = _recording->next();
        if (!packet) {
            stop();
            return std::nullopt;
        }
        if (isOther(*packet)) {
            _journal._hasChanged = true;
            stop();
            return std::nullopt;
        }
        const std::uint64_t number = _next++;
        account(*packet, number);
        return JournalPacket{number, packet->time, packet->data};
    }

    /// Whether another packet was at this place before.
    bool isOther(const RecordedPacket& packet) const {
        const std::uint64_t place = (_next - 1) / kPlacesEvery;
        const auto& places = _journal._places;
        if (_next % kPlacesEvery != 1 || place >= places.size()) {
            return false;
        }
        const Place& noted = places[place];
        return packet.time != noted.time || packet.data.size() != noted.length ||
               digestOf(packet.data) != noted.digest;
    }

    /// Notes the place of every 4096th packet. Where something else than packets, and the digests
    /// of a recorder, lies between two such places, a reader from the middle might miss it, so then
    /// none is used. (Asking for the position takes a system call, so it is not done for each
    /// packet.)
    void account(const RecordedPacket& packet, std::uint64_t number) {
        const std::size_t length = packet.data.size();
        _asPcap += capture::kPcapPacketHeader + length;
        _asPcapNg += PcapNgWriter::sizeOfPacket(length);
        if (number % kPlacesEvery != 1) {
            return;
        }
        const std::uint64_t end = _recording->position().value_or(0);
        const bool isPcap = end == _position + _asPcap;
        // Those of a recorder between two places.
        constexpr std::uint64_t kDigests =
            kPlacesEvery / EmbeddedDigests::kPacketsOfBlock * EmbeddedDigests::kBlockSize;
        const std::uint64_t asPcapNg = _position + _asPcapNg;
        const bool isPcapNg = end == asPcapNg || end == asPcapNg + kDigests;
        if (_journal._places.empty() || _journal._places.back().packet < number) {
            _journal._canSeek = _journal._canSeek && (number == 1 || isPcap || isPcapNg);
            const std::uint64_t size =
                isPcap ? capture::kPcapPacketHeader + length : PcapNgWriter::sizeOfPacket(length);
            _journal._places.push_back(
                {number, end - size, packet.time, length, digestOf(packet.data)});
            _journal._read = end;
        }
        _position = end;
        _asPcap = 0;
        _asPcapNg = 0;
    }

    void stop() {
        const auto& error = _recording->error();
        _journal._error = error ? std::optional(error->sentence) : std::nullopt;
        _continueAt = _next;
        _sizeAtEnd = sizeOfFile(_journal._path);
        _journal._sizeAtEnd = _sizeAtEnd;
        _recording.reset();
    }
    bool hasGrown() const {
        return !_journal._hasChanged && sizeOfFile(_journal._path) > _sizeAtEnd;
    }

    RecordingJournal& _journal;
    std::uint64_t _from;
    std::unique_ptr<Recording> _recording; // null: at the end, or not readable
    std::uint64_t _next = 1;
    std::uint64_t _continueAt = 0; // after the end: the number of the packet that may follow
    std::uint64_t _sizeAtEnd = 0;
    std::uint64_t _position = 0; // in the file, where the reader began or last looked
    std::uint64_t _asPcap = 0;   // what the packets since take, in each form
    std::uint64_t _asPcapNg = 0;
};

bool RecordingJournal::isSuitable(const std::string& path) {
    if (RecordingFile::isStream(path) || !regularFile(path)) {
        return false;
    }
    const int first = std::ifstream(path, std::ios::binary).get();
    return first == std::ifstream::traits_type::eof() ||
           !mayBeCompressed(static_cast<std::uint8_t>(first));
}

Result<std::unique_ptr<RecordingJournal>, RecordingError>
RecordingJournal::open(const std::string& path) {
    std::unique_ptr<RecordingJournal> journal(new RecordingJournal(path));
    const auto opened = Recording::open(path);
    if (!opened) {
        return opened.error();
    }
    journal->_technology = (*opened)->technology();
    return journal;
}

std::unique_ptr<PacketReader> RecordingJournal::reader(std::uint64_t from) {
    return std::make_unique<Reader>(*this, from);
}

bool RecordingJournal::isRewritten() const {
    return _hasChanged || sizeOfFile(_path) < std::max({_watch.size(), _read, _sizeAtEnd});
}

std::optional<std::string> RecordingJournal::trouble() const {
    if (auto trouble = _watch.trouble(_read)) {
        return trouble;
    }
    if (_hasChanged) {
        return formatText("%@ was changed while it was read.", {_path});
    }
    return _error;
}

bool RecordingJournal::hasReadGrowth() const {
    return _watch.isSameFile() && !_hasChanged && !_error && _sizeAtEnd > _watch.size() &&
           _sizeAtEnd == sizeOfFile(_path);
}

double RecordingJournal::share() const {
    const std::uint64_t size = _watch.size();
    return size != 0 ? std::min(static_cast<double>(_read) / static_cast<double>(size), 1.0) : 1.0;
}

} // namespace pallax
