#include "tests/reference/DisplayComparison.h"

#include "host/RecordingWriter.h"
#include "samples/Sample.h"
#include "tests/reference/ReferenceFixture.h"
#include "text/Printable.h"
#include "text/Utf8.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <map>
#include <sstream>

namespace pallax::doubles {

namespace {

using Json = nlohmann::json;

/// The display after each packet, by number; a dropped packet has none.
std::map<std::size_t, Json> decoded(const std::string& recording) {
    const auto run =
        runCommand(PALLAX_BINARY_DIR "/pallax decode --every packet " + recording + " 2>/dev/null");
    EXPECT_EQ(run.status, 0) << run.out;
    std::map<std::size_t, Json> displays;
    std::istringstream lines(run.out);
    for (std::string line; std::getline(lines, line);) {
        const Json shown = Json::parse(line);
        displays.emplace(shown["packet"].get<std::size_t>(), shown["display"]);
    }
    return displays;
}

/// A text as the analyser shows it, with control characters replaced.
std::string printable(const std::string& text) {
    std::string line;
    for (std::size_t at = 0; at < text.size();) {
        const Utf8CodePoint character = utf8At(text, at);
        const bool isControl =
            character.value < 0x20 || (character.value >= 0x7F && character.value < 0xA0);
        const std::size_t size = std::max<std::size_t>(character.size, 1);
        line += isControl || character.size == 0 ? kReplacementCharacter
                                                 : std::string_view(text).substr(at, size);
        at += size;
    }
    return line;
}

std::string textOf(const Json& value) {
    return value.is_string() ? printable(value.get<std::string>()) : value.dump();
}

/// Compares numbers by value, because the JSON parser does not keep their notation.
bool isSame(const std::string& text, const Json& value) {
    return value.is_number() ? Json::parse(text, nullptr, false) == value : text == textOf(value);
}

bool isListLabel(const AnalyserItem& item) {
    return item.label.starts_with("Property list, ");
}

bool isUnread(const AnalyserItem& packet) {
    return std::any_of(packet.items.begin(), packet.items.end(),
                       [](const AnalyserItem& item) { return item.label.ends_with("(not read)"); });
}

/// Whether a packet has added more than empty lists.
bool bringsValues(const Json& before, const Json& after) {
    if (!after.is_object()) {
        return before != after;
    }
    return std::any_of(after.items().begin(), after.items().end(), [&](const auto& section) {
        const bool isNew = !before.is_object() || !before.contains(section.key()) ||
                           before[section.key()] != section.value();
        return isNew && !section.value().empty();
    });
}

/// Compares the dissector with the displays of one recording.
class Comparison {
public:
    const Compared& compared() const { return _compared; }

    /// `packet` is the analyser's output, `before` and `after` are the displays around it.
    void compare(const AnalyserItem& packet, const Json& before, const Json& after) {
        for (const AnalyserItem& item : packet.items) {
            if (isSection(item)) {
                compareSection(item, sectionOf(after, item.label));
            }
        }
        if (!isUnread(packet)) {
            expectChangesShown(packet, "", before, after);
        } else if (bringsValues(before, after)) {
            ++_compared.unread;
        }
    }

    /// The same for an object stream, whose display is the packet's content.
    void compareObject(const AnalyserItem& packet, const Json& before, const Json& after) {
        ASSERT_FALSE(packet.items.empty());
        ASSERT_TRUE(isListLabel(packet.items.back())) << packet.items.back().label;
        if (!isUnread(packet)) {
            compareWhole({packet.items.begin(), packet.items.end() - 1}, after);
        } else if (bringsValues(before, after)) {
            ++_compared.unread;
        }
    }

    /// A dropped packet does not change the display, so the analyser must show no values.
    static void compareDropped(const AnalyserItem& packet, bool isObject) {
        EXPECT_TRUE(isUnread(packet) || (isObject && packet.label.ends_with("unknown type)")))
            << packet.label;
        EXPECT_TRUE(std::none_of(packet.items.begin(), packet.items.end(), [](const auto& item) {
            return isSection(item) || !item.items.empty();
        }));
    }

private:
    static bool isSection(const AnalyserItem& item) {
        return !item.hasValue() && !isListLabel(item) && !item.label.ends_with(")");
    }

    static const Json& sectionOf(const Json& display, const std::string& path) {
        static const Json kNone;
        const std::size_t slash = path.find(" / ");
        const std::string key = path.substr(0, slash);
        if (!display.is_object() || !display.contains(key)) {
            return kNone;
        }
        return slash == std::string::npos ? display[key]
                                          : sectionOf(display[key], path.substr(slash + 3));
    }

    void compareSection(const AnalyserItem& section, const Json& display) {
        if (display.is_array()) {
            compareList(section, display);
        } else {
            compareKeys(section, display);
        }
    }

    void compareKeys(const AnalyserItem& holder, const Json& display) {
        for (const AnalyserItem& item : holder.items) {
            if (item.label == "Not displayed") {
                continue;
            }
            ASSERT_TRUE(display.is_object() && display.contains(item.key()))
                << holder.label << ", " << item.label << ", " << display;
            const Json& shown = display[item.key()];
            if (shown.is_array()) {
                compareList(item, shown);
            } else if (shown.is_object() && !shown.contains("_sorted")) {
                compareWhole(item.items, shown);
            } else if (shown.is_object()) {
                compareKeys(item, shown);
                EXPECT_EQ(item.items.size() + 1, shown.size()) << item.label; // and "_sorted"
            } else {
                EXPECT_TRUE(isSame(item.value(), shown)) << holder.label << item.label << shown;
                ++_compared.values;
            }
        }
    }

