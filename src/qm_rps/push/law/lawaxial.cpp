#include "qm_rps/push/law/lawaxial.h"

#include "qm_base/say.h"
#include "qm_rps/hinge/hingechoices.h"
#include "qm_rps/hinge/hingetypefindings.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

/// A line of moments over axial forces, tension positive, ascending.
struct T_LINE_POINT {
    double axial = 0.0, moment = 0.0;
};
using T_LINE = std::vector<T_LINE_POINT>;

constexpr double kAside = 1e-9;    // of the range: how far the ends of an upright piece stand apart
constexpr double kRounding = 1e-9; // of the largest moment: at its tips a line has none
constexpr double kBeyond = 1e15;   // N: no member comes there

/// The points of a curve P / Pmax, M / largest, whichever way they run. A side whose moments are
/// entered with their sign, none above 0, has their magnitudes.
template <class POINTS>
T_LINE LineOf(const POINTS& points, double pMax)
{
    const bool isSigned = std::ranges::all_of(
        points, [](double m) { return m <= kRounding; }, &T_PM_POINT::m);
    T_LINE line;
    for (const T_PM_POINT& p : points)
        line.push_back({-p.p * pMax, std::fabs(p.m) <= kRounding ? 0.0 : (isSigned ? -p.m : p.m)});
    if (line.front().axial > line.back().axial) std::ranges::reverse(line);
    const double aside = kAside * (line.back().axial - line.front().axial);
    T_LINE out;
    for (T_LINE_POINT p : line) {
        if (!out.empty() && p.axial <= out.back().axial) {
            if (p.moment == out.back().moment) continue;
            p.axial = out.back().axial + aside;
        }
        out.push_back(p);
    }
    return out;
}

double At(const T_LINE& line, double axial)
{
    const auto above = std::ranges::lower_bound(line, axial, {}, &T_LINE_POINT::axial);
    if (above == line.end()) return line.back().moment;
    // A point itself: the formula below may round a 0 to less.
    if (above == line.begin() || above->axial == axial) return above->moment;
    const T_LINE_POINT& below = *(above - 1);
    return below.moment +
           (above->moment - below.moment) * (axial - below.axial) / (above->axial - below.axial);
}

/// Both sides at the forces of either, from where both begin to where both end.
void Join(const T_SIDES<T_LINE>& lines, T_SIDES<double> factor,
          std::vector<solver::T_AXIAL_STRENGTH>& out)
{
    const double low = std::max(lines.pos.front().axial, lines.neg.front().axial);
    const double high = std::min(lines.pos.back().axial, lines.neg.back().axial);
    std::vector<double> forces;
    for (const T_LINE* line : {&lines.pos, &lines.neg})
        for (const T_LINE_POINT& p : *line)
            if (low <= p.axial && p.axial <= high) forces.push_back(p.axial);
    std::ranges::sort(forces);
    // Forces that rounding sets apart would give a slope of its own between them.
    const double same = 0.1 * kAside * (high - low);
    const auto isSame = [same](double a, double b) { return b - a <= same; };
    forces.erase(std::ranges::unique(forces, isSame).begin(), forces.end());
    for (const double n : forces)
        out.push_back({n, factor.pos * At(lines.pos, n), factor.neg * At(lines.neg, n)});
}

/// Lines of (+) and (-) of a section by the signs of an analysis.
template <class SIDES>
T_SIDES<T_LINE> SectionLines(HINGE_COMPONENT component, const SIDES& sides, double pMax)
{
    T_SIDES<T_LINE> lines{LineOf(sides.pos, pMax), LineOf(sides.neg, pMax)};
    if (IsSectionSignOpposite(component)) std::swap(lines.pos, lines.neg);
    return lines;
}

