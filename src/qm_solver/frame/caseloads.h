// One load case, sorted by where its loads act.
#pragma once

#include "qm_solver/element/spanload.h"
#include "qm_solver/frame/framedofs.h"

#include <span>
#include <vector>

namespace solver {

/// Loads of a checked case on a checked frame. State: fixed.
class CCaseLoads {
public:
    CCaseLoads(const T_FRAME& frame, const CFrameDofs& dofs, const T_LOAD_CASE& load);

    /// Loads at nodes by full index: nodal loads and the shares of loads on trusses.
    std::span<const double> Nodal() const { return m_nodal; }
    /// Prescribed displacements by full index, slaves included; empty if there are none.
    std::span<const double> Settled() const { return m_settled; }
    /// Loads on the span of a beam, local axes.
    std::span<const T_SPAN_LOAD> OnSpan(std::size_t element) const
    {
        if (m_from.empty()) return {};
        return {m_loads.data() + m_from[element], m_from[element + 1] - m_from[element]};
    }
    /// Tension of the element, were its ends clamped, from temperature and initial tension.
    double Axial(std::size_t element) const { return m_axial.empty() ? 0.0 : m_axial[element]; }

private:
    struct T_PLACED {
        std::size_t element;
        T_SPAN_LOAD load;
    };
    void AddSelfWeight(const T_FRAME& frame, const T_VEC3& factor, std::vector<T_PLACED>& placed);
    void AddBeamLoad(const T_FRAME& frame, const T_BEAM_LOAD& load, std::vector<T_PLACED>& placed);
    void ShareOnTruss(const T_FRAME& frame, const T_BEAM_LOAD& load);
    void AddStrains(const T_FRAME& frame, const T_LOAD_CASE& load);
    void AddSettlements(const CFrameDofs& dofs, const T_LOAD_CASE& load);
    void Sort(std::vector<T_PLACED>& placed, std::size_t elements);

    std::vector<double> m_nodal, m_settled, m_axial;
    std::vector<std::size_t> m_from;
    std::vector<T_SPAN_LOAD> m_loads;
};

} // namespace solver
