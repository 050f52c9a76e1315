#include "qm_solver/libraryspace.h"

#include <cstddef>
#include <cstdlib>
#include <new>
#include <sys/mman.h>
#include <sys/resource.h>
#include <unistd.h>

namespace solver {

namespace {

constexpr const char* kThreads = "OPENBLAS_NUM_THREADS";
constexpr std::size_t kMegaByte = std::size_t{1} << 20;
// OpenBLAS: one buffer of 128 MB for each thread; what is needed beside it is small.
constexpr std::size_t kBuffer = 144 * kMegaByte;
// Enough for a buffer for each of many threads.
constexpr rlim_t kPlenty = rlim_t{16} << 30;

bool IsSpaceLimited()
{
    rlimit limit{};
    return getrlimit(RLIMIT_AS, &limit) == 0 && limit.rlim_cur < kPlenty;
}

} // namespace

void StartLean(char** argv)
{
    if (!IsSpaceLimited() || std::getenv(kThreads)) return;
    if (setenv(kThreads, "1", 1) == 0) execv("/proc/self/exe", argv);
    // Without /proc the program goes on as it is.
}

void NeedLibrarySpace()
{
    static const bool isThere = [] { // the library keeps its first buffer
        if (!IsSpaceLimited()) return true;
        void* const space = mmap(nullptr, kBuffer, PROT_NONE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
        if (space == MAP_FAILED) throw std::bad_alloc();
        return munmap(space, kBuffer) == 0;
    }();
    (void)isThere;
}

} // namespace solver
