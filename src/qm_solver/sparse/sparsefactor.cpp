#include "qm_solver/sparse/sparsefactor.h"

#include "qm_solver/sparse/equationorder.h"
#include "qm_solver/sparse/mumps.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace solver {

namespace {

constexpr int kMaxTries = 6;              // of a factorisation, each with twice the slack and more
constexpr double kMegaByte = 1.0e6;       // of INFOG
constexpr std::size_t kLeastSpace = 1000; // entries of a lent work array beyond the estimate

bool PatternIsValid(const T_SYMMETRIC_MATRIX& m)
{
    const std::size_t n = m.Size();
    if (n == 0) return m.column.empty() && m.value.empty();
    if (m.rowStart.front() != 0 || m.column.size() != m.value.size()) return false;
    if (static_cast<std::size_t>(m.rowStart.back()) != m.column.size()) return false;
    for (std::size_t i = 0; i < n; ++i) {
        if (m.rowStart[i + 1] < m.rowStart[i]) return false;
        int last = static_cast<int>(i) - 1; // of the upper triangle alone
        for (int k = m.rowStart[i]; k < m.rowStart[i + 1]; ++k) {
            const int c = m.column[static_cast<std::size_t>(k)];
            if (c <= last || static_cast<std::size_t>(c) >= n) return false;
            last = c;
        }
    }
    return true;
}

bool BlocksAreValid(std::span<const int> block, std::size_t n)
{
    if (block.size() != n) return false;
    int last = 0;
    for (std::size_t i = 0; i < n; ++i) {
        const bool next = i == 0 ? block[i] == 0 : block[i] == last || block[i] == last + 1;
        if (!next) return false;
        last = block[i];
    }
    return true;
}

bool AllFinite(std::span<const double> values)
{
    return std::all_of(values.begin(), values.end(), [](double v) { return std::isfinite(v); });
}

} // namespace

struct CFactorSpace::T_SPACE {
    std::unique_ptr<double[]> data;
    std::size_t size = 0, wanted = 0; // wanted: by the largest of those that share it
    const void* user = nullptr;       // whose factorisation is in it
};

CFactorSpace::CFactorSpace() : m_space(std::make_unique<T_SPACE>()) {}
CFactorSpace::~CFactorSpace() = default;

struct CSparseFactor::T_STATE {
    std::size_t n = 0;
    bool analysed = false, factored = false;
    std::vector<int> row, column, order; // numbered from 1
    std::unique_ptr<CMumps> mumps;       // after its arrays: it is destroyed before them
    T_FACTOR_INFO info;
    std::shared_ptr<CFactorSpace> space;

    int Fail(T_SOLVER_REASON& reason) const
    {
        reason = mumps->Words();
        return 0;
    }
    void Take(const T_SYMMETRIC_MATRIX& matrix);
    int Analyse(T_SOLVER_REASON& reason);
    int Factor(const T_SYMMETRIC_MATRIX& matrix, PIVOTS pivots, T_SOLVER_REASON& reason);
    int RunFactor();
    std::size_t SpaceFor(double slack) const
    {
        return static_cast<std::size_t>(mumps->SpaceEstimate() * slack) + kLeastSpace;
    }
    bool InSpace() const { return !space || space->m_space->user == this; }
    int Solve(std::span<double> rhs, std::size_t count, T_SOLVER_REASON& reason);
    void ReadInfo();
};

void CSparseFactor::T_STATE::Take(const T_SYMMETRIC_MATRIX& matrix)
{
    n = matrix.Size();
    row.reserve(matrix.column.size());
    column.reserve(matrix.column.size());
    for (std::size_t i = 0; i < n; ++i)
        for (int k = matrix.rowStart[i]; k < matrix.rowStart[i + 1]; ++k) {
            row.push_back(static_cast<int>(i) + 1);
            column.push_back(matrix.column[static_cast<std::size_t>(k)] + 1);
        }
}

int CSparseFactor::T_STATE::Analyse(T_SOLVER_REASON& reason)
{
    mumps = std::make_unique<CMumps>();
    if (mumps->Global(1) < 0) return Fail(reason);
    DMUMPS_STRUC_C& id = mumps->Id();
    id.n = static_cast<int>(n);
    id.nnz = static_cast<MUMPS_INT8>(row.size());
    id.irn = row.data();
    id.jcn = column.data();
    id.perm_in = order.data();
    if (mumps->Run(CMumps::kAnalyse) < 0) return Fail(reason);
    if (mumps->Global(7) != CMumps::kGivenOrder) {
        reason = {"IDS_QM_ENGINE_ORDERING", {std::to_string(mumps->Global(7))}};
        return 0;
    }
    if (space) space->m_space->wanted = std::max(space->m_space->wanted, SpaceFor(1.0));
    analysed = true;
    return 1;
}

