#include "app/PallaxSaveViewController.h"

#include "platform/Clock.h"
#include "platform/FileSystem.h"
#include "platform/MainQueue.h"
#include "platform/SystemLog.h"
#include "plist/XmlWritable.h"
#include "text/Format.h"

#include <utility>
#include <vector>

namespace pallax {

namespace {

constexpr std::string_view kLayoutName = "PallaxSaveViewController";
constexpr const char* kSaveCellIdentifier = "SaveHistoryContentCell";
constexpr ui::Font kItemFont{ui::FontFace::Helvetica, 13};
constexpr std::string_view kDescriptionKey = "Description";

/// The entry's "Description", or "".
std::string descriptionOf(const PropertyList& entry) {
    std::string text;
    const DictionaryRef item = entry.dictionary();
    if (const PropertyList* description = item ? item->find(kDescriptionKey) : nullptr) {
        description->appendString(text);
    }
    return text;
}

NodeRef itemsOf(const PropertyList& saveHistory) {
    std::vector<NodeRef> items;
    if (const ArrayRef entries = saveHistory.array()) {
        for (const PropertyList& entry : *entries) {
            items.push_back(std::make_shared<PallaxModelNode>(descriptionOf(entry)));
        }
    }
    return std::make_shared<PallaxModelTreeNode>(std::string(), std::move(items));
}

} // namespace

PallaxSaveViewController::PallaxSaveViewController(Surroundings surroundings,
                                                   const PropertyList& saveHistory)
    : ModalScreen(surroundings.toolkit, kLayoutName), _surroundings(std::move(surroundings)),
      _timeStamp(dateOf(_surroundings.clock.now())), _saveHistory(saveHistory.shallowCopy()),
      _items(itemsOf(_saveHistory), "") {}

Dictionary PallaxSaveViewController::snapshot(const PropertyList& timestamp,
                                              const PropertyList& data,
                                              const PropertyList& description) {
    const std::pair<std::string_view, const PropertyList&> entries[] = {
        {"Timestamp", timestamp}, {"Data", data}, {kDescriptionKey, description}};
    Dictionary root;
    for (const auto& [key, value] : entries) {
        if (value.isNull()) {
            break;
        }
        root.setFixed(key, value);
    }
    return root;
}

void PallaxSaveViewController::viewDidLoad() {
    saveDescription().setDelegate(this);
    ModalScreen::viewDidLoad();
    saveContentTable().sizeToFit();
}

void PallaxSaveViewController::viewWillAppear(bool /*animated*/) {
    view().setFrame(_surroundings.toolkit.applicationFrame());
}

std::string PallaxSaveViewController::snapshotPath() const {
    return formatText("%@/PallaxSnapshot-%ld.pallax",
                      {_surroundings.snapshotDirectory,
                       dateOf(_surroundings.present.now()).time_since_epoch().count()});
}

void PallaxSaveViewController::savePressed() {
    _surroundings.bringUpToDate();
    const PropertyList root = writableInXml(
        snapshot(dateText(_timeStamp), _saveHistory, saveDescription().text()),
        [](const std::string& place) {
            systemLog(LogPriority::Warning,
                      "Characters that XML cannot hold are written as U+FFFD in the snapshot's %@",
                      place);
        });
    const std::string path = snapshotPath();
    if (!_surroundings.files.writePropertyList(path, root)) {
        reportFailure(path);
    }
    _surroundings.queue.async(_surroundings.closeSaveView);
}

void PallaxSaveViewController::reportFailure(const std::string& path) {
    systemLog(LogPriority::Error, "Unable to write snapshot to %s", path);
    _surroundings.toolkit.showAlert({"File Error", "Unable to write file to disk", "Close"});
}

void PallaxSaveViewController::cancelPressed() {
    _surroundings.queue.async(_surroundings.closeSaveView);
}

void PallaxSaveViewController::backgroundTouched() {
    saveDescription().resignFirstResponder();
}

bool PallaxSaveViewController::textFieldShouldReturn(ui::TextField& field) {
    field.resignFirstResponder();
    return true;
}

std::size_t PallaxSaveViewController::numberOfRows() const {
    return _items.totalRows();
}

std::shared_ptr<ui::TableCell> PallaxSaveViewController::cellForRow(std::size_t row) {
    std::shared_ptr<ui::TableCell> cell =
        saveContentTable().dequeueReusableCell(kSaveCellIdentifier);
    if (!cell) {
        cell = std::make_shared<ui::TableCell>(ui::CellStyle::Plain, kSaveCellIdentifier);
        cell->setContentBounds(saveContentTable().contentBounds());
    }
    cell->textLabel().text = _items.row(row).name;
    cell->textLabel().font = kItemFont;
    cell->setAccessory(ui::CellAccessory::Checkmark);
    return cell;
}

void PallaxSaveViewController::didSelectRow(std::optional<std::size_t> /*row*/) {
    saveDescription().resignFirstResponder();
}

} // namespace pallax
