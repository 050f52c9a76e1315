#include "qm_solver/sparse/sparsefactor.h"

#include "qm_base/textformat.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <mutex>
#include <new>

#include <dmumps_c.h>
#include <metis.h>

namespace solver {

namespace {

static_assert(sizeof(MUMPS_INT) == sizeof(int) && sizeof(idx_t) == sizeof(int));

constexpr int kJobInit = -1, kJobEnd = -2, kJobAnalyse = 1, kJobFactor = 2, kJobSolve = 3;
constexpr int kCommWorld = -987654;       // the sequential library's stand-in for a communicator
constexpr int kIndefinite = 2;            // SYM: 1 would let singular matrices pass without a word
constexpr int kGivenOrder = 1;            // ICNTL(7)
constexpr int kFirstSlackPct = 30;        // ICNTL(14): memory beyond the estimate
constexpr int kMaxTries = 6;              // of a factorisation, each with twice the slack and more
constexpr std::size_t kRhsBlock = 64;     // about ten times cheaper per side than single solves
constexpr double kMegaByte = 1.0e6;       // of INFOG
constexpr std::size_t kLeastSpace = 1000; // entries of a lent work array beyond the estimate

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

std::string Words(int code, int detail)
{
    const auto row =
        std::find_if(kErrors.begin(), kErrors.end(), [&](const auto& r) { return r.code == code; });
    const char* words = row == kErrors.end() ? "the sparse solver failed" : row->words;
    return FormatText("%s (MUMPS %d, %d)", words, code, detail);
}

/// The library keeps state that all its instances share: two instances used from two threads at
/// once crash. Every call goes through this lock.
std::mutex& ProcessLock()
{
    static std::mutex lock;
    return lock;
}

/// One MUMPS instance: job -1 when made, job -2 when destroyed.
class CMumps {
public:
    CMumps()
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
    ~CMumps() { Run(kJobEnd); }
    CMumps(const CMumps&) = delete;
    CMumps& operator=(const CMumps&) = delete;

    /// Runs a phase and returns INFOG(1).
    int Run(int job)
    {
        const std::lock_guard<std::mutex> guard(ProcessLock());
        m_id.job = job;
        dmumps_c(&m_id);
        return m_id.infog[0];
    }
    DMUMPS_STRUC_C& Id() { return m_id; }
    int& Control(int i) { return m_id.icntl[i - 1]; } // numbered as in the library's guide
    int Global(int i) const { return m_id.infog[i - 1]; }
    /// Counts that do not fit are given in millions, negative.
    double GlobalCount(int i) const { return Count(Global(i)); }
    /// Entries of the main work array that the analysis estimates.
    double SpaceEstimate() const { return Count(m_id.info[7]); }
    /// Lends the library its main work array.
    void Lend(double* space, std::size_t size)
    {
        m_id.wk_user = space;
        m_id.lwk_user =
            size <= kIntMax ? static_cast<int>(size) : -static_cast<int>(size / kMillion);
    }

private:
    static constexpr std::size_t kMillion = 1000000;
    static constexpr std::size_t kIntMax = std::numeric_limits<int>::max();
    static double Count(double raw) { return raw < 0.0 ? -raw * double{kMillion} : raw; }