    void compareList(const AnalyserItem& holder, const Json& list) {
        if (holder.find("Not displayed") != nullptr) {
            return;
        }
        ASSERT_EQ(holder.items.size(), list.size()) << holder.label << list;
        for (std::size_t index = 0; index < list.size(); ++index) {
            const AnalyserItem& entry = holder.items[index];
            if (list[index].is_object()) {
                compareKeys(entry, list[index]);
                EXPECT_EQ(entry.items.size(), list[index].size()) << holder.label << list[index];
            } else if (list[index].is_array()) {
                compareList(entry, list[index]);
            } else {
                EXPECT_TRUE(isSame(entry.label, list[index])) << holder.label << list[index];
                ++_compared.values;
            }
        }
    }

    /// Compares all content of both sides.
    void compareWhole(const std::vector<AnalyserItem>& items, const Json& shown) {
        if (!shown.is_structured()) {
            ASSERT_EQ(items.size(), 1U) << shown;
            EXPECT_TRUE(isSame(items.front().label, shown)) << shown;
            ++_compared.values;
            return;
        }
        ASSERT_EQ(items.size(), shown.size()) << shown;
        std::size_t index = 0;
        for (const auto& [key, value] : shown.items()) {
            const bool isNested = value.is_structured();
            const std::string name = shown.is_object() ? printable(key) : "Entry " + key;
            const std::string label = isNested            ? name
                                      : shown.is_object() ? name + ": " + textOf(value)
                                                          : textOf(value);
            const auto item =
                shown.is_object()
                    ? std::find_if(items.begin(), items.end(),
                                   [&](const auto& each) { return each.label == label; })
                    : items.begin() + static_cast<std::ptrdiff_t>(index++);
            ASSERT_TRUE(item != items.end() && item->label == label) << label;
            if (isNested) {
                compareWhole(item->items, value);
            }
            _compared.values += isNested ? 0 : 1;
        }
    }

    /// Checks that the analyser shows everything that the packet has changed.
    void expectChangesShown(const AnalyserItem& packet, const std::string& path, const Json& before,
                            const Json& after) {
        for (const auto& [key, value] : after.items()) {
            const bool isNew = !before.is_object() || !before.contains(key);
            if (!isNew && before[key] == value) {
                continue;
            }
            const AnalyserItem* section = path.empty() ? nullptr : packet.find(path);
            const bool isShown = section != nullptr && section->find(key) != nullptr;
            if (!isShown && value.is_object() && !value.contains("_sorted")) {
                const std::string inner = path.empty() ? key : path + " / " + key;
                expectChangesShown(packet, inner, isNew ? Json() : before[key], value);
            } else if (path.empty()) {
                EXPECT_TRUE(value.empty() || packet.find(key) != nullptr) << key << value;
            } else if (value != "") {
                EXPECT_TRUE(isShown)
                    << packet.label << ", " << path << ", " << key << ": " << value;
            }
        }
    }

    Compared _compared;
};

std::string titleOf(std::string_view technology) {
    for (const TechnologyReference& each : reference()) {
        if (each.technology->commandName == technology) {
            return std::string(each.title);
        }
    }
    return "";
}

} // namespace

std::string recordingOf(const TemporaryFolder& folder, std::string_view technology,
                        const std::vector<ByteBuffer>& packets) {
    std::string path = folder.path(std::string(technology) + ".pcap");
    auto created = RecordingWriter::create(path, technologyOfCommandName(technology)->linkType);
    EXPECT_TRUE(created);
    Time time = kSampleStart;
    for (const ByteBuffer& packet : packets) {
        EXPECT_EQ((*created)->write(time, packet), std::nullopt);
        time += std::chrono::seconds(1);
    }
    return path;
}

std::string dissected(const std::string& recording, std::string_view technology) {
    const auto run = runCommand("LC_ALL=C.UTF-8 tshark -X lua_script:" PALLAX_SOURCE_DIR
                                "/extras/wireshark/pallax.lua -V -O pallax_" +
                                std::string(technology) + " -r " + recording);
    EXPECT_EQ(run.status, 0) << run.out;
    EXPECT_EQ(run.out.find("Lua Error"), std::string::npos)
        << run.out.substr(run.out.find("Lua Error"), 2000);
    EXPECT_EQ(run.out.find("Malformed"), std::string::npos);
    return run.out;
}

std::vector<AnalyserItem> dissectedPackets(const std::string& recording,
                                           std::string_view technology) {
    return packetsIn(dissected(recording, technology), titleOf(technology) + " log record");
}

Compared compareRecording(const std::string& recording, std::string_view technology) {
    const std::map<std::size_t, Json> displays = decoded(recording);
    const auto packets = dissectedPackets(recording, technology);
    EXPECT_GE(packets.size(), displays.empty() ? 0 : displays.rbegin()->first);
    const bool isObjects = technology == "ifx";
    Comparison comparison;
    Json before;
    for (std::size_t index = 0; index < packets.size() && !testing::Test::HasFailure(); ++index) {
        SCOPED_TRACE("packet " + std::to_string(index + 1));
        const auto after = displays.find(index + 1);
        if (after == displays.end()) {
            Comparison::compareDropped(packets[index], isObjects);
            continue;
        }
        if (isObjects) {
            comparison.compareObject(packets[index], before, after->second);
        } else {
            comparison.compare(packets[index], before, after->second);
        }
        before = after->second;
    }
    return comparison.compared();
}

} // namespace pallax::doubles
