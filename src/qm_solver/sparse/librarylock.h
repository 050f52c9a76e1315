// One call at a time into the libraries of the factorisation.
#pragma once

#include <mutex>

namespace solver {

/// MUMPS and METIS keep state that all callers share: two instances used from two threads at once
/// crash. Every call goes through this lock.
inline std::mutex& LibraryLock()
{
    static std::mutex lock;
    return lock;
}

} // namespace solver
