#pragma once

#include "app/tree/PallaxModelNode.h"
#include "platform/ui/TableScreen.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

namespace pallax {

namespace ui {
class NavigationStack;
class Toolkit;
} // namespace ui

/// What a pane asks of the application object.
class PaneApplication {
public:
    virtual ~PaneApplication() = default;
    /// Whether panes offer the save button.
    virtual bool allowSaveButton() const = 0;
    virtual void showSaveView() = 0;
    /// The stack that panes lie on; null as long as there is none.
    virtual ui::NavigationStack* navigationController() = 0;
};

/// One screen of the navigation stack: a table of the children of one node of the display tree,
/// under the node's name, above a toolbar with the state of the connection.
class PallaxPaneController final : public ui::TableScreen {
public:
    /// `node` may be null: no data yet. Toolkit and application outlive the pane.
    PallaxPaneController(ui::Toolkit& toolkit, PaneApplication& application, NodeRef node,
                         std::string path);

    /// Rebuilds the toolbar: spinner, status, space and, where it is allowed, the save button.
    void createToolbarItems();
    void viewWillAppear(bool animated) override;
    /// Gives up first-responder status and leaves the toolkit's own handling out.
    void viewWillDisappear(bool animated) override;

    /// No status counts as an empty one.
    void setStatus(std::optional<std::string> status, bool isLoading);
    /// Shows the node that now stands at the pane's path, or null. The node shown before is kept
    /// to tell what has changed; nothing is compared here.
    void reloadWithNode(NodeRef node);
    /// The node's path in the display tree; "/" for the root pane.
    const std::string& path() const { return _keyPath; }

    std::size_t numberOfRows() const override;
    std::shared_ptr<ui::TableCell> cellForRow(std::size_t row) override;
    /// A branch counts as a list when its children are named "0", "1", ... in order, at least
    /// one: the tree names the elements of an array so, and keeps no other trace of it. A leaf has
    /// changed when the node shown before had another value under its name, or none; as long as
    /// no node was shown before, nothing has.
    ui::RowText textOfRow(std::size_t row) const override;
    void didSelectRow(std::optional<std::size_t> row) override;

private:
    /// The node of a row; null where there is no such row.
    NodeRef childAt(std::size_t row) const;
    void showTitle();
    bool hasChanged(const PallaxModelNode& leaf, std::size_t row) const;
    /// The child of that name in the node shown before: looked for in the same row, then by name.
    const PallaxModelNode* previousNamed(std::string_view name, std::size_t row) const;

    ui::Toolkit& _toolkit;
    PaneApplication& _application;
    NodeRef _nodes;
    std::string _keyPath;
    std::string _status;
    bool _isLoading = true;
    /// What `_nodes` was before the last reload with another node.
    NodeRef _previousNodes;
    /// Its children, made when a row has moved; of two with one name the later, as a path has it.
    /// The names belong to the nodes.
    mutable std::unordered_map<std::string_view, const PallaxModelNode*> _previousByName;
};

} // namespace pallax
