#pragma once

#include "app/pane/PaneModel.h"
#include "platform/ui/ModalScreen.h"
#include "plist/PropertyList.h"
#include "text/Date.h"

#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

class Clock;
class FileSystem;
class MainQueue;

/// The snapshot screen: lists the items to save and writes them, with a description, as one
/// property-list file. Its items and time stamp are set when it is created.
class PallaxSaveViewController final : public ui::ModalScreen, public PaneOwner {
public:
    /// All references must outlive the screen.
    struct Surroundings {
        ui::Toolkit& toolkit;
        FileSystem& files;
        const Clock& clock;   ///< for the time stamp
        const Clock& present; ///< for the file name
        MainQueue& queue;
        std::string snapshotDirectory;
        /// Closes the screen. Posted to the queue, it may run after the screen is destroyed.
        std::function<void()> closeSaveView;
        /// Brings the saved displays, which share the live sections, up to date with the latest
        /// packet.
        std::function<void()> bringUpToDate;
    };

    /// `saveHistory` is an array, or null without save contents.
    PallaxSaveViewController(Surroundings surroundings, const PropertyList& saveHistory);

    /// The root dictionary of a snapshot file; it ends at the first null value.
    static Dictionary snapshot(const PropertyList& timestamp, const PropertyList& data,
                               const PropertyList& description);

    void viewDidLoad() override;
    /// Takes the application's area of the screen, without the toolkit's own handling.
    void viewWillAppear(bool animated) override;

    /// Writes the file. A character that the file cannot hold is replaced by U+FFFD and logged.
    /// Closes the screen in any case; a failure is logged and shown as an alert.
    void savePressed() override;
    void cancelPressed() override;
    void backgroundTouched() override;
    bool textFieldShouldReturn(ui::TextField& field) override;

    ui::TableView& saveContentTable() { return list(); }
    ui::TextField& saveDescription() { return field(); }

    std::size_t numberOfRows() const override;
    std::shared_ptr<ui::TableCell> cellForRow(std::size_t row) override;
    void didSelectRow(std::optional<std::size_t> row) override;
    /// The items, named by their descriptions; they have no values.
    PaneModel& pane() override { return _items; }

private:
    std::string snapshotPath() const;
    void reportFailure(const std::string& path);

    Surroundings _surroundings;
    Date _timeStamp;
    PropertyList _saveHistory;
    PaneModel _items;
};

} // namespace pallax