    DMUMPS_STRUC_C m_id{};
};

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

/// The graph of the blocks, both directions of each edge, without loops.
struct T_GRAPH {
    std::vector<idx_t> start, neighbour, weight; // weight: equations of the block
};

T_GRAPH BlockGraph(const T_SYMMETRIC_MATRIX& m, std::span<const int> block)
{
    const auto blocks = static_cast<std::size_t>(block.back()) + 1;
    std::vector<std::vector<idx_t>> above(blocks); // neighbours with a higher number
    T_GRAPH graph;
    graph.weight.assign(blocks, 0);
    std::vector<int> seenBy(blocks, -1);
    for (std::size_t i = 0; i < m.Size(); ++i) {
        const auto own = static_cast<std::size_t>(block[i]);
        ++graph.weight[own];
        seenBy[own] = block[i];
        for (int k = m.rowStart[i]; k < m.rowStart[i + 1]; ++k) {
            const int other =
                block[static_cast<std::size_t>(m.column[static_cast<std::size_t>(k)])];
            int& seen = seenBy[static_cast<std::size_t>(other)];
            if (seen == block[i]) continue;
            seen = block[i];
            above[own].push_back(other);
        }
    }
    graph.start.assign(blocks + 1, 0);
    for (std::size_t b = 0; b < blocks; ++b) {
        graph.start[b + 1] += static_cast<idx_t>(above[b].size());
        for (idx_t other : above[b])
            ++graph.start[static_cast<std::size_t>(other) + 1];
    }
    for (std::size_t b = 0; b < blocks; ++b)
        graph.start[b + 1] += graph.start[b];
    graph.neighbour.resize(static_cast<std::size_t>(graph.start.back()));
    std::vector<idx_t> next(graph.start.begin(), graph.start.end() - 1);
    for (std::size_t b = 0; b < blocks; ++b)
        for (idx_t other : above[b]) {
            const auto o = static_cast<std::size_t>(other);
            graph.neighbour[static_cast<std::size_t>(next[b]++)] = other;
            graph.neighbour[static_cast<std::size_t>(next[o]++)] = static_cast<idx_t>(b);
        }
    return graph;
}

/// Position of each block in the order of elimination. Nested dissection; where the library has
/// nothing to dissect or fails, the order that is there.
std::vector<idx_t> BlockOrder(T_GRAPH& graph)
{
    auto blocks = static_cast<idx_t>(graph.weight.size());
    std::vector<idx_t> atPosition(graph.weight.size()), position(graph.weight.size());
    const auto keep = [&] {
        for (idx_t b = 0; b < blocks; ++b)
            position[static_cast<std::size_t>(b)] = b;
    };
    if (graph.neighbour.empty()) {
        keep();
        return position;
    }
    std::array<idx_t, METIS_NOPTIONS> options{};
    METIS_SetDefaultOptions(options.data());
    options[METIS_OPTION_SEED] = 1; // the same order in every run
    const std::lock_guard<std::mutex> guard(ProcessLock());
    if (METIS_NodeND(&blocks, graph.start.data(), graph.neighbour.data(), graph.weight.data(),
                     options.data(), atPosition.data(), position.data()) != METIS_OK)
        keep();
    return position;
}

/// PERM_IN: position of each equation, from 1; equations of a block follow each other.
std::vector<int> EquationOrder(std::span<const int> block, std::span<const idx_t> position,
                               std::span<const idx_t> weight)
{
    std::vector<int> first(weight.size() + 1, 1), at(weight.size());
    for (std::size_t b = 0; b < weight.size(); ++b)
        first[static_cast<std::size_t>(position[b]) + 1] = weight[b];
    for (std::size_t p = 1; p < first.size(); ++p)
        first[p] += first[p - 1];
    for (std::size_t b = 0; b < weight.size(); ++b)
        at[b] = first[static_cast<std::size_t>(position[b])];
    std::vector<int> order(block.size());
    for (std::size_t i = 0; i < block.size(); ++i)
        order[i] = at[static_cast<std::size_t>(block[i])]++;
    return order;
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

    int Fail(std::string& reason) const
    {
        reason = Words(mumps->Global(1), mumps->Global(2));
        return 0;
    }
    void Take(const T_SYMMETRIC_MATRIX& matrix);
    int Analyse(std::string& reason);
    int Factor(const T_SYMMETRIC_MATRIX& matrix, PIVOTS pivots, std::string& reason);
    int RunFactor();
    std::size_t SpaceFor(double slack) const
    {
        return static_cast<std::size_t>(mumps->SpaceEstimate() * slack) + kLeastSpace;
    }
    bool InSpace() const { return !space || space->m_space->user == this; }
    int Solve(std::span<double> rhs, std::size_t count, std::string& reason);
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

int CSparseFactor::T_STATE::Analyse(std::string& reason)
{
    mumps = std::make_unique<CMumps>();
    if (mumps->Global(1) < 0) return Fail(reason);
    DMUMPS_STRUC_C& id = mumps->Id();
    id.n = static_cast<int>(n);
    id.nnz = static_cast<MUMPS_INT8>(row.size());
    id.irn = row.data();
    id.jcn = column.data();
    id.perm_in = order.data();
    if (mumps->Run(kJobAnalyse) < 0) return Fail(reason);
    if (mumps->Global(7) != kGivenOrder) {
        reason = FormatText("the sparse solver took ordering %d in place of the given one",
                            mumps->Global(7));
        return 0;
    }
    if (space) space->m_space->wanted = std::max(space->m_space->wanted, SpaceFor(1.0));
    analysed = true;
    return 1;
}

int CSparseFactor::T_STATE::Factor(const T_SYMMETRIC_MATRIX& matrix, PIVOTS pivots,
                                   std::string& reason)
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
    if (!space) return mumps->Run(kJobFactor);
    CFactorSpace::T_SPACE& own = *space->m_space;
    const double slack = (100.0 + mumps->Control(14)) / (100.0 + kFirstSlackPct);
    own.wanted = std::max(own.wanted, SpaceFor(slack));
    if (own.size < own.wanted) {
        own.data.reset(); // the old memory goes first
        own.size = 0;
        own.data = std::make_unique_for_overwrite<double[]>(own.wanted);
        own.size = own.wanted;
    }
    own.user = this;
    mumps->Lend(own.data.get(), own.size);
    return mumps->Run(kJobFactor);
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

int CSparseFactor::T_STATE::Solve(std::span<double> rhs, std::size_t count, std::string& reason)
{
    DMUMPS_STRUC_C& id = mumps->Id();
    id.lrhs = static_cast<int>(n);
    for (std::size_t first = 0; first < count; first += kRhsBlock) {
        id.nrhs = static_cast<int>(std::min(kRhsBlock, count - first));
        id.rhs = rhs.data() + first * n;
        if (mumps->Run(kJobSolve) < 0) return Fail(reason);
    }
    id.rhs = nullptr;
    if (AllFinite(rhs)) return 1;
    reason = "the solution overflows";
    return 0;
}

CSparseFactor::CSparseFactor() = default;
CSparseFactor::~CSparseFactor() = default;
CSparseFactor::CSparseFactor(CSparseFactor&&) noexcept = default;
CSparseFactor& CSparseFactor::operator=(CSparseFactor&&) noexcept = default;

int CSparseFactor::Analyse(const T_SYMMETRIC_MATRIX& matrix, std::span<const int> block,
                           std::string& reason, std::shared_ptr<CFactorSpace> space)
try {
    m_state.reset();
    const std::size_t n = matrix.Size();
    if (n > static_cast<std::size_t>(std::numeric_limits<int>::max()) || !PatternIsValid(matrix) ||
        !BlocksAreValid(block, n)) {
        reason = "the pattern of the matrix is not an upper triangle by rows";
        return 0;
    }
    auto state = std::make_unique<T_STATE>();
    state->Take(matrix);
    state->analysed = n == 0;
    state->space = std::move(space);
    if (n > 0) {
        T_GRAPH graph = BlockGraph(matrix, block);
        const std::vector<idx_t> position = BlockOrder(graph);
        state->order = EquationOrder(block, position, graph.weight);
        if (!state->Analyse(reason)) return 0;
    }
    m_state = std::move(state);
    return 1;
} catch (const std::bad_alloc&) {
    reason = "not enough memory to analyse the matrix";
    return 0;
}

int CSparseFactor::Factor(const T_SYMMETRIC_MATRIX& matrix, std::string& reason, PIVOTS pivots)
try {
    if (!m_state || !m_state->analysed || matrix.Size() != m_state->n ||
        matrix.value.size() != m_state->column.size()) {
        reason = "the matrix is not the one that was analysed";
        return 0;
    }
    m_state->factored = m_state->n == 0;
    m_state->info = {};
    if (!AllFinite(matrix.value)) {
        reason = "the matrix holds a value that is no number";
        return 0;
    }
    return m_state->n == 0 ? 1 : m_state->Factor(matrix, pivots, reason);
} catch (const std::bad_alloc&) {
    reason = "not enough memory to factorise the matrix";
    return 0;
}

int CSparseFactor::Solve(std::span<double> rhs, std::size_t count, std::string& reason)
{
    if (!m_state || !m_state->factored || rhs.size() != m_state->n * count ||
        (m_state->n > 0 && !m_state->InSpace())) {
        reason = "no factorisation of the right-hand sides' size";
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
