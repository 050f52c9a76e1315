// Moment over curvature of a section at an axial force.
#pragma once

#include "qm_solver/section/sectionbalance.h"

namespace solver {

/// Equilibrium for rising curvature, up to what ends it.
class CCurvaturePath {
public:
    /// The shape must outlive the path.
    CCurvaturePath(const T_SECTION_SHAPE& shape, const T_CURVATURE_REQUEST& request);

    /// 1 done; 0 error filled, `out` unchanged.
    [[nodiscard]] int Run(T_MOMENT_CURVATURE& out, T_SECTION_ERROR& error);

private:
    bool Start(T_BENT_STATE& first, T_SECTION_ERROR& error);
    std::vector<double> UniformStrains() const;
    bool March(T_MOMENT_CURVATURE& out);
    bool EndsAt(const T_BENT_STATE& state, T_MOMENT_CURVATURE& out);
    double LargestMoment();
    template <class F>
    std::optional<T_BENT_STATE> Locate(const T_BENT_STATE& before, const T_BENT_STATE& after,
                                       const F& value);
    bool Fill(T_MOMENT_CURVATURE& out);

    CSectionBalance m_balance;
    T_CURVATURE_REQUEST m_request;
    std::vector<T_BENT_STATE> m_path;
};

} // namespace solver
