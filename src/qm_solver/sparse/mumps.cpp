#include "qm_solver/sparse/mumps.h"

#include "qm_solver/libraryspace.h"
#include "qm_solver/sparse/librarylock.h"

#include <algorithm>
#include <array>
#include <limits>
#include <new>

namespace solver {

namespace {

constexpr int kJobInit = -1, kJobEnd = -2;
constexpr int kCommWorld = -987654; // the sequential library's stand-in for a communicator
constexpr int kIndefinite = 2;      // SYM: 1 would let singular matrices pass without a word
constexpr std::size_t kMillion = 1000000;
constexpr std::size_t kIntMax = std::numeric_limits<int>::max();

struct T_ERROR_WORDS {
    int code;
    const char* key;
};

constexpr std::array<T_ERROR_WORDS, 10> kErrors{{
    {-6, "IDS_QM_ENGINE_SINGULAR_PATTERN"},
    {-8, "IDS_QM_ENGINE_FACTOR_SPACE"},
    {-9, "IDS_QM_ENGINE_FACTOR_SPACE"},
    {-10, "IDS_QM_ENGINE_SINGULAR"},
    {-11, "IDS_QM_ENGINE_FACTOR_SPACE"},
    {-14, "IDS_QM_ENGINE_SOLVE_SPACE"},
    {-16, "IDS_QM_ENGINE_EQUATIONS"},
    {-19, "IDS_QM_ENGINE_MEMORY_LIMIT"},
    {-51, "IDS_QM_ENGINE_TOO_LARGE"},
    {-52, "IDS_QM_ENGINE_TOO_LARGE"},
}};

constexpr std::array kNoMemory{-5, -7, -13}; // an allocation of the library failed

double Count(double raw)
{
    return raw < 0.0 ? -raw * double{kMillion} : raw;
}

} // namespace

CMumps::CMumps()
{
    NeedLibrarySpace();
    m_id.par = 1;
    m_id.sym = kIndefinite;
    m_id.comm_fortran = kCommWorld;
    Run(kJobInit);
    for (int i : {1, 2, 3, 4})
        Control(i) = 0; // nothing is printed
    Control(6) = 0;     // no column permutation: it would overrule the order
    Control(7) = kGivenOrder;
    Control(12) = 1; // order of the matrix itself, not of a compressed one
    Control(13) = 1; // the last block in the same code: exact counts of pivots
    Control(14) = kFirstSlackPct;
    Control(27) = static_cast<int>(kRhsBlock);
    Control(28) = 1; // sequential analysis
}

CMumps::~CMumps()
{
    Run(kJobEnd);
}

int CMumps::Run(int job)
{
    const std::lock_guard<std::mutex> guard(LibraryLock());
    m_id.job = job;
    dmumps_c(&m_id);
    return m_id.infog[0];
}

T_SOLVER_REASON CMumps::Words() const
{
    const int code = Global(1);
    if (std::ranges::find(kNoMemory, code) != kNoMemory.end()) throw std::bad_alloc();
    const auto row =
        std::find_if(kErrors.begin(), kErrors.end(), [&](const auto& r) { return r.code == code; });
    const char* key = row == kErrors.end() ? "IDS_QM_ENGINE_SPARSE_FAILED" : row->key;
    return {"IDS_QM_ENGINE_SPARSE_CODE", {key, std::to_string(code), std::to_string(Global(2))}};
}

double CMumps::GlobalCount(int i) const
{
    return Count(Global(i));
}

double CMumps::SpaceEstimate() const
{
    return Count(m_id.info[7]);
}

void CMumps::Lend(double* space, std::size_t size)
{
    m_id.wk_user = space;
    m_id.lwk_user = size <= kIntMax ? static_cast<int>(size) : -static_cast<int>(size / kMillion);
}

} // namespace solver
