#pragma once

#include "app/pane/PaneModel.h"
#include "platform/ui/TableScreen.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>

namespace pallax {

namespace ui {
class NavigationStack;
class Toolkit;
} // namespace ui

/// The part of the application object that panes use.
class PaneApplication {
public:
    virtual ~PaneApplication() = default;
    /// Whether panes offer the save button.
    virtual bool allowSaveButton() const = 0;
    virtual void showSaveView() = 0;
    /// Where the panes get the ages of their values; valid as long as the application.
    virtual ReadingAges readingAges() { return {}; }
    /// The panes' stack; null until it exists.
    virtual ui::NavigationStack* navigationController() = 0;
};

/// One screen of the navigation stack: a table of the children of one node of the display tree,
/// with the node's name as title and a toolbar with the state of the connection below. It fills the
/// toolkit's roles from the pane's model.
class PallaxPaneController final : public ui::TableScreen, public PaneOwner {
public:
    /// `node` may be null: no data yet. Toolkit and application must outlive the pane.
    PallaxPaneController(ui::Toolkit& toolkit, PaneApplication& application, NodeRef node,
                         std::string path);

    /// Rebuilds the toolbar: spinner, status, space and, if allowed, the save button.
    void createToolbarItems();
    void viewWillAppear(bool animated) override;
    /// Resigns first-responder status without the toolkit's own handling.
    void viewWillDisappear(bool animated) override;

    /// A missing status is shown as empty.
    void setStatus(std::optional<std::string> status, bool isLoading);
    /// As PaneModel::show. The cursor and filter apply to the new rows.
    void reloadWithNode(NodeRef node, std::optional<Time> time = {});
    /// The node's path in the display tree; "/" for the root pane.
    const std::string& path() const { return _pane.path(); }
    PaneModel& pane() override { return _pane; }

    std::size_t numberOfRows() const override;
    std::shared_ptr<ui::TableCell> cellForRow(std::size_t row) override;
    void didSelectRow(std::optional<std::size_t> row) override;

private:
    void showTitle() { setTitle(_pane.title()); }

    ui::Toolkit& _toolkit;
    PaneApplication& _application;
    PaneModel _pane;
};

} // namespace pallax
