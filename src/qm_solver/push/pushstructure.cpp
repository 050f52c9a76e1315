#include "qm_solver/push/pushstructure.h"

#include "qm_solver/checks/mechanism.h"
#include "qm_solver/checks/modelcheck.h"
#include "qm_solver/model/frameextent.h"

#include <algorithm>
#include <cmath>
#include <map>

namespace solver {

namespace {

T_SOLVER_ERROR Failed(T_SOLVER_REASON reason)
{
    T_SOLVER_ERROR error;
    error.fault = SOLVER_FAULT::Failed;
    error.reason = std::move(reason);
    return error;
}

T_VEC12 Gather(const T_ELEMENT& element, std::span<const double> full)
{
    T_VEC12 u{};
    for (std::size_t k = 0; k < ElementSize(element); ++k)
        u[k] = full[ElementIndex(element, k)];
    return u;
}

} // namespace

CPushStructure::CPushStructure(const T_PUSH_MODEL& model)
    : m_model(model), m_dofs(model.frame), m_extent(Extent(model.frame))
{
    MakeRows();
}

/// A component that two laws name at one place is refused before; the axial force of a place is a
/// row of its own where no law is on it.
void CPushStructure::MakeRows()
{
    const T_FRAME& frame = m_model.frame;
    std::vector<std::vector<T_PLACED_COMPONENT>> placed(frame.elements.size());
    std::vector<std::vector<std::pair<std::size_t, std::size_t>>> ofLaw(m_model.hinges.size());
    std::vector<std::optional<std::size_t>> axial(m_model.hinges.size());
    for (std::size_t h = 0; h < m_model.hinges.size(); ++h) {
        const T_PUSH_HINGE& hinge = m_model.hinges[h];
        auto& list = placed[hinge.element];
        bool wantsAxial = false;
        for (const T_HINGE_LAW& law : hinge.laws) {
            ofLaw[h].emplace_back(hinge.element, list.size());
            if (law.component == 0) axial[h] = list.size();
            wantsAxial = wantsAxial || !law.byAxial.empty();
            list.push_back({hinge.at, law.component, law.stiffness});
        }
        if (wantsAxial && !axial[h]) {
            axial[h] = list.size();
            list.push_back({hinge.at, 0, 0.0});
        }
    }
    m_rowsOf.resize(frame.elements.size());
    for (std::size_t e = 0; e < frame.elements.size(); ++e) {
        m_firstRow.push_back(m_rows.size());
        for (std::size_t c = 0; c < placed[e].size(); ++c) {
            m_rowsOf[e].push_back(m_rows.size());
            m_rows.push_back({e, c});
        }
        for (const T_PLACED_COMPONENT& c : placed[e])
            m_spring.push_back(c.spring > 0.0 ? 1.0 / c.spring : 0.0);
        m_elements.emplace_back(frame, e, placed[e]);
    }
    for (std::size_t h = 0; h < m_model.hinges.size(); ++h) {
        auto& rows = m_lawRow.emplace_back();
        for (const auto& [e, c] : ofLaw[h])
            rows.push_back(m_rowsOf[e][c]);
        m_axialRow.push_back(axial[h] ? m_rowsOf[m_model.hinges[h].element][*axial[h]]
                                      : m_rows.size());
    }
    m_placed = std::move(placed);
    m_soft.assign(m_rows.size(), 0.0);
    MakeTerms();
}

/// Influence of the rows over the unknowns.
void CPushStructure::MakeTerms()
{
    const T_FRAME& frame = m_model.frame;
    m_terms.clear();
    m_termFrom.clear();
    m_termFrom.push_back(0);
    for (const T_PUSH_ROW& row : m_rows) {
        const T_ELEMENT& element = frame.elements[row.element];
        const T_VEC12& influence = m_elements[row.element].Influence(row.component);
        std::map<int, double> sum;
        for (std::size_t k = 0; k < ElementSize(element); ++k)
            for (const T_TERM& t : m_dofs.Terms(ElementIndex(element, k)))
                if (influence[k] != 0.0) sum[t.index] += t.factor * influence[k];
        for (const auto& [index, factor] : sum)
            m_terms.push_back({index, factor});
        m_termFrom.push_back(m_terms.size());
    }
}

/// A structure that carries nothing yet is measured by what its hinges carry.
void CPushStructure::MakeForceScale()
{
    constexpr double kPart = 1e-3;
    for (const T_PUSH_HINGE& hinge : m_model.hinges)
        for (const T_HINGE_LAW& law : hinge.laws)
            for (const T_HINGE_SIDE* side : {&law.positive, &law.negative})
                for (const T_BACKBONE_POINT& p : side->points)
                    m_least =
                        std::max(m_least, kPart * p.force / (law.component < 3 ? 1.0 : m_extent));
    m_largest = m_least;
}

CPushStructure::T_FAULT CPushStructure::Prepare()
{
    MakeForceScale();
    T_SOLVER_REASON reason;
    if (!m_assembly.Prepare(m_model.frame, m_dofs, reason)) return Failed(reason);
    if (m_dofs.EquationCount() > 0) {
        m_assembly.Assemble([&](std::size_t e, T_MATRIX12& k) { m_elements[e].Stiffness(0.0, k); });
        if (!m_factor.Analyse(m_assembly.Matrix(), m_dofs.Blocks(), reason)) return Failed(reason);
        T_SOLVER_ERROR error;
        if (!FactorStable(m_model.frame, m_dofs, m_assembly.Matrix(), m_factor, error))
            return error;
        ++m_cost.factorisations;
    }
    return {};
}

CPushStructure::T_FAULT CPushStructure::Factorise(std::vector<double> tension)
{
    if (tension.empty() && m_tension.empty() && !m_isSoft) return {};
    m_tension = std::move(tension);
    if (auto fault = Refactorise()) return fault;
    // What has yielded may well be unstable (its path falls); the elastic frame must stand.
    const bool isElastic =
        std::all_of(m_soft.begin(), m_soft.end(), [](double c) { return c == 0.0; });
    if (isElastic && m_factor.Info().negativePivots > 0)
        return Failed("IDS_QM_ENGINE_PUSH_BUCKLES");
    return {};
}

CPushStructure::T_FAULT CPushStructure::Refactorise()
{
    if (m_dofs.EquationCount() == 0) return {};
    m_assembly.Assemble([&](std::size_t e, T_MATRIX12& k) {
        m_elements[e].Stiffness(m_tension.empty() ? 0.0 : m_tension[e], k);
    });
    T_SOLVER_REASON reason;
    if (!m_factor.Factor(m_assembly.Matrix(), reason, PIVOTS::AsTheyAre)) return Failed(reason);
    m_isSoft = false;
    ++m_cost.factorisations;
    return {};
}

void CPushStructure::MakeElement(std::size_t element)
{
    std::vector<T_PLACED_COMPONENT> components = m_placed[element];
    for (std::size_t c = 0; c < components.size(); ++c) {
        const double compliance = Compliance(m_firstRow[element] + c);
        components[c].spring = compliance > 0.0 ? 1.0 / compliance : 0.0;
    }
    m_elements[element] = CPushElement(m_model.frame, element, std::move(components));
}

CPushStructure::T_FAULT CPushStructure::Soften(std::span<const double> compliance)
{
    const std::vector<double> before(m_soft);
    m_soft.assign(compliance.begin(), compliance.end());
    for (std::size_t r = 0; r < m_rows.size(); ++r)
        if (m_soft[r] != before[r]) MakeElement(m_rows[r].element);
    MakeTerms();
    for (T_PUSH_LOADS& set : m_loads)
        FillLoads(set);
    return Refactorise();
}

void CPushStructure::Stiffen()
{
    for (std::size_t r = 0; r < m_rows.size(); ++r) {
        if (m_soft[r] == 0.0) continue;
        m_soft[r] = 0.0;
        MakeElement(m_rows[r].element);
        m_isSoft = true;
    }
    if (!m_isSoft) return;
    MakeTerms();
    for (T_PUSH_LOADS& set : m_loads)
        FillLoads(set);
}

CPushStructure::T_FAULT CPushStructure::Solve(std::span<double> sides, std::size_t count)
{
    T_SOLVER_REASON reason;
    m_cost.solves += count;
    if (m_dofs.EquationCount() > 0 && !m_factor.Solve(sides, count, reason)) return Failed(reason);
    return {};
}

CPushStructure::T_FAULT CPushStructure::AddLoads(const T_LOAD_CASE& given, std::size_t number)
{
    if (auto fault = CheckCase(m_model.frame, m_dofs, given, number)) return fault;
    T_PUSH_LOADS& set = m_loads.emplace_back();
    set.loads = std::make_unique<CCaseLoads>(m_model.frame, m_dofs, given);
    FillLoads(set);
    return {};
}

/// What the loads do to the elements as they are now.
void CPushStructure::FillLoads(T_PUSH_LOADS& set) const
{
    const T_FRAME& frame = m_model.frame;
    set.sum = {};
    set.element.clear();
    std::vector<double> full(set.loads->Nodal().begin(), set.loads->Nodal().end());
    const auto addSum = [&](std::size_t index, double force) {
        T_VEC3 f{};
        const std::size_t d = index % 6;
        if (d > 2) {
            set.sum[d] += force;
            return;
        }
        f[d] = force;
        set.sum[d] += force;
        AddPart(set.sum, 3, Cross(frame.nodes[index / 6].xyz, f));
    };
    for (std::size_t i = 0; i < full.size(); ++i)
        if (full[i] != 0.0) addSum(i, full[i]);
    const auto settled = set.loads->Settled();
    for (std::size_t e = 0; e < frame.elements.size(); ++e) {
        const T_ELEMENT& element = frame.elements[e];
        set.element.push_back(m_elements[e].Loads(set.loads->OnSpan(e), set.loads->Axial(e)));
        T_ELEMENT_LOADS& own = set.element.back();
        T_VEC12 moved{};
        if (!settled.empty()) moved = Gather(element, settled);
        own.moved.resize(settled.empty() ? 0 : own.force.size());
        for (std::size_t c = 0; c < own.moved.size(); ++c)
            for (std::size_t k = 0; k < 12; ++k)
                own.moved[c] += m_elements[e].Influence(c)[k] * moved[k];
        for (std::size_t k = 0; k < ElementSize(element); ++k)
            if (own.nodes[k] != 0.0) {
                full[ElementIndex(element, k)] -= own.nodes[k];
                addSum(ElementIndex(element, k), -own.nodes[k]);
            }
        if (settled.empty()) continue;
        double tension = 0.0;
        const T_VEC12 forced =
            m_elements[e].AtNodes(moved, std::vector<double>(own.force.size()), 0.0, tension);
        for (std::size_t k = 0; k < ElementSize(element); ++k)
            full[ElementIndex(element, k)] -= forced[k];
    }
    set.side.assign(m_dofs.EquationCount(), 0.0);
    m_dofs.Reduce(full, set.side);
}

CPushStructure::T_FAULT CPushStructure::SolveLoads()
{
    const std::size_t n = m_dofs.EquationCount();
    std::vector<double> sides;
    for (const T_PUSH_LOADS& set : m_loads)
        sides.insert(sides.end(), set.side.begin(), set.side.end());
    if (auto fault = Solve(sides, m_loads.size())) return fault;
    for (std::size_t l = 0; l < m_loads.size(); ++l) {
        T_PUSH_LOADS& set = m_loads[l];
        set.unknowns.assign(sides.begin() + static_cast<long>(l * n),
                            sides.begin() + static_cast<long>((l + 1) * n));
        set.force.resize(RowCount());
        for (std::size_t r = 0; r < RowCount(); ++r) {
            const T_ELEMENT_LOADS& own = set.element[m_rows[r].element];
            const std::size_t c = m_rows[r].component;
            double sum = own.force[c] + (own.moved.empty() ? 0.0 : own.moved[c]);
            for (std::size_t k = m_termFrom[r]; k < m_termFrom[r + 1]; ++k)
                sum += m_terms[k].factor * set.unknowns[static_cast<std::size_t>(m_terms[k].index)];
            set.force[r] = sum;
        }
    }
    return {};
}

CPushStructure::T_FAULT CPushStructure::Columns(std::span<const std::size_t> rows,
                                                std::span<const T_PROBE> probes,
                                                std::vector<double>& forces,
                                                std::vector<double>& values)
{
    const std::size_t n = m_dofs.EquationCount(), count = rows.size();
    std::vector<double> x(n * count, 0.0);
    for (std::size_t c = 0; c < count; ++c)
        for (std::size_t k = m_termFrom[rows[c]]; k < m_termFrom[rows[c] + 1]; ++k)
            x[c * n + static_cast<std::size_t>(m_terms[k].index)] = m_terms[k].factor;
    if (auto fault = Solve(x, count)) return fault;
    m_cost.columns += count;
    forces.resize(RowCount() * count);
    values.resize(probes.size() * count);
    for (std::size_t c = 0; c < count; ++c) {
        const std::span<const double> own(x.data() + c * n, n);
        double* column = forces.data() + c * RowCount();
        for (std::size_t r = 0; r < RowCount(); ++r) {
            double sum = 0.0;
            for (std::size_t k = m_termFrom[r]; k < m_termFrom[r + 1]; ++k)
                sum += m_terms[k].factor * own[static_cast<std::size_t>(m_terms[k].index)];
            column[r] = sum;
        }
        const std::size_t e = m_rows[rows[c]].element;
        for (const std::size_t r : m_rowsOf[e]) {
            column[r] -= m_elements[e].Own(m_rows[r].component, m_rows[rows[c]].component);
            if (!m_tension.empty())
                column[r] -= m_tension[e] *
                             m_elements[e].Kink(m_rows[r].component, m_rows[rows[c]].component);
        }
        for (std::size_t p = 0; p < probes.size(); ++p)
            values[c * probes.size() + p] = Value(probes[p], own);
    }
    return {};
}

T_PROBE CPushStructure::Displacement(std::size_t node, const T_VEC6& way) const
{
    T_PROBE out;
    for (std::size_t d = 0; d < 6; ++d)
        if (way[d] != 0.0)
            for (const T_TERM& t : m_dofs.Terms(6 * node + d))
                out.push_back({t.index, way[d] * t.factor});
    return out;
}

double CPushStructure::Value(const T_PROBE& probe, std::span<const double> unknowns) const
{
    double sum = 0.0;
    for (const T_TERM& t : probe)
        sum += t.factor * unknowns[static_cast<std::size_t>(t.index)];
    return sum;
}

} // namespace solver
