// Copies of a document beside its file, for the case that the program ends without saving it.
//
// A copy is a whole model file, "<file>.auto-<sequence number>", written as every model file is: a
// temporary file, read back and compared, renamed. The newest three are kept; an older one goes
// only when a newer one has been verified. File dates are never asked for.
#pragma once

#include "qm_db/modelstore.h"

#include <map>
#include <memory>
#include <vector>

class CDBDoc;

struct T_AUTOSAVE_COPY {
    std::string path;
    long sequence = 0;
    bool operator==(const T_AUTOSAVE_COPY&) const = default;
};

enum class AUTOSAVE { Nothing, Written, Failed };

class CAutosave {
public:
    static constexpr double kIntervalS = 20.0;
    static constexpr std::size_t kKept = 3;

    /// The document must outlive the object.
    explicit CAutosave(CDBDoc& doc) : m_doc(doc) {}
    ~CAutosave();
    CAutosave(const CAutosave&) = delete;
    CAutosave& operator=(const CAutosave&) = delete;

    /// Copies go beside this file from now on; numbers go on after those that are there. The
    /// copies of the file before stay as they are.
    void Follow(const std::string& file);

    /// Writes a copy where the document has unsaved changes that the latest copy lacks, at most
    /// every 20 s and so that writing takes a twentieth of the time at most. nowS: a clock that
    /// does not go back, s. Failed: error says why, the copies are as they were; it is tried again
    /// after the interval.
    AUTOSAVE Tick(double nowS, T_FILE_ERROR& error);

    /// Removes the copies of the file: it was saved, or its changes were given up.
    void Remove();

    /// Copies of a file, the newest first, damaged ones too. Empty also while another program has
    /// one of them in use: it has not crashed.
    static std::vector<T_AUTOSAVE_COPY> Find(const std::string& file);
    /// The copy with the highest number whose content and checksums are right. 1 found; 0 none.
    [[nodiscard]] static int Newest(const std::string& file, T_AUTOSAVE_COPY& out);

private:
    int Write(T_FILE_ERROR& error);

    CDBDoc& m_doc;
    std::string m_file;
    long m_next = 1;
    long m_revision = -1; // of the document in the latest copy
    double m_dueS = 0.0;
    bool m_started = false;                                // the first tick has set the clock
    std::map<long, std::unique_ptr<CModelStore>> m_copies; // of this object, with their locks
};
