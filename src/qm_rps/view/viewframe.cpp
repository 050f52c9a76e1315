#include "qm_rps/view/viewframe.h"

#include "qm_rps/judge/vectors.h"
#include "qm_rps/push/loadalgebra.h"

#include <algorithm>
#include <cmath>

namespace {

using KIND = T_SHAPE_SOURCE::KIND;

long IndexIn(const std::vector<int>& ids, int id)
{
    const auto at = std::ranges::lower_bound(ids, id);
    return at == ids.end() || *at != id ? -1 : static_cast<long>(at - ids.begin());
}

/// Keys of the load cases that act at a step: what has come less what has gone, stages one after
/// the other by their keys.
std::set<int> ActingCases(const T_MODEL& model, int stage, int step)
{
    std::set<int> acting;
    for (const auto& [key, record] : model.stages) {
        if (key > stage) break;
        const int last = key < stage ? record.steps : StageStepNumber(record, step);
        for (int s = 1; s <= last; ++s) {
            for (const T_STAG_LOAD& load : record.deactivate.loads)
                if (StageStepNumber(record, load.step) == s) acting.erase(load.loadCase);
            for (const T_STAG_LOAD& load : record.activate.loads)
                if (StageStepNumber(record, load.step) == s) acting.insert(load.loadCase);
        }
    }
    return acting;
}

/// Keeps the loads on elements that stand and on their nodes.
void KeepStanding(solver::T_LOAD_CASE& loads, const CAnalysisModel& model,
                  const std::set<int>& elements)
{
    std::set<std::size_t> standing, nodes;
    for (std::size_t e = 0; e < model.ElementIds().size(); ++e) {
        if (!elements.contains(model.ElementIds()[e])) continue;
        standing.insert(e);
        nodes.insert({model.Frame().elements[e].i, model.Frame().elements[e].j});
    }
    const auto off = [&](const auto& load) { return !standing.contains(load.element); };
    std::erase_if(loads.beam, off);
    std::erase_if(loads.temperature, off);
    std::erase_if(loads.pretension, off);
    std::erase_if(loads.nodal, [&](const auto& load) { return !nodes.contains(load.node); });
}

} // namespace

std::array<double, 3> ToAxes(const T_MEMBER_AXES& axes, const std::array<double, 3>& v)
{
    return {Dot(axes.x, v), Dot(axes.y, v), Dot(axes.z, v)};
}

std::array<double, 3> FromAxes(const T_MEMBER_AXES& axes, const std::array<double, 3>& v)
{
    return Plus(Plus(Plus({}, axes.x, v[0]), axes.y, v[1]), axes.z, v[2]);
}

int CViewFrame::Refresh(std::string& why)
{
    if (m_revision != m_doc.Data().Revision()) {
        m_revision = m_doc.Data().Revision();
        const T_MODEL& model = m_doc.Data().Model();
        m_model.emplace(model);
        m_axes.clear();
        m_why.clear();
        T_ANALYSIS_ERROR error;
        if (!m_model->BuildFrame(error)) m_why = error.text;
        for (const auto& entry : model.elements) {
            const bool spans = m_why.empty() && entry.second.kind != ELEM_KIND::Spring;
            m_axes.push_back(spans ? AxesOf(model, entry.second) : std::nullopt);
        }
    }
    if (!m_why.empty()) why = m_why;
    return m_why.empty() ? 1 : 0;
}

long CViewFrame::ElementAt(int id) const
{
    return IndexIn(m_model->ElementIds(), id);
}

long CViewFrame::NodeAt(int id) const
{
    return IndexIn(m_model->NodeIds(), id);
}

T_LINE_STIFFNESS CViewFrame::Stiffness(std::size_t element) const
{
    const solver::T_ELEMENT& e = Frame().elements[element];
    if (e.kind != solver::ELEMENT_KIND::Beam) return {};
    const solver::T_MATERIAL& m = Frame().materials[e.material];
    const solver::T_SECTION& s = Frame().sections[e.section];
    return {m.E * s.Iy, m.E * s.Iz, m.G * s.Asy, m.G * s.Asz};
}

