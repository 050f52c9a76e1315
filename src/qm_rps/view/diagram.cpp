#include "qm_rps/view/diagram.h"

#include "qm_rps/judge/vectors.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr int kParts = 32;               // of a member whose diagram is curved
constexpr std::size_t kManyLines = 4000; // more than so many have fewer parts
constexpr double kNothing = 1e-9;        // of the largest force, or moment

bool IsMoment(MEMBER_FORCE what)
{
    return what == MEMBER_FORCE::T || what == MEMBER_FORCE::My || what == MEMBER_FORCE::Mz;
}

std::array<double, 3> Side(const T_MEMBER_AXES& axes, MEMBER_FORCE what)
{
    if (what == MEMBER_FORCE::Vy) return axes.y;
    if (what == MEMBER_FORCE::Mz) return Plus({}, axes.y, -1.0);
    return axes.z;
}

/// The largest force or moment of the whole picture: what is far below it is rounding.
double SizeOf(const std::vector<T_ELEM_FORCES>& all, bool moment)
{
    double size = 0.0;
    for (const T_ELEM_FORCES& forces : all)
        for (const T_DOF6& at : forces)
            for (std::size_t c = moment ? 3 : 0; c < (moment ? 6U : 3U); ++c)
                size = std::max(size, std::fabs(at[c]));
    return size;
}

class CDiagramMaker {
public:
    CDiagramMaker(MEMBER_FORCE what, const T_UNITS& units, int parts, double nothing)
        : m_what(what), m_factor(1.0 / SiFactor(units, IsMoment(what) ? kDimMoment : kDimForce)),
          m_parts(parts), m_nothing(nothing)
    {
    }

    void Add(std::size_t line, const T_MEMBER_AXES& axes, const CMemberLine& member, bool exact,
             T_DIAGRAM& out) const
    {
        const auto c = static_cast<std::size_t>(m_what);
        T_MEMBER_DIAGRAM d{line, out.points.size(), 0, 0, 0, Side(axes, m_what), exact};
        const auto add = [&](double x, double value) {
            const double shown = std::fabs(value) > m_nothing ? value * m_factor : 0.0;
            out.points.push_back({x / member.Length(), shown});
        };
        for (const double x : member.Stations(c, m_parts)) {
            const double before = member.Force(c, x), behind = member.Force(c, x, true);
            add(x, before);
            if (std::fabs(behind - before) > m_nothing && x < member.Length()) add(x, behind);
        }
        d.count = out.points.size() - d.first;
        d.largest = d.smallest = d.first;
        for (std::size_t p = d.first; p < out.points.size(); ++p) {
            if (out.Value(p) > out.Value(d.largest)) d.largest = p;
            if (out.Value(p) < out.Value(d.smallest)) d.smallest = p;
        }
        if (!exact) ++out.notExact;
        out.members.push_back(d);
    }

private:
    MEMBER_FORCE m_what;
    double m_factor;
    int m_parts;
    double m_nothing;
};

void FindExtremes(T_DIAGRAM& d)
{
    for (std::size_t m = 0; m < d.members.size(); ++m) {
        if (d.Value(d.members[m].largest) > d.Value(d.members[d.largest].largest)) d.largest = m;
        if (d.Value(d.members[m].smallest) < d.Value(d.members[d.smallest].smallest))
            d.smallest = m;
    }
}

std::span<const T_LINE_LOAD> LoadsAt(const std::vector<std::vector<T_LINE_LOAD>>& all, long element)
{
    return all[static_cast<std::size_t>(element)];
}

/// From node I to node J: the rigid offsets go straight.
void AddBent(const CDeflectedLine& bent, const T_MEMBER_AXES& axes, double toSi,
             std::vector<std::array<double, 3>>& out)
{
    for (std::size_t p = 0; p <= kBentParts; ++p) {
        const double x = axes.length * static_cast<double>(p) / kBentParts;
        out.push_back(Plus({}, FromAxes(axes, bent.At(x)), 1.0 / toSi));
    }
}

} // namespace

T_HINGE_TURNS HingeTurnsOf(const T_PUSH_RUN& run, int step)
{
    constexpr double kAtEnd = 1e-6; // of the length
    T_HINGE_TURNS out;
    for (std::size_t h = 0; h < run.hinges.size(); ++h) {
        const T_PUSH_HINGE_SERIES& hinge = run.hinges[h];
        const bool y = hinge.place.component == HINGE_COMPONENT::My;
        if (!y && hinge.place.component != HINGE_COMPONENT::Mz) continue;
        const double at = run.data.hinges[h].at;
        if (at > kAtEnd && at < 1.0 - kAtEnd) continue;
        T_ENDS<std::array<double, 2>>& turns = out[hinge.place.element];
        (at < 0.5 ? turns.I : turns.J)[y ? 0 : 1] +=
            hinge.deformation[static_cast<std::size_t>(step - 1)];
    }
    return out;
}

