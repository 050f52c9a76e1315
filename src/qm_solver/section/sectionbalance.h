// Equilibrium of a section for an axial force and a curvature. The curvature is the component in
// the direction asked for; where that is the direction of the moment, the neutral axis turns so
// that no moment is across.
#pragma once

#include "qm_solver/section/sectionview.h"
#include "qm_solver/sectionsolver.h"

#include <optional>

namespace solver {

/// Strain at the point of moments, curvature in the direction and across it.
struct T_BENDING {
    double axial = 0.0, along = 0.0, across = 0.0;
};

/// Largest part of a mark that a fibre has reached.
struct T_REACHED {
    double part = 0.0;
    T_FIBRE fibre;
};

struct T_BENT_STATE {
    T_BENDING at;
    T_CURVATURE_POINT point;
    T_REACHED limit, yield;
};

class CSectionBalance {
public:
    /// The shape must outlive this.
    CSectionBalance(const T_SECTION_SHAPE& shape, const T_CURVATURE_REQUEST& request);

    const CSectionView& View() const { return m_view; }
    double Depth() const { return m_depth; }
    /// Scale of the forces that a residual is measured by.
    void SetForceScale(double force) { m_force = force; }
    double ForceScale() const { return m_force; }

    double UniformForce(double strain) { return Balance({strain, 0.0, 0.0}).force; }
    T_BENT_STATE StateOf(const T_BENDING& at);
    /// The state near another with the same curvature along; none where it is not found.
    std::optional<T_BENT_STATE> Near(const T_BENDING& guess);
    /// From a state to another curvature, in smaller steps where one does not get there.
    std::optional<T_BENT_STATE> Reach(const T_BENT_STATE& from, double curvature,
                                      int halvings = kHalvings);

    static constexpr int kHalvings = 5;

private:
    /// Forces in the directions of the unknowns, with their derivatives by axial and across.
    struct T_BALANCE {
        double force = 0.0, along = 0.0, across = 0.0;
        double byAxial = 0.0, mixed = 0.0, byAcross = 0.0;
    };

    T_BALANCE Balance(const T_BENDING& at);
    double Miss(const T_BALANCE& balance, bool turning) const;
    std::optional<T_BENT_STATE> Newton(T_BENDING at, bool turning);
    std::optional<T_BENT_STATE> Bracketed(T_BENDING at);
    std::optional<T_BENT_STATE> AtAxis(const T_BENDING& guess);
    std::optional<T_BENT_STATE> Turned(T_BENDING at);
    T_REACHED Reached(const std::vector<T_MARK>& marks, double e0, double kappa) const;

    CSectionView m_view;
    T_CURVATURE_REQUEST m_request;
    double m_force = 0.0, m_depth = 0.0;
};

} // namespace solver
