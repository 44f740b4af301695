#include "window/Instance.h"

#include "tests/doubles/Shell.h"

#include <gtest/gtest.h>

#include <functional>
#include <future>
#include <memory>
#include <optional>

namespace pallax {
namespace {

using Words = std::vector<std::string>;

/// A private bus, with one connection for each process that a test plays.
class InstanceTest : public testing::Test {
protected:
    void SetUp() override {
        if (!doubles::isInstalled("dbus-daemon")) {
            GTEST_SKIP() << "dbus-daemon is not installed";
        }
        _bus.reset(g_test_dbus_new(G_TEST_DBUS_NONE));
        g_test_dbus_up(_bus.get());
    }
    void TearDown() override {
        if (_bus) {
            g_test_dbus_stop(_bus.get());
        }
    }

    gtk::Ref<GDBusConnection> connection() const {
        return gtk::Ref<GDBusConnection>(g_dbus_connection_new_for_address_sync(
            g_test_dbus_get_bus_address(_bus.get()),
            static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                              G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION),
            nullptr, nullptr, nullptr));
    }

    /// What was asked for, one line each.
    Instance::Requests requests(const std::string& process) {
        return {.open =
                    [this, process](const Words& words, const std::string& token) {
                        std::string line = process + " opens";
                        for (const std::string& word : words) {
                            line += " " + word;
                        }
                        diary.push_back(line + (token.empty() ? "" : ", token " + token));
                    },
                .present =
                    [this, process](const std::string& token) {
                        diary.push_back(process + " comes to the front" +
                                        (token.empty() ? "" : ", token " + token));
                    }};
    }

    /// Calls a method of the application as a desktop does, while the loop runs. Returns the error,
    /// "" for success.
    std::string call(const char* method, const std::string& arguments) {
        struct Answer {
            bool hasCome = false;
            std::string error;
        } answer;
        const auto desktop = connection();
        g_dbus_connection_call(
            desktop.get(), kApplicationId, "/example/pallax/Pallax", "org.freedesktop.Application",
            method, g_variant_new_parsed(arguments.c_str()), nullptr, G_DBUS_CALL_FLAGS_NONE, -1,
            nullptr,
            +[](GObject* bus, GAsyncResult* result, gpointer data) {
                GError* error = nullptr;
                GVariant* value =
                    g_dbus_connection_call_finish(G_DBUS_CONNECTION(bus), result, &error);
                auto& come = *static_cast<Answer*>(data);
                come.hasCome = true;
                if (error != nullptr) {
                    (void)g_dbus_error_strip_remote_error(error);
                    come.error = error->message;
                    g_error_free(error);
                } else {
                    g_variant_unref(value);
                }
            },
            &answer);
        while (!answer.hasCome) {
            (void)g_main_context_iteration(nullptr, TRUE);
        }
        return answer.error;
    }

