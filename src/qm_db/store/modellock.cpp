#include "qm_db/store/modellock.h"

#include "qm_db/file/storefault.h"

std::unique_ptr<CModelLock> CModelLock::Take(const std::string& path)
{
    // Between opening and locking, a save may put another file under this name: try that one then.
    constexpr int kAttempts = 10;
    for (int attempt = 0; attempt < kAttempts; ++attempt) {
        CFileHandle file = CFileHandle::OpenRegular(path, "IDS_QM_DB_FILE_CANT_OPEN");
        if (file.TryLock() && file.IsFileAt(path))
            return std::make_unique<CModelLock>(std::move(file));
    }
    throw CStoreFault(FILE_FAULT::NoAccess, "IDS_QM_DB_FILE_LOCKED");
}
