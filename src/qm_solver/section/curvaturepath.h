// Moment over curvature of a section at an axial force.
#pragma once

#include "qm_solver/section/sectionview.h"
#include "qm_solver/sectionsolver.h"

#include <optional>

namespace solver {

/// Equilibrium for rising curvature. The curvature is the component in the direction asked for;
/// where that is the direction of the moment, the neutral axis turns so that no moment is across.
class CCurvaturePath {
public:
    /// The shape must outlive the path.
    CCurvaturePath(const T_SECTION_SHAPE& shape, const T_CURVATURE_REQUEST& request);

    /// 1 done; 0 error filled, `out` unchanged.
    [[nodiscard]] int Run(T_MOMENT_CURVATURE& out, T_SECTION_ERROR& error);

private:
    /// Strain at the point of moments, curvature in the direction and across it.
    struct T_UNKNOWN {
        double axial = 0.0, along = 0.0, across = 0.0;
    };
    /// Largest part of a mark that a fibre has reached.
    struct T_REACHED {
        double part = 0.0;
        T_FIBRE fibre;
    };
    struct T_STATE {
        T_UNKNOWN at;
        T_CURVATURE_POINT point;
        T_REACHED limit, yield;
    };
    /// Forces in the directions of the unknowns, with their derivatives by axial and across.
    struct T_BALANCE {
        double force = 0.0, along = 0.0, across = 0.0;
        double byAxial = 0.0, mixed = 0.0, byAcross = 0.0;
    };

    bool Start(T_STATE& first, T_SECTION_ERROR& error);
    std::vector<double> UniformStrains() const;
    T_BALANCE Balance(const T_UNKNOWN& at);
    double Miss(const T_BALANCE& balance, bool turning) const;
    std::optional<T_STATE> Newton(T_UNKNOWN guess, bool turning);
    std::optional<T_STATE> Bracketed(T_UNKNOWN guess);
    std::optional<T_STATE> AtAxis(const T_UNKNOWN& guess);
    std::optional<T_STATE> Turned(T_UNKNOWN guess);
    std::optional<T_STATE> Solve(const T_STATE& from, double curvature);
    std::optional<T_STATE> Reach(const T_STATE& from, double curvature, int halvings);
    T_STATE StateOf(const T_UNKNOWN& at);
    T_REACHED Reached(const std::vector<T_MARK>& marks, double e0, double kappa) const;
    bool March(T_MOMENT_CURVATURE& out);
    bool EndsAt(const T_STATE& state, T_MOMENT_CURVATURE& out);
    double LargestMoment();
    template <class F>
    std::optional<T_STATE> Locate(const T_STATE& before, const T_STATE& after, const F& value);
    bool Fill(T_MOMENT_CURVATURE& out);

    CSectionView m_view;
    T_CURVATURE_REQUEST m_request;
    double m_force = 0.0, m_depth = 0.0; // scales of the forces and the section
    std::vector<T_STATE> m_path;
};

} // namespace solver
