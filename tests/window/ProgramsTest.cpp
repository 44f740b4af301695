#include "window/Programs.h"

#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

#include <glib.h>
#include <optional>

namespace pallax {
namespace {

using Words = std::vector<std::string>;

/// Runs a shell script to its end and returns what the user is told of it.
std::string told(const std::string& script) {
    doubles::SteppedQueue queue;
    Programs programs(queue);
    std::optional<std::string> told;
    programs.start({"/bin/sh", "-c", script}, [&](const std::string& text) { told = text; });
    while (!told) {
        (void)g_main_context_iteration(nullptr, TRUE);
        queue.runReady();
    }
    return *told;
}

TEST(Programs, WhatAProgramComplainsOfIsTold) {
    EXPECT_EQ(told("echo broken >&2; exit 1"), "broken");
    EXPECT_EQ(told("echo first >&2; echo second >&2; exit 2"), "first\nsecond");
    EXPECT_EQ(told("kill -KILL $$"), "The program was ended.");
}

TEST(Programs, SuccessIsSilent) {
    EXPECT_EQ(told("echo warning >&2"), "");
    EXPECT_EQ(told("echo told in a page >&2; exit 70"), "");
}

TEST(Programs, WhatCannotBeStartedIsTold) {
    doubles::SteppedQueue queue;
    Programs programs(queue);
    Words told;
    programs.start({"/nowhere/pallax"}, [&](const std::string& text) { told.push_back(text); });
    EXPECT_EQ(told, Words{}) << "not before the queue runs";
    queue.runReady();
    ASSERT_EQ(told.size(), 1U);
    EXPECT_NE(told.front().find("/nowhere/pallax"), std::string::npos) << told.front();
}

TEST(Programs, NothingIsToldOnceTheObjectIsGone) {
    doubles::SteppedQueue queue;
    auto programs = std::make_optional<Programs>(queue);
    Words diary;
    programs->start({"/bin/sh", "-c", "exit 1"},
                    [&](const std::string& /*text*/) { diary.emplace_back("first"); });
    programs.reset();
    programs.emplace(queue);
    programs->start({"/bin/sh", "-c", "sleep 0.2; exit 1"},
                    [&](const std::string& /*text*/) { diary.emplace_back("second"); });
    while (diary.empty()) {
        (void)g_main_context_iteration(nullptr, TRUE);
        queue.runReady();
    }
    EXPECT_EQ(diary, Words{"second"});
}

} // namespace
} // namespace pallax
