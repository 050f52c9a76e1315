#include "qm_solver/stages/stagepart.h"

#include "qm_solver/checks/mechanism.h"
#include "qm_solver/checks/modelcheck.h"
#include "qm_solver/checks/stabilitycheck.h"
#include "qm_solver/model/frameextent.h"

#include <algorithm>

namespace solver {

namespace {

using T_FAULT = std::optional<T_SOLVER_ERROR>;

T_SOLVER_ERROR Failed(T_SOLVER_REASON reason)
{
    T_SOLVER_ERROR error;
    error.fault = SOLVER_FAULT::Failed;
    error.reason = std::move(reason);
    return error;
}

T_SOLVER_ERROR BadAt(long T_SOLVER_ERROR::*where, std::size_t index, const char* reason)
{
    T_SOLVER_ERROR error;
    error.fault = SOLVER_FAULT::BadModel;
    error.*where = static_cast<long>(index);
    error.reason = reason;
    return error;
}

/// Numbers of elements as the model has them.
T_FAULT InModel(T_FAULT fault, const T_ACTIVE& active)
{
    if (fault && fault->element >= 0 &&
        static_cast<std::size_t>(fault->element) < active.elements.size())
        fault->element =
            static_cast<long>(active.elements[static_cast<std::size_t>(fault->element)]);
    return fault;
}

T_VEC6 Times(double factor, T_VEC6 v)
{
    for (double& value : v)
        value *= factor;
    return v;
}

} // namespace

CStagePart::CStagePart(const T_FRAME& whole, const T_ACTIVE& active)
    : m_active(active), m_frame(whole), m_extent(Extent(whole)), m_own(whole.elements.size(), -1),
      m_standing(whole.nodes.size(), 0)
{
    m_frame.elements.clear();
    for (std::size_t n = 0; n < whole.nodes.size(); ++n)
        m_frame.nodes[n].fixed = active.held[n];
    for (const std::size_t e : active.elements) {
        const T_ELEMENT& element = whole.elements[e];
        m_own[e] = static_cast<long>(m_frame.elements.size());
        m_frame.elements.push_back(element);
        for (const std::size_t n : {element.i, element.j}) {
            const bool ends = n == element.i || element.kind != ELEMENT_KIND::Spring;
            if (ends && n < m_standing.size()) m_standing[n] = 1;
        }
    }
    // A node that is missing stays, so that the check of the model finds it.
    const auto away = [&](std::size_t n) { return n < m_standing.size() && !m_standing[n]; };
    for (T_DIAPHRAGM& d : m_frame.diaphragms)
        std::erase_if(d.nodes, away);
    for (T_EQUAL_DISPLACEMENT& d : m_frame.equalDisplacements)
        std::erase_if(d.nodes, away);
}

std::optional<T_SOLVER_ERROR> CStagePart::Prepare(std::shared_ptr<CFactorSpace> space)
{
    T_FAULT fault = CheckModel(m_frame);
    if (!fault) fault = CheckRigidBodies(m_frame);
    if (fault) return InModel(fault, m_active);
    m_dofs.emplace(m_frame);
    T_SOLVER_REASON reason;
    if (!m_assembly.Prepare(m_frame, *m_dofs, reason)) return Failed(reason);
    if (!m_factor.Analyse(Matrix(), m_dofs->Blocks(), reason, std::move(space)))
        return Failed(reason);
    return {};
}

std::optional<T_SOLVER_ERROR> CStagePart::Factorise()
{
    if (!m_firstOrder) m_assembly.Assemble(m_frame);
    m_firstOrder = true;
    return Numeric({}, !m_proven);
}

std::optional<T_SOLVER_ERROR> CStagePart::Factorise(std::span<const T_AXIAL> axial, bool search)
{
    m_assembly.Assemble(m_frame, axial);
    m_firstOrder = false;
    return Numeric(axial, search);
}

std::optional<T_SOLVER_ERROR> CStagePart::Numeric(std::span<const T_AXIAL> axial, bool search)
{
    if (m_dofs->EquationCount() == 0) return {}; // everything is held
    T_SOLVER_REASON reason;
    T_SOLVER_ERROR error;
    if (search) {
        if (!FactorStable(m_frame, *m_dofs, Matrix(), m_factor, error, axial)) return error;
        m_proven = m_proven || m_firstOrder;
        return {};
    }
    const PIVOTS pivots = m_firstOrder ? PIVOTS::AsTheyAre : PIVOTS::Watch;
    if (!m_factor.Factor(Matrix(), reason, pivots)) return Failed(reason);
    return {};
}

std::optional<std::size_t> CStagePart::Own(std::size_t element) const
{
    if (m_own[element] < 0) return {};
    return static_cast<std::size_t>(m_own[element]);
}

/// Forces may not act on what is not there; strains and settlements leave with what they act on.
std::optional<T_SOLVER_ERROR> CStagePart::CheckPlaces(const T_LOAD_CASE& load, bool comes) const
{
    const auto element = [&](std::size_t e, bool must) -> T_FAULT {
        if (e >= m_own.size())
            return BadAt(&T_SOLVER_ERROR::element, e, "IDS_QM_ENGINE_LOAD_NO_ELEMENT");
        if (Own(e) || !must) return {};
        return BadAt(&T_SOLVER_ERROR::element, e, "IDS_QM_ENGINE_INACTIVE_ELEMENT");
    };
    const auto node = [&](std::size_t n, const char* missing) -> T_FAULT {
        if (n < m_standing.size()) return {};
        return BadAt(&T_SOLVER_ERROR::node, n, missing);
    };
    for (const T_NODAL_LOAD& l : load.nodal) {
        if (T_FAULT fault = node(l.node, "IDS_QM_ENGINE_LOAD_NO_NODE")) return fault;
        if (!m_standing[l.node])
            return BadAt(&T_SOLVER_ERROR::node, l.node, "IDS_QM_ENGINE_LONE_NODE");
    }
    for (const T_SETTLEMENT& l : load.settlement)
        if (T_FAULT fault = node(l.node, "IDS_QM_ENGINE_SETTLEMENT_NO_NODE")) return fault;
    for (const T_BEAM_LOAD& l : load.beam)
        if (T_FAULT fault = element(l.element, true)) return fault;
    for (const T_TEMPERATURE& l : load.temperature)
        if (T_FAULT fault = element(l.element, comes)) return fault;
    for (const T_PRETENSION& l : load.pretension)
        if (T_FAULT fault = element(l.element, comes)) return fault;
    return {};
}

std::optional<T_SOLVER_ERROR> CStagePart::CheckLoads(const T_LOAD_CASE& load, std::size_t loadCase,
                                                     bool comes) const
{
    T_FAULT fault = CheckPlaces(load, comes);
    if (!fault) {
        T_LOAD_CASE own;
        AddLoads(load, 1.0, own);
        if (comes) own.settlement = load.settlement;
        fault = InModel(CheckCase(m_frame, *m_dofs, own, loadCase), m_active);
    }
    if (fault) fault->loadCase = static_cast<long>(loadCase);
    return fault;
}

void CStagePart::AddLoads(const T_LOAD_CASE& load, double factor, T_LOAD_CASE& sum) const
{
    for (std::size_t d = 0; d < 3; ++d)
        sum.selfWeight[d] += factor * load.selfWeight[d];
    for (const T_NODAL_LOAD& l : load.nodal)
        sum.nodal.push_back({l.node, Times(factor, l.load)});
    for (T_BEAM_LOAD l : load.beam)
        if (const auto own = Own(l.element)) {
            l.element = *own;
            l.w = {factor * l.w[0], factor * l.w[1]};
            sum.beam.push_back(l);
        }
    for (const T_TEMPERATURE& l : load.temperature)
        if (const auto own = Own(l.element)) sum.temperature.push_back({*own, factor * l.change});
    for (const T_PRETENSION& l : load.pretension)
        if (const auto own = Own(l.element)) sum.pretension.push_back({*own, factor * l.force});
    for (T_SETTLEMENT l : load.settlement) {
        for (std::size_t d = 0; d < 6; ++d)
            if (!m_active.held[l.node][d]) l.displacement[d] = 0.0;
        sum.settlement.push_back({l.node, Times(factor, l.displacement)});
    }
}

} // namespace solver
