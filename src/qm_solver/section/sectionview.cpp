#include "qm_solver/section/sectionview.h"

#include "qm_solver/section/gausspoints.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace solver {

namespace {

constexpr double kEndless = std::numeric_limits<double>::infinity();
using std::numbers::pi;

/// Cosine or sine; of a quarter turn without the rounding of pi, so that both sides of a symmetric
/// section give the same.
double Exact(double v)
{
    constexpr double kRounding = 1e-15;
    return std::fabs(v) < kRounding ? 0.0 : v;
}

} // namespace

CSectionView::CSectionView(const T_SECTION_SHAPE& shape, double direction)
    : m_shape(shape), m_laws(shape.laws)
{
    m_lines.reserve(shape.edges.size());
    m_bows.reserve(shape.arcs.size());
    m_points.reserve(shape.bars.size());
    Turn(direction);
}

void CSectionView::Turn(double direction)
{
    m_direction = direction;
    m_cos = Exact(std::cos(direction));
    m_sin = Exact(std::sin(direction));
    m_lines.clear(), m_bows.clear(), m_points.clear();
    m_ranges.assign(m_shape.model.regions.size(), {kEndless, -kEndless});
    for (const T_EDGE& e : m_shape.edges)
        AddLine(e);
    for (const T_ARC& a : m_shape.arcs)
        AddBow(a);
    for (const T_SHAPE_BAR& b : m_shape.bars)
        m_points.push_back(
            {b.y * m_sin + b.z * m_cos, b.z * m_sin - b.y * m_cos, b.area, b.law, b.host});
    Mark();
}

void CSectionView::AddLine(const T_EDGE& e)
{
    const T_LINE line{e.y0 * m_sin + e.z0 * m_cos,
                      e.z0 * m_sin - e.y0 * m_cos,
                      e.y1 * m_sin + e.z1 * m_cos,
                      e.z1 * m_sin - e.y1 * m_cos,
                      e.sign,
                      m_shape.model.regions[e.region].law};
    m_lines.push_back(line);
    T_RANGE& range = m_ranges[e.region];
    range.low = std::min({range.low, line.s0, line.s1});
    range.high = std::max({range.high, line.s0, line.s1});
}

void CSectionView::AddBow(const T_ARC& a)
{
    // The s axis is turned from +y by pi / 2 - direction.
    double from = std::fmod(a.from - (0.5 * pi - m_direction), 2.0 * pi);
    if (from < 0.0) from += 2.0 * pi;
    const bool full = a.sweep >= 2.0 * pi;
    const T_BOW bow{a.y * m_sin + a.z * m_cos,
                    a.z * m_sin - a.y * m_cos,
                    a.radius,
                    full ? 0.0 : from,
                    a.sweep,
                    a.sign,
                    m_shape.model.regions[a.region].law};
    m_bows.push_back(bow);
    T_RANGE& range = m_ranges[a.region];
    const auto reach = [&](double angle) {
        const double s = bow.s + bow.radius * std::cos(angle);
        range.low = std::min(range.low, s);
        range.high = std::max(range.high, s);
    };
    reach(bow.from);
    reach(bow.from + bow.sweep);
    for (int k = 1; k <= 4; ++k) // the turning points within the arc
        if (bow.from < k * pi && k * pi < bow.from + bow.sweep) reach(k * pi);
}

// ---- strains that fibres may reach --------------------------------------------------------------

void CSectionView::Mark()
{
    m_limits.clear(), m_yields.clear();
    m_top = m_blockTop = -kEndless, m_bottom = kEndless;
    for (std::size_t r = 0; r < m_ranges.size(); ++r) {
        m_top = std::max(m_top, m_ranges[r].high);
        m_bottom = std::min(m_bottom, m_ranges[r].low);
        if (m_shape.LawOf(m_shape.model.regions[r]).kind == STRESS_LAW::Block)
            m_blockTop = std::max(m_blockTop, m_ranges[r].high);
        MarkRegion(r);
    }
    MarkBars();
}

void CSectionView::MarkRegion(std::size_t r)
{
    const T_STRESS_LAW& law = m_shape.LawOf(m_shape.model.regions[r]);
    const auto& [low, high] = m_ranges[r];
    if (law.kind == STRESS_LAW::Steel) {
        if (m_shape.model.plastic) return;
        const T_FIBRE pressed{FIBRE_KIND::Steel, r, false}, pulled{FIBRE_KIND::Steel, r, true};
        const double yield = law.strength / law.modulus;
        m_yields.push_back({high, yield, pressed});
        m_yields.push_back({low, -yield, pulled});
        if (law.limitStrain == 0.0) return;
        m_limits.push_back({high, law.limitStrain, pressed});
        m_limits.push_back({low, -law.limitStrain, pulled});
        return;
    }
    if (law.spalls) return;
    const T_FIBRE edge{FIBRE_KIND::Concrete, r, false};
    m_limits.push_back({high, law.limitStrain, edge});
    if (law.kind == STRESS_LAW::Block) return;
    m_yields.push_back({high, law.peakStrain, edge});
    if (m_shape.model.pivot != PIVOT_RULE::Eurocode || law.kind == STRESS_LAW::Mander) return;
    const double down = (1.0 - law.peakStrain / law.limitStrain) * (high - low);
    m_limits.push_back({high - down, law.peakStrain, edge, true});
}

