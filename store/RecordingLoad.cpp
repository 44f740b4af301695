#include "store/RecordingLoad.h"

#include "host/Sha256.h"
#include "host/Snapshot.h"
#include "platform/Bundle.h"
#include "platform/RecordedTechnology.h"
#include "store/IntervalWriter.h"
#include "store/NamedRows.h"
#include "text/Format.h"

#include <bit>
#include <charconv>
#include <filesystem>
#include <utility>
#include <vector>

namespace pallax {

namespace {

std::int64_t millisecondsOf(Time time) {
    return std::chrono::floor<std::chrono::milliseconds>(time.time_since_epoch()).count();
}

/// The digest of packets with their times.
class PacketDigest {
public:
    void add(const RecordedPacket& packet) {
        const auto since = packet.time.time_since_epoch().count();
        _digest.add(std::to_string(since) + " " + std::to_string(packet.data.size()) + ":");
        _digest.add(packet.data);
        if (std::has_single_bit(++_packets)) {
            _beginnings += " " + std::to_string(_packets) + ":" + _digest.soFar();
        }
    }
    std::string soFar() const { return _digest.soFar(); }
    const std::string& beginnings() const { return _beginnings; }

private:
    Sha256 _digest;
    std::uint64_t _packets = 0;
    std::string _beginnings;
};

/// "0.10.2" is later than "0.9".
bool isLater(std::string_view one, std::string_view other) {
    while (!one.empty() || !other.empty()) {
        const auto part = [](std::string_view& version) {
            unsigned number = 0;
            const char* end = version.data() + version.size();
            const auto read = std::from_chars(version.data(), end, number);
            version.remove_prefix(static_cast<std::size_t>(read.ptr - version.data()));
            version.remove_prefix(version.empty() ? 0 : 1);
            return number;
        };
        const unsigned mine = part(one);
        const unsigned its = part(other);
        if (mine != its) {
            return mine > its;
        }
    }
    return false;
}

/// The name of the folder that has the file.
std::string folderName(const std::string& path) {
    std::error_code error;
    const auto absolute = std::filesystem::absolute(path, error).lexically_normal();
    const std::string name = absolute.parent_path().filename().string();
    return name.empty() ? "/" : name;
}

constexpr std::size_t kMostEvents = 65536; ///< that wait to be written

/// Another program has loaded more of it in the meantime.
struct AlreadyThere {
    std::string reason;
};

class Load {
public:
    Load(const std::string& path, const LoadRequest& request, const StoreDecoder& decoder,
         MeasurementStore& store)
        : _path(path), _request(request), _decoder(decoder), _store(store) {}

    LoadOutcome run();

private:
    std::optional<std::string> examine();
    std::optional<std::string> reasonToSkip();
    std::optional<std::string> longerOne();
    std::optional<std::string> decode();
    void begin();
    void write();
    void finish();
    bool isWanted(const Interval& interval) const {
        return _request.keepsPseudonyms || !_measurements->fields()[interval.field].isPersonal;
    }

    const std::string& _path;
    const LoadRequest& _request;
    const StoreDecoder& _decoder;
    MeasurementStore& _store;

