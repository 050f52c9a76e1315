#include "qm_solver/sparse/mumps.h"

#include "qm_base/textformat.h"
#include "qm_solver/sparse/librarylock.h"

#include <algorithm>
#include <array>
#include <limits>

namespace solver {

namespace {

constexpr int kJobInit = -1, kJobEnd = -2;
constexpr int kCommWorld = -987654; // the sequential library's stand-in for a communicator
constexpr int kIndefinite = 2;      // SYM: 1 would let singular matrices pass without a word
constexpr std::size_t kMillion = 1000000;
constexpr std::size_t kIntMax = std::numeric_limits<int>::max();

struct T_ERROR_WORDS {
    int code;
    const char* words;
};

constexpr std::array<T_ERROR_WORDS, 13> kErrors{{
    {-5, "not enough memory to analyse the matrix"},
    {-6, "the matrix is singular in structure"},
    {-7, "not enough memory to analyse the matrix"},
    {-8, "the factorisation ran out of work space"},
    {-9, "the factorisation ran out of work space"},
    {-10, "the matrix is singular"},
    {-11, "the factorisation ran out of work space"},
    {-13, "not enough memory to factorise the matrix"},
    {-14, "the solution ran out of work space"},
    {-16, "the number of equations is out of range"},
    {-19, "the memory limit of the factorisation is too small"},
    {-51, "the matrix is too large for the ordering"},
    {-52, "the matrix is too large for the ordering"},
}};

double Count(double raw)
{
    return raw < 0.0 ? -raw * double{kMillion} : raw;
}

} // namespace

CMumps::CMumps()
{
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

std::string CMumps::Words() const
{
    const int code = Global(1);
    const auto row =
        std::find_if(kErrors.begin(), kErrors.end(), [&](const auto& r) { return r.code == code; });
    const char* words = row == kErrors.end() ? "the sparse solver failed" : row->words;
    return FormatText("%s (MUMPS %d, %d)", words, code, Global(2));
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
