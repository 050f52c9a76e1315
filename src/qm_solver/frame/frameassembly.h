// Assembles the stiffness matrix of a frame over its unknowns.
#pragma once

#include "qm_solver/element/elementstiffness.h"
#include "qm_solver/frame/framedofs.h"
#include "qm_solver/solverreason.h"
#include "qm_solver/sparse/sparsefactor.h"

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace solver {

/// The pattern is that of the node blocks: all unknowns of two nodes that share an element are
/// coupled (zeros included), so that a row is a few runs of columns. For each element a list of
/// places in the value array is made once; assembling again is then one pass over the elements.
/// State: pattern and places fixed by Prepare; values by Assemble.
class CFrameAssembly {
public:
    /// Pattern and places. Frame and map are used again by Assemble with the same topology.
    /// 1 done; 0 `reason` filled: the matrix has more entries than can be counted.
    [[nodiscard]] int Prepare(const T_FRAME& frame, const CFrameDofs& dofs,
                              T_SOLVER_REASON& reason);
    /// Values of the matrix from the elements' stiffness; axial by element, empty: first order.
    void Assemble(const T_FRAME& frame, std::span<const T_AXIAL> axial = {});
    /// Values from the stiffness of each element over the displacements of its nodes, global axes.
    void Assemble(const std::function<void(std::size_t element, T_MATRIX12&)>& stiffness);
    const T_SYMMETRIC_MATRIX& Matrix() const { return m_matrix; }

private:
    /// Displacement `local` of an element contributes to unknown `unknown` of the element's list.
    struct T_PART {
        std::uint16_t local, unknown;
        double factor;
    };
    /// Where an element's lists begin; those of the next element end them.
    struct T_START {
        std::size_t part = 0, place = 0;
        std::uint16_t unknowns = 0;
        bool plain = true; // each part is an unknown of its own with the factor 1
    };
    class CPattern;

    void ListParts(const T_FRAME& frame, const CFrameDofs& dofs);
    void MakePlaces(const CPattern& pattern);
    void AddPlain(std::size_t element, const T_MATRIX12& stiffness);
    void AddTransformed(std::size_t element, const T_MATRIX12& stiffness);

    std::vector<T_PART> m_parts;
    std::vector<T_START> m_starts;       // elements + 1
    std::vector<int> m_places;           // upper triangle of each element's unknowns, by rows
    std::vector<int> m_unknowns;         // equations of the elements, one after the other
    std::vector<std::size_t> m_listFrom; // of each element in m_unknowns
    std::vector<double> m_product;       // work space
    T_SYMMETRIC_MATRIX m_matrix;
};

} // namespace solver
