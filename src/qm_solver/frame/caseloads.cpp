#include "qm_solver/frame/caseloads.h"

#include "qm_solver/element/beamelement.h"
#include "qm_solver/element/elementstiffness.h"
#include "qm_solver/model/framemass.h"

#include <algorithm>

namespace solver {

CCaseLoads::CCaseLoads(const T_FRAME& frame, const CFrameDofs& dofs, const T_LOAD_CASE& load)
    : m_nodal(dofs.FullCount(), 0.0)
{
    for (const T_NODAL_LOAD& l : load.nodal)
        for (std::size_t d = 0; d < 6; ++d)
            m_nodal[6 * l.node + d] += l.load[d];
    std::vector<T_PLACED> placed;
    if (Norm(load.selfWeight) > 0.0) AddSelfWeight(frame, load.selfWeight, placed);
    for (const T_BEAM_LOAD& l : load.beam)
        AddBeamLoad(frame, l, placed);
    if (!placed.empty()) Sort(placed, frame.elements.size());
    AddStrains(frame, load);
    AddSettlements(dofs, load);
}

void CCaseLoads::AddSelfWeight(const T_FRAME& frame, const T_VEC3& factor,
                               std::vector<T_PLACED>& placed)
{
    for (std::size_t e = 0; e < frame.elements.size(); ++e) {
        const T_ELEMENT& element = frame.elements[e];
        const T_VEC3 weight = Scaled(factor, frame.gravity * ElementMass(frame, element));
        if (Norm(weight) == 0.0) continue;
        if (element.kind == ELEMENT_KIND::Truss) {
            AddPart(m_nodal, 6 * element.i, Scaled(weight, 0.5));
            AddPart(m_nodal, 6 * element.j, Scaled(weight, 0.5));
            continue;
        }
        T_AXES axes;
        double length = 0.0;
        if (!BeamAxes(frame, element, axes, length)) continue; // not in a checked frame
        const T_VEC3 w = ToLocal(axes, Scaled(weight, 1.0 / length));
        placed.push_back({e, {BEAM_LOAD::Distributed, w, w, 0.0, length}});
    }
}

void CCaseLoads::AddBeamLoad(const T_FRAME& frame, const T_BEAM_LOAD& load,
                             std::vector<T_PLACED>& placed)
{
    const T_ELEMENT& element = frame.elements[load.element];
    if (element.kind == ELEMENT_KIND::Truss) return ShareOnTruss(frame, load);
    T_AXES axes;
    double length = 0.0;
    if (!BeamAxes(frame, element, axes, length)) return; // not in a checked frame
    T_VEC3 direction{};
    direction[static_cast<std::size_t>(load.direction)] = 1.0;
    if (!load.local) direction = ToLocal(axes, direction);
    placed.push_back({load.element,
                      {load.type, Scaled(direction, load.w[0]), Scaled(direction, load.w[1]),
                       load.at[0] * length, load.at[1] * length}});
}

/// The lever rule: J takes the load's moment about I over the length.
void CCaseLoads::ShareOnTruss(const T_FRAME& frame, const T_BEAM_LOAD& load)
{
    const T_ELEMENT& element = frame.elements[load.element];
    const double a = load.at[0], b = load.at[1];
    double total = load.w[0], atJ = load.w[0] * a;
    if (load.type == BEAM_LOAD::Distributed) {
        double length = 0.0;
        TrussDirection(frame, element, length);
        const double run = (b - a) * length;
        total = 0.5 * (load.w[0] + load.w[1]) * run;
        atJ = (load.w[0] * (2.0 * a + b) + load.w[1] * (a + 2.0 * b)) / 6.0 * run;
    }
    const std::size_t d = static_cast<std::size_t>(load.direction);
    m_nodal[6 * element.i + d] += total - atJ;
    m_nodal[6 * element.j + d] += atJ;
}

void CCaseLoads::AddStrains(const T_FRAME& frame, const T_LOAD_CASE& load)
{
    if (load.temperature.empty() && load.pretension.empty()) return;
    m_axial.assign(frame.elements.size(), 0.0);
    for (const T_PRETENSION& p : load.pretension)
        m_axial[p.element] += p.force;
    for (const T_TEMPERATURE& t : load.temperature) {
        const T_ELEMENT& element = frame.elements[t.element];
        const T_MATERIAL& material = frame.materials[element.material];
        m_axial[t.element] -=
            material.E * frame.sections[element.section].StiffA() * material.alpha * t.change;
    }
}

void CCaseLoads::AddSettlements(const CFrameDofs& dofs, const T_LOAD_CASE& load)
{
    if (load.settlement.empty()) return;
    std::vector<double> given(dofs.FullCount(), 0.0);
    for (const T_SETTLEMENT& s : load.settlement)
        for (std::size_t d = 0; d < 6; ++d)
            given[6 * s.node + d] += s.displacement[d];
    m_settled.assign(dofs.FullCount(), 0.0);
    for (std::size_t full = 0; full < dofs.FullCount(); ++full)
        for (const T_TERM& t : dofs.FixedTerms(full))
            m_settled[full] += t.factor * given[static_cast<std::size_t>(t.index)];
}

void CCaseLoads::Sort(std::vector<T_PLACED>& placed, std::size_t elements)
{
    std::stable_sort(placed.begin(), placed.end(),
                     [](const T_PLACED& a, const T_PLACED& b) { return a.element < b.element; });
    m_from.assign(elements + 1, 0);
    for (const T_PLACED& p : placed) {
        ++m_from[p.element + 1];
        m_loads.push_back(p.load);
    }
    for (std::size_t e = 0; e < elements; ++e)
        m_from[e + 1] += m_from[e];
}

} // namespace solver
