#include "qm_db/filectrl.h"

#include "qm_base/say.h"
#include "qm_db/file/checksum.h"
#include "qm_db/file/newfile.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/modellock.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <ctime>
#include <fcntl.h>
#include <filesystem>
#include <memory>
#include <sys/stat.h>
#include <unistd.h>

namespace {

constexpr const char* kCantOpen = "IDS_QM_FILE_CANT_OPEN";
constexpr const char* kCantRead = "IDS_QM_FILE_CANT_READ";
constexpr const char* kCantWrite = "IDS_QM_FILE_CANT_WRITE";

/// An open file that is closed at the end of its scope.
class CScopedDescriptor {
public:
    explicit CScopedDescriptor(int fd) : m_fd(fd) {}
    CScopedDescriptor(const CScopedDescriptor&) = delete;
    CScopedDescriptor& operator=(const CScopedDescriptor&) = delete;
    ~CScopedDescriptor()
    {
        if (m_fd >= 0) close(m_fd);
    }
    int Get() const { return m_fd; }
    /// Closes now; some file systems report a failed write only here.
    bool Close()
    {
        const int fd = m_fd;
        m_fd = -1;
        return close(fd) == 0;
    }

private:
    int m_fd;
};

/// Turns the signal of a file-size limit into the error EFBIG while it lives: a full quota must
/// end in a message, not in the end of the process.
class CSizeSignalBlock {
public:
    CSizeSignalBlock()
    {
        sigemptyset(&m_signal);
        sigaddset(&m_signal, SIGXFSZ);
        pthread_sigmask(SIG_BLOCK, &m_signal, &m_before);
    }
    CSizeSignalBlock(const CSizeSignalBlock&) = delete;
    CSizeSignalBlock& operator=(const CSizeSignalBlock&) = delete;
    ~CSizeSignalBlock()
    {
        const std::timespec now{};
        sigtimedwait(&m_signal, nullptr, &now); // takes the one that is pending
        pthread_sigmask(SIG_SETMASK, &m_before, nullptr);
    }

private:
    sigset_t m_signal;
    sigset_t m_before;
};

/// `key`: what can't be done, in the message catalogue.
int Refuse(const std::string& path, const char* key, int code, T_FILE_ERROR& error)
{
    error = {FILE_FAULT::NoAccess, Say(key, path, SystemReason(code))};
    return 0;
}

/// The file that a write replaces: a link keeps pointing at it.
std::string TargetOf(const std::string& path)
{
    std::error_code ignored;
    if (!std::filesystem::is_symlink(path, ignored)) return path;
    const auto target = std::filesystem::canonical(path, ignored);
    return ignored ? path : target.string();
}

/// Devices and pipes have no old content to keep.
void WriteSpecial(const std::string& path, std::string_view text)
{
    std::FILE* const file = std::fopen(path.c_str(), "we");
    if (!file) ThrowSystem(kCantWrite, errno);
    const bool isWhole = std::fwrite(text.data(), 1, text.size(), file) == text.size();
    if (std::fclose(file) != 0 || !isWhole) ThrowSystem(kCantWrite, errno);
}

} // namespace

std::string CFileCtrl::GetFilePathAndNameWithoutExtension(const std::string& path)
{
    return std::filesystem::path(path).replace_extension().string();
}

int CFileCtrl::WriteWholeFile(const std::string& path, std::string_view text, T_FILE_ERROR& error)
{
    return Guarded(path, error, [&] {
        const CSizeSignalBlock block;
        const std::string target = TargetOf(path);
        struct stat old {};
        const bool exists = stat(target.c_str(), &old) == 0;
        if (exists && S_ISDIR(old.st_mode)) ThrowSystem(kCantWrite, EISDIR);
        if (exists && !S_ISREG(old.st_mode)) return WriteSpecial(target, text);
        if (exists && access(target.c_str(), W_OK) != 0) ThrowSystem(kCantWrite, errno);
        CNewFile file(target, kCantWrite);
        file.Write(text);
        file.Flush();
        (void)file.ReplaceTarget();
    });
}

int CFileCtrl::UpdateWholeFile(const std::string& path, std::string_view text,
                               std::uint64_t sumBefore, T_FILE_ERROR& error)
{
    std::unique_ptr<CModelLock> lock;
    std::string now;
    const int isSame = Guarded(path, error, [&] {
        T_FILE_ERROR fault;
        if (!std::filesystem::exists(path)) return;
        lock = CModelLock::Take(path);
        if (!ReadWholeFile(path, now, fault) || SumOf(now) != sumBefore)
            throw CStoreFault(FILE_FAULT::Changed, "IDS_QM_DB_FILE_CHANGED");
    });
    return isSame ? WriteWholeFile(path, text, error) : 0;
}

std::uint64_t CFileCtrl::SumOf(std::string_view text)
{
    CChecksum sum;
    sum.AddBytes(std::as_bytes(std::span(text)));
    return sum.Value();
}

void CFileCtrl::SweepBeside(const std::string& path)
{
    CNewFile::SweepBeside(TargetOf(path));
}

int CFileCtrl::ReadWholeFile(const std::string& path, std::string& text, T_FILE_ERROR& error)
{
    // O_NONBLOCK: a pipe of that name must not hold us up
    const CScopedDescriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    if (file.Get() < 0) return Refuse(path, kCantOpen, errno, error);
    struct stat info {};
    if (fstat(file.Get(), &info) != 0) return Refuse(path, kCantRead, errno, error);
    if (S_ISDIR(info.st_mode)) return Refuse(path, kCantRead, EISDIR, error);
    if (!S_ISREG(info.st_mode)) {
        error = {FILE_FAULT::NoAccess, Say("IDS_QM_FILE_NOT_REGULAR", path)};
        return 0;
    }

    std::string whole;
    std::size_t used = 0;
    const auto size = static_cast<std::size_t>(info.st_size);
    whole.resize(std::min(size, kMostRead) + 1); // the end shows without growing
    for (; used <= kMostRead;) {
        if (used == whole.size()) whole.resize(2 * whole.size());
        const ssize_t count = read(file.Get(), whole.data() + used, whole.size() - used);
        if (count < 0 && errno == EINTR) continue;
        if (count < 0) return Refuse(path, kCantRead, errno, error);
        if (count == 0) break;
        used += static_cast<std::size_t>(count);
    }
    if (used > kMostRead) {
        error = {FILE_FAULT::BadInput,
                 Say("IDS_QM_FILE_TOO_BIG", path, std::to_string(kMostRead >> 20))};
        return 0;
    }
    whole.resize(used);
    text = std::move(whole);
    return 1;
}
