#include "qm_solver/factors/ulfactiveset.h"

#include "qm_solver/ulfproblem.h"

#define EIGEN_MPL2_ONLY
#include <Eigen/Dense>
#include <algorithm>
#include <array>
#include <cmath>
#include <functional>

namespace {

constexpr std::size_t kNone = static_cast<std::size_t>(-1);
constexpr long double kNever = std::numeric_limits<long double>::infinity();
constexpr double kMeetTol = 1e-12;  // a row is met in double precision; below kUlfFeasibleTol
constexpr double kExactTol = 1e-15; // a row is met in long double
// Part of a unit normal outside the active ones that is rounding, by precision.
constexpr std::array<long double, 2> kDependentTol{1e-11L, 1e-15L};
constexpr double kNearTol = 1e-5;              // below it the part is computed in long double
constexpr double kRatioTol = 1e-11;            // weight of an active normal that can block a step
constexpr long double kMultiplierTol = 1e-11L; // relative to the largest multiplier
constexpr int kRefinements = 6;
constexpr int kStepsPerRow = 60;

long double Norm(std::span<const long double> v)
{
    long double sum = 0.0L;
    for (long double e : v)
        sum += e * e;
    return std::sqrt(sum);
}

long double Largest(std::span<const long double> v)
{
    long double most = 0.0L;
    for (long double e : v)
        most = std::max(most, std::fabs(e));
    return most;
}

} // namespace

CUlfActiveSet::CUlfActiveSet(const T_ULF_ROWS& rows, ULF_PRECISION precision)
    : m_rows(rows), m_precision(precision), m_factor(MakeUlfFactor(rows.nVar, precision)),
      m_g(rows.nVar), m_y(rows.nVar), m_orient(rows.Size(), 1.0), m_state(rows.Size(), 0),
      m_slack(rows.nWideRows), m_yFast(rows.nVar),
      m_stepLimit(kStepsPerRow * static_cast<int>(rows.nVar + 50) +
                  10 * static_cast<int>(rows.Size()))
{
}

void CUlfActiveSet::SetObjective(std::span<const double> gradient, double capFactor)
{
    m_capFactor = capFactor;
    m_g = OnThisSide(gradient, capFactor);
    Refine();
    Repair();
}

void CUlfActiveSet::Start(std::span<const std::size_t> rows)
{
    for (std::size_t row : rows) {
        Direct(row);
        if (!IsDependent()) Activate(row, 0.0L);
    }
    Refine();
}

ULF_STEP CUlfActiveSet::Solve(std::size_t begin, std::size_t end)
{
    for (std::size_t i = begin; i < end; ++i) { // equalities first: they never leave
        if (!m_rows.equality[i] || m_state[i]) continue;
        const ULF_STEP step = Add(i);
        if (step != ULF_STEP::Done) return step;
    }
    for (;;) {
        std::size_t row = WorstFast(end);
        if (row == kNone) {
            Refine();
            if (Repair()) continue;
            row = WorstExact(end);
            if (row == kNone) return ULF_STEP::Done;
        }
        const ULF_STEP step = Add(row);
        if (step != ULF_STEP::Done) return step;
    }
}

std::vector<long double> CUlfActiveSet::Multipliers() const
{
    std::vector<long double> all(m_rows.Size(), 0.0L);
    for (std::size_t i = 0; i < m_active.size(); ++i)
        all[m_active[i]] = m_orient[m_active[i]] * m_u[i];
    return all;
}

