// The new file of a save, beside the old one: "<file>.tmp-<process>-<counter>".
#pragma once

#include "qm_db/file/filehandle.h"
#include "qm_db/store/modellock.h"

#include <memory>
#include <string>

/// Empty and locked; removed unless it has replaced the old file, whose permissions it then has.
/// Failures are thrown as CStoreFault (NoAccess).
class CModelTemp {
public:
    explicit CModelTemp(const std::string& target);
    CModelTemp(const CModelTemp&) = delete;
    CModelTemp& operator=(const CModelTemp&) = delete;
    ~CModelTemp();

    const std::string& Path() const { return m_path; }
    /// Has the content reach the disk.
    void Flush() const;
    /// Renames it over the old file and has the folder reach the disk. Where there was no old file,
    /// one that has appeared meanwhile is left alone (refused). Returns the lock of the new file.
    std::unique_ptr<CModelLock> ReplaceTarget();

    /// Removes what saves of this model that were killed have left: files of that name pattern
    /// that nobody has locked, and whose process is gone or that are older than ten minutes.
    static void SweepStale(const std::string& target);

private:
    void TakeOldPermissions() const;

    std::string m_target;
    std::string m_path;
    bool m_targetExists;
    CFileHandle m_file;
    bool m_isRemoved = false; // nothing left to remove under m_path
};