T_LINE_ENDS CViewFrame::Ends(std::size_t element, const T_DOF6& nodeI, const T_DOF6& nodeJ) const
{
    const solver::T_ELEMENT& e = Frame().elements[element];
    const T_MEMBER_AXES& axes = *m_axes[element];
    const auto end = [&](const T_DOF6& node, const std::array<double, 3>& offset) {
        const std::array<double, 3> turn{node[3], node[4], node[5]};
        const auto u = ToAxes(axes, Plus({node[0], node[1], node[2]}, Cross(turn, offset), 1.0));
        const auto r = ToAxes(axes, turn);
        return T_DOF6{u[0], u[1], u[2], r[0], r[1], r[2]};
    };
    return {{end(nodeI, e.offsetI), end(nodeJ, e.offsetJ)}, {e.releaseI, e.releaseJ}};
}

int CViewFrame::AddCase(int key, double factor, solver::T_LOAD_CASE& to, std::string& why) const
{
    solver::T_LOAD_CASE loads;
    T_ANALYSIS_ERROR error;
    if (!m_model->BuildCase(key, loads, error)) {
        why = error.text;
        return 0;
    }
    AddLoads(to, loads, factor);
    return 1;
}

int CViewFrame::LoadsOf(const T_SHAPE_SOURCE& source, int step, solver::T_LOAD_CASE& out,
                        std::string& why) const
{
    out = {};
    const T_MODEL& model = m_doc.Data().Model();
    if (source.kind == KIND::Static) return AddCase(source.key, 1.0, out, why);
    if (source.kind == KIND::Combination) {
        T_LCOM_D record, flat;
        if (!m_doc.Attr().GetLcom(source.key, record)) return 0;
        if (!m_doc.Attr().NormalizeLcom(record, flat, why)) return 0;
        return std::ranges::all_of(flat.items, [&](const T_LCOM_ITEM& item) {
            return AddCase(item.key, item.factor, out, why) != 0;
        });
    }
    if (source.kind != KIND::Stage) return 1;
    for (const int key : ActingCases(model, source.key, step))
        if (!AddCase(key, 1.0, out, why)) return 0;
    KeepStanding(out, *m_model, StandingElements(model, source.key));
    return 1;
}

std::vector<std::vector<T_LINE_LOAD>> CViewFrame::LineLoads(const solver::T_LOAD_CASE& loads) const
{
    const solver::T_FRAME& frame = Frame();
    std::vector<std::vector<T_LINE_LOAD>> out(frame.elements.size());
    const bool weighs = std::ranges::any_of(loads.selfWeight, [](double f) { return f != 0.0; });
    for (std::size_t e = 0; weighs && e < out.size(); ++e) {
        const solver::T_ELEMENT& element = frame.elements[e];
        if (element.kind != solver::ELEMENT_KIND::Beam || !m_axes[e]) continue;
        const double weight = frame.gravity * frame.materials[element.material].density *
                              frame.sections[element.section].A;
        if (weight == 0.0) continue;
        const auto w = ToAxes(*m_axes[e], Plus({}, loads.selfWeight, weight));
        out[e].push_back({solver::BEAM_LOAD::Distributed, w, w, 0.0, m_axes[e]->length});
    }
    for (const solver::T_BEAM_LOAD& load : loads.beam) {
        if (!m_axes[load.element] ||
            frame.elements[load.element].kind != solver::ELEMENT_KIND::Beam)
            continue;
        const T_MEMBER_AXES& axes = *m_axes[load.element];
        std::array<double, 3> direction{};
        direction[static_cast<std::size_t>(load.direction)] = 1.0;
        if (!load.local) direction = ToAxes(axes, direction);
        out[load.element].push_back({load.type, Plus({}, direction, load.w[0]),
                                     Plus({}, direction, load.w[1]), load.at[0] * axes.length,
                                     load.at[1] * axes.length});
    }
    return out;
}
