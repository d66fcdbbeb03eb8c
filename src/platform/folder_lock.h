#pragma once

// One run at a time on a database folder: an import or a print run holds the folder's lock
// while it works, and a second run on the same folder is refused at once with FolderBusy
// instead of failing half-way in the database engine. The lock is an flock on the file
// "etiquon.lock" in the folder: the system drops it when the holder ends, also when it is
// killed, so no stale lock outlives a run. The lock file itself stays, as lock files must (a
// file deleted while another run waits on it would let two runs in).

#include <QString>

#include "platform/unique_fd.h"

namespace etq {

class FolderLock {
  public:
    inline static const QString kLockFileName = QStringLiteral("etiquon.lock");

    // Takes the lock of `folder` without waiting. Throws FolderBusy when another run holds
    // it, Failure when the lock file cannot be opened (a folder that is missing, say).
    explicit FolderLock(const QString& folder);
    ~FolderLock();
    FolderLock(FolderLock&&) noexcept = default;
    FolderLock& operator=(FolderLock&&) noexcept = default;

  private:
    UniqueFd fd_;
};

}  // namespace etq