std::vector<long double> CUlfActiveSet::MultipliersOf(std::span<const double> cost,
                                                      double capFactor) const
{
    const std::vector<long double> sided = OnThisSide(cost, capFactor);
    std::vector<long double> u(m_active.size()), all(m_rows.Size());
    const std::vector<long double> none(m_active.size(), 0.0);
    std::vector<long double> z, r;
    for (int pass = 0; pass < kRefinements; ++pass) {
        std::vector<long double> rest(sided.size());
        std::transform(sided.begin(), sided.end(), rest.begin(), std::negate<>());
        for (std::size_t i = 0; i < u.size(); ++i)
            m_rows.AddTo(m_active[i], -m_orient[m_active[i]] * u[i], rest);
        m_factor->Solve(rest, none, z, r);
        for (std::size_t i = 0; i < r.size(); ++i)
            u[i] += r[i];
    }
    for (std::size_t i = 0; i < u.size(); ++i)
        all[m_active[i]] = m_orient[m_active[i]] * u[i];
    return all;
}

/// The gradient with the full cost of the elastic rows that are violated.
std::vector<long double> CUlfActiveSet::OnThisSide(std::span<const double> gradient,
                                                   double capFactor) const
{
    std::vector<long double> g(gradient.begin(), gradient.end());
    for (std::size_t i = 0; i < m_rows.Size(); ++i)
        if (m_orient[i] < 0.0 && !m_rows.equality[i])
            m_rows.AddTo(i, m_rows.cap[i] * static_cast<long double>(capFactor), g);
    return g;
}

long double CUlfActiveSet::Tolerance(double relative) const
{
    return relative * std::max(1.0L, Norm(m_y));
}

long double CUlfActiveSet::Cap(std::size_t row) const
{
    return m_rows.cap[row] * static_cast<long double>(m_capFactor);
}

long double CUlfActiveSet::Violation(std::size_t row) const
{
    return m_orient[row] * (m_rows.Dot(row, m_y) - m_rows.rhs[row]);
}

/// The most violated row in double precision.
std::size_t CUlfActiveSet::WorstFast(std::size_t end)
{
    using Eigen::Index;
    std::transform(m_y.begin(), m_y.end(), m_yFast.begin(),
                   [](long double v) { return static_cast<double>(v); });
    const std::size_t wide = std::min(end, m_rows.nWideRows);
    const auto rows = static_cast<Index>(wide), cols = static_cast<Index>(m_rows.nWide);
    using T_ROWS = Eigen::Matrix<double, Eigen::Dynamic, Eigen::Dynamic, Eigen::RowMajor>;
    Eigen::Map<Eigen::VectorXd>(m_slack.data(), rows).noalias() =
        Eigen::Map<const T_ROWS>(m_rows.wide.data(), rows, cols) *
        Eigen::Map<const Eigen::VectorXd>(m_yFast.data(), cols);
    double most = static_cast<double>(Tolerance(kMeetTol));
    std::size_t worst = kNone;
    for (std::size_t i = 0; i < end; ++i) {
        if (m_state[i]) continue;
        double v = -m_rows.rhs[i];
        if (const T_ULF_SHORT_ROW* s = m_rows.Short(i))
            v += s->a * m_yFast[s->j] + s->b * m_yFast[s->k];
        else
            v += m_slack[i];
        v *= m_orient[i];
        if (v > most) {
            most = v;
            worst = i;
        }
    }
    return worst;
}

std::size_t CUlfActiveSet::WorstExact(std::size_t end) const
{
    long double most = Tolerance(kExactTol);
    std::size_t worst = kNone;
    for (std::size_t i = 0; i < end; ++i) {
        if (m_state[i]) continue;
        const long double v = Violation(i);
        if (v > most) {
            most = v;
            worst = i;
        }
    }
    return worst;
}

/// Steps until the row is met, dropping the rows that block (Goldfarb and Idnani, section 3).
ULF_STEP CUlfActiveSet::Add(std::size_t row)
{
    if (m_rows.equality[row] && Violation(row) < 0.0L) m_orient[row] = -1.0;
    long double multiplier = 0.0L;
    for (bool hasTurned = false;;) {
        if (++m_steps > m_stepLimit) return ULF_STEP::Limit;
        Direct(row);
        const bool free = !IsDependent();
        const long double full = free ? Violation(row) / m_dir.zz : kNever;
        const long double room = Cap(row) - multiplier;
        const T_RATIO block = DualRatio();
        const long double t = std::min({full, block.t, room});
        if (t == kNever) {
            if (hasTurned || !TurnsRound(row)) return GiveUp(row, multiplier);
            hasTurned = true;
            continue;
        }
        Move(t, free);
        multiplier += t;
        if (t == full)
            Activate(row, multiplier);
        else if (t == block.t)
            Drop(block.at);
        else
            Flip(row);
        if (t == full || t != block.t) return ULF_STEP::Done;
    }
}

