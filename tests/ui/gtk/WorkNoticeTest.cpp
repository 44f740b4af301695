#include "ui/gtk/WorkNotice.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

#include <stdexcept>
#include <string>

namespace pallax::gtk {
namespace {

using namespace std::chrono_literals;

class WorkNoticeTest : public DisplayTest {
protected:
    void SetUp() override {
        DisplayTest::SetUp();
        if (!IsSkipped()) {
            stage = std::make_unique<WindowStage>(360, 720);
            stage->tick(Dictionary{{"RSRP", "-92.25 dBm"}});
            notice = std::make_unique<WorkNotice>(stage->frame.window(), stage->guard,
                                                  [this] { return now; });
        }
    }
    /// The dialog, if it is open.
    static GtkWidget* dialog() {
        const Ref<GListModel> all(G_LIST_MODEL(g_object_ref(gtk_window_get_toplevels())));
        for (guint index = 0; index < g_list_model_get_n_items(all.get()); ++index) {
            const Ref<GtkWidget> each(GTK_WIDGET(g_list_model_get_item(all.get(), index)));
            if (ADW_IS_MESSAGE_DIALOG(each.get()) != FALSE &&
                gtk_widget_get_visible(each.get()) != FALSE) {
                return each.get();
            }
        }
        return nullptr;
    }
    bool isUsable() {
        return gtk_widget_is_sensitive(
                   WindowStage::below(stage->table().widget(), GTK_TYPE_LIST_VIEW)) != FALSE;
    }

    std::unique_ptr<WindowStage> stage;
    std::unique_ptr<WorkNotice> notice;
    std::chrono::steady_clock::time_point now{};
};

TEST_F(WorkNoticeTest, ShortWorkIsNotTold) {
    notice->during([this] {
        now += 400ms;
        EXPECT_TRUE(notice->mayGoOn("Searching."));
        EXPECT_EQ(dialog(), nullptr);
    });
    now += 10s;
    EXPECT_TRUE(notice->mayGoOn("Searching.")) << "there is no work";
    EXPECT_EQ(dialog(), nullptr);
}

TEST_F(WorkNoticeTest, LongWorkIsToldAndKeepsTheWindowFromOtherUse) {
    notice->during([this] {
        now += 600ms;
        EXPECT_TRUE(notice->mayGoOn("Searching: 1 %."));
        ASSERT_NE(dialog(), nullptr);
        EXPECT_STREQ(adw_message_dialog_get_body(ADW_MESSAGE_DIALOG(dialog())), "Searching: 1 %.");
        EXPECT_TRUE(gtk_window_get_modal(GTK_WINDOW(dialog())));
        EXPECT_FALSE(isUsable());
        now += 60ms;
        EXPECT_TRUE(notice->mayGoOn("Searching: 2 %."));
        EXPECT_STREQ(adw_message_dialog_get_body(ADW_MESSAGE_DIALOG(dialog())), "Searching: 2 %.");
    });
    EXPECT_EQ(dialog(), nullptr);
    EXPECT_TRUE(isUsable());
}

TEST_F(WorkNoticeTest, TheUserStopsIt) {
    notice->during([this] {
        now += 600ms;
        EXPECT_TRUE(notice->mayGoOn("Searching."));
        ASSERT_NE(dialog(), nullptr);
        gtk_window_close(GTK_WINDOW(dialog())); // as Escape does
        now += 60ms;
        EXPECT_FALSE(notice->mayGoOn("Searching."));
    });
    stage->settle();
    EXPECT_EQ(dialog(), nullptr);
    EXPECT_TRUE(isUsable());
    notice->during([this] { EXPECT_TRUE(notice->mayGoOn("Other work.")); });
}

TEST_F(WorkNoticeTest, ThereIsOnlyOneWorkAtATime) {
    int works = 0;
    notice->during([&] {
        ++works;
        notice->during([&] { ++works; });
    });
    EXPECT_EQ(works, 1);
}

TEST_F(WorkNoticeTest, WorkThatFailsEnds) {
    EXPECT_THROW(notice->during([this] {
        now += 600ms;
        (void)notice->mayGoOn("Searching.");
        throw std::runtime_error("it failed");
    }),
                 std::runtime_error);
    EXPECT_EQ(dialog(), nullptr);
    EXPECT_TRUE(isUsable());
}

} // namespace
} // namespace pallax::gtk
