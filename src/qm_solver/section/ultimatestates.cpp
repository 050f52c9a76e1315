#include "qm_solver/section/ultimatestates.h"

#include "qm_solver/section/bracketroot.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace solver {

namespace {

constexpr std::size_t kSamples = 65;
constexpr double kAxialTol = 1e-12;  // of an axial force, over the range of them
constexpr double kPlaceTol = 1e-11;  // of the largest moment, whose curve is flat there
constexpr double kAllTension = -1e3; // a strain that all steel yields at
constexpr double kRounding = 1e-13;  // of a moment
constexpr int kMaxIterations = 200;
constexpr double kEndless = std::numeric_limits<double>::infinity();

/// Neutral axis at uniform compression, at the lower edge, at the upper edge, at uniform tension.
constexpr double kCompression = 2.0, kFullDepth = 1.0, kNoDepth = 0.0, kTension = -1.0;

T_CAPACITY Mixed(const T_CAPACITY& a, const T_CAPACITY& b, double ofB)
{
    T_CAPACITY mixed = a;
    mixed.axial += ofB * (b.axial - a.axial);
    mixed.My += ofB * (b.My - a.My);
    mixed.Mz += ofB * (b.Mz - a.Mz);
    return mixed;
}

} // namespace

T_SECTION_ERROR CapacityFault(const T_SECTION_SHAPE& shape)
{
    T_SECTION_ERROR error;
    const T_SECTION_MODEL& model = shape.model;
    if (model.plastic) return error;
    for (std::size_t i = 0; i < model.laws.size(); ++i)
        if (model.laws[i].limitStrain == 0.0 && model.laws[i].hardening > 0.0) {
            error.fault = SECTION_FAULT::NoLimit;
            error.law = static_cast<long>(i);
            return error;
        }
    const CSectionView view(shape);
    if (std::ranges::none_of(view.Limits(), [](const T_MARK& m) { return m.strain > 0.0; })) {
        error.fault = SECTION_FAULT::NoLimit;
        error.law = static_cast<long>(model.regions[0].law);
    }
    return error;
}

CUltimateStates::CUltimateStates(const T_SECTION_SHAPE& shape, double direction) : m_view(shape)
{
    Turn(direction);
}

void CUltimateStates::Turn(double direction)
{
    m_view.Turn(direction);
    m_samples.clear();
    m_tensionEnds = false;
    m_top = -kEndless;
    for (const T_MARK& limit : m_view.Limits()) {
        if (limit.strain < 0.0)
            m_tensionEnds = true;
        else
            m_top = std::max(m_top, limit.s);
    }
    const bool plastic = m_view.Shape().model.plastic;
    if (plastic) m_top = m_view.Top();
    m_depth = m_top - m_view.Bottom();
    m_first = m_tensionEnds ? kTension : kNoDepth;
    m_last = plastic ? kFullDepth : kCompression;
    m_tension = Of(Strains(m_first));
    m_compression = Of(Strains(m_last));
}

// ---- strains ------------------------------------------------------------------------------------

CUltimateStates::T_STRAINS CUltimateStates::PlasticStrains(double place) const
{
    if (place <= m_first) return {-1.0, 0.0, {}};
    if (place >= m_last) return {1.0, 0.0, {}};
    return {place - m_top / m_depth, 1.0 / m_depth, {}};
}

CUltimateStates::T_STRAINS CUltimateStates::Uniform(bool compression) const
{
    T_STRAINS out{compression ? kEndless : kAllTension, 0.0, {}};
    for (const T_MARK& limit : m_view.Limits()) {
        if ((limit.strain > 0.0) != compression) continue;
        if (compression ? limit.strain < out.e0 : limit.strain > out.e0)
            out.e0 = limit.strain, out.governs = limit.fibre;
    }
    return out;
}

CUltimateStates::T_STRAINS CUltimateStates::Strains(double place) const
{
    if (m_view.Shape().model.plastic) return PlasticStrains(place);
    if (place >= m_last) return Uniform(true);
    if (place <= m_first) return Uniform(false);
    double axis = m_top - place * m_depth;
    if (place > kFullDepth) axis = m_top - m_depth / (kCompression - place);
    if (place < kNoDepth) axis = m_top - m_depth + m_depth / (place - kTension);
    T_STRAINS out{0.0, kEndless, {}};
    for (const T_MARK& limit : m_view.Limits()) {
        const double arm = limit.s - axis;
        if (!(arm * limit.strain > 0.0) || limit.strain / arm >= out.kappa) continue;
        out.kappa = limit.strain / arm;
        out.governs = limit.fibre;
    }
    out.e0 = -out.kappa * axis;
    return out;
}

// ---- states -------------------------------------------------------------------------------------

T_CAPACITY CUltimateStates::Of(const T_STRAINS& strains)
{
    const T_SUMS sums = m_view.Sums(strains.e0, strains.kappa);
    return {sums.force, m_view.MomentY(sums), m_view.MomentZ(sums),
            m_view.Plane(strains.e0, strains.kappa), strains.governs};
}

