#pragma once

#include "host/Recording.h"
#include "sources/PacketSource.h"
#include "sources/Source.h"

namespace pallax {

/// The packets of a recording in a file.
class RecordingSource final : public PacketSource {
public:
    /// Fails if the recording cannot be opened or has an unknown link type.
    static Result<std::unique_ptr<PacketSource>, HostError> open(const std::string& path) {
        return open(FileRecording{path});
    }
    static Result<std::unique_ptr<PacketSource>, HostError> open(const FileRecording& file);

    explicit RecordingSource(FileRecording file, std::unique_ptr<Recording> recording)
        : _file(std::move(file)), _recording(std::move(recording)) {}

    std::string technology() const override;
    Next next() override;
    void whenReady(std::function<void()> ready) override;
    bool restart() override;
    std::string failure() const override;

private:
    FileRecording _file;
    std::unique_ptr<Recording> _recording;
};

/// Opens a recording and checks its technology.
Result<std::unique_ptr<Recording>, HostError> openKnownRecording(const FileRecording& file);
Result<std::unique_ptr<Recording>, HostError> openKnownRecording(const Recording::Input& input);

} // namespace pallax
