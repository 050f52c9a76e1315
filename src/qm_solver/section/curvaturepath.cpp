#include "qm_solver/section/curvaturepath.h"

#include "qm_solver/section/bracketroot.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace solver {

namespace {

constexpr double kTol = 1e-11; // of a root, over its scale
constexpr int kMarchSteps = 2000;
constexpr int kUniformSteps = 64;
constexpr double kFirstStep = 0.05;   // of the least curvature that yields
constexpr double kGrowth = 0.04;      // of a step, over the curvature
constexpr double kLoss = 0.8;         // of the largest moment
constexpr double kBeyondYield = 20.0; // uniform tension of steel without a limit
constexpr double kStuck = 1e-7;       // a step over the curvature: nothing holds beyond

} // namespace

CCurvaturePath::CCurvaturePath(const T_SECTION_SHAPE& shape, const T_CURVATURE_REQUEST& request)
    : m_balance(shape, request), m_request(request)
{
}

// ---- start --------------------------------------------------------------------------------------

/// Uniform strains from the end in tension to the end in compression, the marks among them.
std::vector<double> CCurvaturePath::UniformStrains() const
{
    double low = 0.0, high = 0.0, lowEnd = -1.0, highEnd = 1.0;
    std::vector<double> out{0.0};
    for (const T_MARK& mark : m_balance.View().Yields()) {
        out.push_back(mark.strain);
        low = std::min(low, kBeyondYield * mark.strain);
        high = std::max(high, kBeyondYield * mark.strain);
    }
    for (const T_MARK& mark : m_balance.View().Limits())
        (mark.strain > 0.0 ? highEnd : lowEnd) =
            mark.strain > 0.0 ? std::min(highEnd, mark.strain) : std::max(lowEnd, mark.strain);
    low = std::max(low, lowEnd), high = std::min(high, highEnd);
    for (int i = 0; i <= kUniformSteps; ++i)
        out.push_back(low + (high - low) * i / kUniformSteps);
    std::erase_if(out, [&](double e) { return e < low || e > high; });
    std::ranges::sort(out);
    return out;
}

bool CCurvaturePath::Start(T_BENT_STATE& first, T_SECTION_ERROR& error)
{
    const std::vector<double> strains = UniformStrains();
    std::vector<double> forces;
    for (const double e : strains)
        forces.push_back(m_balance.UniformForce(e));
    const auto [least, most] = std::ranges::minmax(forces);
    m_balance.SetForceScale(std::max(std::fabs(least), std::fabs(most)));
    error.fault = SECTION_FAULT::AxialBeyond;
    error.axialMin = least, error.axialMax = most;
    // Out from no strain, so that what descends beyond a peak comes last.
    const auto zero = static_cast<std::size_t>(std::ranges::find(strains, 0.0) - strains.begin());
    const auto passes = [&](std::size_t i, std::size_t k) {
        return std::min(forces[i], forces[k]) <= m_request.axial &&
               m_request.axial <= std::max(forces[i], forces[k]);
    };
    std::optional<std::size_t> at;
    for (std::size_t i = zero; i + 1 < strains.size() && !at; ++i)
        if (passes(i, i + 1)) at = i;
    for (std::size_t i = zero; i-- > 0 && !at;)
        if (passes(i, i + 1)) at = i;
    if (!at) return false;
    const auto miss = [&](double e) { return m_balance.UniformForce(e) - m_request.axial; };
    const T_BRACKET root =
        BracketRoot(miss, strains[*at], forces[*at] - m_request.axial, strains[*at + 1],
                    forces[*at + 1] - m_request.axial, kTol * m_balance.ForceScale());
    first = m_balance.StateOf({root.x, 0.0, 0.0});
    error.fault = SECTION_FAULT::NotConverged;
    // Without curvature the direction of the moment can only be had by bending across.
    if (!m_request.ofMoment) return true;
    const auto turned = m_balance.Near(first.at);
    if (turned)
        first = *turned;
    else
        error.fault = SECTION_FAULT::NoSuchMoment;
    return turned.has_value();
}

// ---- march --------------------------------------------------------------------------------------

template <class F>
std::optional<T_BENT_STATE> CCurvaturePath::Locate(const T_BENT_STATE& before,
                                                   const T_BENT_STATE& after, const F& value)
{
    const auto at = [&](double curvature) {
        const auto found = m_balance.Reach(before, curvature);
        return found ? value(*found) : std::numeric_limits<double>::quiet_NaN();
    };
    const T_BRACKET root =
        BracketRoot(at, before.at.along, value(before), after.at.along, value(after), kTol);
    return m_balance.Reach(before, root.x);
}

/// The largest moment near the best state of the path, by golden section.
double CCurvaturePath::LargestMoment()
{
    const auto best =
        std::ranges::max_element(m_path, {}, [](const T_BENT_STATE& s) { return s.point.moment; });
    const T_BENT_STATE& from = best == m_path.begin() ? *best : *(best - 1);
    double lo = from.at.along, hi = (best + 1 == m_path.end() ? best : best + 1)->at.along;
    double largest = best->point.moment;
    constexpr double kGolden = 1.0 / std::numbers::phi;
    const auto at = [&](double curvature) {
        const auto state = m_balance.Reach(from, curvature);
        const double moment = state ? state->point.moment : best->point.moment;
        largest = std::max(largest, moment);
        return moment;
    };
    for (int i = 0; i < 30; ++i) {
        const double a = hi - kGolden * (hi - lo), b = lo + kGolden * (hi - lo);
        if (at(a) < at(b))
            lo = a;
        else
            hi = b;
    }
    return largest;
}

