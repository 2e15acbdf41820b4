// Failures made to order, for tests. Pictures, blocks and what opens, reads, writes, renames or
// changes a file ask here first; in the program the answer is always no.
#pragma once

#include <cstddef>

namespace seam {

/// What can fail; `change` is what alters a file or a directory but is no write: cut, mode, sync,
/// unlink, mkdir. `any` stands for each of those that touch files.
enum class Operation { picture, block, open, read, write, rename, change, any };

/// How the chosen operation fails, and what becomes of those behind it.
enum class Fault {
    error,     // it is refused
    lessened,  // it moves fewer bytes than asked for; the rest goes with the next one
    cut,       // it moves fewer bytes, and the next one of its kind is refused
    onwards,   // it is refused, and all of its kind from there on
    killed,    // the process is killed in its place
    halfKilled // it moves fewer bytes, and the process is killed in place of the next one of any
               // kind
};

/// Whether operations are counted. makeFault and endFaults of the harness write it.
extern bool faultsWatched;

/// Counts an operation. True if it is to be refused, with the reason in errno; else `bytes`, if not
/// null, becomes what may be moved.
bool countOperation(Operation operation, std::size_t* bytes);

/// Whether an operation that is about to be done is refused.
inline bool faultDue(Operation operation, std::size_t* bytes = nullptr) {
    return faultsWatched && countOperation(operation, bytes);
}

} // namespace seam
