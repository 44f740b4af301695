#include "cli/HelpText.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

TEST(HelpText, ItIsTakenApartIntoExamplesNotesAndStatuses) {
    const HelpText text = takenApart("Examples:\n"
                                     "  pallax a\n"
                                     "  pallax b\n"
                                     "\n"
                                     "One note,\n"
                                     "of two lines.\n"
                                     "\n"
                                     "Another.\n"
                                     "\n"
                                     "Exit status:\n"
                                     "  0   success\n"
                                     "  70  ended by a fatal record");
    EXPECT_EQ(text.examples, "  pallax a\n  pallax b");
    EXPECT_EQ(text.notes, (std::vector<std::string>{"One note,\nof two lines.", "Another."}));
    ASSERT_EQ(text.statuses.size(), 2U);
    EXPECT_EQ(text.statuses[0].number, "0");
    EXPECT_EQ(text.statuses[0].meaning, "success");
    EXPECT_EQ(text.statuses[1].number, "70");
    EXPECT_EQ(text.statuses[1].meaning, "ended by a fatal record");
}

TEST(HelpText, OfNothingHasNoParts) {
    const HelpText text = takenApart("");
    EXPECT_EQ(text.examples, "");
    EXPECT_TRUE(text.notes.empty());
    EXPECT_TRUE(text.statuses.empty());
}

} // namespace
} // namespace pallax
