#include "sources/Source.h"

#include "host/Recording.h"
#include "tests/doubles/Files.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <sys/stat.h>

namespace pallax {
namespace {

using Arguments = std::vector<std::string>;

SimulationOptions drive(std::string_view technology) {
    SimulationOptions options;
    options.technology = technologyOfCommandName(technology);
    return options;
}

TEST(Source, APathLeadsToAFileOrToAStream) {
    const doubles::TemporaryFolder folder;
    const std::string pipe = folder.path("pipe");
    ASSERT_EQ(::mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    EXPECT_TRUE(std::holds_alternative<FileRecording>(recordingAt(folder.write("file", "a"))));
    EXPECT_TRUE(std::holds_alternative<FileRecording>(recordingAt(folder.path("missing"))));
    EXPECT_TRUE(std::holds_alternative<StreamedRecording>(recordingAt(pipe)));
    EXPECT_TRUE(std::holds_alternative<StreamedRecording>(recordingAt("-")));
    EXPECT_EQ(recordingPath(recordingAt(pipe)), pipe);
    EXPECT_EQ(recordingPath(recordingAt("a.pcap")), "a.pcap");
    EXPECT_EQ(recordingPath(ServiceModem()), std::nullopt);
    EXPECT_EQ(recordingPath(drive("lte")), std::nullopt);
}

TEST(Source, HasANameForMessages) {
    EXPECT_EQ(sourceName(ServiceModem()), "live modem");
    EXPECT_EQ(sourceName(ServiceModem{"car1"}), "car1");
    EXPECT_EQ(sourceName(FileRecording{"a/drive.pcap"}), "a/drive.pcap");
    EXPECT_EQ(sourceName(StreamedRecording{"-"}), "standard input");
    EXPECT_EQ(sourceName(StreamedRecording{"/dev/fd/63"}), "/dev/fd/63");
    EXPECT_EQ(sourceName(StreamedRecording{"-", "pipe"}), "pipe");
    EXPECT_EQ(sourceName(drive("cdma")), "simulated cdma");
    EXPECT_EQ(sourceName(LocalModem{"auto"}), "modem");
    EXPECT_EQ(sourceName(LocalModem{"AT-9"}), "modem AT-9");
}

TEST(Source, OnlyAStreamIsReadOnce) {
    EXPECT_TRUE(isReadOnce(StreamedRecording{"-"}));
    EXPECT_FALSE(isReadOnce(FileRecording{"a"}));
    EXPECT_FALSE(isReadOnce(ServiceModem()));
    EXPECT_FALSE(isReadOnce(drive("lte")));
}

TEST(Source, OnlyAModemOfThisMachineIsLive) {
    EXPECT_TRUE(isLive(LocalModem{"auto"}));
    EXPECT_FALSE(isLive(StreamedRecording{"-"}));
    EXPECT_FALSE(isLive(drive("lte")));
}

TEST(Source, NumberedPartsAreOneRecording) {
    const auto source = recordingInParts({"d-0003.pcap", "d-0001.pcap", "d-0002.pcap.gz"});
    ASSERT_TRUE(source);
    EXPECT_EQ(std::get<FileRecording>(*source).parts(),
              (std::vector<std::string>{"d-0001.pcap", "d-0002.pcap.gz", "d-0003.pcap"}));
    EXPECT_EQ(sourceName(*source), "d-0001.pcap and 2 more");
    EXPECT_EQ(recordingPath(*source), "d-0001.pcap");
    EXPECT_FALSE(recordingInParts({"d-0001.pcap", "e-0002.pcap"}));
    EXPECT_FALSE(recordingInParts({"d-0001.pcap", "d-0001.pcap"}));
    EXPECT_FALSE(recordingInParts({"d-0001.pcap", "-"}));
    EXPECT_FALSE(recordingInParts({"d.pcap", "d-2.pcap"}));
}

TEST(Source, IsWrittenAsArguments) {
    EXPECT_EQ(argumentsOf(ServiceModem()), (Arguments{"service"}));
    EXPECT_EQ(argumentsOf(ServiceModem{"car1"}), (Arguments{"service", "car1"}));
    EXPECT_EQ(argumentsOf(FileRecording{"a b"}), (Arguments{"file", "a b"}));
    EXPECT_EQ(argumentsOf(FileRecording{"a", {"b", "c"}}), (Arguments{"file", "a", "b", "c"}));
    EXPECT_EQ(argumentsOf(StreamedRecording{"-", "pipe"}), (Arguments{"stream", "-", "pipe"}));
    EXPECT_EQ(argumentsOf(LocalModem{"AT-9"}), (Arguments{"modem", "AT-9", ""}));
    EXPECT_EQ(argumentsOf(LocalModem{"AT-9", true}),
              (Arguments{"modem", "AT-9", "with-identities"}));
    SimulationOptions options = drive("utran");
    EXPECT_EQ(argumentsOf(options), (Arguments{"simulated", "utran", "1", "40"}));
    options.seed = 18446744073709551615U;
    options.packetsPerSecond = 7;
    options.duration = std::chrono::seconds(60);
    EXPECT_EQ(argumentsOf(options),
              (Arguments{"simulated", "utran", "18446744073709551615", "7", "60"}));
}

TEST(Source, IsReadFromItsArguments) {
    EXPECT_TRUE(doubles::holds([] {
        Source source;
        switch (doubles::any::between(0, 5)) {
        case 0:
            break;
        case 1:
            source = FileRecording{doubles::any::text()};
            for (int further = doubles::any::between(0, 3); further > 0; --further) {
                std::get<FileRecording>(source).further.push_back(doubles::any::text());
            }
            break;
        case 2:
            source = StreamedRecording{doubles::any::text(), doubles::any::text()};
            break;
        case 3:
            source = LocalModem{doubles::any::text(), doubles::any::boolean()};
            break;
        default:
            SimulationOptions options;
            options.technology = doubles::any::elementOf(simulatedTechnologies());
            options.seed = doubles::any::bits();
            options.packetsPerSecond = 1 + doubles::any::below(1'000'000);
            if (doubles::any::boolean()) {
                options.duration =
                    std::chrono::seconds(doubles::any::longBetween(1, 1'000'000'000));
            }
            source = options;
        }
        const auto again = sourceOf(argumentsOf(source));
        RC_ASSERT(again.has_value());
        RC_ASSERT(again->index() == source.index());
        RC_ASSERT(argumentsOf(*again) == argumentsOf(source));
    }));
}

TEST(Source, OtherArgumentsStandForNone) {
    for (const Arguments& arguments :
         {Arguments{}, Arguments{"modem"}, Arguments{"service", ".x"},
          Arguments{"service", "x", "y"}, Arguments{"file"}, Arguments{"stream", "-"},
          Arguments{"simulated"}, Arguments{"simulated", "lte", "1"},
          Arguments{"simulated", "nr", "1", "40"}, Arguments{"simulated", "lte", "-1", "40"},
          Arguments{"simulated", "lte", "1", "0"}, Arguments{"simulated", "lte", "1", "40", "0"},
          Arguments{"simulated", "lte", "1", "40", "6x"},
          Arguments{"simulated", "lte", "1", "40", "60", "1"}}) {
        EXPECT_FALSE(sourceOf(arguments)) << testing::PrintToString(arguments);
    }
}

} // namespace
} // namespace pallax
