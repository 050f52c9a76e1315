// The elastic frame behind a push: its factor, its answers to loads and to plastic deformations.
#pragma once

#include "qm_solver/frame/frameassembly.h"
#include "qm_solver/push/pushelement.h"
#include "qm_solver/pushmodel.h"
#include "qm_solver/pushresult.h"

#include <memory>
#include <optional>

namespace solver {

/// A force of an element that is watched or flows: of its hinges' laws and, where strengths hang on
/// it, the axial force at their places.
struct T_PUSH_ROW {
    std::size_t element = 0;
    std::size_t component = 0; // of the CPushElement
};

/// A linear functional of the unknowns: a displacement.
using T_PROBE = std::vector<T_TERM>;

/// One set of loads at factor 1, and the elastic answer to it.
struct T_PUSH_LOADS {
    std::unique_ptr<CCaseLoads> loads;
    std::vector<T_ELEMENT_LOADS> element; // by element
    std::vector<double> side;             // right-hand side over the unknowns
    std::vector<double> unknowns;         // solution
    std::vector<double> force;            // by row
    T_VEC6 sum{}; // resultant about the origin: nodal loads and loads on elements
};

/// A displaced state of the whole structure.
struct T_PUSH_STATE {
    std::vector<double> factors; // by set of loads
    std::vector<double> plastic; // by row
};

class CPushStructure {
public:
    using T_FAULT = std::optional<T_SOLVER_ERROR>;

    explicit CPushStructure(const T_PUSH_MODEL& model);

    /// Rows, pattern, symbolic factorisation and the first factorisation.
    T_FAULT Prepare();
    /// Factorises with the couples of these axial forces, by element; empty: first order. Answers
    /// to loads and plastic deformations are those of the last factorisation: they are to be asked
    /// for again. Compression that the elastic frame can't stand is a fault.
    T_FAULT Factorise(std::vector<double> tension);
    /// The same factor once more.
    T_FAULT Refactorise();
    std::span<const double> Tension() const { return m_tension; }
    /// Checks and takes a set of loads, the next one; `number` names it in a fault.
    T_FAULT AddLoads(const T_LOAD_CASE& loads, std::size_t number);
    /// Compliance in series with rows, beyond their own springs: elements, loads and factor anew.
    /// Answers to loads and plastic deformations are to be asked for again.
    T_FAULT Soften(std::span<const double> compliance);
    /// The elements as they were given, without a factor.
    void Stiffen();
    /// Of all that is elastic in series with the element.
    double Compliance(std::size_t row) const { return m_spring[row] + m_soft[row]; }
    void DropLoads()
    {
        m_loads.clear();
        m_largest = m_least;
    }
    T_FAULT SolveLoads();

    std::size_t RowCount() const { return m_rows.size(); }
    std::size_t LoadCount() const { return m_loads.size(); }
    const T_PUSH_LOADS& Loads(std::size_t number) const { return m_loads[number]; }
    /// Row of a law of a hinge, and of the axial force at its place (none: RowCount()).
    std::size_t RowOf(std::size_t hinge, std::size_t law) const { return m_lawRow[hinge][law]; }
    std::size_t AxialRow(std::size_t hinge) const { return m_axialRow[hinge]; }

    /// Force of a row by a unit of its own plastic deformation while the nodes are held.
    double OwnStiffness(std::size_t row) const
    {
        return m_elements[m_rows[row].element].Own(m_rows[row].component, m_rows[row].component);
    }
    /// The plastic deformation of a row kinks a member with P-Delta: no spring can stand for it.
    bool Kinks(std::size_t row) const
    {
        const std::size_t e = m_rows[row].element, c = m_rows[row].component;
        return !m_tension.empty() && m_tension[e] != 0.0 && m_elements[e].Kink(c, c) != 0.0;
    }
    /// Forces of all rows and values of the probes by unit plastic deformations of these rows, one
    /// column after the other, solved in one block.
    T_FAULT Columns(std::span<const std::size_t> rows, std::span<const T_PROBE> probes,
                    std::vector<double>& forces, std::vector<double>& values);
    /// Displacement of a node along a way, by factors of its six directions.
    T_PROBE Displacement(std::size_t node, const T_VEC6& way) const;
    double Value(const T_PROBE& probe, std::span<const double> unknowns) const;

    /// Displacements of all nodes of states, reactions, axial forces at hinges and the residual,
    /// one solve for all.
    /// tension: mean axial forces of the elements in the last one.
    T_FAULT Displace(std::span<const T_PUSH_STATE> states, std::span<T_PUSH_STEP> steps,
                     std::vector<double>& tension);
    /// Unknowns and forces of all rows of a state, from its displacements.
    T_FAULT Solve(const T_PUSH_STATE& state, std::vector<double>& unknowns,
                  std::vector<double>& forces);
    /// Forces inside all elements of a displaced state.
    void Inside(const T_PUSH_STATE& state, const T_PUSH_STEP& step, T_RESULT& out) const;
    /// Axial forces that P-Delta acts on: 0 of what is level.
    std::vector<double> Coupled(std::vector<double> tension) const;

    const T_FRAME& Frame() const { return m_model.frame; }
    const CFrameDofs& Dofs() const { return m_dofs; }
    const T_SYMMETRIC_MATRIX& Matrix() const { return m_assembly.Matrix(); }
    CSparseFactor& Factor() { return m_factor; }
    const T_PUSH_COST& Cost() const { return m_cost; }
    T_PUSH_COST& Cost() { return m_cost; }

private:
    void MakeRows();
    void MakeForceScale();
    void MakeTerms();
    void MakeElement(std::size_t element);
    void FillLoads(T_PUSH_LOADS& set) const;
    void AddSides(const T_PUSH_STATE& state, std::span<double> side) const;
    void TakeDisplacements(const T_PUSH_STATE& state, std::span<const double> unknowns,
                           std::span<double> full) const;
    T_FAULT Solve(std::span<double> sides, std::size_t count);
    std::span<const double> PlasticOf(std::size_t element, std::span<const double> plastic) const;
    T_VEC12 ElementLoads(std::size_t element, std::span<const double> factors) const;
    void Balance(const T_PUSH_STATE& state, std::span<const double> full, T_PUSH_STEP& step,
                 std::vector<double>& left, std::vector<double>& tension);

    const T_PUSH_MODEL& m_model;
    CFrameDofs m_dofs;
    CFrameAssembly m_assembly;
    CSparseFactor m_factor;
    double m_extent = 1.0;
    std::vector<CPushElement> m_elements;
    std::vector<std::vector<T_PLACED_COMPONENT>> m_placed; // of the elements, as given
    std::vector<double> m_spring, m_soft; // by row: compliance of its spring, and in series with it
    std::vector<T_PUSH_ROW> m_rows;
    std::vector<std::vector<std::size_t>> m_lawRow, m_rowsOf; // by hinge; by element
    std::vector<std::size_t> m_axialRow, m_firstRow;          // by hinge; by element
    std::vector<std::size_t> m_termFrom; // influence of the rows over the unknowns
    std::vector<T_TERM> m_terms;
    std::vector<double> m_tension; // of the factor; empty: first order
    bool m_isSoft = false;         // the factor is that of softer elements
    std::vector<T_PUSH_LOADS> m_loads;
    double m_largest = 0.0; // force of the run so far, what residuals are compared with
    double m_least = 0.0;   // a part of the strengths, below which it does not fall
    T_PUSH_COST m_cost;
};

} // namespace solver
