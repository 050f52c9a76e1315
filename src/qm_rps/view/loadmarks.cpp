#include "qm_rps/view/loadmarks.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/judge/vectors.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kNothing = 1e-9; // of the largest value of a kind: rounding

double Norm(const std::array<double, 3>& v)
{
    return std::sqrt(Dot(v, v));
}

std::array<double, 3> Vector(const std::array<double, 6>& v, std::size_t first)
{
    return {v[first], v[first + 1], v[first + 2]};
}

class CMarks {
public:
    CMarks(const T_FRAME_SCENE& scene, const T_UNITS& units) : m_scene(scene), m_units(units)
    {
        const std::string force(NameOf(units.force)), length(NameOf(units.length));
        m_out.unit = {force, force + "*" + length, length, "rad"};
        m_out.bandUnit = force + "/" + length;
        for (std::size_t n = 0; n < scene.nodes.size(); ++n)
            m_nodes[scene.nodes[n].id] = n;
        for (std::size_t l = 0; l < scene.lines.size(); ++l)
            m_lines[scene.lines[l].id] = l;
    }

    /// The node's place; null: it is not shown.
    const std::array<double, 3>* Node(int id) const
    {
        const auto at = m_nodes.find(id);
        return at == m_nodes.end() || !m_scene.nodes[at->second].shown
                   ? nullptr
                   : &m_scene.nodes[at->second].xyz;
    }
    const T_SCENE_LINE* Line(int element) const
    {
        const auto at = m_lines.find(element);
        return at == m_lines.end() ? nullptr : &m_scene.lines[at->second];
    }
    /// A place along a line, between the ends of its flexible length.
    std::array<double, 3> On(const T_SCENE_LINE& line, double s) const
    {
        const auto i = Plus(m_scene.nodes[line.i].xyz, line.offsetI, 1.0);
        const auto j = Plus(m_scene.nodes[line.j].xyz, line.offsetJ, 1.0);
        return Plus(Plus({}, i, 1.0 - s), j, s);
    }
    void Arrow(MARK_KIND kind, const std::array<double, 3>& at, const std::array<double, 3>& si)
    {
        constexpr std::array<T_DIM, kMarkKinds> kDims{kDimForce, kDimMoment, kDimLength, kDimNone};
        const double size = Norm(si);
        if (size == 0.0) return;
        m_out.arrows.push_back({kind, at, Plus({}, si, 1.0 / size),
                                FromSi(size, m_units, kDims[static_cast<std::size_t>(kind)]), 0.0});
    }
    void Arrows(const std::array<double, 3>& at, const std::array<double, 6>& si, MARK_KIND linear,
                MARK_KIND angular)
    {
        Arrow(linear, at, Vector(si, 0));
        Arrow(angular, at, Vector(si, 3));
    }
    void Band(const T_SCENE_LINE& line, double a, double b, const std::array<double, 3>& w0,
              const std::array<double, 3>& w1)
    {
        const double factor = 1.0 / SiFactor(m_units, {1, -1});
        m_out.bands.push_back({On(line, a),
                               On(line, b),
                               Plus({}, w0, factor),
                               Plus({}, w1, factor),
                               {factor * Norm(w0), factor * Norm(w1)}});
        if (Dot(w0, w1) < 0.0) m_out.bands.back().value[1] *= -1.0;
    }
    void Word(const T_SCENE_LINE& line, std::string text)
    {
        m_out.words.push_back({On(line, 0.5), std::move(text)});
    }
    void Note(std::string text) { m_out.notes.push_back(std::move(text)); }

    /// Sizes over the largest of each kind; what is nothing beside it goes.
    T_LOAD_MARKS Done()
    {
        std::array<double, kMarkKinds> largest{};
        for (const T_ARROW_MARK& arrow : m_out.arrows) {
            double& of = largest[static_cast<std::size_t>(arrow.kind)];
            of = std::max(of, arrow.value);
        }
        for (T_ARROW_MARK& arrow : m_out.arrows)
            arrow.size = arrow.value / largest[static_cast<std::size_t>(arrow.kind)];
        std::erase_if(m_out.arrows, [](const T_ARROW_MARK& a) { return a.size < kNothing; });
        double most = 0.0;
        for (const T_BAND_MARK& band : m_out.bands)
            most = std::max({most, std::fabs(band.value[0]), std::fabs(band.value[1])});
        for (T_BAND_MARK& band : m_out.bands)
            for (auto* along : {&band.along0, &band.along1})
                *along = Plus({}, *along, most > 0.0 ? 1.0 / most : 0.0);
        return std::move(m_out);
    }

private:
    const T_FRAME_SCENE& m_scene;
    T_UNITS m_units;
    std::map<int, std::size_t> m_nodes, m_lines;
    T_LOAD_MARKS m_out;
};

