// A block of load cases of one frame: right-hand sides before, results after the solution.
#pragma once

#include "qm_solver/caseloads.h"
#include "qm_solver/frameresult.h"
#include "qm_solver/vec3.h"

#include <span>
#include <vector>

namespace solver {

/// Goes through the elements once for all cases of the block. Frame and map must outlive it.
class CCaseBlock {
public:
    CCaseBlock(const T_FRAME& frame, const CFrameDofs& dofs, std::span<const T_LOAD_CASE> cases);

    std::size_t Size() const { return m_cases.size(); }
    /// One column per case: T' (nodal loads - fixed-end forces - forces of settlements).
    std::vector<double> RightSides() const;

    /// Results from the unknowns (columns as of RightSides), appended to `out`.
    void Recover(std::span<const double> unknowns, std::vector<T_RESULT>& out) const;

private:
    using T_FIELD = std::vector<double>; // by full index

    /// Calls use(case, forces at its nodes, result) for element e under the displacements of each
    /// case that has `wanted(case)`.
    template <class WANTED, class USE>
    void ForElement(std::size_t e, std::span<const T_FIELD> displacement, WANTED&& wanted,
                    USE&& use) const;
    bool Acts(std::size_t e, std::size_t c) const;
    void Finish(std::size_t c, const T_FIELD& displacement, const T_FIELD& internal,
                T_RESULT& result) const;

    const T_FRAME& m_frame;
    const CFrameDofs& m_dofs;
    std::vector<CCaseLoads> m_cases;
};

} // namespace solver
