#include "ui/gtk/Question.h"

#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

#include <adwaita.h>

namespace pallax::gtk {
namespace {

class QuestionTest : public DisplayTest {
protected:
    /// How often the question was agreed to, after this answer.
    static int agreed(const char* answer) {
        WindowStage stage(360, 720);
        int count = 0;
        GtkWindow* dialog = ask(
            stage.frame.window(), stage.guard,
            {.title = "Really?", .text = "It ends.", .no = "Keep", .yes = "End"}, [&] { ++count; });
        EXPECT_STREQ(adw_message_dialog_get_heading(ADW_MESSAGE_DIALOG(dialog)), "Really?");
        EXPECT_STREQ(adw_message_dialog_get_default_response(ADW_MESSAGE_DIALOG(dialog)), "no");
        adw_message_dialog_response(ADW_MESSAGE_DIALOG(dialog), answer);
        stage.settle();
        return count;
    }
};

TEST_F(QuestionTest, OnlyYesAgrees) {
    EXPECT_EQ(agreed("yes"), 1);
    EXPECT_EQ(agreed("no"), 0);
}

TEST_F(QuestionTest, ClosingTheDialogIsNo) {
    WindowStage stage(360, 720);
    int count = 0;
    gtk_window_close(ask(stage.frame.window(), stage.guard,
                         {.title = "Really?", .text = "", .no = "Keep", .yes = "End"},
                         [&] { ++count; }));
    stage.settle();
    EXPECT_EQ(count, 0);
}

} // namespace
} // namespace pallax::gtk