void CSectionView::MarkBars()
{
    for (std::size_t i = 0; i < m_points.size(); ++i) {
        const T_STRESS_LAW& law = m_shape.model.laws[m_points[i].law];
        const double s = m_points[i].s, yield = law.strength / law.modulus;
        const T_FIBRE pressed{FIBRE_KIND::Bar, i, false}, pulled{FIBRE_KIND::Bar, i, true};
        m_yields.push_back({s, yield, pressed});
        m_yields.push_back({s, -yield, pulled});
        if (law.limitStrain == 0.0) continue;
        m_limits.push_back({s, law.limitStrain, pressed});
        m_limits.push_back({s, -law.limitStrain, pulled});
    }
}

// ---- sums ---------------------------------------------------------------------------------------
// By Green's theorem the sum of f(s) t^k over a region is minus that of f(s) t^(k+1) / (k+1) ds
// around its outline. Each way is cut where its strain passes from one piece of the law to the
// next.

namespace {

/// What a place of the outline adds to the sums over the section of 1, t and t2.
struct T_PLACE {
    double s = 0.0, area = 0.0, overT = 0.0, overTT = 0.0;
};

/// ds is the part of the way, with the weight and the sign.
T_PLACE PlaceAt(double s, double t, double ds)
{
    const double area = -ds * t;
    return {s, area, area * t / 2.0, area * t * t / 3.0};
}

template <bool kTangent>
void AddPlace(const CStressLaw& law, const T_LAW_PIECE& piece, double strain, const T_PLACE& at,
              T_SUMS& sums)
{
    const double stress = law.Stress(piece, strain);
    sums.force += stress * at.area;
    sums.overS += stress * at.area * at.s;
    sums.overT += stress * at.overT;
    if constexpr (kTangent) {
        const double slope = law.Tangent(piece, strain);
        const std::array<double, 6> parts{
            at.area, at.area * at.s, at.overT, at.area * at.s * at.s, at.overT * at.s, at.overTT};
        for (std::size_t i = 0; i < parts.size(); ++i)
            sums.tangent[i] += slope * parts[i];
    }
}

/// f(at, weight) over the way from a to b.
template <class F>
void ForEven(double a, double b, const F& f)
{
    ForGauss16([&](double at, double weight) { f(a + (b - a) * at, (b - a) * weight); });
}

/// The points gather at the end that is nearer to the root of a broken power: w^4 makes it smooth.
template <class F>
void ForGathered(double a, double b, bool atB, const F& f)
{
    const double from = atB ? b : a, way = atB ? a - b : b - a;
    ForGauss16([&](double w, double weight) {
        const double w3 = w * w * w;
        f(from + way * w3 * w, weight * 4.0 * w3 * std::fabs(way));
    });
}

} // namespace

template <bool kTangent>
void CSectionView::SumLine(const T_LINE& line, double e0, double kappa, T_SUMS& sums) const
{
    const CStressLaw& law = m_laws[line.law];
    const double ds = line.s1 - line.s0, dt = line.t1 - line.t0;
    const double ea = e0 + kappa * line.s0, eb = e0 + kappa * line.s1;
    const double low = std::min(ea, eb), high = std::max(ea, eb);
    for (const T_LAW_PIECE& piece : law.Pieces()) {
        if (piece.to <= low || piece.Zero()) continue;
        if (piece.from > high) break;
        double a = 0.0, b = 1.0;
        if (low < high) {
            const double p = (std::max(low, piece.from) - ea) / (eb - ea);
            const double q = (std::min(high, piece.to) - ea) / (eb - ea);
            a = std::min(p, q), b = std::max(p, q);
        }
        const auto add = [&](double at, double weight) {
            AddPlace<kTangent>(
                law, piece, ea + at * (eb - ea),
                PlaceAt(line.s0 + at * ds, line.t0 + at * dt, line.sign * weight * ds), sums);
        };
        if (piece.shape == LAW_SHAPE::Polynomial) {
            for (const auto& [at, weight] : kGauss3)
                add(a + (b - a) * at, (b - a) * weight);
        } else if (!piece.root) {
            ForEven(a, b, add);
        } else {
            const bool atB = std::fabs(ea + b * (eb - ea) - *piece.root) <
                             std::fabs(ea + a * (eb - ea) - *piece.root);
            ForGathered(a, b, atB, add);
        }
    }
}

