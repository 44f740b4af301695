#pragma once

#include "LogGenerator/LogGenerator.h"
#include "decoding/RequiredTemplates.h"
#include "host/Recording.h"
#include "platform/Clock.h"

#include <chrono>
#include <cstddef>
#include <memory>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

/// A recording defined by a test, and a generator for its packets.
namespace pallax::doubles {

inline constexpr Time kFirstPacket{std::chrono::seconds{1700000000}}; // 2023-11-14T22:13:20Z
inline constexpr NumberFormat kScriptedDbm{"%.2f dBm"};

/// Packets are texts: "KEY=VALUE" stores a value in the display's section "Cell" ("KEY=-94.75dBm" a
/// display number), "KEY" alone removes it, "!REASON" throws, "?SENTENCE" reports a missing
/// template.
class ScriptedGenerator final : public LogGenerator {
public:
    using LogGenerator::LogGenerator;

    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment) {
        return std::make_unique<ScriptedGenerator>(environment);
    }

    struct Generated {
        Time time;
        std::size_t captured;
        friend bool operator==(const Generated&, const Generated&) = default;
    };
    /// The display generations of all instances, until a test clears them.
    inline static std::vector<Generated> generations;

    void updateState(Dictionary& state, Bytes data) override {
        const std::string text(data.begin(), data.end());
        if (text.starts_with('!')) {
            throw std::runtime_error(text.substr(1));
        }
        if (text.starts_with('?')) {
            throw TemplateFailure(text.substr(1));
        }
        if (!state.contains("Display")) {
            state.set("Display", Dictionary{{"Cell", Dictionary{}}});
        }
        const DictionaryRef cell = state.find("Display")->dictionary()->find("Cell")->dictionary();
        const std::size_t equals = text.find('=');
        if (equals == std::string::npos) {
            (void)cell->remove(text);
        } else {
            cell->set(Text(text.substr(0, equals)), valueOf(text.substr(equals + 1)));
        }
        _captured += data.size();
    }

    PropertyList generateLogUsingState(Dictionary& state) override {
        generations.push_back({environment().clock.now(), std::exchange(_captured, 0)});
        const PropertyList* display = state.find("Display");
        return display != nullptr ? *display : PropertyList();
    }

private:
    static PropertyList valueOf(const std::string& text) {
        if (text.ends_with("dBm")) {
            return DisplayNumber(std::stod(text), kScriptedDbm);
        }
        return text;
    }

    std::size_t _captured = 0;
};

inline constexpr Technology kScriptedTechnologies[] = {
    {"Zorell_LTE", &ScriptedGenerator::generator},
};

inline constexpr RecordedTechnology kScriptedLte{150, "Zorell_LTE", "lte"};
inline constexpr RecordedTechnology kUnknownToGenerators{0, "Another", "other"};

class ScriptedRecording : public Recording {
public:
    struct Packet {
        std::chrono::milliseconds sinceFirst;
        std::string text;
        bool isOutOfRange = false;
    };

    ScriptedRecording(std::string name, std::vector<Packet> packets,
                      const RecordedTechnology* technology = &kScriptedLte,
                      std::optional<RecordingError> atEnd = std::nullopt)
        : _name(std::move(name)), _packets(std::move(packets)), _technology(technology),
          _atEnd(std::move(atEnd)) {}

    const std::string& name() const override { return _name; }
    std::string format() const override { return "script"; }
    int linkType() const override { return _technology != nullptr ? _technology->linkType : 1; }
    const RecordedTechnology* technology() const override { return _technology; }
    RecordingError foreignLinkType() const override {
        return {RecordingError::Kind::UnknownLinkType, _name + " has a foreign link type"};
    }
    std::optional<RecordedPacket> next() override {
        if (_next == _packets.size()) {
            _error = _atEnd;
            return std::nullopt;
        }
        const Packet& packet = _packets[_next++];
        _bytes.assign(packet.text.begin(), packet.text.end());
        return RecordedPacket{kFirstPacket + packet.sinceFirst, _bytes, packet.isOutOfRange};
    }
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    std::string _name;
    std::vector<Packet> _packets;
    const RecordedTechnology* _technology;
    std::optional<RecordingError> _atEnd;
    std::size_t _next = 0;
    ByteBuffer _bytes; // one buffer for all packets, as in a real recording
    std::optional<RecordingError> _error;
};

} // namespace pallax::doubles
