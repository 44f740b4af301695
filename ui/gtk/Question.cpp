#include "ui/gtk/Question.h"

#include "ui/gtk/ShownText.h"

#include <adwaita.h>
#include <string_view>

namespace pallax::gtk {

GtkWindow* ask(GtkWindow* window, const Guard& guard, const Question& question,
               const std::function<void()>& agreed) {
    constexpr const char* kNo = "no";
    constexpr const char* kYes = "yes";
    auto* dialog = ADW_MESSAGE_DIALOG(adw_message_dialog_new(
        window, shownText(question.title).c_str(), shownText(question.text).c_str()));
    adw_message_dialog_add_response(dialog, kNo, question.no);
    adw_message_dialog_add_response(dialog, kYes, question.yes);
    adw_message_dialog_set_response_appearance(dialog, kYes, ADW_RESPONSE_DESTRUCTIVE);
    adw_message_dialog_set_default_response(dialog, kNo);
    adw_message_dialog_set_close_response(dialog, kNo);
    gtk_window_set_destroy_with_parent(GTK_WINDOW(dialog), TRUE);
    connect(dialog, "response", guard,
            std::function<void(const char*)>([agreed](const char* response) {
                if (std::string_view(response) == kYes) {
                    agreed();
                }
            }));
    gtk_window_present(GTK_WINDOW(dialog));
    return GTK_WINDOW(dialog);
}

} // namespace pallax::gtk
