#pragma once

#include "host/Recording.h"
#include "telephony/PacketSource.h"

namespace pallax {

/// The packets of a recording in a file.
class RecordingSource final : public PacketSource {
public:
    /// Fails for what cannot be opened, and for a link type that is no technology's.
    static Result<std::unique_ptr<PacketSource>, HostError> open(const std::string& path);

    explicit RecordingSource(std::string path, std::unique_ptr<Recording> recording)
        : _path(std::move(path)), _recording(std::move(recording)) {}

    std::string technology() const override;
    Next next() override;
    void whenReady(std::function<void()> ready) override;
    bool restart() override;
    std::string failure() const override;

private:
    std::string _path;
    std::unique_ptr<Recording> _recording;
};

/// Opens a recording and makes sure of its technology.
Result<std::unique_ptr<Recording>, HostError> openKnownRecording(const Recording::Input& input);

} // namespace pallax
