#include "sources/SourceFactory.h"

#include "host/AsioMainQueue.h"
#include "host/Recording.h"
#include "sources/Relay.h"
#include "tests/telephony/ServiceFolder.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <fstream>
#include <sys/file.h>
#include <sys/stat.h>
#include <thread>

namespace pallax {
namespace {

using namespace std::chrono_literals;

class SourceFactoryTest : public testing::Test {
protected:
    Result<OpenSource, HostError> open(const Source& source) {
        return openSource(source, {_queue, [this](const std::string& sentence) {
                                       _reports.push_back(sentence);
                                   }});
    }
    std::string failure(const Source& source) {
        const auto opened = open(source);
        return opened ? "" : opened.error().sentence;
    }
    /// A named pipe into which a thread writes the recording.
    std::string pipeOf(const std::string& recording) {
        const std::string pipe = _folder.file("pipe");
        EXPECT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
        _writer = std::jthread([recording, pipe] {
            const std::ifstream file(recording);
            std::ofstream(pipe) << file.rdbuf();
        });
        return pipe;
    }
    std::size_t packetsOf(PacketSource& reader) {
        std::size_t count = 0;
        bool hasEnded = false;
        const std::function<void()> read = [&] {
            for (auto next = reader.next(); next.state != PacketSource::State::Later;
                 next = reader.next()) {
                if (next.state == PacketSource::State::End) {
                    hasEnded = true;
                    return;
                }
                ++count;
            }
            reader.whenReady(read);
        };
        read();
        EXPECT_TRUE(runUntil(_queue, [&] { return hasEnded; }));
        return count;
    }

    doubles::RuntimeFolder _folder;
    AsioMainQueue _queue;
    std::vector<std::string> _reports;
    std::jthread _writer;
};

TEST_F(SourceFactoryTest, AFileIsReadFromItsStartByEachReader) {
    const std::string path = recordLte(_folder, 3);
    const auto opened = open(FileRecording{path});
    ASSERT_TRUE(opened);
    EXPECT_EQ(opened->technology, "Zorell_LTE");
    EXPECT_EQ(opened->relay, nullptr);
    EXPECT_EQ(packetsOf(**opened->makeReader()), 3U);
    EXPECT_EQ(packetsOf(**opened->makeReader()), 3U);
    const Descriptor recorder(::open(path.c_str(), O_RDWR | O_CLOEXEC));
    EXPECT_NE(::flock(recorder.number(), LOCK_EX | LOCK_NB), 0) << "recorders must not replace it";
}

TEST_F(SourceFactoryTest, AStreamIsReadOnce) {
    const std::string pipe = pipeOf(recordLte(_folder, 3));
    const auto opened = open(StreamedRecording{pipe});
    ASSERT_TRUE(opened);
    EXPECT_EQ(opened->technology, "Zorell_LTE");
    const auto only = opened->makeReader();
    ASSERT_TRUE(only);
    const auto second = opened->makeReader();
    ASSERT_FALSE(second);
    EXPECT_EQ(second.error().sentence, pipe + " is already being played.");
    EXPECT_EQ(packetsOf(**only), 3U);
}

TEST_F(SourceFactoryTest, ARelayedStreamHasAnyNumberOfReaders) {
    const std::string pipe = pipeOf(recordLte(_folder, 3));
    std::optional<bool> orderly;
    SourceSurroundings surroundings{
        _queue, [this](const std::string& sentence) { _reports.push_back(sentence); },
        SourceSurroundings::Relaying{10s, [&](bool isOrderly) { orderly = isOrderly; }}};
    const auto opened = openSource(StreamedRecording{pipe}, std::move(surroundings));
    ASSERT_TRUE(opened);
    ASSERT_NE(opened->relay, nullptr);
    const auto first = opened->makeReader();
    const auto second = opened->makeReader();
    ASSERT_TRUE(first && second);
    EXPECT_EQ((*second)->next().state, PacketSource::State::Later);
    EXPECT_EQ(packetsOf(**first), 3U);
    EXPECT_EQ(packetsOf(**second), 3U);
    EXPECT_EQ(orderly, true);
}

TEST_F(SourceFactoryTest, ASimulationStartsForEachReader) {
    SimulationOptions options;
    options.technology = technologyOfCommandName("gsm");
    options.packetsPerSecond = 10;
    options.duration = 2s;
    const auto opened = open(options);
    ASSERT_TRUE(opened);
    EXPECT_EQ(opened->technology, "Zorell_GSM");
    const std::size_t count = packetsOf(**opened->makeReader());
    EXPECT_GT(count, 0U);
    EXPECT_EQ(packetsOf(**opened->makeReader()), count);
}

TEST_F(SourceFactoryTest, WhatCannotBeReadFailsAtOnce) {
    const std::string missing = _folder.file("missing.pcap");
    EXPECT_EQ(failure(FileRecording{missing}),
              missing + " cannot be opened: No such file or directory.");
    EXPECT_EQ(failure(ServiceModem()),
              "The modem of the telephony service can be read through the service only.");
}

} // namespace
} // namespace pallax
