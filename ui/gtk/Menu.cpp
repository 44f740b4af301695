#include "ui/gtk/Menu.h"

#include "ui/gtk/Ref.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

namespace pallax::gtk {

namespace {

Ref<GSimpleAction> actionOf(const MenuEntry& entry, const Guard& guard) {
    const char* name = entry.name.c_str();
    Ref<GSimpleAction> action(
        entry.isOn ? g_simple_action_new_stateful(
                         name, nullptr, g_variant_new_boolean(entry.isOn() ? TRUE : FALSE))
                   : g_simple_action_new(name, nullptr));
    onSignal(action.get(), "activate", guard, [self = action.get(), entry] {
        entry.action();
        if (entry.isOn) {
            g_simple_action_set_state(self, g_variant_new_boolean(entry.isOn() ? TRUE : FALSE));
        }
    });
    return action;
}

} // namespace

GtkWidget* menuButton(GtkWindow* window, const Guard& guard,
                      const std::vector<std::vector<MenuEntry>>& sections) {
    const Ref<GMenu> menu(g_menu_new());
    const Ref<GSimpleActionGroup> actions(g_simple_action_group_new());
    for (const std::vector<MenuEntry>& section : sections) {
        const Ref<GMenu> made(g_menu_new());
        for (const MenuEntry& entry : section) {
            const Ref<GSimpleAction> action = actionOf(entry, guard);
            g_action_map_add_action(G_ACTION_MAP(actions.get()), G_ACTION(action.get()));
            const Ref<GMenuItem> item(
                g_menu_item_new(entry.label.c_str(), ("window." + entry.name).c_str()));
            if (entry.besides != nullptr) {
                g_menu_item_set_attribute(item.get(), "hidden-when", "s", "action-disabled");
                g_object_bind_property(entry.besides, "visible", action.get(), "enabled",
                                       G_BINDING_SYNC_CREATE);
            }
            g_menu_append_item(made.get(), item.get());
        }
        g_menu_append_section(menu.get(), nullptr, G_MENU_MODEL(made.get()));
    }
    gtk_widget_insert_action_group(GTK_WIDGET(window), "window", G_ACTION_GROUP(actions.get()));
    GtkWidget* button = gtk_menu_button_new();
    gtk_menu_button_set_icon_name(GTK_MENU_BUTTON(button), "open-menu-symbolic");
    gtk_menu_button_set_menu_model(GTK_MENU_BUTTON(button), G_MENU_MODEL(menu.get()));
    gtk_menu_button_set_primary(GTK_MENU_BUTTON(button), TRUE);
    nameWidget(button, translated("Menu"));
    return button;
}

} // namespace pallax::gtk