    /// Asks a name of the bus to come up, without waiting for the answer; it has been sent on.
    void send(const std::string& name, const char* path) {
        _desktop = connection();
        g_dbus_connection_call(_desktop.get(), name.c_str(), path, "org.freedesktop.Application",
                               "Activate", g_variant_new_parsed("(@a{sv} {},)"), nullptr,
                               G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr, nullptr);
        ASSERT_TRUE(g_dbus_connection_flush_sync(_desktop.get(), nullptr, nullptr));
        g_variant_unref(g_dbus_connection_call_sync( // answered after the call above
            _desktop.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
            "GetId", nullptr, nullptr, G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
    }

    Words diary;

private:
    gtk::Ref<GDBusConnection> _desktop; ///< that has sent
    gtk::Ref<GTestDBus> _bus;
};

TEST_F(InstanceTest, WhoHasTheNameAnswersTheDesktop) {
    const auto bus = connection();
    Instance instance(bus.get());
    instance.serve(requests("A"));
    EXPECT_EQ(call("Activate", "(@a{sv} {},)"), "");
    EXPECT_EQ(call("Open", "(['file:///tmp/a%20b.pcap', 'file:///c.pcap'], "
                           "{'activation-token': <'t1'>})"),
              "");
    EXPECT_EQ(call("ActivateAction", "('demo', @av [], {'desktop-startup-id': <'t2'>})"), "");
    EXPECT_EQ(call("ActivateAction", "('modem', @av [], @a{sv} {})"), "");
    EXPECT_EQ(diary,
              (Words{"A opens", "A opens /tmp/a b.pcap, token t1", "A opens /c.pcap, token t1",
                     "A opens demo, token t2", "A opens modem"}));
}

TEST_F(InstanceTest, WhatItCannotDoIsRefused) {
    const auto bus = connection();
    Instance instance(bus.get());
    instance.serve(requests("A"));
    EXPECT_EQ(call("Open", "(['http://pallax.example/a.pcap'], @a{sv} {})"),
              "This is not a file of this machine.");
    EXPECT_EQ(call("ActivateAction", "('print', @av [], @a{sv} {})"), "There is no such action.");
    EXPECT_EQ(diary, Words{});
}

TEST_F(InstanceTest, TheNextOneTakesOverWhenOneEnds) {
    const auto first = connection();
    const auto second = connection();
    auto a = std::make_unique<Instance>(first.get());
    Instance b(second.get());
    a->serve(requests("A"));
    b.serve(requests("B"));
    EXPECT_EQ(call("Activate", "(@a{sv} {},)"), "");
    a.reset();
    EXPECT_EQ(call("Activate", "(@a{sv} {},)"), "");
    EXPECT_EQ(diary, (Words{"A opens", "B opens"}));
}

TEST_F(InstanceTest, ASecondStartBringsTheWindowToTheFront) {
    const auto first = connection();
    const auto second = connection();
    Instance a(first.get());
    Instance b(second.get());
    EXPECT_TRUE(a.claim("drive.pcap", ""));
    a.serve(requests("A"));
    EXPECT_TRUE(b.claim("other.pcap", "t1")) << "shows something else";
    const auto third = connection();
    Instance c(third.get());
    auto claimed = std::async(std::launch::async, [&] { return c.claim("drive.pcap", "t2"); });
    while (diary.empty()) {
        (void)g_main_context_iteration(nullptr, TRUE);
    }
    EXPECT_FALSE(claimed.get());
    EXPECT_EQ(diary, Words{"A comes to the front, token t2"});
}

TEST_F(InstanceTest, AWindowThatIsOverNoLongerStandsForItsSource) {
    const auto first = connection();
    const auto second = connection();
    Instance a(first.get());
    Instance b(second.get());
    EXPECT_TRUE(a.claim("drive.pcap", ""));
    EXPECT_NE(a.windowName(), "");
    a.giveUpClaim();
    EXPECT_EQ(a.windowName(), "");
    EXPECT_TRUE(b.claim("drive.pcap", ""));
    EXPECT_NE(b.windowName(), "");
}

TEST_F(InstanceTest, ANoticeBringsItsWindowToTheFront) {
    const auto first = connection();
    const auto second = connection();
    Instance a(first.get());
    Instance b(second.get());
    EXPECT_TRUE(a.claim("a", ""));
    EXPECT_TRUE(b.claim("b", ""));
    a.serve(requests("A"));
    b.serve(requests("B"));
    for (const Instance* shown : {&a, &b}) {
        EXPECT_EQ(call("ActivateAction",
                       "('show', [<'" + shown->windowName() + "'>], {'activation-token': <'t'>})"),
                  "");
    }
    while (diary.size() < 2) {
        (void)g_main_context_iteration(nullptr, TRUE);
    }
    EXPECT_EQ(diary, (Words{"A comes to the front, token t", "B comes to the front, token t"}));
    for (const std::string other :
         {"org.example.Other", "example.pallax.Pallax.Window.s no name"}) {
        EXPECT_EQ(call("ActivateAction", "('show', [<'" + other + "'>], @a{sv} {})"), "");
    }
    EXPECT_EQ(diary.size(), 2U);
}

TEST_F(InstanceTest, RequestsThatHaveComeWhenItEndsAreAnswered) {
    const auto bus = connection();
    auto a = std::make_unique<Instance>(bus.get());
    a->serve(requests("A"));
    send(kApplicationId, "/example/pallax/Pallax");
    a.reset();
    EXPECT_EQ(diary, Words{"A opens"});
}

TEST_F(InstanceTest, AWindowThatEndsNoLongerComesToTheFront) {
    const auto bus = connection();
    Instance a(bus.get());
    ASSERT_TRUE(a.claim("drive.pcap", ""));
    a.serve(requests("A"));
    send(a.windowName(), "/example/pallax/Pallax/shown");
    a.endServing();
    EXPECT_EQ(diary, Words{});
    EXPECT_EQ(a.windowName(), "");
}

TEST_F(InstanceTest, NothingIsAskedOfItAfterItsEnd) {
    const auto bus = connection();
    Instance a(bus.get());
    a.serve(requests("A"));
    a.endServing();
    for (const char* path : {"/example/pallax/Pallax", "/example/pallax/Pallax/shown"}) {
        send(g_dbus_connection_get_unique_name(bus.get()), path);
        while (g_main_context_iteration(nullptr, FALSE) != FALSE) {
        }
    }
    EXPECT_EQ(diary, Words{});
}

TEST(Instance, WithoutABusEverythingIsClaimed) {
    Instance a(nullptr);
    Instance b(nullptr);
    a.serve({});
    EXPECT_TRUE(a.claim("drive.pcap", ""));
    EXPECT_TRUE(b.claim("drive.pcap", ""));
    EXPECT_EQ(a.windowName(), "");
}

} // namespace
} // namespace pallax
