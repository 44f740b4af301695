#include "ui/gtk/Signals.h"

#include "tests/doubles/SteppedQueue.h"
#include "ui/gtk/Ref.h"

#include <gtest/gtest.h>

#include <gio/gio.h>
#include <stdexcept>

namespace pallax::gtk {
namespace {

TEST(Signals, AnExceptionOfAHandlerIsThrownByABlockOfTheQueue) {
    doubles::SteppedQueue queue;
    const Guard guard(queue);
    const Ref<GListStore> store(g_list_store_new(G_TYPE_OBJECT));
    const Ref<GObject> item(G_OBJECT(g_object_new(G_TYPE_OBJECT, nullptr)));
    onSignal(store.get(), "items-changed", guard, [] { throw std::runtime_error("broken"); });
    g_list_store_append(store.get(), item.get());
    EXPECT_THROW(queue.runReady(), std::runtime_error);
}

TEST(Signals, TheResultAfterAnExceptionIsTheDefaultOne) {
    doubles::SteppedQueue queue;
    const Guard guard(queue);
    EXPECT_EQ(guard.run([]() -> int { throw std::runtime_error("broken"); }), 0);
    EXPECT_EQ(guard.run([] { return 7; }), 7);
}

TEST(Signals, HandlersGetTheArguments) {
    doubles::SteppedQueue queue;
    const Guard guard(queue);
    const Ref<GListStore> store(g_list_store_new(G_TYPE_OBJECT));
    const Ref<GObject> item(G_OBJECT(g_object_new(G_TYPE_OBJECT, nullptr)));
    guint added = 0;
    const gulong handler =
        connect(store.get(), "items-changed", guard,
                std::function<void(guint, guint, guint)>(
                    [&](guint /*position*/, guint /*removed*/, guint count) { added += count; }));
    g_list_store_append(store.get(), item.get());
    EXPECT_EQ(added, 1U);
    g_signal_handler_disconnect(store.get(), handler);
    g_list_store_append(store.get(), item.get());
    EXPECT_EQ(added, 1U);
}

TEST(Signals, AHandlerMayDisconnectItself) {
    doubles::SteppedQueue queue;
    const Guard guard(queue);
    const Ref<GListStore> store(g_list_store_new(G_TYPE_OBJECT));
    const Ref<GObject> item(G_OBJECT(g_object_new(G_TYPE_OBJECT, nullptr)));
    int calls = 0;
    gulong handler = 0;
    handler = onSignal(store.get(), "items-changed", guard, [&] {
        g_signal_handler_disconnect(store.get(), handler);
        ++calls;
    });
    g_list_store_append(store.get(), item.get());
    g_list_store_append(store.get(), item.get());
    EXPECT_EQ(calls, 1);
}

} // namespace
} // namespace pallax::gtk
