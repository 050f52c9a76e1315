#include "faultlayer.h"

#include <atomic>
#include <cerrno>
#include <cstdarg>
#include <cstdlib>
#include <fcntl.h>
#include <map>
#include <memory>
#include <new>
#include <sqlite3.h>
#include <stdexcept>
#include <sys/stat.h>
#include <sys/types.h>

namespace {

std::atomic<int> g_kind{-1}; // of the faults that are on; -1: none
std::atomic<long> g_at{0}, g_count{0};
std::atomic<bool> g_fromNow{false};

bool Fails(FAULT_KIND kind)
{
    if (g_kind != static_cast<int>(kind)) return false;
    const long count = ++g_count, at = g_at;
    return at > 0 && (count == at || (g_fromNow && count > at));
}

bool FileFails(int reason)
{
    if (!Fails(FAULT_KIND::File)) return false;
    errno = reason;
    return true;
}

/// SQLite's methods of a file, with ours in front.
struct T_METHODS {
    sqlite3_io_methods ours{};
    const sqlite3_io_methods* theirs = nullptr;
};

const sqlite3_io_methods* Theirs(sqlite3_file* file)
{
    return reinterpret_cast<const T_METHODS*>(file->pMethods)->theirs;
}

int ReadFile(sqlite3_file* file, void* to, int count, sqlite3_int64 at)
{
    return FileFails(EIO) ? SQLITE_IOERR_READ : Theirs(file)->xRead(file, to, count, at);
}

int WriteFile(sqlite3_file* file, const void* from, int count, sqlite3_int64 at)
{
    return FileFails(ENOSPC) ? SQLITE_FULL : Theirs(file)->xWrite(file, from, count, at);
}

int TruncateFile(sqlite3_file* file, sqlite3_int64 size)
{
    return FileFails(EIO) ? SQLITE_IOERR_TRUNCATE : Theirs(file)->xTruncate(file, size);
}

int SizeOfFile(sqlite3_file* file, sqlite3_int64* size)
{
    return FileFails(EIO) ? SQLITE_IOERR_FSTAT : Theirs(file)->xFileSize(file, size);
}

sqlite3_vfs* g_system = nullptr;
sqlite3_vfs g_faulty{};
sqlite3_mem_methods g_memory{};

int OpenFile(sqlite3_vfs*, const char* name, sqlite3_file* file, int flags, int* outFlags)
{
    static std::map<const sqlite3_io_methods*, std::unique_ptr<T_METHODS>> tables;
    file->pMethods = nullptr;
    if (FileFails(EMFILE)) return SQLITE_CANTOPEN;
    const int code = g_system->xOpen(g_system, name, file, flags, outFlags);
    if (!file->pMethods) return code;
    std::unique_ptr<T_METHODS>& table = tables[file->pMethods];
    if (!table) {
        table = std::make_unique<T_METHODS>(T_METHODS{*file->pMethods, file->pMethods});
        table->ours.xRead = ReadFile;
        table->ours.xWrite = WriteFile;
        table->ours.xTruncate = TruncateFile;
        table->ours.xFileSize = SizeOfFile;
    }
    file->pMethods = &table->ours;
    return code;
}

void* SqliteMalloc(int size)
{
    return Fails(FAULT_KIND::Memory) ? nullptr : g_memory.xMalloc(size);
}

void* SqliteRealloc(void* old, int size)
{
    return Fails(FAULT_KIND::Memory) ? nullptr : g_memory.xRealloc(old, size);
}

} // namespace

CFaults::CFaults(FAULT_KIND kind, long n, FAULT_LENGTH length)
{
    g_count = 0;
    g_at = n;
    g_fromNow = length == FAULT_LENGTH::FromNow;
    g_kind = static_cast<int>(kind);
}

CFaults::~CFaults()
{
    g_kind = -1;
}

long CFaults::Count()
{
    return g_count;
}

void CFaults::Install()
{
    sqlite3_config(SQLITE_CONFIG_GETMALLOC, &g_memory);
    sqlite3_mem_methods faulty = g_memory;
    faulty.xMalloc = SqliteMalloc;
    faulty.xRealloc = SqliteRealloc;
    if (sqlite3_config(SQLITE_CONFIG_MALLOC, &faulty) != SQLITE_OK)
        throw std::runtime_error("SQLite is in use already");
    g_system = sqlite3_vfs_find(nullptr);
    g_faulty = *g_system;
    g_faulty.zName = "faulty";
    g_faulty.xOpen = OpenFile;
    sqlite3_vfs_register(&g_faulty, 1);
}

// Not inlined: the compiler would see free() paired with its own operator new and complain.
[[gnu::noinline]] void* operator new(std::size_t size)
{
    void* const p = Fails(FAULT_KIND::Memory) ? nullptr : std::malloc(size);
    if (!p) throw std::bad_alloc();
    return p;
}

[[gnu::noinline]] void* operator new(std::size_t size, const std::nothrow_t&) noexcept
{
    return Fails(FAULT_KIND::Memory) ? nullptr : std::malloc(size);
}

[[gnu::noinline]] void operator delete(void* p) noexcept
{
    std::free(p);
}

[[gnu::noinline]] void operator delete(void* p, std::size_t) noexcept
{
    std::free(p);
}

// The linker has these called in place of the system's (see CMakeLists.txt).
extern "C" {
int __real_open(const char* path, int flags, ...);
ssize_t __real_read(int fd, void* to, std::size_t count);
ssize_t __real_write(int fd, const void* from, std::size_t count);
int __real_fsync(int fd);
int __real_fchmod(int fd, mode_t mode);
int __real_flock(int fd, int what);
int __real_rename(const char* from, const char* to);
int __real_renameat2(int fromFd, const char* from, int toFd, const char* to, unsigned flags);

int __wrap_open(const char* path, int flags, ...)
{
    std::va_list args;
    va_start(args, flags);
    const mode_t mode = (flags & O_CREAT) != 0 ? va_arg(args, mode_t) : 0;
    va_end(args);
    return FileFails(EMFILE) ? -1 : __real_open(path, flags, mode);
}

ssize_t __wrap_read(int fd, void* to, std::size_t count)
{
    return FileFails(EIO) ? -1 : __real_read(fd, to, count);
}

ssize_t __wrap_write(int fd, const void* from, std::size_t count)
{
    return FileFails(ENOSPC) ? -1 : __real_write(fd, from, count);
}

int __wrap_fsync(int fd)
{
    return FileFails(EIO) ? -1 : __real_fsync(fd);
}

int __wrap_fchmod(int fd, mode_t mode)
{
    return FileFails(EPERM) ? -1 : __real_fchmod(fd, mode);
}

int __wrap_flock(int fd, int what)
{
    return FileFails(ENOLCK) ? -1 : __real_flock(fd, what);
}

int __wrap_rename(const char* from, const char* to)
{
    return FileFails(EIO) ? -1 : __real_rename(from, to);
}

int __wrap_renameat2(int fromFd, const char* from, int toFd, const char* to, unsigned flags)
{
    return FileFails(EIO) ? -1 : __real_renameat2(fromFd, from, toFd, to, flags);
}
}
