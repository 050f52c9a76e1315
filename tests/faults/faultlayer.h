// Faults on demand below everything that writes: the n-th call of the system, of SQLite's file
// layer or for memory fails. For programs of their own: the layer stands between them and the
// system.
#pragma once

#include <string>

enum class FAULT_KIND {
    File,  // open, read, write, fsync, rename, chmod, flock; SQLite's open, read, write, truncate
    Memory // operator new; SQLite's allocations
};
enum class FAULT_LENGTH {
    Once,   // one call
    FromNow // it and all that follow: a full disk
};

/// While it lives, the n-th call of the kind fails (n from 1; 0: none, they are counted).
class CFaults {
public:
    CFaults(FAULT_KIND kind, long n, FAULT_LENGTH length = FAULT_LENGTH::Once);
    CFaults(const CFaults&) = delete;
    CFaults& operator=(const CFaults&) = delete;
    ~CFaults();

    /// Calls so far.
    static long Count();
    /// Puts the layer below SQLite; before its first use.
    static void Install();
};
