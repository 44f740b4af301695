#include "storing/Loading.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "fleet/ServerStore.h"
#include "host/Sha256.h"
#include "host/UserFolders.h"
#include "masking/KeyFile.h"
#include "store/FileStore.h"
#include "text/Counted.h"
#include "text/Format.h"

#include <filesystem>

namespace pallax {

namespace {

/// Which key made the pseudonyms, without telling it.
std::string nameOfKey(const ByteBuffer& key) {
    constexpr std::size_t kDigits = 8;
    return Sha256().add("pseudonyms ").add(key).finish().substr(0, kDigits);
}

std::string textOf(const LoadOutcome& outcome, const std::string& path) {
    if (outcome.kind == LoadOutcome::Kind::Skipped) {
        return formatText("skipped   %@: %@", {path, outcome.reason});
    }
    const char* done = outcome.kind == LoadOutcome::Kind::Replaced ? "replaced " : "loaded   ";
    return formatText("%@ %@: device %@, %@, %@",
                      {done, path, outcome.device,
                       counted(static_cast<std::uint64_t>(outcome.packets), "packet"),
                       counted(outcome.intervals, "interval")});
}

} // namespace

std::string storeFile(const std::string& url) {
    const auto scheme = url.find("://");
    if (scheme != std::string::npos) {
        throw StoreFailure(formatText("\"%@\" is no store: it is neither a file nor "
                                      "clickhouse://HOST/DATABASE.",
                                      {url}));
    }
    if (!url.empty()) {
        return url;
    }
    const auto folder = dataFolder();
    if (!folder) {
        throw StoreFailure("There is no folder for data, as neither XDG_DATA_HOME nor HOME is set; "
                           "name the file of the store.");
    }
    std::error_code error;
    std::filesystem::create_directories(*folder / "pallax", error);
    if (error) {
        throw StoreFailure(formatText("The folder %@ cannot be made: %@.",
                                      {(*folder / "pallax").string(), error.message()}));
    }
    return *folder / "pallax" / "measurements.db";
}

Loading::Loading(const LoadingOptions& options)
    : _options(options), _resources(DirectoryResources::programFolder()), _identities("left out") {
    if (!options.keyFile.empty()) {
        auto key = readKeyFile(options.keyFile);
        if (!key) {
            throw StoreFailure(key.error().sentence);
        }
        _identities = "pseudonyms " + nameOfKey(*key);
        _replacements.identities = Replacement(std::move(key).value());
    }
    // What is opened is not kept: other processes may be made.
    if (isStoreAddress(options.store)) {
        _address = parseStoreAddress(options.store);
        const ServerStore store(*_address);
    } else {
        _file = storeFile(options.store);
        const FileStore store(_file);
    }
}

std::unique_ptr<MeasurementStore> Loading::open(const std::string& path, const Seams& seams) const {
    if (_address) {
        return std::make_unique<ServerStore>(*_address);
    }
    auto store = std::make_unique<FileStore>(_file);
    if (seams.isAlone) {
        store->connection().setWaiting([this, &path, &seams] {
            seams.complain(
                formatText("%@: another program writes to %@; waiting for it.", {path, _file}));
        });
    }
    return store;
}

ExitStatus Loading::load(const std::string& path, const Seams& seams) {
    const auto store = open(path, seams);
    const LoadOutcome outcome =
        loadRecording(path, requestOf(seams), {_resources, _bundle, technologies()}, *store);
    if (outcome.kind == LoadOutcome::Kind::Refused) {
        seams.complain(outcome.reason);
        return kExitFailure;
    }
    seams.tell(outcome.kind, textOf(outcome, path));
    if (outcome.trouble) {
        seams.complain(*outcome.trouble + " It was loaded up to there.");
        return kExitFailure;
    }
    return kExitSuccess;
}

LoadRequest Loading::requestOf(const Seams& seams) {
    return {_options.device,
            _options.resolution,
            [this](const RecordedTechnology& technology) { return maskOf(technology); },
            !_options.keyFile.empty(),
            _identities,
            seams.progress};
}

LoadRequest::Mask Loading::maskOf(const RecordedTechnology& technology) {
    auto& plan = _plans[&technology];
    if (plan == nullptr) {
        plan = std::make_unique<MaskPlan>(technology, _resources, MaskChoice{});
    }
    return [mask = PacketMask(*plan, _replacements)](ByteBuffer& packet) {
        MaskReport ignored;
        mask.mask(packet, ignored);
    };
}

} // namespace pallax
