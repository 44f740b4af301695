#include "link/WaitNotice.h"

#include "tests/doubles/SteppedQueue.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace pallax {
namespace {

using namespace std::chrono_literals;

class WaitNoticeTest : public testing::Test {
protected:
    using Texts = std::vector<std::string>;

    doubles::SteppedQueue _queue;
    bool _isConnected = false;
    std::string _obstacle = "No service";
    Texts _said;
    WaitNotice _notice{{_queue, [this] { return _isConnected; }, [this] { return _obstacle; },
                        [this](const std::string& text) { _said.push_back(text); },
                        [this] { return std::chrono::steady_clock::time_point(_queue.now()); }}};
};

TEST_F(WaitNoticeTest, SaysOnceAfterASecondWhatIsWaitedFor) {
    _queue.advance(1s - 1ns);
    EXPECT_EQ(_said, Texts());
    _queue.advance(1ns);
    EXPECT_EQ(_said, Texts{"No service; waiting"});
    _queue.advance(60s);
    EXPECT_EQ(_said.size(), 1U);
}

TEST_F(WaitNoticeTest, RepeatsTheNoticeWhenTheReasonChanges) {
    _queue.advance(2s);
    _obstacle = "Busy";
    _queue.advance(500ms);
    EXPECT_EQ(_said, (Texts{"No service; waiting", "Busy; waiting"}));
}

TEST_F(WaitNoticeTest, StopsWithTheConnectionAndBeginsAgainASecondAfterItIsLost) {
    _queue.advance(2s);
    _isConnected = true;
    _queue.advance(10s);
    EXPECT_EQ(_said, (Texts{"No service; waiting", ""}));
    _isConnected = false;
    _queue.advance(999ms);
    EXPECT_EQ(_said.size(), 2U);
    _queue.advance(1ms);
    EXPECT_EQ(_said, (Texts{"No service; waiting", "", "No service; waiting"}));
}

TEST_F(WaitNoticeTest, AQuickConnectionIsNotSpokenOf) {
    _queue.advance(900ms);
    _isConnected = true;
    _queue.advance(10s);
    EXPECT_EQ(_said, Texts());
}

TEST_F(WaitNoticeTest, WhatIsNotKnownIsNotSaid) {
    _obstacle = "";
    _queue.advance(10s);
    EXPECT_EQ(_said, Texts());
}

} // namespace
} // namespace pallax
