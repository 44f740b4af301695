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

/// The snapshot screen: lists what will be saved and writes it, with a description, as one
/// property-list file. Its items and its time stamp are those of its creation.
class PallaxSaveViewController final : public ui::ModalScreen, public PaneOwner {
public:
    /// All that is referred to outlives the screen.
    struct Surroundings {
        ui::Toolkit& toolkit;
        FileSystem& files;
        const Clock& clock;   ///< of the display: stamps the screen
        const Clock& present; ///< names the file
        MainQueue& queue;
        std::string snapshotDirectory;
        /// The application's; posted to the queue, where it may run after the screen's end.
        std::function<void()> closeSaveView;
        /// Updates the displays that are saved, whose sections are the live ones, with every packet
        /// that has arrived.
        std::function<void()> bringUpToDate;
    };

    /// `saveHistory` is an array, or null when there are no save contents.
    PallaxSaveViewController(Surroundings surroundings, const PropertyList& saveHistory);

    /// A snapshot file's root dictionary; it ends at the first value that is null.
    static Dictionary snapshot(const PropertyList& timestamp, const PropertyList& data,
                               const PropertyList& description);

    void viewDidLoad() override;
    /// Takes the application's area of the screen and leaves the toolkit's own handling out.
    void viewWillAppear(bool animated) override;

    /// Writes the file; for a character that it cannot hold stands U+FFFD, which is logged. Whether
    /// that succeeds or not, the screen is closed afterwards; a failure is logged and shown as an
    /// alert.
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
