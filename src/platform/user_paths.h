#pragma once

#include <QString>

namespace etq {

// Where the component keeps its files for the current user.

// The folder of the local databases when the user has chosen none: the user's data folder
// for Etiquon (~/.local/share/Etiquon).
QString userDataFolder();

// The label design file offered when none is chosen: "mylabel.lbl" in the home folder.
QString defaultLabelFile();

// A file of a folder: folder, "/", file name (one separator, also when the folder ends with one).
QString joinPath(const QString& folder, const QString& fileName);

// The user's private folder for files that live only during a run (pages, bitmaps): "etiquon"
// under the runtime folder, else under the cache folder, created with mode 0700. Empty, with
// the reason in `error`, when it is a link, another user's or open to others
// (private_folder.h: work in it through openPrivateTempFolder).
QString privateTempFolder(QString* error = nullptr);

}  // namespace etq