/// The strength without an axial force is that of the hinge.
int FromShape(const T_AXIAL_BASIS& b, const T_SIDES<T_LINE>& lines,
              std::vector<solver::T_AXIAL_STRENGTH>& out, std::string& reason)
{
    T_SIDES<double> factor;
    for (const bool positive : {true, false}) {
        const T_LINE& line = positive ? lines.pos : lines.neg;
        const bool spans = line.size() > 1 && line.front().axial < 0.0 && line.back().axial > 0.0;
        const double atZero = spans ? At(line, 0.0) : 0.0;
        if (!(atZero > 0.0) || !std::isfinite(atZero)) {
            reason = Say("IDS_QM_PUSH_LAW_PM_ZERO", positive ? "(+)" : "(-)");
            return 0;
        }
        (positive ? factor.pos : factor.neg) = (positive ? b.yield.pos : b.yield.neg) / atZero;
    }
    Join(lines, factor, out);
    return 1;
}

/// Near the axial strengths an unsymmetrical section bends about its centroid whatever it carries:
/// there one of its strengths has the other sign. The lines end where it is 0; beyond, the run ends
/// at the axial strength.
void EndAtZero(std::vector<solver::T_AXIAL_STRENGTH>& rows)
{
    const auto least = [](const solver::T_AXIAL_STRENGTH& r) {
        return std::min(r.positive, r.negative);
    };
    const auto end = [&](solver::T_AXIAL_STRENGTH& outer, const solver::T_AXIAL_STRENGTH& inner) {
        double part = 1.0; // of the way out
        for (const auto& [a, b] :
             {std::pair{inner.positive, outer.positive}, std::pair{inner.negative, outer.negative}})
            if (b < 0.0) part = std::min(part, a / (a - b));
        const auto at = [part](double a, double b) { return std::max(0.0, a + part * (b - a)); };
        outer = {inner.axial + part * (outer.axial - inner.axial),
                 at(inner.positive, outer.positive), at(inner.negative, outer.negative)};
    };
    while (rows.size() > 2 && least(rows[0]) < 0.0 && least(rows[1]) <= 0.0)
        rows.erase(rows.begin());
    while (rows.size() > 2 && least(rows.back()) < 0.0 && least(rows[rows.size() - 2]) <= 0.0)
        rows.pop_back();
    if (rows.size() < 3) return;
    if (least(rows[0]) < 0.0) end(rows[0], rows[1]);
    if (least(rows.back()) < 0.0) end(rows.back(), rows[rows.size() - 2]);
}

int FromSection(const T_AXIAL_BASIS& b, std::vector<solver::T_AXIAL_STRENGTH>& out,
                std::string& reason)
{
    const auto* strength = b.sources.Strength(b.section, b.material);
    if (!strength || strength->fault != SECT_FAULT::None) {
        reason = Say("IDS_QM_PUSH_LAW_NO_PM");
        return 0;
    }
    const double pMax = strength->strength.level.compression;
    const T_PM_LINES found = b.sources.Lines(b.section, b.material);
    const auto& sides = b.component == HINGE_COMPONENT::My ? found.y : found.z;
    if (sides.pos.empty() || sides.neg.empty()) {
        reason = Say("IDS_QM_PUSH_LAW_NO_PM");
        return 0;
    }
    if (!FromShape(b, SectionLines(b.component, sides, pMax), out, reason)) return 0;
    EndAtZero(out);
    return 1;
}

int FromSurface(const T_AXIAL_BASIS& b, std::vector<solver::T_AXIAL_STRENGTH>& out,
                std::string& reason)
{
    if (!b.type.yieldSurface) return FromSection(b, out, reason);
    const T_YIELD_LEVEL& level = b.type.yieldSurface->yield;
    const T_YIELD_AXIS& axis = b.component == HINGE_COMPONENT::My ? level.y : level.z;
    T_SIDES<double> largest = axis.momentMax;
    if (!axis.used || !(level.compression > 0.0) || !(largest.pos > 0.0) || !(largest.neg > 0.0)) {
        reason = Say("IDS_QM_PUSH_LAW_NO_PM");
        return 0;
    }
    if (IsSectionSignOpposite(b.component)) std::swap(largest.pos, largest.neg);
    Join(SectionLines(b.component, axis.curves, level.compression), largest, out);
    return 1;
}