void AddBeamLoad(const CViewFrame& frame, const solver::T_BEAM_LOAD& load, CMarks& marks, int id)
{
    const T_SCENE_LINE* const line = marks.Line(id);
    const auto& axes = frame.Axes(load.element);
    if (!line || !axes) return;
    std::array<double, 3> direction{};
    direction[static_cast<std::size_t>(load.direction)] = 1.0;
    if (load.local) direction = FromAxes(*axes, direction);
    const auto w0 = Plus({}, direction, load.w[0]), w1 = Plus({}, direction, load.w[1]);
    if (load.type == solver::BEAM_LOAD::Distributed)
        return marks.Band(*line, load.at[0], load.at[1], w0, w1);
    const bool moment = load.type == solver::BEAM_LOAD::Moment;
    marks.Arrow(moment ? MARK_KIND::Moment : MARK_KIND::Force, marks.On(*line, load.at[0]), w0);
}

/// "Self weight: 1 times along -Z".
void AddSelfWeight(const solver::T_LOAD_CASE& loads, CMarks& marks)
{
    for (std::size_t d = 0; d < 3; ++d) {
        const double factor = loads.selfWeight[d];
        if (factor == 0.0) continue;
        const std::string axis = std::string(factor < 0.0 ? "-" : "+") + "XYZ"[d];
        marks.Note(Say("IDS_QM_VIEW_SELF_WEIGHT", FormatText("%.4g", std::fabs(factor)), axis));
    }
}

/// Loads of one kind at one place, added up.
template <class LOADS, class VALUE>
std::map<std::size_t, solver::T_VEC6> ByNode(const LOADS& loads, VALUE value)
{
    std::map<std::size_t, solver::T_VEC6> out;
    for (const auto& load : loads)
        for (std::size_t d = 0; d < 6; ++d)
            out[load.node][d] += (load.*value)[d];
    return out;
}

} // namespace

T_LOAD_MARKS LoadMarksOf(const CViewFrame& frame, const T_FRAME_SCENE& scene,
                         const solver::T_LOAD_CASE& loads, const T_UNITS& units)
{
    CMarks marks(scene, units);
    AddSelfWeight(loads, marks);
    for (const auto& [node, value] : ByNode(loads.nodal, &solver::T_NODAL_LOAD::load))
        if (const auto* at = marks.Node(frame.NodeId(node)))
            marks.Arrows(*at, value, MARK_KIND::Force, MARK_KIND::Moment);
    for (const auto& [node, value] : ByNode(loads.settlement, &solver::T_SETTLEMENT::displacement))
        if (const auto* at = marks.Node(frame.NodeId(node)))
            marks.Arrows(*at, value, MARK_KIND::Movement, MARK_KIND::Turn);
    for (const solver::T_BEAM_LOAD& load : loads.beam)
        AddBeamLoad(frame, load, marks, frame.ElementId(load.element));
    std::map<std::size_t, double> pretension, warming;
    for (const solver::T_PRETENSION& load : loads.pretension)
        pretension[load.element] += load.force;
    for (const solver::T_TEMPERATURE& load : loads.temperature)
        warming[load.element] += load.change;
    const std::string force(NameOf(units.force));
    for (const auto& [element, value] : pretension)
        if (const auto* line = marks.Line(frame.ElementId(element)))
            marks.Word(*line, Say("IDS_QM_VIEW_PRETENSION",
                                  FormatText("%.4g", FromSi(value, units, kDimForce)), force));
    for (const auto& [element, value] : warming)
        if (const auto* line = marks.Line(frame.ElementId(element)))
            marks.Word(*line, Say("IDS_QM_VIEW_WARMING", FormatText("%+.4g", value)));
    return marks.Done();
}

T_LOAD_MARKS ReactionMarksOf(const T_FRAME_SCENE& scene, const T_VIEW_RESULTS& results,
                             const T_UNITS& units)
{
    CMarks marks(scene, units);
    for (const T_NODE_VALUES& at : results.reactions)
        for (std::size_t d = 0; d < 6; ++d) {
            std::array<double, 3> component{};
            component[d % 3] = at.values[d];
            marks.Arrow(d < 3 ? MARK_KIND::Force : MARK_KIND::Moment, scene.nodes[at.node].xyz,
                        component);
        }
    return marks.Done();
}
