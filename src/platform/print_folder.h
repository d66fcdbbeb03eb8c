#pragma once

// The folder of one print run of the built-in label page: a new folder of its own inside the
// user's private print folder "etiqon" (private_folder.h), so that two runs at once never
// share, overwrite or empty each other's files. The page and its bitmaps keep their names
// inside it. While the run's object lives, the folder is locked (flock on its descriptor).
//
// The folder stays after the run, for the browser that shows the page. Each new run removes
// the folders of earlier runs that are done with: folders of ours, reached by descriptor,
// never through a link, not locked by a live run and untouched for kFinishedRunAge, so that a
// page just shown by another run keeps its bitmaps. Nothing outside those folders is deleted.

#include <QString>
#include <chrono>

#include "platform/private_folder.h"

namespace etq {

class PrintRunFolder {
  public:
    // How long a folder of a finished run stays for the page shown from it.
    static constexpr std::chrono::seconds kFinishedRunAge{3600};

    // Makes the run's folder. Throws Failure when the print folder cannot be used (a link, a
    // folder of another user or open to others) or the run's folder cannot be made.
    PrintRunFolder();
    ~PrintRunFolder();
    PrintRunFolder(const PrintRunFolder&) = delete;
    PrintRunFolder& operator=(const PrintRunFolder&) = delete;

    // The run's folder, for the page and its bitmaps.
    const QString& path() const { return folder_.path; }

  private:
    OpenFolder folder_;
};

// Removes the folders of finished runs from the print folder `runs` (see above); a folder it
// cannot remove is left as it is. Returns how many it removed.
int removeFinishedRuns(const OpenFolder& runs);

}  // namespace etq