template <bool kTangent>
void CSectionView::SumBow(const T_BOW& bow, double e0, double kappa, T_SUMS& sums) const
{
    const CStressLaw& law = m_laws[bow.law];
    const double mid = e0 + kappa * bow.s, reach = kappa * bow.radius;
    // Angle from s, 0 ... pi, where the strain is e; strains fall with it.
    const auto angle = [&](double e) {
        if (e <= mid - reach) return pi;
        return e >= mid + reach ? 0.0 : std::acos((e - mid) / reach);
    };
    // The circle between two angles, on the side of t (+1), against it (-1) or on both (0), which
    // are symmetric about its centre.
    const auto part = [&](double from, double to, double side) {
        for (const T_LAW_PIECE& piece : law.Pieces()) {
            if (piece.Zero() || piece.to <= mid - reach || piece.from > mid + reach) continue;
            const double a = std::max(from, angle(piece.to));
            const double b = std::min(to, angle(piece.from));
            if (!(a < b)) continue;
            const auto add = [&](double at, double weight) {
                const double across = bow.radius * std::sin(at), s = bow.radius * std::cos(at);
                const double ds = -bow.sign * weight * across, both = -2.0 * ds * across;
                const T_PLACE place = side != 0.0
                                          ? PlaceAt(bow.s + s, bow.t + side * across, side * ds)
                                          : T_PLACE{bow.s + s, both, both * bow.t,
                                                    both * (bow.t * bow.t + across * across / 3.0)};
                AddPlace<kTangent>(law, piece, mid + kappa * s, place, sums);
            };
            if (piece.shape == LAW_SHAPE::Polynomial) {
                ForEven(a, b, add);
                continue;
            }
            const double c = 0.5 * (a + b); // two panels: strains bend at 0 and pi
            if (!piece.root) {
                ForEven(a, c, add);
                ForEven(c, b, add);
            } else {
                const double root = angle(*piece.root);
                const bool atB = std::fabs(root - b) < std::fabs(root - a);
                ForGathered(a, c, atB, add);
                ForGathered(c, b, atB, add);
            }
        }
    };
    if (bow.sweep >= 2.0 * pi) return part(0.0, pi, 0.0);
    for (int k = 0; k < 4; ++k) {
        const double from = std::max(bow.from, k * pi),
                     to = std::min(bow.from + bow.sweep, (k + 1) * pi);
        if (!(from < to)) continue;
        if (k % 2 == 0)
            part(from - k * pi, to - k * pi, 1.0);
        else
            part((k + 1) * pi - to, (k + 1) * pi - from, -1.0);
    }
}

template <bool kTangent>
void CSectionView::SumPoint(const T_POINT& bar, double e0, double kappa, T_SUMS& sums) const
{
    const CStressLaw &steel = m_laws[bar.law], &host = m_laws[bar.host];
    const double strain = e0 + kappa * bar.s;
    const double force = bar.area * (steel.Stress(strain) - host.Stress(strain));
    sums.force += force;
    sums.overS += force * bar.s;
    sums.overT += force * bar.t;
    if constexpr (kTangent) {
        const double k = bar.area * (steel.Tangent(steel.PieceAt(strain), strain) -
                                     host.Tangent(host.PieceAt(strain), strain));
        const std::array<double, 6> parts{1.0,           bar.s,         bar.t,
                                          bar.s * bar.s, bar.s * bar.t, bar.t * bar.t};
        for (std::size_t i = 0; i < parts.size(); ++i)
            sums.tangent[i] += k * parts[i];
    }
}

template <bool kTangent>
T_SUMS CSectionView::Add(double e0, double kappa)
{
    if (m_blockTop >= m_bottom)
        for (CStressLaw& law : m_laws)
            law.SetTopStrain(e0 + kappa * m_blockTop);
    T_SUMS sums;
    for (const T_LINE& line : m_lines)
        SumLine<kTangent>(line, e0, kappa, sums);
    for (const T_BOW& bow : m_bows)
        SumBow<kTangent>(bow, e0, kappa, sums);
    for (const T_POINT& bar : m_points)
        SumPoint<kTangent>(bar, e0, kappa, sums);
    return sums;
}

T_SUMS CSectionView::Sums(double e0, double kappa)
{
    return Add<false>(e0, kappa);
}

T_SUMS CSectionView::SumsAndTangent(double e0, double kappa)
{
    return Add<true>(e0, kappa);
}

} // namespace solver
