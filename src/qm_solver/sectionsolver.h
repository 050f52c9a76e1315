// The section calculator: response, capacities and moment-curvature of a cross-section of concrete,
// bars and steel. Plane sections. Integration is exact for the laws (piecewise polynomials in
// closed form, powers by quadrature to 1e-10), over straight edges and circles alike.
#pragma once

#include "qm_solver/sectionresult.h"

#include <memory>
#include <span>

namespace solver {

struct T_CURVATURE_REQUEST {
    double axial = 0.0;
    double direction = 0.0;
    bool ofMoment = false;     // the direction is that of the moment, else of the neutral axis
    std::size_t points = 50;   // about so many; yield and ultimate are among them
    double maxCurvature = 0.0; // 0: none
};

/// Of T_AXIAL_CURVE: the five extremes.
inline constexpr std::size_t kFewestPoints = 5;

class CSectionSolver {
public:
    CSectionSolver();
    ~CSectionSolver();
    CSectionSolver(CSectionSolver&&) noexcept;
    CSectionSolver& operator=(CSectionSolver&&) noexcept;

    /// Checks the section. 1 done; 0 error filled, and the solver holds no section. Every other
    /// operation wants a section; it returns 1, or 0 with error filled and `out` unchanged.
    [[nodiscard]] int Prepare(const T_SECTION_MODEL& model, T_SECTION_ERROR& error);

    [[nodiscard]] int Respond(const T_STRAIN_PLANE& plane, T_SECTION_RESPONSE& out,
                              T_SECTION_ERROR& error) const;

    /// The capacity for a place of the neutral axis. `place` runs from -1 (uniform strain of the
    /// steel's limit in tension) over 0 (axis at the compressed edge) and 1 (at the other edge) to
    /// 2 (uniform compression): on 0 ... 1 the depth of the axis over that of the section, beyond
    /// in its inverse. Without limits of the steel it starts at 0, where all steel yields in
    /// tension; of a plastic section 0 and 1 are its ends. Outside of its range: its end.
    [[nodiscard]] int Capacity(double direction, double place, T_CAPACITY& out,
                               T_SECTION_ERROR& error) const;

    /// Where the moment in the direction of bending is largest, and its place.
    [[nodiscard]] int Largest(double direction, T_CAPACITY& out, double& place,
                              T_SECTION_ERROR& error) const;

    /// At an axial force, for bending in a direction. AxialBeyond says what this direction carries.
    [[nodiscard]] int AtAxial(double direction, double axial, T_CAPACITY& out,
                              T_SECTION_ERROR& error) const;

    /// At an axial force, with the moment in a direction: My / Mz = cos / sin.
    [[nodiscard]] int TowardsMoment(double direction, double axial, T_CAPACITY& out,
                                    T_SECTION_ERROR& error) const;

    /// So many points: the extremes, the rest at even axial forces between them.
    [[nodiscard]] int Curve(double direction, std::size_t points, T_AXIAL_CURVE& out,
                            T_SECTION_ERROR& error) const;

    /// Directions even around the circle from 0 on; for each so many even axial forces from uniform
    /// compression to tension, its ends included. Row-major, directions x points.
    [[nodiscard]] int Surface(std::size_t directions, std::size_t points,
                              std::vector<T_CAPACITY>& out, T_SECTION_ERROR& error) const;

    [[nodiscard]] int MomentCurvature(const T_CURVATURE_REQUEST& request, T_MOMENT_CURVATURE& out,
                                      T_SECTION_ERROR& error) const;

private:
    struct T_STATE;
    std::unique_ptr<T_STATE> m_state;
};

} // namespace solver
