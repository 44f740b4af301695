#include "decoding/Preconditions.h"

#include "tests/decoding/ScriptedRadio.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::kScriptedTechnologies;
using doubles::ScriptedRecording;

TEST(Preconditions, ATechnologyWithoutAGeneratorIsASentence) {
    const ScriptedRecording recording("a.pcap", {}, &doubles::kUnknownToGenerators);
    EXPECT_EQ(missingGenerator(recording, kScriptedTechnologies),
              "a.pcap: there is no log generator for the technology Another.");
}

TEST(Preconditions, ATechnologyOfTheTableIsNone) {
    const ScriptedRecording recording("a.pcap", {});
    EXPECT_EQ(missingGenerator(recording, kScriptedTechnologies), std::nullopt);
}

TEST(Preconditions, AForeignLinkTypeIsForOthersToReport) {
    const ScriptedRecording recording("a.pcap", {}, nullptr);
    EXPECT_EQ(missingGenerator(recording, kScriptedTechnologies), std::nullopt);
}

} // namespace
} // namespace pallax
