// Records of plastic hinges: hinge types, generated hinges.
// Plain data; in the store every quantity is in SI. Signs are as entered: the negative side of a
// FEMA or Eurocode curve holds negative numbers, the sides of a multilinear curve hold magnitudes.
#pragma once

#include "qm_db/records/structrecords.h"
#include "qm_db/records/units.h"

#include <array>
#include <optional>
#include <string>
#include <variant>
#include <vector>

// ---- hinge type -------------------------------------------------------------------------------

enum class HINGE_ELEMENT { BeamColumn, Wall, Truss, GeneralLink, PointSpring };
/// Moment-rotation; moment-curvature lumped; moment-curvature distributed (FEMA curve alone).
enum class HINGE_DEFINITION { MomentRotation, CurvatureLumped, CurvatureDistributed };
enum class HINGE_INTERACTION { P, MyMz, VyVz, PMM, User };
enum class HINGE_COMPONENT { Fx, Fy, Fz, Mx, My, Mz };
inline constexpr std::array<const char*, 6> kComponentNames{"Fx", "Fy", "Fz", "Mx", "My", "Mz"};
enum class HINGE_LOCATION { IEnd = 1, JEnd = 2, BothEnds = 3, Center = 4 };

/// Skeleton-curve codes as stored per component.
enum class SKEL_TYPE {
    Bilinear,
    Trilinear,
    SlipBilinear,
    SlipTrilinear,
    Fema,
    Ec8,
    CompressionOnly
};

template <class T>
struct T_SIDES {
    T pos{}, neg{};
    bool operator==(const T_SIDES&) const = default;
};

/// A point of a FEMA or Eurocode curve: deformation in the curve's measure, strength / yield.
struct T_SKEL_POINT {
    double deform = 0.0, strength = 0.0;
    bool operator==(const T_SKEL_POINT&) const = default;
};

/// One side of a FEMA or Eurocode curve.
struct T_SKEL_SIDE {
    double yield = 0.0;       // yield strength, force or moment
    double yieldDeform = 0.0; // Dy: displacement, rotation, curvature or strain
    T_SKEL_POINT B, C, D, E;
    double IO = 0.0, LS = 0.0, CP = 0.0; // acceptance criteria in the curve's measure
    double userStiffness = 0.0;          // used with the user initial stiffness
    std::array<double, 4> energy{};      // dissipation factors A~B, C, D, E
    bool operator==(const T_SKEL_SIDE&) const = default;
};

enum class SKEL_MEASURE { DDy, Plastic }; // ratio D / Dy, or plastic deformation
/// Moments 6EI/L, 3EI/L, 2EI/L; user; elastic (EA/L, GJ/L, G times the shear area).
enum class INIT_STIFFNESS { EI6L, EI3L, EI2L, User, Elastic };
enum class UNLOAD_TYPE { Origin, NonlinearElastic, Bilinear, StiffnessDegrading, DegradingSlip };

/// Curve of one axial force.
struct T_SKEL_AXIAL {
    double axial = 0.0; // force
    T_SIDES<T_SKEL_SIDE> sides;
    bool operator==(const T_SKEL_AXIAL&) const = default;
};

struct T_SKEL_FEMA {
    bool symmetric = true; // the negative side mirrors the positive one
    bool autoYield = true; // yield strength from section and material
    SKEL_MEASURE measure = SKEL_MEASURE::DDy;
    T_SIDES<T_SKEL_SIDE> sides;
    bool strengthLoss = true;
    INIT_STIFFNESS initStiffness = INIT_STIFFNESS::EI6L;
    bool asymStiffness = false;
    UNLOAD_TYPE unloadType = UNLOAD_TYPE::StiffnessDegrading;
    double unloadFactor = 0.0;     // [-1, 1] with the energy-based model
    double unloadExponent = 0.0;   // >= 0
    double unloadProportion = 0.0; // [0, 1]
    bool energyBased = false;
    bool multiCurve = false;
    std::vector<T_SKEL_AXIAL> curves;       // by axial force, ascending
    std::optional<T_SIDES<double>> dcRatio; // demand / capacity limits, [0, 1]
    bool infillStrut = false;
    bool infillGeneral = false; // general form, else plastic form
    bool compliance = true;     // the acceptance criteria are in use
    bool operator==(const T_SKEL_FEMA&) const = default;
};

struct T_SKEL_EC8 {
    bool symmetric = true;
    bool autoYield = true;
    bool strengthLoss = true;
    SKEL_MEASURE measure = SKEL_MEASURE::DDy;
    INIT_STIFFNESS initStiffness = INIT_STIFFNESS::EI6L;
    T_SIDES<T_SKEL_SIDE> sides;
    bool operator==(const T_SKEL_EC8&) const = default;
};