void TakeHinges(const T_HINGE_TURNS& turns, int element, T_LINE_ENDS& ends)
{
    const auto found = turns.find(element);
    if (found == turns.end()) return;
    for (const std::size_t k : {0U, 1U}) {
        ends.moved.I[4 + k] += found->second.I[k];
        ends.moved.J[4 + k] -= found->second.J[k];
    }
}

double T_DIAGRAM::Size() const
{
    if (members.empty()) return 0.0;
    return std::max(std::fabs(Value(members[largest].largest)),
                    std::fabs(Value(members[smallest].smallest)));
}

T_DIAGRAM DiagramOf(const CViewFrame& frame, const T_FRAME_SCENE& scene,
                    const T_VIEW_RESULTS& results, const solver::T_LOAD_CASE& loads,
                    MEMBER_FORCE what, const T_UNITS& units)
{
    T_DIAGRAM out;
    out.name = kMemberForceNames[static_cast<std::size_t>(what)];
    out.unit = std::string(NameOf(units.force));
    if (IsMoment(what)) out.unit += "*" + std::string(NameOf(units.length));
    if (results.force.size() != scene.lines.size()) return out;
    const auto lineLoads = frame.LineLoads(loads);
    const CDiagramMaker maker(what, units, scene.lines.size() > kManyLines ? 6 : kParts,
                              kNothing * SizeOf(results.force, IsMoment(what)));
    for (std::size_t l = 0; l < scene.lines.size(); ++l) {
        const long e = frame.ElementAt(scene.lines[l].id);
        if (e < 0 || scene.lines[l].kind == ELEM_KIND::Link) continue;
        const auto& axes = frame.Axes(static_cast<std::size_t>(e));
        if (!axes) continue;
        const bool beam = scene.lines[l].kind == ELEM_KIND::Beam;
        if (!beam && what != MEMBER_FORCE::N) continue;
        const auto acting = beam ? LoadsAt(lineLoads, e) : std::span<const T_LINE_LOAD>();
        CMemberLine member(axes->length, results.force[l][0], acting);
        const bool exact = member.FitTo(results.force[l]);
        maker.Add(l, *axes, member, exact, out);
    }
    FindExtremes(out);
    return out;
}

T_BENT_LINES BentLinesOf(const CViewFrame& frame, const T_FRAME_SCENE& scene,
                         const T_VIEW_RESULTS& results, const solver::T_LOAD_CASE& loads,
                         const T_UNITS& units, T_DIM dim, const T_HINGE_TURNS& hingeTurns)
{
    T_BENT_LINES out;
    if (results.moved.size() != scene.nodes.size() || scene.lines.size() > kBentLines) return out;
    out.parts = kBentParts;
    out.moved.reserve(scene.lines.size() * (kBentParts + 1));
    const auto lineLoads = frame.LineLoads(loads);
    const double toSi = SiFactor(units, dim);
    const bool known = results.force.size() == scene.lines.size();
    for (std::size_t l = 0; l < scene.lines.size(); ++l) {
        const T_SCENE_LINE& line = scene.lines[l];
        const long at = frame.ElementAt(line.id);
        const auto e = static_cast<std::size_t>(at);
        const T_DOF6 &i = results.moved[line.i], &j = results.moved[line.j];
        if (at < 0 || line.kind != ELEM_KIND::Beam || !frame.Axes(e)) {
            for (std::size_t p = 0; p <= kBentParts; ++p) {
                const double s = static_cast<double>(p) / kBentParts;
                out.moved.push_back({((1.0 - s) * i[0] + s * j[0]) / toSi,
                                     ((1.0 - s) * i[1] + s * j[1]) / toSi,
                                     ((1.0 - s) * i[2] + s * j[2]) / toSi});
            }
            continue;
        }
        const T_LINE_STIFFNESS stiffness = frame.Stiffness(e);
        T_LINE_ENDS ends = frame.Ends(e, i, j);
        TakeHinges(hingeTurns, line.id, ends);
        CMemberLine member =
            known ? CMemberLine(frame.Axes(e)->length, results.force[l][0], LoadsAt(lineLoads, at))
                  : CMemberLine(frame.Axes(e)->length, ends, stiffness);
        if (known) (void)member.FitTo(results.force[l]);
        AddBent(CDeflectedLine(member, ends, stiffness), *frame.Axes(e), toSi, out.moved);
    }
    return out;
}
