// Yield strengths and P-M interaction of a section from its material.
#pragma once

#include "qm_db/records.h"
#include "qm_db/sectionproperties.h"

#include <array>
#include <optional>
#include <span>
#include <vector>

/// What CSectionStrength finds. All values are magnitudes, in the units of the input.
/// The (+) moments compress the side +z (My) or +y (Mz); Fx (+) is tension, (-) compression.
struct T_SECTION_STRENGTH {
    /// By HINGE_COMPONENT; absent: there is no method (Mx; shear of concrete).
    std::array<std::optional<T_SIDES<double>>, 6> yield;
    /// Axial strengths, moments at P = 0, largest moments and the curves of the yield level.
    T_YIELD_LEVEL level;
};

/// The surface of both moments at an axial force, compression positive: how far it lies beyond the
/// ellipse of the four strengths about the axes, by direction.
struct T_SURFACE_ROW {
    double axial = 0.0;
    std::vector<double> share;
};

/// Characteristic strengths, without partial factors. Bending is uniaxial about the section's
/// axes; moments refer to the centroid of the gross section.
///
/// Steel (any shape): full plasticity with fy in tension and compression, Fx = A fy, shear
/// Av fy / sqrt(3) (CSectionProperties::StrengthShearAreas), moments Z fy. The interaction is exact
/// for the shape: the plastic neutral axis at +-a gives P = fy (area within a) and M = fy (first
/// moment beyond a). A channel under an axial force carries My with Mz = 0: its neutral axis leans,
/// an axis along y would leave a moment Mz and give too much. A section given by values has no
/// shape; its interaction is the straight line M = Z fy (1 - P / A fy), a lower bound for every
/// section that is symmetric about both axes.
///
/// Concrete (rectangle, circle, with bars): plane sections; parabola-rectangle of EN 1992-1-1
/// 3.1.7 (ConcreteLaw, up to C90; alpha_cc = 1); bars elastic-perfectly plastic without a strain
/// limit; no concrete in tension; the concrete that a bar in compression displaces is taken off
/// (bar stress minus concrete stress). Strains as in EN 1992-1-1 6.1: eps_cu2 at the edge while the
/// neutral axis cuts the section, then turning about eps_c2 at 1 - eps_c2 / eps_cu2 of the depth
/// down to a uniform eps_c2. So the compressive strength has the bars at min(fyk, eps_c2 Es).
///
/// Ten points: E(c), D(c), C(c), B(c), A(c) lie at 100, 75, 50, 25 and 0 % of the way from the
/// axial force of the largest moment to pure compression, so that A(c) is the largest moment; A(t)
/// to E(t) at 5, 25 ... 100 % of the way to pure tension. Compression is positive. The rules of a
/// yield surface want every ratio below 1: that of the largest moment is kLargestRatio.
/// Where the largest moment lies beyond pure compression (one heavy bar far off the centroid) the
/// points can't fall, and the section is refused as NotConverged.
class CSectionStrength {
public:
    static constexpr double kLargestRatio = 1.0 - 1e-9;

    /// The units are those of the input; the law of concrete hangs on fck in MPa.
    /// 1 done; 0 with the fault, `out` unchanged.
    [[nodiscard]] static int Calc(const T_SECT_D& section, const T_MATL_D& material,
                                  const T_UNITS& units, T_SECTION_STRENGTH& out, SECT_FAULT& fault);

    /// Moment capacity at an axial force (compression positive, within the axial strengths), about
    /// y or z, (+) or (-). 1 done; 0 with the fault (Values: P out of range), `moment` unchanged.
    [[nodiscard]] static int CalcMoment(const T_SECT_D& section, const T_MATL_D& material,
                                        const T_UNITS& units, bool aboutY, bool positive,
                                        double axial, double& moment, SECT_FAULT& fault);

    /// The whole curve about y or z, (+) or (-), from pure compression to pure tension: the points
    /// P / Pmax and M / largest moment that the ten points stand on. 1 done; 0 with the fault,
    /// `out` unchanged.
    [[nodiscard]] static int CalcCurve(const T_SECT_D& section, const T_MATL_D& material,
                                       const T_UNITS& units, bool aboutY, bool positive,
                                       std::vector<T_PM_POINT>& out, SECT_FAULT& fault);

    /// The surface at so many axial forces, evenly within the axial strengths, ascending.
    /// Directions: angles from the axis of My / strength to that of Mz / strength. 1 done; 0 with
    /// the fault (Values: a section without a shape), `out` unchanged.
    [[nodiscard]] static int CalcSurface(const T_SECT_D& section, const T_MATL_D& material,
                                         const T_UNITS& units, std::size_t rows,
                                         std::span<const double> directions,
                                         std::vector<T_SURFACE_ROW>& out, SECT_FAULT& fault);
};
