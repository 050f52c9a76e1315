// An open file descriptor, closed at the end of its life.
#pragma once

#include <string>
#include <sys/stat.h>

class CFileHandle {
public:
    explicit CFileHandle(int descriptor) : m_descriptor(descriptor) {}
    CFileHandle(CFileHandle&& other) noexcept;
    CFileHandle& operator=(CFileHandle&& other) noexcept;
    ~CFileHandle();

    /// A regular file for reading; else CStoreFault (NoAccess) with that message key.
    static CFileHandle OpenRegular(const std::string& path, const char* key);

    int Get() const { return m_descriptor; }
    bool IsOpen() const { return m_descriptor >= 0; }
    /// Status of the open file, whatever its name is by now.
    struct stat Status() const;
    /// True when this is the file that the path names now.
    bool IsFileAt(const std::string& path) const;
    /// Takes the exclusive lock of the file without waiting; it ends with the handle.
    bool TryLock() const;

private:
    int m_descriptor;
};
