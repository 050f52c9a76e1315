// Address space of the linear algebra library. It takes a buffer of 128 MB for each of its threads
// and asks for one again and again, without end, where the process can't have it.
#pragma once

namespace solver {

/// First statement of main(). Where the address space of the process is limited, starts the program
/// again with a library of one thread: its threads wait for their buffers from the start.
void StartLean(char** argv);

/// Throws std::bad_alloc where the library could not have its buffer.
void NeedLibrarySpace();

} // namespace solver
