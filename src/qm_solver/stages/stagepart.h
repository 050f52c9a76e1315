// The part of a staged model that stands in a stage, ready to be factorised.
#pragma once

#include "qm_solver/frame/frameassembly.h"
#include "qm_solver/frameresult.h"
#include "qm_solver/stages/stageplan.h"

#include <memory>
#include <optional>

namespace solver {

/// A frame of the active elements over all nodes of the model, held by the active supports.
/// Diaphragms and equal displacements tie those of their nodes that stand. Elements of the part
/// have indices of their own.
class CStagePart {
public:
    CStagePart(const T_FRAME& whole, const T_ACTIVE& active);

    /// Checks the part and does the symbolic factorisation; errors have the model's indices.
    std::optional<T_SOLVER_ERROR> Prepare(std::shared_ptr<CFactorSpace> space);
    /// Factorises the stiffness of the first order; looks for mechanisms the first time.
    std::optional<T_SOLVER_ERROR> Factorise();
    /// The same with axial forces, by element of the part. `search`: for mechanisms.
    std::optional<T_SOLVER_ERROR> Factorise(std::span<const T_AXIAL> axial, bool search);

    const T_ACTIVE& Active() const { return m_active; }
    const T_FRAME& Frame() const { return m_frame; }
    const CFrameDofs& Dofs() const { return *m_dofs; }
    const T_SYMMETRIC_MATRIX& Matrix() const { return m_assembly.Matrix(); }
    CSparseFactor& Factor() { return m_factor; }
    double Size() const { return m_extent; }

    /// An element of the model stands in the part.
    bool Holds(std::size_t element) const { return m_own[element] >= 0; }

    /// The first fault of a load case that acts on the part. `comes`: it begins to act here, so
    /// that also its temperatures, initial tensions and settlements must find their place.
    std::optional<T_SOLVER_ERROR> CheckLoads(const T_LOAD_CASE& load, std::size_t loadCase,
                                             bool comes) const;
    /// Adds factor times what of a load case acts on the part.
    void AddLoads(const T_LOAD_CASE& load, double factor, T_LOAD_CASE& sum) const;

private:
    std::optional<T_SOLVER_ERROR> Numeric(std::span<const T_AXIAL> axial, bool search);
    std::optional<std::size_t> Own(std::size_t element) const;
    std::optional<T_SOLVER_ERROR> CheckPlaces(const T_LOAD_CASE& load, bool comes) const;

    T_ACTIVE m_active;
    T_FRAME m_frame;
    double m_extent = 1.0;
    std::vector<long> m_own;      // index in the part by the model's element, -1 not there
    std::vector<char> m_standing; // by node: an element joins it
    std::optional<CFrameDofs> m_dofs;
    CFrameAssembly m_assembly;
    CSparseFactor m_factor;
    bool m_firstOrder = false; // the matrix holds the stiffness of the first order
    bool m_proven = false;     // which is known to be regular
};

} // namespace solver
