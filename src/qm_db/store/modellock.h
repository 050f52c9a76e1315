// The writer's lock of a model file.
#pragma once

#include "qm_db/file/filehandle.h"

#include <memory>
#include <string>

/// An advisory lock on the file itself (its inode), not on its name: it goes with the file when it
/// is renamed, ends with the process, and leaves nothing lying about. Two locks of one file
/// exclude each other in one process too.
class CModelLock {
public:
    explicit CModelLock(CFileHandle file) : m_file(std::move(file)) {}

    /// Throws CStoreFault (NoAccess): no such file, or another holds the lock.
    static std::unique_ptr<CModelLock> Take(const std::string& path);

    /// True when this is the lock of the file that the path names now.
    bool Holds(const std::string& path) const { return m_file.IsFileAt(path); }

private:
    CFileHandle m_file;
};