/// An equality that is met, and that only inequalities keep met, must become active all the same:
/// from the other side one of them gives way.
bool CUlfActiveSet::TurnsRound(std::size_t row)
{
    if (!m_rows.equality[row] || Violation(row) > Tolerance(kMeetTol)) return false;
    m_orient[row] = -m_orient[row];
    return true;
}

/// The direction of a row, in long double where little of its normal is left.
void CUlfActiveSet::Direct(std::size_t row)
{
    m_factor->Direct(m_rows, row, m_orient[row], m_dir);
    m_z.assign(m_dir.z.begin(), m_dir.z.end());
    m_dr.assign(m_dir.r.begin(), m_dir.r.end());
    if (m_dir.zz > kNearTol * kNearTol || m_active.empty()) return;
    std::vector<long double> dz, dr;
    for (int pass = 0; pass < 2; ++pass) { // z + N r = normal, N' z = 0
        std::vector<long double> first(m_y.size()), second(m_active.size());
        m_rows.AddTo(row, m_orient[row], first);
        for (std::size_t j = 0; j < first.size(); ++j)
            first[j] -= m_z[j];
        for (std::size_t i = 0; i < m_active.size(); ++i) {
            m_rows.AddTo(m_active[i], -m_orient[m_active[i]] * m_dr[i], first);
            second[i] = -m_orient[m_active[i]] * m_rows.Dot(m_active[i], m_z);
        }
        m_factor->Solve(first, second, dz, dr);
        for (std::size_t j = 0; j < dz.size(); ++j)
            m_z[j] += dz[j];
        for (std::size_t i = 0; i < dr.size(); ++i)
            m_dr[i] += dr[i];
    }
    const long double length = Norm(m_z);
    m_dir.zz = length * length;
}

bool CUlfActiveSet::IsDependent() const
{
    const long double tol = kDependentTol[static_cast<std::size_t>(m_precision)];
    return !(m_dir.zz > tol * tol);
}

/// The step at which the first active row leaves: its multiplier reaches zero or its cap.
CUlfActiveSet::T_RATIO CUlfActiveSet::DualRatio() const
{
    T_RATIO first{kNever, 0};
    long double firstRate = 0.0L;
    for (std::size_t i = 0; i < m_active.size(); ++i) {
        if (m_rows.equality[m_active[i]]) continue;
        const long double rate = std::fabs(m_dr[i]);
        if (!(rate > kRatioTol)) continue;
        const long double cap = Cap(m_active[i]);
        const long double room = m_dr[i] > 0.0L ? m_u[i] : cap - m_u[i];
        const long double t = std::max(0.0L, room) / rate;
        if (t < first.t || (t == first.t && t < kNever && rate > firstRate)) {
            first = {t, i};
            firstRate = rate;
        }
    }
    return first;
}

void CUlfActiveSet::Move(long double t, bool primal)
{
    if (primal)
        for (std::size_t j = 0; j < m_y.size(); ++j)
            m_y[j] -= t * m_z[j];
    for (std::size_t i = 0; i < m_u.size(); ++i)
        m_u[i] -= t * m_dr[i];
}

void CUlfActiveSet::Activate(std::size_t row, long double multiplier)
{
    m_factor->Append(m_dir);
    m_active.push_back(row);
    m_u.push_back(multiplier);
    m_state[row] = 1;
}

