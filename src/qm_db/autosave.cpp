#include "qm_db/autosave.h"

#include "qm_base/textformat.h"
#include "qm_db/dbdoc.h"
#include "qm_db/file/foldernames.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/modellock.h"

#include <algorithm>
#include <charconv>
#include <chrono>
#include <filesystem>
#include <functional>
#include <optional>
#include <random>
#include <set>

namespace fs = std::filesystem;

namespace {

constexpr std::string_view kMark = ".auto-";
constexpr double kTimesWriting = 20.0; // of the time that a copy takes, between copies

std::string CopyPath(const std::string& file, const std::string& session, long sequence)
{
    return file + std::string(kMark) + session + '-' + std::to_string(sequence);
}

/// Two sessions never have the same name, on whatever machines they run.
std::string NewSession()
{
    std::random_device source;
    return FormatText("%08x%08x", source(), source());
}

/// "<session>-<sequence number>"; nothing for another text.
std::optional<T_AUTOSAVE_COPY> ParseCopy(std::string_view text)
{
    const auto dash = text.find('-');
    if (dash == text.npos || dash == 0) return std::nullopt;
    long sequence = 0;
    const char* const last = text.data() + text.size();
    const auto [stop, fault] = std::from_chars(text.data() + dash + 1, last, sequence);
    if (fault != std::errc() || stop != last || sequence <= 0) return std::nullopt;
    return T_AUTOSAVE_COPY{{}, std::string(text.substr(0, dash)), sequence};
}

/// Every copy of a file, the newest first.
std::vector<T_AUTOSAVE_COPY> AllCopies(const std::string& file)
{
    std::vector<T_AUTOSAVE_COPY> copies;
    const std::string begin = fs::path(file).filename().string() + std::string(kMark);
    for (const std::string& name : NamesBeside(file)) {
        if (!name.starts_with(begin)) continue;
        std::optional<T_AUTOSAVE_COPY> copy =
            ParseCopy(std::string_view(name).substr(begin.size()));
        if (!copy) continue;
        copy->path = CopyPath(file, copy->session, copy->sequence);
        copies.push_back(std::move(*copy));
    }
    std::ranges::sort(copies, std::greater<>(), &T_AUTOSAVE_COPY::sequence);
    return copies;
}

bool IsInUse(const std::string& path)
{
    try {
        return CModelLock::Take(path) == nullptr;
    } catch (const CStoreFault&) {
        return fs::exists(path);
    }
}

void RemoveFile(const std::string& path)
{
    std::error_code ignored; // what stays is found again
    fs::remove(path, ignored);
}

} // namespace

CAutosave::CAutosave(CDBDoc& doc) : m_doc(doc), m_session(NewSession()) {}
CAutosave::~CAutosave() = default;

void CAutosave::Follow(const std::string& file)
{
    m_copies.clear();
    m_taken.clear();
    m_session = NewSession(); // what stays beside the file before is no longer ours
    m_file = file;
    m_revision = -1;
    m_started = false;
    const auto copies = AllCopies(file);
    m_next = copies.empty() ? 1 : copies.front().sequence + 1;
}

AUTOSAVE CAutosave::Tick(double nowS, T_FILE_ERROR& error)
{
    const CDataCtrl& data = m_doc.Data();
    if (!m_started) m_dueS = nowS + m_intervalS;
    m_started = true;
    const bool changed = data.IsModified() && data.Revision() != m_revision;
    if (m_file.empty() || nowS < m_dueS || !changed || m_doc.IsExcuted()) return AUTOSAVE::Nothing;
    if (const CEditData* edit = data.Editor(); edit && edit->IsOpen()) return AUTOSAVE::Nothing;
    using CLOCK = std::chrono::steady_clock;
    const CLOCK::time_point begin = CLOCK::now();
    const int done = Write(error);
    const double tookS = std::chrono::duration<double>(CLOCK::now() - begin).count();
    m_dueS = nowS + std::max(m_intervalS, kTimesWriting * tookS);
    if (done) m_revision = data.Revision();
    return done ? AUTOSAVE::Written : AUTOSAVE::Failed;
}

int CAutosave::Write(T_FILE_ERROR& error)
{
    auto copy = m_copies.end();
    T_FILE_ERROR refusal, ignored;
    int isSaved = 0;
    const int isTried = Guarded(m_file, error, [&] {
        copy = m_copies.emplace(m_next, std::make_unique<CModelStore>()).first;
        const std::string path = CopyPath(m_file, m_session, m_next);
        isSaved = copy->second->Save(path, m_doc.Data().Content(), refusal);
    });
    if (isTried && !isSaved) error = std::move(refusal);
    if (!isSaved) {
        if (copy != m_copies.end()) m_copies.erase(copy);
        return 0;
    }
    ++m_next;
    (void)!Guarded(m_file, ignored, [&] { RemoveOld(); }); // they go next time
    return 1;
}

/// The new copy was verified (CModelStore::Save) before the oldest ones go.
void CAutosave::RemoveOld()
{
    std::size_t kept = 0;
    for (const T_AUTOSAVE_COPY& copy : AllCopies(m_file)) {
        const bool isTaken = m_taken.contains(copy.path);
        if ((copy.session != m_session && !isTaken) || ++kept <= kKept) continue;
        RemoveFile(copy.path);
        m_taken.erase(copy.path);
        m_copies.erase(copy.sequence);
    }
}

/// Files first: until they are gone nobody else may take them for those of a crash.
void CAutosave::Remove()
{
    for (const auto& entry : m_copies)
        RemoveFile(CopyPath(m_file, m_session, entry.first));
    for (const auto& entry : m_taken)
        RemoveFile(entry.first);
    m_copies.clear();
    m_taken.clear();
    m_revision = -1;
}

std::vector<T_AUTOSAVE_COPY> CAutosave::Find(const std::string& file)
{
    std::vector<T_AUTOSAVE_COPY> copies = AllCopies(file);
    std::set<std::string> running;
    for (const T_AUTOSAVE_COPY& copy : copies)
        if (IsInUse(copy.path)) running.insert(copy.session);
    std::erase_if(copies, [&](const auto& copy) { return running.contains(copy.session); });
    return copies;
}

int CAutosave::Newest(const std::string& file, T_AUTOSAVE_COPY& out)
{
    for (const T_AUTOSAVE_COPY& copy : Find(file)) {
        T_FILE_ERROR ignored; // of a damaged copy: the one before it is tried
        if (!CModelStore::CheckWhole(copy.path, ignored)) continue;
        out = copy;
        return 1;
    }
    return 0;
}

int CAutosave::TakeOver(const T_AUTOSAVE_COPY& copy)
{
    std::map<std::string, std::unique_ptr<CModelLock>> taken;
    try {
        for (const T_AUTOSAVE_COPY& other : AllCopies(m_file))
            if (other.session == copy.session) taken[other.path] = CModelLock::Take(other.path);
    } catch (const CStoreFault&) {
        return 0;
    }
    m_taken.merge(taken);
    return 1;
}