int CSparseFactor::T_STATE::Factor(const T_SYMMETRIC_MATRIX& matrix, PIVOTS pivots,
                                   T_SOLVER_REASON& reason)
{
    // The library reads the values and does not write them.
    mumps->Id().a = const_cast<double*>(matrix.value.data());
    mumps->Control(24) = pivots == PIVOTS::Watch ? 1 : 0;
    int code = RunFactor();
    for (int tries = 1; (code == -8 || code == -9 || code == -11) && tries < kMaxTries; ++tries) {
        mumps->Control(14) = 2 * mumps->Control(14) + 50;
        code = RunFactor();
    }
    mumps->Id().a = nullptr;
    if (code < 0) return Fail(reason);
    ReadInfo();
    factored = true;
    return 1;
}

/// The estimate of the analysis holds the first slack already.
int CSparseFactor::T_STATE::RunFactor()
{
    if (!space) return mumps->Run(CMumps::kFactor);
    CFactorSpace::T_SPACE& own = *space->m_space;
    const double slack = (100.0 + mumps->Control(14)) / (100.0 + CMumps::kFirstSlackPct);
    own.wanted = std::max(own.wanted, SpaceFor(slack));
    if (own.size < own.wanted) {
        own.data.reset(); // the old memory goes first
        own.size = 0;
        own.data = std::make_unique_for_overwrite<double[]>(own.wanted);
        own.size = own.wanted;
    }
    own.user = this;
    mumps->Lend(own.data.get(), own.size);
    return mumps->Run(CMumps::kFactor);
}

void CSparseFactor::T_STATE::ReadInfo()
{
    info.factorBytes = mumps->GlobalCount(29) * static_cast<double>(sizeof(double));
    // The library counts whole megabytes: 0 for a small matrix.
    info.peakBytes = std::max(info.factorBytes, mumps->Global(22) * kMegaByte);
    info.negativePivots = static_cast<std::size_t>(mumps->Global(12));
    const int* list = mumps->Id().pivnul_list;
    const int count = list ? mumps->Global(28) : 0;
    for (int i = 0; i < count; ++i)
        info.nullPivots.push_back(static_cast<std::size_t>(list[i] - 1));
    std::sort(info.nullPivots.begin(), info.nullPivots.end());
}

int CSparseFactor::T_STATE::Solve(std::span<double> rhs, std::size_t count, T_SOLVER_REASON& reason)
{
    DMUMPS_STRUC_C& id = mumps->Id();
    id.lrhs = static_cast<int>(n);
    for (std::size_t first = 0; first < count; first += kRhsBlock) {
        id.nrhs = static_cast<int>(std::min(kRhsBlock, count - first));
        id.rhs = rhs.data() + first * n;
        if (mumps->Run(CMumps::kSolve) < 0) return Fail(reason);
    }
    id.rhs = nullptr;
    if (AllFinite(rhs)) return 1;
    reason = "IDS_QM_ENGINE_OVERFLOW";
    return 0;
}

CSparseFactor::CSparseFactor() = default;
CSparseFactor::~CSparseFactor() = default;
CSparseFactor::CSparseFactor(CSparseFactor&&) noexcept = default;
CSparseFactor& CSparseFactor::operator=(CSparseFactor&&) noexcept = default;

int CSparseFactor::Analyse(const T_SYMMETRIC_MATRIX& matrix, std::span<const int> block,
                           T_SOLVER_REASON& reason, std::shared_ptr<CFactorSpace> space)
{
    m_state.reset();
    const std::size_t n = matrix.Size();
    if (n > static_cast<std::size_t>(std::numeric_limits<int>::max()) || !PatternIsValid(matrix) ||
        !BlocksAreValid(block, n)) {
        reason = "IDS_QM_ENGINE_NOT_TRIANGLE";
        return 0;
    }
    auto state = std::make_unique<T_STATE>();
    state->Take(matrix);
    state->analysed = n == 0;
    state->space = std::move(space);
    if (n > 0) {
        state->order = EquationOrder(matrix, block);
        if (!state->Analyse(reason)) return 0;
    }
    m_state = std::move(state);
    return 1;
}

int CSparseFactor::Factor(const T_SYMMETRIC_MATRIX& matrix, T_SOLVER_REASON& reason, PIVOTS pivots)
{
    if (!m_state || !m_state->analysed || matrix.Size() != m_state->n ||
        matrix.value.size() != m_state->column.size()) {
        reason = "IDS_QM_ENGINE_OTHER_MATRIX";
        return 0;
    }
    m_state->factored = m_state->n == 0;
    m_state->info = {};
    if (!AllFinite(matrix.value)) {
        reason = "IDS_QM_ENGINE_NOT_A_NUMBER";
        return 0;
    }
    return m_state->n == 0 ? 1 : m_state->Factor(matrix, pivots, reason);
}

int CSparseFactor::Solve(std::span<double> rhs, std::size_t count, T_SOLVER_REASON& reason)
{
    if (!m_state || !m_state->factored || rhs.size() != m_state->n * count ||
        (m_state->n > 0 && !m_state->InSpace())) {
        reason = "IDS_QM_ENGINE_NO_FACTOR";
        return 0;
    }
    return m_state->n == 0 ? 1 : m_state->Solve(rhs, count, reason);
}

const T_FACTOR_INFO& CSparseFactor::Info() const
{
    static const T_FACTOR_INFO kNothing;
    return m_state ? m_state->info : kNothing;
}

} // namespace solver
