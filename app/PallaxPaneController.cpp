#include "app/PallaxPaneController.h"

#include "app/PallaxCell.h"
#include "platform/ui/NavigationStack.h"
#include "platform/ui/Toolkit.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace pallax {

namespace {

constexpr std::string_view kTitleWithoutNode = "Pallax";
constexpr const char* kPaneCellIdentifier = "PallaxPaneControllerCell";
constexpr ui::Font kStatusFont{ui::FontFace::System, 14};

ui::Label statusLabel(const std::string& status, const ui::TextMetrics& metrics) {
    ui::Label label;
    label.text = status;
    label.font = kStatusFont;
    label.clearBackground = true;
    label.color = ui::TextColor::Dark;
    label.frame.size = metrics.measure(status, kStatusFont);
    return label;
}

/// True for the names that the tree gives the elements of an array.
bool areNumbered(const std::vector<NodeRef>& children) {
    std::size_t expected = 0;
    return std::all_of(children.begin(), children.end(), [&expected](const NodeRef& child) {
        return child->displayName() == std::to_string(expected++);
    });
}

/// The text of a leaf's value; a branch, which has none, shows nothing.
std::string valueText(const PallaxModelNode& node) {
    std::string text;
    if (const PropertyList* value = node.value()) {
        value->appendString(text);
    }
    return text;
}

/// A label that the cell does not have takes no text.
void setText(const std::shared_ptr<ui::Label>& label, std::string text) {
    if (label) {
        label->text = std::move(text);
    }
}

/// The cell that the table has to spare, whatever kind it was made as.
std::shared_ptr<PallaxCell> reusableCell(ui::TableView& table) {
    return std::dynamic_pointer_cast<PallaxCell>(table.dequeueReusableCell(kPaneCellIdentifier));
}

} // namespace

PallaxPaneController::PallaxPaneController(ui::Toolkit& toolkit, PaneApplication& application,
                                           NodeRef node, std::string path)
    : TableScreen(toolkit), _toolkit(toolkit), _application(application), _nodes(std::move(node)),
      _keyPath(std::move(path)) {}

void PallaxPaneController::createToolbarItems() {
    ui::ActivityIndicator indicator;
    indicator.style = ui::IndicatorStyle::Gray;
    indicator.hidesWhenStopped = true;
    indicator.isSpinning = _isLoading;
    ui::BarItems items = {indicator, statusLabel(_status, _toolkit.textMetrics()),
                          ui::FlexibleSpace{}};
    if (_application.allowSaveButton()) {
        items.emplace_back(ui::SaveButton{[&app = _application] { app.showSaveView(); }});
    }
    setToolbarItems(std::move(items), true);
}

void PallaxPaneController::showTitle() {
    setTitle(_nodes ? _nodes->displayName() : std::string(kTitleWithoutNode));
}

void PallaxPaneController::viewWillAppear(bool animated) {
    TableScreen::viewWillAppear(animated);
    showTitle();
    if (ui::NavigationStack* stack = _application.navigationController()) {
        stack->showToolbar();
    }
    createToolbarItems();
}

void PallaxPaneController::viewWillDisappear(bool /*animated*/) {
    view().resignFirstResponder();
}

void PallaxPaneController::setStatus(std::optional<std::string> status, bool isLoading) {
    _status = std::move(status).value_or("");
    _isLoading = isLoading;
    createToolbarItems();
}

void PallaxPaneController::reloadWithNode(NodeRef node) {
    if (node != _nodes) { // the same node again is no new data: what has changed stays so
        _previousByName.clear();
        _previousNodes = std::exchange(_nodes, std::move(node));
    }
    showTitle();
    table().reloadData();
    createToolbarItems();
}

std::size_t PallaxPaneController::numberOfRows() const {
    const std::vector<NodeRef>* children = _nodes ? _nodes->childNodes() : nullptr;
    return children != nullptr ? children->size() : 0;
}

NodeRef PallaxPaneController::childAt(std::size_t row) const {
    return row < numberOfRows() ? (*_nodes->childNodes())[row] : nullptr;
}

std::shared_ptr<ui::TableCell> PallaxPaneController::cellForRow(std::size_t row) {
    const NodeRef child = childAt(row);
    if (!child) {
        return nullptr;
    }
    const bool isBranch = child->childNodes() != nullptr;
    std::shared_ptr<PallaxCell> cell = reusableCell(table());
    if (!cell) {
        const auto kind = isBranch ? PallaxCell::Kind::Branch : PallaxCell::Kind::Leaf;
        cell = std::make_shared<PallaxCell>(kind, kPaneCellIdentifier, _toolkit.textMetrics());
        cell->setContentBounds(table().contentBounds());
    }
    setText(cell->key(), child->displayName());
    cell->setAccessory(isBranch ? ui::CellAccessory::DisclosureIndicator : ui::CellAccessory::None);
    setText(cell->value(), valueText(*child));
    if (isBranch) {
        cell->setLayoutKey();
    } else {
        cell->setLayout();
    }
    return cell;
}

ui::RowText PallaxPaneController::textOfRow(std::size_t row) const {
    ui::RowText text;
    const NodeRef child = childAt(row);
    if (!child) {
        return text;
    }
    text.name = child->displayName();
    if (const std::vector<NodeRef>* children = child->childNodes()) {
        text.isBranch = true;
        if (!children->empty() && areNumbered(*children)) {
            text.elements = children->size();
        }
        return text;
    }
    text.value = valueText(*child);
    text.hasChanged = hasChanged(*child, row);
    return text;
}

bool PallaxPaneController::hasChanged(const PallaxModelNode& leaf, std::size_t row) const {
    if (!_previousNodes) {
        return false;
    }
    const PallaxModelNode* previous = previousNamed(leaf.displayName(), row);
    const PropertyList* before = previous != nullptr ? previous->value() : nullptr;
    const PropertyList* now = leaf.value();
    return before == nullptr || now == nullptr || !(*before == *now);
}

const PallaxModelNode* PallaxPaneController::previousNamed(std::string_view name,
                                                           std::size_t row) const {
    const std::vector<NodeRef>* children = _previousNodes->childNodes();
    if (children == nullptr) {
        return nullptr;
    }
    if (row < children->size() && (*children)[row]->displayName() == name) {
        return (*children)[row].get();
    }
    if (_previousByName.empty()) {
        _previousByName.reserve(children->size());
        for (const NodeRef& child : *children) {
            _previousByName.insert_or_assign(child->displayName(), child.get());
        }
    }
    const auto found = _previousByName.find(name);
    return found != _previousByName.end() ? found->second : nullptr;
}

void PallaxPaneController::didSelectRow(std::optional<std::size_t> row) {
    const NodeRef child = row ? childAt(*row) : nullptr;
    if (!child) {
        return;
    }
    if (child->childNodes() == nullptr) {
        table().deselectRow(*row, false);
        return;
    }
    auto pane = std::make_shared<PallaxPaneController>(_toolkit, _application, child,
                                                       childPath(_keyPath, child->displayName()));
    pane->setStatus(_status, _isLoading);
    if (ui::NavigationStack* stack = _application.navigationController()) {
        stack->push(std::move(pane), true);
    }
}

} // namespace pallax
