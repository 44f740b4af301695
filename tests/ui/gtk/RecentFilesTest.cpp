#include "ui/gtk/RecentFiles.h"

#include "tests/doubles/Files.h"
#include "tests/ui/gtk/WindowStage.h"
#include "tests/ui/gtk/XDisplay.h"

#include <filesystem>

namespace pallax::gtk {
namespace {

class RecentFilesTest : public DisplayTest {
protected:
    void SetUp() override {
        DisplayTest::SetUp();
        if (!IsSkipped()) {
            g_object_set(gtk_settings_get_default(), "gtk-recent-files-enabled", TRUE, nullptr);
            manager = owned(GTK_RECENT_MANAGER(g_object_new(
                GTK_TYPE_RECENT_MANAGER, "filename", folder.path("list.xbel").c_str(), nullptr)));
            // The toolkit does not disconnect a manager from the settings, so that none may go.
            static std::vector<Ref<GtkRecentManager>> kept;
            kept.push_back(shared(manager.get()));
            stage = std::make_unique<WindowStage>(360, 720);
            files = std::make_unique<RecentFiles>(
                stage->frame.window(), stage->guard, manager.get(),
                [this](const std::string& path) { opened.push_back(path); });
        }
    }

    std::string file(const std::string& name) const {
        folder.write(name, "");
        return folder.path(name);
    }
    /// The manager tells of changes a little later.
    void await(std::size_t count) const {
        const int wanted = count > 0 ? 1 : 0;
        while (files->paths().size() != count || entries() != wanted) {
            (void)g_main_context_iteration(nullptr, TRUE);
        }
        stage->settle();
    }
    /// What the menu says, and what each entry opens.
    std::vector<std::pair<std::string, std::string>> offered() const {
        std::vector<std::pair<std::string, std::string>> offered;
        GMenuModel* recent = g_menu_model_get_item_link(files->section(), 0, G_MENU_LINK_SUBMENU);
        for (int index = 0; index + 1 < g_menu_model_get_n_items(recent); ++index) {
            gchar* label = nullptr;
            gchar* path = nullptr;
            EXPECT_TRUE(g_menu_model_get_item_attribute(recent, index, "label", "s", &label));
            EXPECT_TRUE(g_menu_model_get_item_attribute(recent, index, "target", "^ay", &path));
            offered.emplace_back(label, path != nullptr ? path : "");
            g_free(label);
            g_free(path);
        }
        g_object_unref(recent);
        return offered;
    }
    int entries() const { return g_menu_model_get_n_items(files->section()); }

    doubles::TemporaryFolder folder;
    Ref<GtkRecentManager> manager;
    std::unique_ptr<WindowStage> stage;
    std::unique_ptr<RecentFiles> files;
    std::vector<std::string> opened;
};

TEST_F(RecentFilesTest, ThoseThatWereShownAreOfferedAndOpened) {
    EXPECT_EQ(entries(), 0);
    const std::string path = file("drive <1>.pcap");
    files->add(path);
    await(1);
    EXPECT_EQ(files->paths(), std::vector<std::string>{path});
    ASSERT_TRUE(gtk_widget_activate_action(stage->window(), "recent.open", "^ay", path.c_str()));
    EXPECT_EQ(opened, std::vector<std::string>{path});
}

/// A menu takes "__" for "_".
TEST_F(RecentFilesTest, NamesAreOfferedAsTheyAre) {
    const std::string path = file("drive_1.pcap");
    files->add(path);
    await(1);
    EXPECT_EQ(offered(),
              (std::vector<std::pair<std::string, std::string>>{{"drive__1.pcap", path}}));
}

TEST_F(RecentFilesTest, ANameThatIsNotUtf8IsOfferedAndOpened) {
    const std::string path = file("drive\xFF\n.pcap");
    files->add(path);
    await(1);
    EXPECT_EQ(offered(), (std::vector<std::pair<std::string, std::string>>{
                             {"drive\xEF\xBF\xBD\\x0A.pcap", path}}));
    ASSERT_TRUE(gtk_widget_activate_action(stage->window(), "recent.open", "^ay", path.c_str()));
    EXPECT_EQ(opened, std::vector<std::string>{path});
}

TEST_F(RecentFilesTest, AreWrittenAndClearedAtOnce) {
    const auto written = [this] { return doubles::contentOf(folder.path("list.xbel")); };
    files->add(file("drive.pcap"));
    EXPECT_NE(written().find("drive.pcap"), std::string::npos);
    ASSERT_TRUE(gtk_widget_activate_action(stage->window(), "recent.clear", nullptr));
    EXPECT_EQ(written().find("drive.pcap"), std::string::npos);
    EXPECT_EQ(entries(), 0);
}

TEST_F(RecentFilesTest, OtherApplicationsDoNotOfferThem) {
    files->add(file("drive.pcap"));
    await(1);
    GList* items = gtk_recent_manager_get_items(manager.get());
    auto* item = static_cast<GtkRecentInfo*>(items->data);
    EXPECT_TRUE(gtk_recent_info_get_private_hint(item));
    gtk_recent_info_unref(item);
    g_list_free(items);
}

TEST_F(RecentFilesTest, ThoseThatAreGoneAreNotOffered) {
    const std::string kept = file("kept.pcap");
    const std::string gone = file("gone.pcap");
    files->add(kept);
    files->add(gone);
    await(2);
    std::filesystem::remove(gone);
    EXPECT_EQ(files->paths(), std::vector<std::string>{kept});
}

TEST_F(RecentFilesTest, ThoseOfOtherApplicationsAreNotOfferedAndStay) {
    const std::string other = "file://" + file("letter.txt");
    std::string type = "text/plain";
    std::string application = "Letters";
    std::string program = "letters";
    const GtkRecentData data{nullptr,        nullptr, type.data(), application.data(),
                             program.data(), nullptr, FALSE};
    ASSERT_TRUE(gtk_recent_manager_add_full(manager.get(), other.c_str(), &data));
    files->add(file("drive.pcap"));
    await(1);
    ASSERT_TRUE(gtk_widget_activate_action(stage->window(), "recent.clear", nullptr));
    await(0);
    EXPECT_EQ(entries(), 0);
    EXPECT_TRUE(gtk_recent_manager_has_item(manager.get(), other.c_str()));
}

TEST_F(RecentFilesTest, WhereTheDesktopKeepsNoneNoneAreKept) {
    files->add(file("before.pcap"));
    await(1);
    g_object_set(gtk_settings_get_default(), "gtk-recent-files-enabled", FALSE, nullptr);
    files->add(file("drive.pcap"));
    stage->settle();
    EXPECT_EQ(files->paths(), std::vector<std::string>{});
    EXPECT_EQ(entries(), 0);
    EXPECT_FALSE(gtk_recent_manager_has_item(manager.get(),
                                             ("file://" + folder.path("drive.pcap")).c_str()));
    g_object_set(gtk_settings_get_default(), "gtk-recent-files-enabled", TRUE, nullptr);
}

} // namespace
} // namespace pallax::gtk
