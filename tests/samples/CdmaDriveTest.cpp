#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "samples/Sample.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordingLog.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

#include <set>

namespace pallax {
namespace {

using doubles::RecordingLog;

/// The parsers' display of the drive, with the installed template.
class CdmaDrive : public testing::Test {
protected:
    CdmaDrive() {
        _fixture.resources.add(
            "C2KTemplate",
            doubles::propertyListFile(PALLAX_SOURCE_DIR "/resources/C2KTemplate.plist"));
        _generator = C2KLogGenerator::generator(_fixture.environment());
        (void)_generator->generateLogUsingState(_state);
        (void)_log.take();
    }

    /// Plays the whole drive and notes the values of each lookup name.
    void play() {
        for (const TimedPacket& packet : cdmaDrivePackets()) {
            _generator->updateState(_state, packet.data);
            (void)_generator->display(_state);
            for (const Dictionary::Entry& name : *_state.find("Lookup")->dictionary()) {
                _shown[name.key.string()].insert(valueOf(name));
            }
        }
    }

    /// The value in the first place of a lookup name.
    static std::string valueOf(const Dictionary::Entry& name) {
        const DictionaryRef place = name.value.array()->front().dictionary();
        const std::string key = *place->find("key")->string();
        const PropertyList* value = place->find("dict")->dictionary()->find(key);
        return value->string().value_or(value->description());
    }

    doubles::GeneratorFixture _fixture;
    RecordingLog _log;
    std::unique_ptr<LogGenerator> _generator;
    Dictionary _state;
    std::map<std::string, std::set<std::string>> _shown;
};

TEST_F(CdmaDrive, InTheEndEveryLookupNameIsFilled) {
    play();
    const DictionaryRef lookup = _state.find("Lookup")->dictionary();
    ASSERT_EQ(lookup->size(), 30U);
    for (const Dictionary::Entry& name : *lookup) {
        EXPECT_NE(valueOf(name), "") << name.key.string();
    }
}

TEST_F(CdmaDrive, EveryLookupNameHasShownAValueOfItsOwn) {
    play();
    const std::set<std::string> noValues = {"", "N/A", "(none)", "Invalid Value"};
    ASSERT_EQ(_shown.size(), 30U);
    for (const auto& [name, values] : _shown) {
        EXPECT_TRUE(std::any_of(values.begin(), values.end(), [&noValues](const auto& value) {
            return !noValues.contains(value);
        })) << name;
    }
    EXPECT_GT(_shown.at("k1xTrafficFER").size(), 50U);
    EXPECT_GT(_shown.at("kFLDataRate").size(), 5U);
    EXPECT_GT(_shown.at("kRLDataRate").size(), 5U);
}

TEST_F(CdmaDrive, EveryPacketIsOneThatItsParserReads) {
    play();
    for (const RecordingLog::Line& line : _log.lines()) {
        EXPECT_EQ(line.priority, 6) << line.text;
    }
    EXPECT_EQ(_log.lines().size(), cdmaDrivePackets().size()) << "one for each header";
}

} // namespace
} // namespace pallax