    const RecordedTechnology* _technology = nullptr;
    Time _first;
    LoadedRecording _recording;
    std::optional<RecordingMeasurements> _measurements;
    std::optional<IntervalWriter> _intervals;
    std::optional<StoreConnection::Transaction> _transaction;
    std::optional<NamedRows> _names;
    bool _replaces = false;
};

LoadOutcome Load::run() {
    if (auto refusal = examine()) {
        return {LoadOutcome::Kind::Refused, {}, std::move(*refusal)};
    }
    if (auto reason = reasonToSkip()) {
        return {LoadOutcome::Kind::Skipped, _recording.device, std::move(*reason)};
    }
    try {
        if (auto refusal = decode()) {
            return {LoadOutcome::Kind::Refused, {}, std::move(*refusal)};
        }
    } catch (AlreadyThere& there) {
        return {LoadOutcome::Kind::Skipped, _recording.device, std::move(there.reason)};
    }
    return {_replaces ? LoadOutcome::Kind::Replaced : LoadOutcome::Kind::Loaded,
            _recording.device,
            {},
            _recording.packets,
            _intervals->count(),
            _recording.trouble};
}

/// Reads it once, to know what it is.
std::optional<std::string> Load::examine() {
    const auto opened = Recording::open(_path);
    if (!opened) {
        return opened.error().sentence;
    }
    Recording& recording = **opened;
    if (recording.isStream()) {
        return formatText("%@ can be read only once; only files can be loaded.",
                          {recording.name()});
    }
    if (snapshotOf(recording) != nullptr) {
        return noTimeOfSnapshot(recording.name()).sentence;
    }
    _technology = recording.technology();
    if (_technology == nullptr) {
        return recording.foreignLinkType().sentence;
    }
    _recording.technology = _technology->commandName;
    _recording.name = std::filesystem::path(_path).filename().string();
    _recording.device = _request.device ? *_request.device : folderName(_path);
    _recording.decoder = _decoder.bundle.version().value_or("");
    _recording.every = wordOf(_request.resolution);
    _recording.identities = _request.identities;
    PacketDigest digest;
    while (const auto packet = recording.next()) {
        if (_recording.packets == 0) {
            _first = packet->time;
            _recording.first = millisecondsOf(packet->time);
            _recording.last = _recording.first;
        }
        digest.add(*packet);
        ++_recording.packets;
        _recording.last = std::max(_recording.last, millisecondsOf(packet->time));
    }
    if (recording.error()) {
        _recording.trouble = recording.error()->sentence;
    }
    if (_recording.packets == 0) {
        return _recording.trouble.value_or(formatText("%@ has no packets.", {recording.name()}));
    }
    _recording.digest = digest.soFar();
    _recording.beginnings = digest.beginnings();
    return std::nullopt;
}

/// Why not to load a recording of which the store has more packets; nothing if it has not.
std::optional<std::string> Load::longerOne() {
    for (const auto& other : _store.beginningAt(_recording.technology, _recording.first)) {
        if (other.packets > _recording.packets && haveSameBeginning(_recording, other)) {
            return formatText("the store has it with more packets (%lld), as %@",
                              {other.packets, other.name});
        }
    }
    return std::nullopt;
}

std::optional<std::string> Load::reasonToSkip() {
    const auto known = _store.withDigest(_recording.digest);
    if (!known) {
        return longerOne();
    }
    if (_request.device && known->device != *_request.device) {
        _recording.device = known->device;
        return formatText("it is in the store as a recording of the device \"%@\"",
                          {known->device});
    }
    _recording.device = known->device;
    if (isLater(known->decoder, _recording.decoder)) {
        return formatText("it is in the store, as the later version %@ has read it",
                          {known->decoder});
    }
    const bool isSame = known->decoder == _recording.decoder && known->every == _recording.every &&
                        known->identities == _recording.identities;
    return isSame ? std::optional<std::string>("it is in the store") : std::nullopt;
}

std::optional<std::string> Load::decode() {
    const auto opened = Recording::open(_path);
    if (!opened) {
        return opened.error().sentence;
    }
    const LoadRequest::Mask mask = _request.maskOf(*_technology);
    const auto take = [this](const Interval& interval) {
        if (isWanted(interval)) {
            _intervals->add(interval);
        }
    };
    _measurements.emplace(
        DecodingSource{*_technology, _decoder.resources, _decoder.bundle, _decoder.technologies},
        _request.resolution, take);
    _intervals.emplace(*_measurements, _first);
    PacketDigest digest;
    ByteBuffer masked;
    std::uint64_t number = 0;
    bool isReadable = true;
    while (const auto packet = (*opened)->next()) {
        ++number;
        digest.add(*packet);
        if (isReadable) {
            masked.assign(packet->data.begin(), packet->data.end());
            mask(masked);
            isReadable = _measurements->add({number, packet->time, masked});
            if (_intervals->isFull() || _measurements->eventCount() > kMostEvents) {
                write();
            }
        }
        _request.progress(**opened, number);
    }
    if (digest.soFar() != _recording.digest) {
        return formatText("%@ was changed while it was read.", {_path}); // nothing is committed
    }
    if (!isReadable) {
        _recording.trouble = formatText("%@ can be decoded only up to a record that cannot be "
                                        "read (see pallax events).",
                                        {_path});
    }
    _measurements->finish();
    finish();
    return std::nullopt;
}

void Load::begin() {
    if (_transaction) {
        return;
    }
    _transaction.emplace(_store.connection());
    // Others may have loaded it meanwhile.
    if (auto reason = longerOne()) {
        throw AlreadyThere{std::move(*reason)};
    }
    for (const auto& before : _store.beginningAt(_recording.technology, _recording.first)) {
        // It was loaded while it grew, or from a damaged copy.
        const bool isShorter =
            before.packets < _recording.packets && haveSameBeginning(_recording, before);
        if (isShorter || before.digest == _recording.digest) {
            _recording.device = before.device;
            _store.remove(before.id);
            _replaces = true;
        }
    }
    _recording.id = _store.add(_recording);
    _names.emplace(_store.connection());
}

void Load::write() {
    begin();
    _intervals->write(_store.connection(), _recording.id, *_names);
    _store.addEvents(_recording.id, _measurements->takeEvents());
}

void Load::finish() {
    write();
    _store.addCells(_recording.id, _measurements->cells());
    _store.addTotals(_recording.id);
    for (FieldIndex field = 0; field < _measurements->fields().size(); ++field) {
        (void)_names->field(_measurements->fields()[field]);
    }
    if (_recording.trouble) {
        _store.setTrouble(_recording.id, *_recording.trouble);
    }
    _transaction->commit();
}

} // namespace

LoadOutcome loadRecording(const std::string& path, const LoadRequest& request,
                          const StoreDecoder& decoder, MeasurementStore& store) {
    return Load(path, request, decoder, store).run();
}

} // namespace pallax
