// The model file (.qmdb): one SQLite file per model.
// Save writes a new file beside the old one, fsyncs it, reads it back, renames it over the old one
// and fsyncs the folder: after a crash or on a full disk there is the old file or the new one.
#pragma once

#include "qm_db/fileerror.h"
#include "qm_db/records.h"
#include "qm_db/results/pushrun.h"
#include "qm_db/results/stagedresult.h"

#include <cstdint>
#include <memory>
#include <string>

enum class OPEN_MODE {
    ReadOnly, // no lock; works in a read-only folder
    Edit      // takes the writer's lock of the file; a second editor is refused
};

/// A model with the sources of its results.
struct T_MODEL_CONTENT {
    T_MODEL model;        // SI
    T_RESULT_MAP results; // by the key of the pushover load case; file-backed sources stay lazy
    T_TURNED_MAP turnedResults{};                  // of pushes with turned loads, likewise
    T_STATIC_MAP staticResults{};                  // by the key of the static load case, likewise
    std::shared_ptr<IStagedResult> stagedResult{}; // of the construction stages, or null; likewise
};

/// Keeps the writer's lock of one model file until it is destroyed.
class CModelLock;

class CModelStore {
public:
    CModelStore();
    ~CModelStore();
    CModelStore(const CModelStore&) = delete;
    CModelStore& operator=(const CModelStore&) = delete;

    /// Opens and checks a model file, in this order: size, application id, schema version (older
    /// ones are migrated in memory), SQLite's integrity check, the checksum of every table and, for
    /// files up to 16 MiB, of every result block; larger files check a block when it is read.
    /// Sweeps stale temporary files of this model (Edit only). 1 done; 0 error filled, `out` as it
    /// was. The file-backed sources in `out` keep working after this object is gone.
    [[nodiscard]] int Open(const std::string& path, OPEN_MODE mode, T_MODEL_CONTENT& out,
                           T_FILE_ERROR& error);

    /// Writes the model with all its results (lazy ones are copied block by block). Refused when
    /// another process or document has the file open for editing, or has changed it since this
    /// object opened or saved it (fault Changed). 1 done; 0 error filled and the file on disk is as
    /// it was.
    [[nodiscard]] int Save(const std::string& path, const T_MODEL_CONTENT& content,
                           T_FILE_ERROR& error);

    /// Reads every table and block and checks every checksum. 1 all well; 0 error filled.
    [[nodiscard]] static int CheckWhole(const std::string& path, T_FILE_ERROR& error);

    /// Whether a path is that of a model file, by its extension or else by how its content begins.
    [[nodiscard]] static bool IsModelFile(const std::string& path);

    /// Gives up the writer's lock, if held.
    void Close();
    /// The next save replaces what is there, whoever has changed it.
    void AcceptChanges() { m_known.clear(); }

private:
    std::unique_ptr<CModelLock> m_lock; // held after Open(Edit) or Save
    std::string m_known;                // file that was opened or saved last; empty: none
    std::uint64_t m_stamp = 0;          // of it, as it was then
};