/// One side of a multilinear, slip or compression-only curve; magnitudes.
struct T_SKEL_MULTI_SIDE {
    double P1 = 0.0, P2 = 0.0, P3 = 0.0; // bilinear: yield; trilinear: crack, yield; ultimate
    double D1 = 0.0, D2 = 0.0, D3 = 0.0; // deformations of the points
    double alpha1 = 0.0, alpha2 = 0.0;   // stiffness reduction ratios
    double gap = 0.0;                    // slip curves: initial gap
    double userStiffness = 0.0;
    bool operator==(const T_SKEL_MULTI_SIDE&) const = default;
};

enum class GAP_SIDES { Both, Positive, Negative };

struct T_SKEL_MULTI {
    bool symmetric = true;
    bool autoYield = true;       // strengths from section and material, else entered
    bool useUltimate = false;    // P3 is entered
    bool useDeformation = false; // D1 to D3 are entered instead of the ratios
    INIT_STIFFNESS initStiffness = INIT_STIFFNESS::EI6L;
    GAP_SIDES gapSides = GAP_SIDES::Both;
    T_SIDES<T_SKEL_MULTI_SIDE> sides;
    bool operator==(const T_SKEL_MULTI&) const = default;
};

using T_SKEL_CURVE = std::variant<T_SKEL_MULTI, T_SKEL_FEMA, T_SKEL_EC8>;

/// One component of a hinge type. The alternative of the curves always fits the type.
struct T_HINGE_COMPONENT {
    bool active = false;
    SKEL_TYPE type = SKEL_TYPE::Bilinear;
    HINGE_LOCATION location = HINGE_LOCATION::BothEnds;
    bool sameEnds = true; // the J-end has the I-end's curve
    T_ENDS<T_SKEL_CURVE> curves;
    bool operator==(const T_HINGE_COMPONENT&) const = default;
};

/// Ten points of an interaction curve, compression side first: E(c), D(c), C(c), B(c), A(c), A(t),
/// B(t), C(t), D(t), E(t); each P / Pmax and M / MY,max.
struct T_PM_POINT {
    double p = 0.0, m = 0.0;
    bool operator==(const T_PM_POINT&) const = default;
};
using T_PM_CURVE = std::array<T_PM_POINT, 10>;

/// One level (crack or yield) of the yield surface of one axis.
struct T_YIELD_AXIS {
    bool used = true;
    T_SIDES<double> moment;    // MC or MY of (+) and (-)
    T_SIDES<double> momentMax; // MY,max or MU,max
    T_SIDES<T_PM_CURVE> curves;
    bool operator==(const T_YIELD_AXIS&) const = default;
};
struct T_YIELD_LEVEL {
    double tension = 0.0;     // PC(t) or PY(t)
    double compression = 0.0; // Pmax(c)
    T_YIELD_AXIS y, z;
    bool operator==(const T_YIELD_LEVEL&) const = default;
};
struct T_YIELD_SURFACE {
    std::optional<T_YIELD_LEVEL> crack; // trilinear curves alone
    T_YIELD_LEVEL yield;
    bool operator==(const T_YIELD_SURFACE&) const = default;
};

/// User P-M interaction: two curves of eleven points, about y and z, P / Pmax and M / Mmax.
using T_PMM_CURVES = std::array<std::array<T_PM_POINT, 11>, 2>;
struct T_PMM_TABLE {
    double Pmax = 0.0;
    T_PMM_CURVES curves{};                  // (+), and (-) where that has none of its own
    std::optional<T_PMM_CURVES> negative{}; // (-)
    bool balanced = false; // M rises from pure compression up to a balanced point, then falls
    bool operator==(const T_PMM_TABLE&) const = default;
};

struct T_MASONRY_HINGE {
    int form = 1;               // 1 or 2
    double compStrength = 0.0;  // stress
    double shearStrength = 0.0; // stress
    double Hp = 0.0;            // form 1: height
    double distribution = 1.0;  // form 2: (0, 1]
    bool operator==(const T_MASONRY_HINGE&) const = default;
};

struct T_HINGE_LENGTH {
    bool relative = false;                      // lengths as fractions of the member length
    T_ENDS<double> My, Mz;                      // moment-rotation
    T_ENDS<std::array<double, 6>> components{}; // moment-curvature: one length per component
    int integrationPoints = 5;
    bool autoSpan = true; // span of the yield rotation from the member
    double span = 0.0;
    bool operator==(const T_HINGE_LENGTH&) const = default;
};

