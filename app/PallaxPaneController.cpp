#include "app/PallaxPaneController.h"

#include "app/PallaxCell.h"
#include "platform/ui/NavigationStack.h"
#include "platform/ui/Toolkit.h"

#include <utility>

namespace pallax {

namespace {

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

/// Does nothing if the cell does not have the label.
void setText(const std::shared_ptr<ui::Label>& label, std::string text) {
    if (label) {
        label->text = std::move(text);
    }
}

/// A free cell of the table, of either kind.
std::shared_ptr<PallaxCell> reusableCell(ui::TableView& table) {
    return std::dynamic_pointer_cast<PallaxCell>(table.dequeueReusableCell(kPaneCellIdentifier));
}

} // namespace

PallaxPaneController::PallaxPaneController(ui::Toolkit& toolkit, PaneApplication& application,
                                           NodeRef node, std::string path)
    : TableScreen(toolkit), _toolkit(toolkit), _application(application),
      _pane(std::move(node), std::move(path)) {
    _pane.setAges(application.readingAges());
}

void PallaxPaneController::createToolbarItems() {
    ui::ActivityIndicator indicator;
    indicator.style = ui::IndicatorStyle::Gray;
    indicator.hidesWhenStopped = true;
    indicator.isSpinning = _pane.isLoading();
    ui::BarItems items = {indicator, statusLabel(_pane.status(), _toolkit.textMetrics()),
                          ui::FlexibleSpace{}};
    if (_application.allowSaveButton()) {
        items.emplace_back(ui::SaveButton{[&app = _application] { app.showSaveView(); }});
    }
    setToolbarItems(std::move(items), true);
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
    _pane.setStatus(std::move(status).value_or(""), isLoading);
    createToolbarItems();
}

void PallaxPaneController::reloadWithNode(NodeRef node, std::optional<Time> time) {
    _pane.show(std::move(node), time);
    showTitle();
    table().reloadData();
    createToolbarItems();
}

std::size_t PallaxPaneController::numberOfRows() const {
    return _pane.totalRows();
}

std::shared_ptr<ui::TableCell> PallaxPaneController::cellForRow(std::size_t row) {
    const NodeRef child = _pane.nodeAt(row);
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
    setText(cell->value(), textOf(*child).value_or(""));
    if (isBranch) {
        cell->setLayoutKey();
    } else {
        cell->setLayout();
    }
    return cell;
}

void PallaxPaneController::didSelectRow(std::optional<std::size_t> row) {
    const NodeRef child = row ? _pane.nodeAt(*row) : nullptr;
    if (!child) {
        return;
    }
    if (child->childNodes() == nullptr) {
        table().deselectRow(*row, false);
        return;
    }
    auto pane = std::make_shared<PallaxPaneController>(_toolkit, _application, child,
                                                       childPath(path(), child->displayName()));
    pane->setStatus(_pane.status(), _pane.isLoading());
    if (ui::NavigationStack* stack = _application.navigationController()) {
        stack->push(std::move(pane), true);
    }
}

} // namespace pallax
