#include "qm_rps/pushover/pushoverallpoints.h"

#include "qm_rps/pushover/adrsformulas.h"
#include "qm_rps/pushover/fema440coefficients.h"
#include "qm_rps/pushover/fema440workingspectrum.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kPrecise = 1e-10; // of the displacement
constexpr double kBalanced = 1e-7; // what is left of demand / capacity - 1 at a point, not a jump
constexpr int kMaxHalvings = 80;
constexpr std::size_t kSamples = 2000; // along the whole curve

T_POINT2 Between(const T_POINT2& a, const T_POINT2& b)
{
    return {0.5 * (a.x + b.x), 0.5 * (a.y + b.y)};
}

} // namespace

CPushOverAllPoints::CPushOverAllPoints(const CPushOverPerfPtRecord& owner, bool fema440)
    : m_owner(owner), m_operations(owner), m_fema440(fema440)
{
}

template <class F>
std::optional<double> CPushOverAllPoints::DemandSd(double T, F&& ordinate) const
{
    const std::vector<double>& grid = m_owner.DesignSpectrum()->Periods();
    const auto it = std::ranges::upper_bound(grid, T);
    if (!(T >= grid.front()) || it == grid.end()) return std::nullopt;
    const auto k = static_cast<std::size_t>(it - grid.begin());
    const double g = m_owner.GetGravity(1);
    const std::array<double, 2> Sa{ordinate(k - 1), ordinate(k)};
    const std::array<double, 2> Sd{SpectralDisplacement(grid[k - 1], Sa[0], g),
                                   SpectralDisplacement(grid[k], Sa[1], g)};
    const auto point = CCurveCrossing::PeriodLine(T, g, {Sd, Sa});
    return point ? std::optional(point->x) : std::nullopt;
}

std::optional<CPushOverAllPoints::T_BALANCE> CPushOverAllPoints::AtAtc40(const T_POINT2& p,
                                                                         double dy, double ay) const
{
    T_PERFPT_REDUCTION r;
    if (!m_operations.CalcReduction(dy, ay, p.x, p.y, r)) return std::nullopt;
    const CETC_DESIGN_SPECT& spectrum = *m_owner.DesignSpectrum();
    const auto Sd = DemandSd(m_operations.PeriodOf(p.x, p.y), [&](std::size_t i) {
        return spectrum.CalcPOOrdinate(r.factors.SRa, r.factors.SRv, i);
    });
    if (!Sd) return std::nullopt;
    return T_BALANCE{*Sd / p.x - 1.0, r.betaEff};
}

std::optional<CPushOverAllPoints::T_BALANCE>
CPushOverAllPoints::AtFema440(const T_POINT2& p, double dy, double ay) const
{
    const double mu = p.x / dy;
    const double alpha = PostYieldRatio(dy, ay, p.x, p.y);
    if (!(mu >= 1.0) || !std::isfinite(alpha)) return std::nullopt;
    const T_FEMA440_ROW& row = Fema440Row(m_operations.CoefficientRow(alpha));
    const int range = Fema440DuctilityRange(mu);
    T_BALANCE b;
    double Teff = 0.0, B = 0.0;
    if (!CalcFema440Period(row, range, m_T0, mu, Teff) ||
        !CalcFema440Damping(row, range, m_T0, Teff, mu, b.betaEff) || !CalcFema440B(b.betaEff, B))
        return std::nullopt;
    const auto Sd = DemandSd(Teff, [&](std::size_t i) { return m_owner.Demand().Sa[i] / B; });
    if (!Sd) return std::nullopt;
    b.ratio = *Sd / p.x - 1.0;
    return b;
}

std::optional<CPushOverAllPoints::T_BALANCE> CPushOverAllPoints::At(const T_POINT2& p) const
{
    double dy = 0.0, ay = 0.0;
    if (!(p.x > 0.0) || !(p.y > 0.0) || !m_operations.BilinearizeAt(p.x, p.y, dy, ay))
        return std::nullopt;
    const auto b = m_fema440 ? AtFema440(p, dy, ay) : AtAtc40(p, dy, ay);
    return b && std::isfinite(b->ratio) ? b : std::nullopt;
}

void CPushOverAllPoints::Refine(const T_POINT2& from, double ratioFrom, const T_POINT2& to,
                                std::vector<T_BALANCED_POINT>& out) const
{
    T_POINT2 a = from, b = to;
    for (int i = 0; i < kMaxHalvings && std::fabs(b.x - a.x) > 0.1 * kPrecise * std::fabs(b.x);
         ++i) {
        const T_POINT2 middle = Between(a, b);
        const auto value = At(middle);
        if (!value) return;
        if ((value->ratio > 0.0) == (ratioFrom > 0.0))
            a = middle;
        else
            b = middle;
    }
    const auto left = At(a), right = At(b);
    if (!left || !right) return;
    const bool nearer = std::fabs(left->ratio) < std::fabs(right->ratio);
    const T_BALANCE& best = nearer ? *left : *right;
    const T_POINT2& at = nearer ? a : b;
    if (std::fabs(best.ratio) < kBalanced) out.push_back({at.x, at.y, best.betaEff});
}

std::vector<T_BALANCED_POINT> CPushOverAllPoints::Find()
{
    std::vector<T_BALANCED_POINT> points;
    const T_ADRS_VIEW curve = m_owner.Capacity().View();
    if (!m_owner.DesignSpectrum() || curve.Size() < 2) return points;
    m_T0 = m_operations.PeriodOf(curve.Sd[1], curve.Sa[1]);
    std::optional<T_BALANCE> before;
    T_POINT2 last;
    const auto visit = [&](const T_POINT2& p) {
        const auto now = At(p);
        if (now && now->ratio == 0.0)
            points.push_back({p.x, p.y, now->betaEff});
        else if (now && before && before->ratio != 0.0 &&
                 (now->ratio > 0.0) != (before->ratio > 0.0))
            Refine(last, before->ratio, p, points);
        before = now;
        last = p;
    };
    visit(curve.At(0));
    const std::size_t parts = std::clamp<std::size_t>(kSamples / (curve.Size() - 1), 4, 500);
    for (std::size_t i = 0; i + 1 < curve.Size(); ++i) {
        const T_POINT2 a = curve.At(i), b = curve.At(i + 1);
        for (std::size_t k = 1; k < parts; ++k) {
            const double w = static_cast<double>(k) / static_cast<double>(parts);
            visit({a.x + w * (b.x - a.x), a.y + w * (b.y - a.y)});
        }
        visit(b);
    }
    return points;
}
