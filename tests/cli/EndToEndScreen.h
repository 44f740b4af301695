#pragma once

#include "tests/cli/EndToEnd.h"
#include "tests/cli/PallaxTerminal.h"
#include "tests/doubles/Files.h"

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace pallax {

using doubles::contentOf;
using doubles::PallaxTerminal;

inline constexpr const char* kEscape = "\x1b";

/// The application in a pseudo-terminal.
class EndToEndScreen : public EndToEnd {
protected:
    EndToEndScreen() {
        std::filesystem::create_directories(world.path("config/pallax"));
        std::filesystem::create_directories(snapshots);
        configure(snapshots);
    }

    void configure(const std::string& directory) const {
        std::ofstream(world.path("config/pallax/pallax.conf"))
            << "snapshot-directory = " << directory
            << "\nsave-button-marker = " << world.path("config") << "\n";
    }

    /// The two registration states in turn, for a minute.
    std::string changing() const {
        std::vector<Packet> packets;
        for (int count = 0; count < 60; ++count) {
            packets.emplace_back(std::chrono::seconds(count),
                                 registration(count / 4 % 2 == 0 ? 0 : 2));
        }
        return record("changing.pcap", packets);
    }

    /// Two packets, a short recording.
    std::string brief() const {
        return record("brief.pcap", {{std::chrono::milliseconds(0), registration(0)},
                                     {std::chrono::milliseconds(100), registration(2)}});
    }

    std::string lteDrive() const {
        return std::string(PALLAX_SOURCE_DIR) + "/samples/lte-drive.pcap";
    }

    std::vector<std::string> filesIn(const std::string& folder) const {
        std::vector<std::string> files;
        for (const auto& entry : std::filesystem::directory_iterator(folder)) {
            files.push_back(entry.path().string());
        }
        return files;
    }

    /// Checks the preference that the application stores at every exit.
    void expectHomeScreenPreference() const {
        const std::string file = world.path("config/pallax/preferences/com.norvane.plinthe.plist");
        EXPECT_NE(contentOf(file).find("<key>PLShowGSMRSSI</key>\n\t<false/>"), std::string::npos)
            << contentOf(file);
    }

    void expectNothingLeft() const {
        EXPECT_TRUE(doubles::noChildLeft());
        EXPECT_TRUE(doubles::eventually([this] { return world.sockets().empty(); }));
    }

    std::string snapshots = world.path("snapshots");
};

} // namespace pallax
