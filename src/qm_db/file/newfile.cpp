#include "qm_db/file/newfile.h"

#include "qm_db/file/foldernames.h"
#include "qm_db/file/storefault.h"

#include <atomic>
#include <cerrno>
#include <charconv>
#include <csignal>
#include <cstdio>
#include <ctime>
#include <fcntl.h>
#include <unistd.h>

namespace {

constexpr std::string_view kMark = ".qm.tmp-"; // of this program alone: a sweep goes by it
constexpr std::time_t kOldS = 600;             // longer than any write takes, s

std::string TempPath(const std::string& target)
{
    static std::atomic<unsigned> counter{0};
    return target + std::string(kMark) + std::to_string(::getpid()) + '-' +
           std::to_string(++counter);
}

int CreateNew(const std::string& path, mode_t mode, const char* key)
{
    const int descriptor = ::open(path.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, mode);
    if (descriptor < 0) ThrowSystem(key, errno);
    return descriptor;
}

bool Exists(const std::string& path)
{
    struct stat status = {};
    return ::stat(path.c_str(), &status) == 0;
}

/// "frame.qmdb.qm.tmp-123-4" gives 123; a name of another pattern gives 0.
pid_t ProcessOf(const std::string& name)
{
    const auto mark = name.rfind(kMark);
    if (mark == name.npos || mark == 0) return 0;
    const char* const end = name.data() + name.size();
    pid_t process = 0;
    const auto first = std::from_chars(name.data() + mark + kMark.size(), end, process);
    if (first.ec != std::errc{} || first.ptr == end || *first.ptr != '-') return 0;
    unsigned counter = 0;
    const auto second = std::from_chars(first.ptr + 1, end, counter);
    return second.ec == std::errc{} && second.ptr == end && process > 0 ? process : 0;
}

bool IsStale(const std::string& path, pid_t process)
{
    const CFileHandle file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOFOLLOW));
    if (!file.IsOpen() || !file.TryLock()) return false;
    const bool gone = ::kill(process, 0) != 0 && errno == ESRCH;
    return gone || std::time(nullptr) - file.Status().st_mtime > kOldS;
}

} // namespace

// Ours alone until it takes the old file's permissions; without an old file those of any new file.
CNewFile::CNewFile(const std::string& target, const char* key)
    : m_target(target), m_key(key), m_path(TempPath(target)), m_targetExists(Exists(target)),
      m_file(CreateNew(m_path, m_targetExists ? 0600 : 0666, key))
{
    SweepBeside(target);
    if (m_file.TryLock()) return;
    const int reason = errno;
    ::unlink(m_path.c_str());
    Fail(reason);
}

CNewFile::~CNewFile()
{
    if (!m_isRemoved) ::unlink(m_path.c_str());
}

void CNewFile::Fail(int errorNumber) const
{
    ThrowSystem(m_key, errorNumber);
}

void CNewFile::Write(std::string_view bytes) const
{
    while (!bytes.empty()) {
        const ssize_t count = ::write(m_file.Get(), bytes.data(), bytes.size());
        if (count < 0 && errno == EINTR) continue;
        if (count <= 0) Fail(count == 0 ? ENOSPC : errno);
        bytes.remove_prefix(static_cast<std::size_t>(count));
    }
}

void CNewFile::TakeOldPermissions() const
{
    struct stat old = {};
    if (::stat(m_target.c_str(), &old) != 0) return;
    const struct stat mine = m_file.Status();
    // Another owner can be kept by root only; the set-id bits go with a change of owner anyway.
    const bool sameOwner = (old.st_uid == mine.st_uid && old.st_gid == mine.st_gid) ||
                           ::fchown(m_file.Get(), old.st_uid, old.st_gid) == 0;
    const mode_t keep = sameOwner ? 07777 : 0777;
    if (::fchmod(m_file.Get(), old.st_mode & keep) != 0) Fail(errno);
}

void CNewFile::Flush() const
{
    if (::fsync(m_file.Get()) != 0) Fail(errno);
}

CFileHandle CNewFile::ReplaceTarget()
{
    const CFileHandle folder(
        ::open(FolderOf(m_target).c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (!folder.IsOpen()) Fail(errno);

    if (m_targetExists) {
        TakeOldPermissions();
        Flush();
    }
    const char* const from = m_path.c_str();
    const char* const to = m_target.c_str();
    int failed = -1;
    errno = EINVAL;
    if (!m_targetExists) failed = ::renameat2(AT_FDCWD, from, AT_FDCWD, to, RENAME_NOREPLACE);
    if (failed && errno == EINVAL) failed = std::rename(from, to); // also: not all folders can that
    if (failed) Fail(errno);
    m_isRemoved = true;

    // The new file is whole and in its place; a folder that can't be flushed changes nothing.
    (void)!::fsync(folder.Get());
    return std::move(m_file);
}

void CNewFile::SweepBeside(const std::string& path) noexcept
{
    try {
        for (const std::string& name : NamesBeside(path)) {
            const pid_t process = ProcessOf(name);
            const std::string whole = FolderOf(path) + '/' + name;
            if (process > 0 && IsStale(whole, process)) ::unlink(whole.c_str());
        }
    } catch (const std::exception&) {
        // what can't be read or removed stays for the next one
    }
}
