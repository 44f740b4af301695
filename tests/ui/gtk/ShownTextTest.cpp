#include "ui/gtk/ShownText.h"

#include "tests/ui/gtk/XDisplay.h"
#include "ui/gtk/Ref.h"

namespace pallax::gtk {
namespace {

class Tooltips : public DisplayTest {
protected:
    void SetUp() override {
        DisplayTest::SetUp();
        if (IsSkipped()) {
            return;
        }
        _label = owned(gtk_label_new(nullptr));
        const auto count =
            +[](GtkWidget* /*label*/, GParamSpec* /*what*/, int* changes) { ++*changes; };
        (void)g_signal_connect(_label.get(), "notify::tooltip-text", G_CALLBACK(count), &_changes);
    }

    Ref<GtkWidget> _label;
    int _changes = 0;
};

TEST_F(Tooltips, AreEscapedAndGoWithTheirText) {
    showTooltip(_label.get(), "a\x1B");
    EXPECT_STREQ(gtk_widget_get_tooltip_text(_label.get()), "a\\x1B");
    showTooltip(_label.get(), "");
    EXPECT_EQ(gtk_widget_get_tooltip_text(_label.get()), nullptr);
}

TEST_F(Tooltips, AreNotSetAgain) {
    showTooltip(_label.get(), "");
    EXPECT_EQ(_changes, 0);
    showTooltip(_label.get(), "long name");
    showTooltip(_label.get(), "long name");
    EXPECT_EQ(_changes, 1);
}

} // namespace
} // namespace pallax::gtk
