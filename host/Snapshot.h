#pragma once

#include "host/Recording.h"
#include "plist/PropertyList.h"
#include "text/Date.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// A saved snapshot, as its file holds it.
struct Snapshot {
    /// One of the saved displays.
    struct Display {
        std::string description;  ///< "Snapshot (2023-11-14 22:13:20 +0000)"
        std::optional<Time> time; ///< nothing if the file does not give it
        PropertyList content;     ///< a dictionary
    };

    std::string saved;             ///< "2023-11-14 22:13:22 +0000"
    std::string description;       ///< the user's
    std::vector<Display> displays; ///< oldest first
    SharedBytes dlf;               ///< the DLF log; null if there is none
};

/// What every description of a snapshot must say about its displays.
inline constexpr std::string_view kSharedSections =
    "Displays that share a section all show it as it was when the snapshot was saved.";

/// A snapshot is recognised by its content: a dictionary with "Timestamp", a string, and "Data", an
/// array of dictionaries. Nothing for any other object.
std::optional<Snapshot> snapshotOf(const PropertyList& object);

/// Nothing if the content of a file is not a snapshot.
std::optional<Snapshot> snapshotIn(Bytes content);

/// The technology of a snapshot that is read as a recording. Its messages, one for each display,
/// are dictionaries with these keys.
inline constexpr RecordedTechnology kSnapshotTechnology{-1, "Snapshot", "snapshot"};
inline constexpr const char* kSnapshotSaved = "Saved";
inline constexpr const char* kSnapshotDescription = "Description";
inline constexpr const char* kSnapshotTitle = "Title";
inline constexpr const char* kSnapshotDisplay = "Display";

/// The display in one of these messages; null if there is none.
PropertyList displayIn(Bytes message);

/// The error for a snapshot where a recording is needed.
RecordingError noTimeOfSnapshot(const std::string& path);

/// A snapshot as a recording. `isStream`: it has been read from a pipe.
std::unique_ptr<Recording> recordingOf(Snapshot snapshot, const std::string& name, bool isStream);
/// The snapshot that is read as this recording; null for any other recording.
const Snapshot* snapshotOf(const Recording& recording);

} // namespace pallax
