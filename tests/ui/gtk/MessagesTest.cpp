#include "ui/gtk/Messages.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"
#include "tests/ui/terminal/StageData.h"

namespace pallax::gtk {
namespace {

/// A window of a phone with a bar below the panes.
class MessagesTest : public DisplayTest {
protected:
    void SetUp() override {
        DisplayTest::SetUp();
        if (!IsSkipped()) {
            stage = std::make_unique<WindowStage>(360, 720);
            bar = gtk_label_new("the bar");
            gtk_widget_set_size_request(bar, -1, 100);
            stage->frame.addBar(bar);
            page = owned(gtk_label_new("a page"));
            stage->tick(terminal::display());
        }
    }
    void TearDown() override {
        if (stage != nullptr) {
            stage->frame.pages().closeAll();
        }
    }
    void settle() {
        for (int time = 0; time < 3; ++time) {
            stage->settle();
        }
    }
    /// The label with this text; null unless it is seen.
    GtkWidget* label(const std::string& text) const {
        return WindowStage::found(stage->window(), [&](GtkWidget* each) {
            return GTK_IS_LABEL(each) != FALSE && gtk_widget_get_mapped(each) != FALSE &&
                   text == gtk_label_get_text(GTK_LABEL(each));
        });
    }
    /// The lower end of a widget, from the top of the window.
    float end(GtkWidget* widget) const {
        graphene_rect_t bounds;
        EXPECT_NE(gtk_widget_compute_bounds(widget, stage->window(), &bounds), FALSE);
        return bounds.origin.y + bounds.size.height;
    }

    std::unique_ptr<WindowStage> stage;
    GtkWidget* bar = nullptr;
    Ref<GtkWidget> page;
};

TEST_F(MessagesTest, DoNotWidenTheWindow) {
    const std::string text = "Recorded " + std::string(100, 'w') + ".pcapng";
    stage->frame.setMessage(text);
    settle();
    ASSERT_NE(label(text), nullptr);
    int least = 0;
    gtk_widget_measure(stage->window(), GTK_ORIENTATION_HORIZONTAL, -1, &least, nullptr, nullptr,
                       nullptr);
    EXPECT_LE(least, 360);
}

TEST_F(MessagesTest, TheLatestReplacesTheOneBefore) {
    stage->frame.setMessage("before");
    settle();
    stage->frame.setMessage("after");
    settle();
    EXPECT_EQ(label("before"), nullptr);
    EXPECT_NE(label("after"), nullptr);
}

TEST_F(MessagesTest, AreShownForThreeSeconds) {
    stage->frame.setMessage("before");
    stage->queue.advance(std::chrono::seconds(2));
    stage->frame.setMessage("after");
    stage->queue.advance(std::chrono::milliseconds(2900));
    settle();
    EXPECT_NE(label("after"), nullptr) << "its own three seconds";
    stage->queue.advance(std::chrono::milliseconds(200));
    settle();
    EXPECT_EQ(label("after"), nullptr);
}

TEST_F(MessagesTest, StandAboveTheBars) {
    stage->frame.setMessage("done");
    settle();
    ASSERT_NE(label("done"), nullptr);
    graphene_rect_t bounds;
    ASSERT_NE(gtk_widget_compute_bounds(bar, stage->window(), &bounds), FALSE);
    EXPECT_LE(end(label("done")), bounds.origin.y);
}

TEST_F(MessagesTest, AreSeenWhereverTheUserGoes) {
    stage->frame.setMessage("done");
    settle();
    stage->frame.pages().open(page.get(), "Page");
    settle();
    ASSERT_NE(label("done"), nullptr);
    EXPECT_GT(end(label("done")), 720 - 100) << "no bar is seen";
    stage->frame.pages().close();
    settle();
    ASSERT_NE(label("done"), nullptr);
    EXPECT_LE(end(label("done")), end(bar) - 100);
}

} // namespace
} // namespace pallax::gtk
