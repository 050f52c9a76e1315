// The new file of a write, beside the old one: "<file>.qm.tmp-<process>-<counter>".
#pragma once

#include "qm_db/file/filehandle.h"

#include <string>
#include <string_view>

/// Empty and locked; removed unless it has replaced the old file, whose permissions it then has.
/// Failures are thrown as CStoreFault (NoAccess) with the message key of the constructor.
class CNewFile {
public:
    /// Sweeps what killed writers have left in the folder, too.
    CNewFile(const std::string& target, const char* key);
    CNewFile(const CNewFile&) = delete;
    CNewFile& operator=(const CNewFile&) = delete;
    ~CNewFile();

    const std::string& Path() const { return m_path; }
    void Write(std::string_view bytes) const;
    /// Has the content reach the disk.
    void Flush() const;
    /// Renames it over the old file and has the folder reach the disk. Where there was no old file,
    /// one that has appeared meanwhile is left alone (refused). Returns the new file, locked.
    CFileHandle ReplaceTarget();

    /// Removes what writers that were killed have left in the folder of this file: files of the
    /// name pattern that nobody has locked, and whose process is gone or that are older than ten
    /// minutes.
    static void SweepBeside(const std::string& path) noexcept;

private:
    void TakeOldPermissions() const;
    [[noreturn]] void Fail(int errorNumber) const;

    std::string m_target;
    const char* m_key; // a literal
    std::string m_path;
    bool m_targetExists;
    CFileHandle m_file;
    bool m_isRemoved = false; // nothing left to remove under m_path
};