/// No step meets the row: it contradicts the active ones, unless it is met within the relaxed
/// tolerance, and then it is left aside.
ULF_STEP CUlfActiveSet::GiveUp(std::size_t row, long double multiplier)
{
    if (Violation(row) > Tolerance(kUlfRelaxedTol)) {
        m_proof.assign(1, {row, m_orient[row]});
        for (std::size_t i = 0; i < m_active.size(); ++i)
            if (std::fabs(m_dr[i]) > kRatioTol)
                m_proof.emplace_back(m_active[i], -m_orient[m_active[i]] * m_dr[i]);
        return ULF_STEP::Infeasible;
    }
    m_state[row] = 2;
    for (std::size_t i = 0; i < m_u.size(); ++i) // its share goes to the rows it depends on
        m_u[i] += multiplier * m_dr[i];
    Repair();
    return ULF_STEP::Done;
}

/// Takes an active row out; one at its cap goes over to the other side.
void CUlfActiveSet::Drop(std::size_t at)
{
    const std::size_t row = m_active[at];
    const bool isAtCap = m_u[at] > Cap(row) / 2;
    m_factor->Remove(at);
    m_active.erase(m_active.begin() + static_cast<std::ptrdiff_t>(at));
    m_u.erase(m_u.begin() + static_cast<std::ptrdiff_t>(at));
    m_state[row] = 0;
    if (isAtCap) Flip(row);
}

/// The violation of an elastic row is paid at its full cap from here on, and the row guards the
/// way back: |y| = y + 2 max(0, -y) = -y + 2 max(0, y).
void CUlfActiveSet::Flip(std::size_t row)
{
    m_rows.AddTo(row, m_orient[row] * Cap(row), m_g);
    m_orient[row] = -m_orient[row];
}

/// Brings y + g + N u = 0, N' y = rhs to the precision of long double.
void CUlfActiveSet::Refine()
{
    for (int pass = 0; pass < kRefinements; ++pass) {
        const long double residual = RefineOnce();
        const long double size = std::max({1.0L, Norm(m_y), Largest(m_g), Largest(m_u)});
        if (residual <= 1e-17L * size) return;
        if (pass == 2 && residual > 1e-13L * size) Rebuild();
    }
}

/// One correction; the residual before it.
long double CUlfActiveSet::RefineOnce()
{
    std::vector<long double> first(m_y.size()), second(m_active.size());
    for (std::size_t j = 0; j < first.size(); ++j)
        first[j] = -m_g[j] - m_y[j];
    for (std::size_t i = 0; i < m_active.size(); ++i) {
        m_rows.AddTo(m_active[i], -m_orient[m_active[i]] * m_u[i], first);
        second[i] = -Violation(m_active[i]);
    }
    std::vector<long double> dy, du;
    m_factor->Solve(first, second, dy, du);
    for (std::size_t j = 0; j < dy.size(); ++j)
        m_y[j] += dy[j];
    for (std::size_t i = 0; i < du.size(); ++i)
        m_u[i] += du[i];
    return std::max(Largest(first), Largest(second));
}

/// Drops active rows, worst first, until every multiplier is within its range. True when any went.
bool CUlfActiveSet::Repair()
{
    bool any = false;
    for (std::size_t count = m_active.size(); count > 0; --count) {
        long double most = kMultiplierTol * std::max(1.0L, Largest(m_u));
        std::size_t worst = kNone;
        for (std::size_t i = 0; i < m_active.size(); ++i) {
            if (m_rows.equality[m_active[i]]) continue;
            const long double cap = Cap(m_active[i]);
            const long double out = std::max(-m_u[i], m_u[i] - cap);
            if (out > most) {
                most = out;
                worst = i;
            }
        }
        if (worst == kNone) return any;
        Drop(worst);
        Refine();
        any = true;
    }
    return any;
}

/// Factorises the active normals anew.
void CUlfActiveSet::Rebuild()
{
    m_factor->Clear();
    for (std::size_t row : m_active) {
        m_factor->Direct(m_rows, row, m_orient[row], m_dir);
        m_factor->Append(m_dir);
    }
}
