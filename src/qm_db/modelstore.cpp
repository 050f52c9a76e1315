#include "qm_db/modelstore.h"

#include "qm_db/file/newfile.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/modellock.h"
#include "qm_db/store/modelreader.h"

#include <cerrno>
#include <filesystem>
#include <fstream>
#include <optional>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

/// The file behind a link, so that a save replaces the file and not the link.
std::string RealPath(const std::string& path)
{
    std::error_code none;
    const fs::path real = fs::canonical(path, none);
    return none ? path : real.string();
}

/// Nothing for what is no model file (any more).
std::optional<std::uint64_t> StampAt(const std::string& path)
{
    try {
        return StampOfModelFile(path);
    } catch (const CStoreFault&) {
        return std::nullopt;
    }
}

/// The model and all sums were right after reading back; is it the model that was meant?
void Verify(const std::string& path, const T_MODEL& model)
{
    const T_MODEL_CONTENT read = ReadModelFile(path, CurrentSchema(), CHECK_DEPTH::Whole);
    if (read.model != model) throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NOT_SAVED");
}

} // namespace

CModelStore::CModelStore() = default;
CModelStore::~CModelStore() = default;

int CModelStore::Open(const std::string& path, OPEN_MODE mode, T_MODEL_CONTENT& out,
                      T_FILE_ERROR& error)
{
    return Guarded(path, error, [&] {
        std::unique_ptr<CModelLock> lock;
        const bool held = mode == OPEN_MODE::Edit && m_lock && m_lock->Holds(path);
        if (mode == OPEN_MODE::Edit) {
            if (!held) lock = CModelLock::Take(path);
        }
        CNewFile::SweepBeside(RealPath(path));
        // Before reading: a change between the two shows at the next save.
        const std::optional<std::uint64_t> stamp = StampAt(path);
        out = ReadModelFile(path, CurrentSchema(), CHECK_DEPTH::BySize);
        if (!held) m_lock = std::move(lock);
        m_known = RealPath(path);
        m_stamp = stamp.value_or(0);
    });
}

int CModelStore::Save(const std::string& path, const T_MODEL_CONTENT& content, T_FILE_ERROR& error)
{
    return Guarded(path, error, [&] {
        const std::string target = RealPath(path);
        std::unique_ptr<CModelLock> lock; // of the file that is replaced
        std::error_code ignored;
        if (fs::exists(target, ignored)) {
            if (!m_lock || !m_lock->Holds(target)) lock = CModelLock::Take(target);
            if (::access(target.c_str(), W_OK) != 0)
                ThrowSystem("IDS_QM_DB_FILE_CANT_WRITE", errno);
            if (m_known == target && StampAt(target) != m_stamp)
                throw CStoreFault(FILE_FAULT::Changed, "IDS_QM_DB_FILE_CHANGED");
        }
        CNewFile temp(target, "IDS_QM_DB_FILE_CANT_WRITE");
        WriteModelFile(temp.Path(), content);
        temp.Flush();
        Verify(temp.Path(), content.model);
        const std::uint64_t stamp = StampOfModelFile(temp.Path());
        auto next = std::make_unique<CModelLock>(CFileHandle(-1));
        std::string known = target;
        *next = CModelLock(temp.ReplaceTarget()); // nothing behind this can fail
        m_lock = std::move(next);
        m_known = std::move(known);
        m_stamp = stamp;
    });
}

int CModelStore::CheckWhole(const std::string& path, T_FILE_ERROR& error)
{
    return Guarded(path, error,
                   [&] { (void)ReadModelFile(path, CurrentSchema(), CHECK_DEPTH::Whole); });
}

bool CModelStore::IsModelFile(const std::string& path)
{
    if (path.ends_with(".qmdb")) return true;
    constexpr std::string_view kMagic = "SQLite format 3";
    std::array<char, kMagic.size()> head{};
    std::ifstream file(path, std::ios::binary);
    file.read(head.data(), head.size());
    return file && std::string_view(head.data(), head.size()) == kMagic;
}

void CModelStore::Close()
{
    m_lock.reset();
    m_known.clear();
}