T_CAPACITY CUltimateStates::At(double place)
{
    return Of(Strains(place));
}

double CUltimateStates::Moment(const T_CAPACITY& c) const
{
    return c.My * std::cos(m_view.Direction()) + c.Mz * std::sin(m_view.Direction());
}

double CUltimateStates::PlaceOf(std::size_t sample) const
{
    return m_first + (m_last - m_first) * double(sample) / double(kSamples - 1);
}

const std::vector<T_CAPACITY>& CUltimateStates::Samples()
{
    if (m_samples.empty())
        for (std::size_t i = 0; i < kSamples; ++i)
            m_samples.push_back(At(PlaceOf(i)));
    return m_samples;
}

CUltimateStates::T_RANGE CUltimateStates::AxialRange()
{
    T_RANGE range{kEndless, -kEndless};
    for (const T_CAPACITY& c : Samples()) {
        range.low = std::min(range.low, c.axial);
        range.high = std::max(range.high, c.axial);
    }
    return range;
}

double CUltimateStates::Peak()
{
    const auto best =
        std::ranges::max_element(Samples(), {}, [this](const T_CAPACITY& c) { return Moment(c); });
    const std::size_t at = static_cast<std::size_t>(best - m_samples.begin());
    constexpr double kGolden = 1.0 / std::numbers::phi;
    double lo = PlaceOf(at ? at - 1 : 0), hi = PlaceOf(std::min(at + 1, kSamples - 1));
    double a = hi - kGolden * (hi - lo), b = lo + kGolden * (hi - lo);
    double ma = Moment(At(a)), mb = Moment(At(b));
    for (int i = 0; i < kMaxIterations && hi - lo > kPlaceTol; ++i) {
        if (ma < mb) {
            lo = a, a = b, ma = mb;
            b = lo + kGolden * (hi - lo), mb = Moment(At(b));
        } else {
            hi = b, b = a, mb = ma;
            a = hi - kGolden * (hi - lo), ma = Moment(At(a));
        }
    }
    const double refined = 0.5 * (lo + hi);
    // A sample that is the largest but for rounding stays: a symmetric section has it there.
    const double least = Moment(*best) + kRounding * std::fabs(Moment(*best));
    return Moment(At(refined)) > least ? refined : PlaceOf(at);
}

T_CAPACITY CUltimateStates::Between(double axial, double a, const T_CAPACITY& atA, double b,
                                    const T_CAPACITY& atB)
{
    const double tol = kAxialTol * std::fabs(m_compression.axial - m_tension.axial);
    const auto miss = [&](double place) { return At(place).axial - axial; };
    const T_BRACKET root = BracketRoot(miss, a, atA.axial - axial, b, atB.axial - axial, tol);
    const T_CAPACITY found = At(root.x);
    if (std::fabs(root.f) <= tol) return found;
    return Mixed(found, At(root.other), root.f / (root.f - root.fOther)); // over the jump
}

std::optional<T_CAPACITY> CUltimateStates::AtAxial(double axial)
{
    const double range = std::fabs(m_compression.axial - m_tension.axial);
    for (const T_CAPACITY* end : {&m_compression, &m_tension})
        if (std::fabs(end->axial - axial) <= kAxialTol * range) return *end;
    if (m_samples.empty() && m_tension.axial < axial && axial < m_compression.axial)
        return Between(axial, m_first, m_tension, m_last, m_compression);
    // From compression on; the curve may pass the force at its end and come back.
    const std::vector<T_CAPACITY>& samples = Samples();
    for (std::size_t i = samples.size() - 1; i-- > 0;)
        if ((samples[i].axial < axial) != (samples[i + 1].axial < axial))
            return Between(axial, PlaceOf(i), samples[i], PlaceOf(i + 1), samples[i + 1]);
    return std::nullopt;
}

std::optional<T_CAPACITY> CUltimateStates::Balanced()
{
    const T_MARK* bar = nullptr;
    for (const T_MARK& yield : m_view.Yields())
        if (yield.fibre.kind == FIBRE_KIND::Bar && yield.fibre.tension &&
            (!bar || yield.s < bar->s))
            bar = &yield;
    if (!bar) return std::nullopt;
    T_STRAINS out{0.0, kEndless, {}};
    for (const T_MARK& limit : m_view.Limits()) {
        const double arm = limit.s - bar->s;
        if (!(arm > 0.0) || !(limit.strain > 0.0)) continue;
        const double kappa = (limit.strain - bar->strain) / arm;
        if (kappa < out.kappa) out.kappa = kappa, out.governs = limit.fibre;
    }
    if (!std::isfinite(out.kappa)) return std::nullopt;
    out.e0 = bar->strain - out.kappa * bar->s;
    return Of(out);
}

} // namespace solver
