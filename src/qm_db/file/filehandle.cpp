#include "qm_db/file/filehandle.h"

#include "qm_db/file/storefault.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>
#include <utility>

CFileHandle::CFileHandle(CFileHandle&& other) noexcept
    : m_descriptor(std::exchange(other.m_descriptor, -1))
{
}

CFileHandle& CFileHandle::operator=(CFileHandle&& other) noexcept
{
    std::swap(m_descriptor, other.m_descriptor);
    return *this;
}

CFileHandle::~CFileHandle()
{
    if (m_descriptor >= 0) ::close(m_descriptor);
}

CFileHandle CFileHandle::OpenRegular(const std::string& path, const char* key)
{
    // O_NONBLOCK: a pipe of that name must not hold us up
    CFileHandle file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    if (!file.IsOpen()) ThrowSystem(key, errno);
    const struct stat status = file.Status();
    if (S_ISDIR(status.st_mode)) ThrowSystem(key, EISDIR);
    if (!S_ISREG(status.st_mode)) ThrowSystem(key, EINVAL);
    return file;
}

struct stat CFileHandle::Status() const
{
    struct stat status = {};
    if (::fstat(m_descriptor, &status) != 0) ThrowSystem("IDS_QM_DB_FILE_CANT_READ", errno);
    return status;
}

bool CFileHandle::IsFileAt(const std::string& path) const
{
    const struct stat mine = Status();
    struct stat named = {};
    return ::stat(path.c_str(), &named) == 0 && mine.st_dev == named.st_dev &&
           mine.st_ino == named.st_ino;
}

bool CFileHandle::TryLock() const
{
    return ::flock(m_descriptor, LOCK_EX | LOCK_NB) == 0;
}
