#include "qm_db/autosave.h"

#include "qm_db/dbdoc.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/modellock.h"

#include <algorithm>
#include <charconv>
#include <chrono>
#include <filesystem>

namespace fs = std::filesystem;

namespace {

constexpr std::string_view kMark = ".auto-";
constexpr double kTimesWriting = 20.0; // of the time that a copy takes, between copies

std::string CopyPath(const std::string& file, long sequence)
{
    return file + std::string(kMark) + std::to_string(sequence);
}

/// Every copy of a file, the newest first.
std::vector<T_AUTOSAVE_COPY> AllCopies(const std::string& file)
{
    std::vector<T_AUTOSAVE_COPY> copies;
    const fs::path path(file);
    const fs::path folder = path.has_parent_path() ? path.parent_path() : fs::path(".");
    const std::string begin = path.filename().string() + std::string(kMark);
    std::error_code none;
    for (fs::directory_iterator it(folder, none), end; !none && it != end; it.increment(none)) {
        const std::string name = it->path().filename().string();
        if (!name.starts_with(begin)) continue;
        long sequence = 0;
        const char* const last = name.data() + name.size();
        const auto [stop, fault] = std::from_chars(name.data() + begin.size(), last, sequence);
        if (fault == std::errc() && stop == last && sequence > 0)
            copies.push_back({CopyPath(file, sequence), sequence});
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

CAutosave::~CAutosave() = default;

void CAutosave::Follow(const std::string& file)
{
    m_copies.clear();
    m_file = file;
    m_revision = -1;
    m_started = false;
    const auto copies = AllCopies(file);
    m_next = copies.empty() ? 1 : copies.front().sequence + 1;
}

AUTOSAVE CAutosave::Tick(double nowS, T_FILE_ERROR& error)
{
    const CDataCtrl& data = m_doc.Data();
    if (!m_started) m_dueS = nowS + kIntervalS;
    m_started = true;
    const bool changed = data.IsModified() && data.Revision() != m_revision;
    if (m_file.empty() || nowS < m_dueS || !changed || m_doc.IsExcuted()) return AUTOSAVE::Nothing;
    if (const CEditData* edit = data.Editor(); edit && edit->IsOpen()) return AUTOSAVE::Nothing;
    using CLOCK = std::chrono::steady_clock;
    const CLOCK::time_point begin = CLOCK::now();
    const int done = Write(error);
    const double tookS = std::chrono::duration<double>(CLOCK::now() - begin).count();
    m_dueS = nowS + std::max(kIntervalS, kTimesWriting * tookS);
    if (done) m_revision = data.Revision();
    return done ? AUTOSAVE::Written : AUTOSAVE::Failed;
}

/// The new copy is verified (CModelStore::Save) before the oldest ones go.
int CAutosave::Write(T_FILE_ERROR& error)
{
    auto store = std::make_unique<CModelStore>();
    if (!store->Save(CopyPath(m_file, m_next), m_doc.Data().Content(), error)) return 0;
    m_copies[m_next++] = std::move(store);
    const auto copies = AllCopies(m_file);
    for (std::size_t i = kKept; i < copies.size(); ++i) {
        m_copies.erase(copies[i].sequence);
        RemoveFile(copies[i].path);
    }
    return 1;
}

void CAutosave::Remove()
{
    m_copies.clear();
    for (const T_AUTOSAVE_COPY& copy : AllCopies(m_file))
        RemoveFile(copy.path);
    m_revision = -1;
}

std::vector<T_AUTOSAVE_COPY> CAutosave::Find(const std::string& file)
{
    std::vector<T_AUTOSAVE_COPY> copies = AllCopies(file);
    if (std::ranges::any_of(copies, [](const auto& copy) { return IsInUse(copy.path); }))
        copies.clear();
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
