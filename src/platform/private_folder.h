#pragma once

// Folders of the user's own for files that live only during a run (label pages, bitmaps). Each
// is opened without following links, and its owner and mode are checked on what was opened: a
// link, a file, a folder of another user or one that others may enter is refused with a
// Failure that names it, never repaired, so that no other user can steer what a run writes or
// deletes. What lies above the private folder (the session's runtime folder, the user's cache
// folder) is the system's and is taken as it is.

#include <QString>

#include "platform/unique_fd.h"

namespace etq {

// A folder held open by its descriptor, with the path that reached it: the descriptor is what
// the work goes through, the path is for messages and for programs that take paths.
struct OpenFolder {
    UniqueFd fd;
    QString path;
};

// The folder `name` inside `parent`, made with mode 0700 when missing. Throws Failure.
OpenFolder openPrivateFolder(const OpenFolder& parent, const QString& name);

// The user's private folder "etiquon" under the runtime folder, else under the cache folder.
// Throws Failure.
OpenFolder openPrivateTempFolder();

}  // namespace etq