/// Whether the path ends between its last state and this one; adds the end.
bool CCurvaturePath::EndsAt(const T_BENT_STATE& state, T_MOMENT_CURVATURE& out)
{
    std::optional<T_BENT_STATE> end;
    if (state.limit.part >= 1.0) {
        out.end = CURVATURE_END::StrainLimit;
        out.governs = state.limit.fibre;
        end =
            Locate(m_path.back(), state, [](const T_BENT_STATE& s) { return s.limit.part - 1.0; });
    } else {
        const auto best = std::ranges::max_element(
            m_path, {}, [](const T_BENT_STATE& s) { return s.point.moment; });
        if (!(state.point.moment < kLoss * best->point.moment)) return false;
        const double left = kLoss * LargestMoment();
        out.end = CURVATURE_END::MomentLoss;
        end = Locate(m_path.back(), state,
                     [&](const T_BENT_STATE& s) { return s.point.moment / left - 1.0; });
    }
    m_path.push_back(end ? *end : state);
    return true;
}

bool CCurvaturePath::March(T_MOMENT_CURVATURE& out)
{
    double least = std::numeric_limits<double>::infinity();
    for (const T_MARK& mark : m_balance.View().Yields())
        least = std::min(least, std::fabs(mark.strain) / m_balance.Depth());
    double step = kFirstStep * least;
    for (int i = 0; i < kMarchSteps; ++i) {
        const T_BENT_STATE before = m_path.back();
        double to = before.at.along + step;
        const bool last = m_request.maxCurvature > 0.0 && to >= m_request.maxCurvature;
        if (last) to = m_request.maxCurvature;
        const auto state = m_balance.Reach(before, to, 0);
        if (!state) {
            step *= 0.5;
            if (step > kStuck * (before.at.along + least)) continue;
            out.end = CURVATURE_END::NoEquilibrium;
            return m_path.size() > 2;
        }
        if (EndsAt(*state, out)) return true;
        m_path.push_back(*state);
        if (last) {
            out.end = CURVATURE_END::MaxCurvature;
            return true;
        }
        step = std::max(step, kGrowth * to);
    }
    return false;
}

// ---- results ------------------------------------------------------------------------------------

bool CCurvaturePath::Fill(T_MOMENT_CURVATURE& out)
{
    T_BENT_STATE yield = m_path.back();
    const auto first =
        std::ranges::find_if(m_path, [](const T_BENT_STATE& s) { return s.yield.part >= 1.0; });
    if (first != m_path.end()) {
        yield = *first;
        out.yields = first->yield.fibre;
        if (first != m_path.begin()) {
            const auto at = Locate(*(first - 1), *first,
                                   [](const T_BENT_STATE& s) { return s.yield.part - 1.0; });
            if (!at) return false;
            yield = *at;
        }
    }
    // A quarter of the points up to yield, the rest from there on.
    std::size_t next = 0;
    const auto add = [&](double from, double to, std::size_t count) {
        for (std::size_t i = 1; i < count; ++i) {
            const double curvature = from + (to - from) * double(i) / double(count);
            while (next + 1 < m_path.size() && m_path[next + 1].at.along <= curvature)
                ++next;
            const auto state = m_balance.Reach(m_path[next], curvature);
            if (!state) return false;
            out.points.push_back(state->point);
        }
        return true;
    };
    const double start = m_path.front().at.along, end = m_path.back().at.along;
    const std::size_t rising = std::max<std::size_t>(1, m_request.points / 4);
    const std::size_t after = std::max<std::size_t>(1, m_request.points - rising);
    out.points.push_back(m_path.front().point);
    if (yield.at.along > start) {
        if (!add(start, yield.at.along, rising)) return false;
        out.points.push_back(yield.point);
    }
    out.yield = out.points.size() - 1;
    if (yield.at.along < end) {
        if (!add(yield.at.along, end, after)) return false;
        out.points.push_back(m_path.back().point);
    }
    return true;
}

namespace {

/// The elastic part goes through yield with the slope k; the level lies m above yield so that it
/// has the area that the curve has above yield beyond it: m U - m2 / (2 k), U up to the ultimate.
void Idealise(T_MOMENT_CURVATURE& out)
{
    const T_CURVATURE_POINT &first = out.points.front(), &yield = out.points[out.yield];
    const double way = out.points.back().curvature - yield.curvature;
    const double slope = (yield.moment - first.moment) / yield.curvature;
    if (!(yield.curvature > 0.0) || !(slope > 0.0) || !(way > 0.0)) return;
    double area = 0.0;
    for (std::size_t i = out.yield + 1; i < out.points.size(); ++i) {
        const T_CURVATURE_POINT &a = out.points[i - 1], &b = out.points[i];
        area += (0.5 * (a.moment + b.moment) - yield.moment) * (b.curvature - a.curvature);
    }
    const double rest = way * way - 2.0 * area / slope;
    if (!(rest >= 0.0)) return;
    // A curve that falls behind yield has a lower level, which is left before yield.
    const double above = area > 0.0 ? slope * (way - std::sqrt(rest)) : area / way;
    const double level = yield.moment + above;
    if (level > std::ranges::max(out.points, {}, &T_CURVATURE_POINT::moment).moment) return;
    out.idealised = true;
    out.idealMoment = level;
    out.idealCurvature = yield.curvature + above / slope;
}

} // namespace

int CCurvaturePath::Run(T_MOMENT_CURVATURE& out, T_SECTION_ERROR& error)
{
    T_BENT_STATE first;
    error = {};
    if (!Start(first, error)) return 0;
    m_path.assign(1, first);
    T_MOMENT_CURVATURE result;
    if (!March(result) || !Fill(result)) return 0; // NotConverged, as Start left it
    Idealise(result);
    out = std::move(result);
    error = {};
    return 1;
}

} // namespace solver
