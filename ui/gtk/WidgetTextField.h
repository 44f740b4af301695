#pragma once

#include "platform/ui/TextField.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

class WidgetTextField final : public ui::TextField {
public:
    explicit WidgetTextField(const Guard& guard);

    std::string text() const override;
    void setDelegate(ui::TextFieldDelegate* delegate) override { _delegate = delegate; }
    void resignFirstResponder() override;

    GtkWidget* widget() const { return GTK_WIDGET(_entry.get()); }

private:
    Ref<GtkEntry> _entry;
    ui::TextFieldDelegate* _delegate = nullptr;
};

} // namespace pallax::gtk