/// Fully restrained connection that the hinges of a steel beam were made for. SI.
struct T_STEEL_CONNECTION {
    std::string kind;             // "RBS"
    double columnFlange = 0.0;    // thickness; 0: of the frame's columns
    double continuityPlate = 0.0; // thickness; 0: none
    double panelRatio = 0.0;      // Vpz / Vye of the panel zone; 0: of the frame
    bool operator==(const T_STEEL_CONNECTION&) const = default;
};

/// Where a generated hinge type came from.
struct T_GENERATED {
    std::string code;       // "ASCE41-17"
    bool secondary = false; // member
    T_ENDS<double> axial{}; // forces that it was made for, compression positive
    /// What went into it, in SI, in the order of the generator: tells whether section, material,
    /// member or loads have changed since.
    std::vector<double> inputs{};
    /// V and M / V of the I-end, then of the J-end, for each axis of bending (y before z), as a
    /// push gave them; SI. Empty: of the strengths at both ends, shear span half of the clear
    /// length.
    std::vector<double> pushed{};
    std::vector<double> axialRange{}; // curves by axial force: from, to; SI; empty: none
    double tie = 0.0;                 // strength of what ties a spandrel, SI
    std::optional<T_STEEL_CONNECTION> connection{}; // of a steel beam; absent: the beam's own rows
    bool operator==(const T_GENERATED&) const = default;
};

/// Hinge type.
struct T_PHGT_D {
    std::string name;
    HINGE_ELEMENT element = HINGE_ELEMENT::BeamColumn;
    HINGE_DEFINITION definition = HINGE_DEFINITION::MomentRotation;
    HINGE_INTERACTION interaction = HINGE_INTERACTION::P; // of My, or of Fy and Fz
    std::optional<HINGE_INTERACTION> interactionMz{};     // absent: as of My
    MATL_CLASS material = MATL_CLASS::Steel;
    std::array<T_HINGE_COMPONENT, 6> components; // by HINGE_COMPONENT
    int section = 0, sectionMaterial = 0;        // keys that automatic strengths read; 0: none
    // Keys of sections; 0: none. The fibres of a frame are those of any section with dimensions and
    // its bars, the fibres and the thickness of a wall those of a rectangle (its smaller side).
    int fibreSection = 0, thicknessSection = 0;
    std::optional<T_YIELD_SURFACE> yieldSurface;
    /// P-M-M: My and Mz together within the surface of section and material of the element, not
    /// within the ellipse of their strengths.
    bool exactSurface = false;
    std::optional<T_PMM_TABLE> pmm;
    T_HINGE_LENGTH length;
    bool withholdMzLength = false; // Mz has no hinge length although its curve asks for one
    std::optional<T_MASONRY_HINGE> masonry; // present: the masonry flag is set
    std::optional<T_GENERATED> generated{};
    bool operator==(const T_PHGT_D&) const = default;
};

/// Hinge generated for an element.
struct T_PHGE_D {
    int element = 0;
    int hingeType = 0;                               // key
    std::array<T_SIDES<double>, 6> crack{}, yield{}; // strengths by component
    /// Those of the J-end of components whose ends have curves of their own; else 0.
    std::array<T_SIDES<double>, 6> crackJ{}, yieldJ{};
    /// Static load case (key) whose axial force automatic moments were taken at; 0: the initial
    /// loads of the global control.
    int axialCase = 0;
    bool operator==(const T_PHGE_D&) const = default;
};

/// Inelastic hinge property of time-history analysis: FEMA curves by component.
struct T_IEHP_D {
    std::string name;
    std::array<std::optional<T_SKEL_FEMA>, 6> components;
    bool operator==(const T_IEHP_D&) const = default;
};

/// Increment function of a pushover load case: fraction of its load (of its displacement, where
/// that is controlled) over step, both rising; a first row of zeros says nothing.
struct T_POFC_D {
    std::string name;
    std::vector<double> step, factor;
    bool operator==(const T_POFC_D&) const = default;
};

/// Dimension of a component's strength and of its deformation in a definition.
inline T_DIM StrengthDim(HINGE_COMPONENT c)
{
    return c < HINGE_COMPONENT::Mx ? kDimForce : kDimMoment;
}
inline T_DIM DeformDim(HINGE_COMPONENT c, HINGE_DEFINITION d)
{
    const bool force = c < HINGE_COMPONENT::Mx;
    if (d == HINGE_DEFINITION::MomentRotation) return force ? kDimLength : kDimNone;
    return force ? kDimNone : T_DIM{0, -1}; // strain, curvature
}
