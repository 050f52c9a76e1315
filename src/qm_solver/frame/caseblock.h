// A block of load cases of one frame: right-hand sides before, results after the solution.
#pragma once

#include "qm_solver/element/elementstiffness.h"
#include "qm_solver/frame/caseloads.h"
#include "qm_solver/frameresult.h"
#include "qm_solver/model/vec3.h"

#include <functional>
#include <span>
#include <vector>

namespace solver {

/// What construction in stages adds to a load case: the elements' forces follow from the
/// displacements since their birth, the geometric stiffness acts on all of the displacement.
struct T_HISTORY {
    /// By column of the block and full index: displacements that stand whatever the unknowns are.
    /// Empty: none.
    std::vector<std::vector<double>> held;
    /// Displacement of the nodes of an element at its birth, in a column; false if it is 0.
    std::function<bool(std::size_t element, std::size_t column, T_VEC12& displacement)> birth;
    std::vector<T_AXIAL> axial; // by element; empty: first order
};

/// Unknowns of a block of load cases, columns as of CCaseBlock::RightSides.
struct T_SOLUTION {
    std::vector<double> x, rest; // unknowns are x + rest; `rest` is empty where none was refined
    std::vector<char> fine;      // by column: was refined
    std::vector<T_ACCURACY> accuracy; // by column
};

/// Goes through the elements once for all cases of the block. Frame, map and history must outlive
/// it.
class CCaseBlock {
public:
    CCaseBlock(const T_FRAME& frame, const CFrameDofs& dofs, std::span<const T_LOAD_CASE> cases,
               const T_HISTORY* history = nullptr);

    std::size_t Size() const { return m_cases.size(); }
    /// One column per case: T' (nodal loads - fixed-end forces - forces of settlements).
    std::vector<double> RightSides() const;

    /// Results from the unknowns, appended to `out`.
    void Recover(const T_SOLUTION& solution, std::vector<T_RESULT>& out) const;

    using T_FIELD = std::vector<double>; // by full index
    /// Displacements by column and, of columns solved beyond the precision of doubles, the rest
    /// that doubles round away; `rest` is empty, or empty in the other columns.
    struct T_FIELDS {
        std::vector<T_FIELD> displacement, rest;
    };
    /// Columns of loads less the elements' forces, from the elements' deformations, where `wanted`
    /// by column; 0 in the others. With a rest.
    std::vector<double> Unbalanced(const T_SOLUTION& solution, std::span<const char> wanted) const;
    /// All displacements, by column.
    std::vector<T_FIELD> Displacements(std::span<const double> unknowns) const;
    /// Results from all displacements, by column, appended to `out`.
    void Results(std::span<const T_FIELD> displacement, std::vector<T_RESULT>& out) const;

private:
    enum class INSIDE { Leave, Give }; // forces between the ends of the elements

    /// Calls use(case, forces at its nodes, result) for element e under the displacements of each
    /// case that has `wanted(case)`.
    template <class WANTED, class USE>
    void ForElement(std::size_t e, const T_FIELDS& fields, INSIDE inside, WANTED&& wanted,
                    USE&& use) const;
    T_FIELDS FineFields(const T_SOLUTION& solution, std::span<const char> wanted) const;
    void Results(const T_FIELDS& fields, std::vector<T_RESULT>& out) const;
    std::vector<double> Reduced(std::span<const T_FIELD> full) const;
    bool Acts(std::size_t e, std::size_t c, const T_FIELD& held) const;
    T_AXIAL Axial(std::size_t e) const;
    bool Birth(std::size_t e, std::size_t c, T_VEC12& displacement) const;
    T_FIELD Held(std::size_t c) const;
    void Finish(std::size_t c, const T_FIELD& displacement, const T_FIELD& internal,
                T_RESULT& result) const;

    const T_FRAME& m_frame;
    const CFrameDofs& m_dofs;
    const T_HISTORY* m_history;
    std::vector<CCaseLoads> m_cases;
};

} // namespace solver
