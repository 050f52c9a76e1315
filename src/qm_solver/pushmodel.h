// What the nonlinear push of a frame takes: the frame, its plastic hinges and the stages of
// loading.
#pragma once

#include "qm_solver/framemodel.h"

#include <algorithm>
#include <limits>
#include <optional>

namespace solver {

/// A vertex of a backbone: magnitudes on its own side. The deformation is that of the hinge, beyond
/// the elastic member: 0 at yield of a hinge that is rigid until then; of a hinge with a spring of
/// its own (T_HINGE_LAW::stiffness) the spring's part is in it. Force 0 at the first vertex: no
/// resistance.
struct T_BACKBONE_POINT {
    double deformation = 0.0, force = 0.0; // radians or length; moment or force
};

/// How a side that has flowed unloads.
enum class UNLOADING {
    Elastic,  // with the elastic stiffness, back to the same point when it is loaded again
    Origin,   // along the line from the furthest point to the origin, and back
    Backbone, // along the backbone, and back (nonlinear elastic)
};

/// One side of a law. Beyond the last vertex the force stays as it is. Each side counts its own
/// plastic deformation: the side that is loaded second starts from what the first one has left.
struct T_HINGE_SIDE {
    std::vector<T_BACKBONE_POINT> points; // from yield on; deformations do not fall
    double gap = 0.0;                     // deformation without force before the side bears
    bool slips = false; // pinching: what has flowed adds to the gap, closed again without force
    bool free = false;  // never bears: the tension of a contact
    UNLOADING unloading = UNLOADING::Elastic; // back from the furthest point
    /// Deformations, rising, at which acceptance states begin (IO, LS, CP). May be empty.
    std::vector<double> marks;
};

/// Strengths of both sides at an axial force, tension positive; straight between the rows.
struct T_AXIAL_STRENGTH {
    double axial = 0.0, positive = 0.0, negative = 0.0; // the strengths as magnitudes
};

/// Law of one component of a hinge. Components are in local axes: 0 Fx, 1 Fy, 2 Fz, 3 Mx, 4 My,
/// 5 Mz, forces with the signs of T_RESULT; of links and springs in global axes.
struct T_HINGE_LAW {
    int component = 5;               // 0 to 5, as above
    T_HINGE_SIDE positive, negative; // of positive and of negative forces
    double stiffness =
        0.0; // spring in series with the member; 0: the hinge is rigid until it flows
    /// Ascending in the axial force. Where it is given, the forces of the sides are multiples of
    /// the strength at the present axial force divided by the force of the first vertex.
    std::vector<T_AXIAL_STRENGTH> byAxial;
};

/// Corners of the polygon that the moments of a biaxial hinge stay in, at fixed directions of
/// (My / strength, Mz / strength); five in each quadrant.
inline constexpr std::size_t kBiaxialCorners = 20;
/// Angles of the corners, from the axis of My to that of Mz, rising. The first and the last of a
/// quadrant stand beside the axes.
std::array<double, kBiaxialCorners> BiaxialCorners();

/// At an axial force, tension positive: how far the corners lie from the centre, as shares of the
/// ellipse there.
struct T_AXIAL_SHAPE {
    double axial = 0.0;                          // tension positive
    std::array<double, kBiaxialCorners> share{}; // in the order of BiaxialCorners
};

/// What flows where a strength follows the axial force.
enum class HINGE_FLOW {
    Rotations,  // the components of the law alone flow, whatever the axial force does
    Associated, // normal to the yield surface
};

/// A plastic hinge at a place of an element.
struct T_PUSH_HINGE {
    std::size_t element = 0;       // place in T_FRAME::elements
    double at = 0.0;               // fraction of the flexible length: 0 I-end, 1 J-end
    std::vector<T_HINGE_LAW> laws; // one for each component that can flow
    /// The laws of My and Mz share one surface: (My / strength)^2 + (Mz / strength)^2 = 1 as a
    /// polygon that is drawn inside it; deformations by the law of the larger share.
    bool biaxial = false;
    /// Of a biaxial hinge: another surface than the ellipse. One row counts at every axial force;
    /// more are ascending, their polygons convex, and the inverse of the shares is straight between
    /// them. Beyond the rows the run ends. Empty: the ellipse.
    std::vector<T_AXIAL_SHAPE> shape;
    HINGE_FLOW flow = HINGE_FLOW::Rotations; // of laws with strengths by the axial force
};

/// Axial forces whose couple (force times lateral drift of the element) acts on the structure. Of
/// beams and trusses that are not level: the force along a floor has no such couple.
enum class P_DELTA { None, Initial, Updated };

/// What grows by steps.
enum class PUSH_CONTROL { LoadFactor, Displacement, LargestTranslation };

/// Where a stage ends before its target. 0 or empty: not asked for.
struct T_PUSH_STOPS {
    double drift = 0.0;          // largest storey drift ratio
    double fractionOfPeak = 0.0; // base reaction fallen to this fraction of its largest value
    double stiffnessRatio = 0.0; // tangent of base reaction against displacement over the first one
    int mark = -1;               // first hinge beyond this entry of its marks
    bool strengthLoss = false;   // first hinge that begins to lose strength
    bool lastPoint = false;      // first hinge beyond the last vertex of its law
};

/// Loads that grow together. Those of the stages before stay as they are.
struct T_PUSH_STAGE {
    T_LOAD_CASE loads;                                 // at the load factor 1
    PUSH_CONTROL control = PUSH_CONTROL::Displacement; // what `target` and `steps` are of
    std::size_t node = 0;                              // control node
    int direction = 0;                                 // 0 to 5; also of the base reaction
    /// Translation and reaction along this unit vector instead of `direction`.
    std::optional<T_VEC3> along;
    /// Of displacement control: displacement of the node, that of earlier stages included, its sign
    /// is the direction of the push; of the largest translation its magnitude, the push goes where
    /// the loads move that node; of load control: the load factor.
    double target = 0.0;
    /// Places of the stored steps: fractions of the way from the start to the target, rising, the
    /// last is 1. Empty: the end alone.
    std::vector<double> steps;
    std::vector<double> additional; // displacements of the control node that are steps too
    T_PUSH_STOPS stops;             // ends before the target
    /// Displacement control: where no path of equilibrium leads on, the run goes on at the next
    /// step in a state that is in equilibrium again, each hinge deformed as little further as its
    /// own condition needs. Else the run ends there.
    bool leaps = false;
};

/// Factors of the six directions that displacement and reaction of a stage are taken along.
inline T_VEC6 WayOf(const T_PUSH_STAGE& stage)
{
    T_VEC6 way{};
    if (stage.along)
        std::copy(stage.along->begin(), stage.along->end(), way.begin());
    else
        way[static_cast<std::size_t>(stage.direction)] = 1.0;
    return way;
}

/// The nodes of a storey whose drift is watched, each with the node below (or the ground).
struct T_PUSH_DRIFT {
    /// In place of a node: the ground, which does not move.
    static constexpr std::size_t kGround = std::numeric_limits<std::size_t>::max();
    std::size_t node = 0, below = kGround; // places in T_FRAME::nodes
    double height = 0.0;                   // of the storey, a length above 0
};

/// All that a run of stages needs.
struct T_PUSH_MODEL {
    T_FRAME frame;
    std::vector<T_PUSH_HINGE> hinges; // results by hinge are in this order
    T_LOAD_CASE initial; // loads that stand before the first stage; brought in from 0 to 1
    P_DELTA pDelta = P_DELTA::None;   // second order of the axial forces
    int vertical = 2;                 // axis of gravity: 0 X, 1 Y, 2 Z
    std::vector<T_PUSH_DRIFT> drifts; // that a stop by drift watches
    std::size_t mostEvents = 100000;  // beyond it the run ends, as TooManyEvents
};

} // namespace solver