int FromUser(const T_AXIAL_BASIS& b, std::vector<solver::T_AXIAL_STRENGTH>& out,
             std::string& reason)
{
    const auto& pmm = b.type.pmm;
    if (!pmm || !(pmm->Pmax > 0.0)) {
        reason = Say("IDS_QM_PUSH_LAW_NO_PM");
        return 0;
    }
    const std::size_t axis = b.component == HINGE_COMPONENT::My ? 0 : 1;
    const T_PMM_CURVES& negative = pmm->negative ? *pmm->negative : pmm->curves;
    return FromShape(b, {LineOf(pmm->curves[axis], pmm->Pmax), LineOf(negative[axis], pmm->Pmax)},
                     out, reason);
}

/// Entered strengths of curves by axial force (compression positive).
void FromList(const T_SKEL_FEMA& curve, std::vector<solver::T_AXIAL_STRENGTH>& out)
{
    for (auto it = curve.curves.rbegin(); it != curve.curves.rend(); ++it) {
        const double negative = curve.symmetric ? it->sides.pos.yield : it->sides.neg.yield;
        out.push_back({-it->axial, it->sides.pos.yield, negative});
    }
    solver::T_AXIAL_STRENGTH first = out.front(), last = out.back();
    first.axial = -kBeyond;
    last.axial = kBeyond;
    out.insert(out.begin(), first);
    out.push_back(last);
}

/// What the engine takes.
bool AreStrengths(const std::vector<solver::T_AXIAL_STRENGTH>& rows)
{
    const auto falls = [](const auto& a, const auto& b) { return !(a.axial < b.axial); };
    return rows.size() > 1 && std::ranges::adjacent_find(rows, falls) == rows.end() &&
           std::ranges::all_of(rows, [](const solver::T_AXIAL_STRENGTH& row) {
               return row.positive >= 0.0 && row.negative >= 0.0;
           });
}

} // namespace

int StrengthsByAxial(const T_AXIAL_BASIS& basis, std::vector<solver::T_AXIAL_STRENGTH>& out,
                     std::string& reason)
{
    std::vector<solver::T_AXIAL_STRENGTH> rows;
    int done = 1;
    const auto* fema = std::get_if<T_SKEL_FEMA>(&basis.curve);
    const HINGE_INTERACTION interaction = InteractionOf(basis.type, basis.component);
    if (fema && fema->multiCurve && !fema->curves.empty()) {
        if (fema->autoYield)
            done = FromSection(basis, rows, reason);
        else
            FromList(*fema, rows);
    } else if (interaction == HINGE_INTERACTION::PMM) {
        done = FromSurface(basis, rows, reason);
    } else if (interaction == HINGE_INTERACTION::User) {
        done = FromUser(basis, rows, reason);
    }
    if (done && !rows.empty() && !AreStrengths(rows)) {
        reason = Say("IDS_QM_ENGINE_HINGE_AXIAL_ROWS");
        return 0;
    }
    if (done) out = std::move(rows);
    return done;
}

T_SIDES<double> StrengthAt(std::span<const solver::T_AXIAL_STRENGTH> rows, double axial)
{
    const auto above = std::ranges::lower_bound(rows, axial, {}, &solver::T_AXIAL_STRENGTH::axial);
    if (above == rows.end()) return {rows.back().positive, rows.back().negative};
    if (above == rows.begin()) return {above->positive, above->negative};
    const auto& below = *(above - 1);
    const double part = (axial - below.axial) / (above->axial - below.axial);
    return {std::lerp(below.positive, above->positive, part),
            std::lerp(below.negative, above->negative, part)};
}
