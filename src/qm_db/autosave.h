// Copies of a document beside its file, for the case that the program ends without saving it.
//
// A copy is a whole model file, "<file>.auto-<session>-<sequence number>", written as every model
// file is: a temporary file, read back and compared, renamed. It belongs to one session, which
// holds its lock: so nobody else takes it for one that a crash has left, or removes it. The newest
// three of a session are kept; an older one goes only when a newer one has been verified. File
// dates are never asked for.
#pragma once

#include "qm_db/modelstore.h"

#include <map>
#include <memory>
#include <vector>

class CDBDoc;

struct T_AUTOSAVE_COPY {
    std::string path;
    std::string session;
    long sequence = 0;
    bool operator==(const T_AUTOSAVE_COPY&) const = default;
};

enum class AUTOSAVE { Nothing, Written, Failed };

class CAutosave {
public:
    static constexpr double kIntervalS = 20.0;
    static constexpr std::size_t kKept = 3;

    /// The document must outlive the object.
    explicit CAutosave(CDBDoc& doc);
    ~CAutosave();
    CAutosave(const CAutosave&) = delete;
    CAutosave& operator=(const CAutosave&) = delete;

    /// Least time between two copies, s; kIntervalS until then.
    void SetInterval(double seconds)
    {
        m_dueS += seconds - m_intervalS; // the next copy, too
        m_intervalS = seconds;
    }
    /// Copies go beside this file from now on; numbers go on after those that are there. The
    /// copies of the file before stay as they are: Remove comes first where they are not wanted.
    void Follow(const std::string& file);
    const std::string& File() const { return m_file; }

    /// Writes a copy where the document has unsaved changes that the latest copy lacks, at most
    /// every interval and so that writing takes a twentieth of the time at most. nowS: a clock that
    /// does not go back, s. Failed: error says why, the copies are as they were; it is tried again
    /// after the interval.
    AUTOSAVE Tick(double nowS, T_FILE_ERROR& error);

    /// Removes the copies of this session: the document was saved, or its changes were given up.
    void Remove();

    /// Copies of a file that sessions which ended without removing them have left, the newest
    /// first, damaged ones too. A session that has one of its copies in use has not ended.
    static std::vector<T_AUTOSAVE_COPY> Find(const std::string& file);
    /// The copy with the highest number whose content and checksums are right. 1 found; 0 none.
    [[nodiscard]] static int Newest(const std::string& file, T_AUTOSAVE_COPY& out);
    /// Makes the copies of that ended session those of this one, so that Remove removes them. 1
    /// done; 0 somebody else has taken them.
    [[nodiscard]] int TakeOver(const T_AUTOSAVE_COPY& copy);

private:
    int Write(T_FILE_ERROR& error);
    void RemoveOld();

    CDBDoc& m_doc;
    std::string m_file;
    long m_next = 1;
    long m_revision = -1; // of the document in the latest copy
    double m_dueS = 0.0;
    double m_intervalS = kIntervalS;
    bool m_started = false;                                     // the first tick has set the clock
    std::string m_session;                                      // of this object
    std::map<std::string, std::unique_ptr<CModelLock>> m_taken; // copies of an ended session
    std::map<long, std::unique_ptr<CModelStore>> m_copies;      // of this object, with their locks
};
