#include "console/TeeSink.h"

#include "tests/doubles/RecordingLog.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

class WrittenTexts final : public LogSink {
public:
    void write(LogPriority /*priority*/, std::string_view text) override {
        texts.emplace_back(text);
    }
    std::vector<std::string> texts;
};

TEST(TeeSink, EachSinkGetsTheLinesUpToItsOwnLevel) {
    WrittenTexts first;
    WrittenTexts second;
    TeeSink both(first, 3, second, 6);
    both.write(LogPriority::Error, "error");
    both.write(LogPriority::Informational, "header");
    both.write(LogPriority::DlfFailure, "the raw value 16 has level 0");
    using Texts = std::vector<std::string>;
    EXPECT_EQ(first.texts, (Texts{"error", "the raw value 16 has level 0"}));
    EXPECT_EQ(second.texts, (Texts{"error", "header", "the raw value 16 has level 0"}));
}

} // namespace
} // namespace pallax
