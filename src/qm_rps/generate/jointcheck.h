// Shear of beam-column joints of concrete: what they are in a model, and their check by a code. SI.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/codes/asce41concrete.h"
#include "qm_rps/generate/codeside.h"

#include <span>

/// A joint in a vertical plane.
struct T_JOINT {
    HINGE_CODE code = HINGE_CODE::Asce17;
    int node = 0, column = 0; // element
    std::vector<int> beams;   // elements in the plane, one or two
    JOINT_KIND kind = JOINT_KIND::Interior;
    double hc = 0.0, width = 0.0; // depth of the column along the beams; of the joint across
    double hjc = 0.0;             // between the outermost bars of the column along the beams
    double columnArea = 0.0;      // Ag
    double lever = 0.0;           // of the beams' bars, 0.9 d of the shallower one
    double fc = 0.0;              // assessed: expected (ASCE 41), mean over the confidence factor
    double fcd = 0.0;             // the same over gamma_C where the check asks for it
    double lower = 0.0;           // lower bound (ASCE 41)
    std::vector<T_CODE_TRACE> trace; // of the strengths
};
/// Beam elements by the nodes of their ends.
using T_NODE_BEAMS = std::map<int, std::vector<int>>;
T_NODE_BEAMS BeamsByNode(const T_MODEL& model);

/// Horizontal directions, unit vectors, of the vertical planes that the beams of a node lie in:
/// beams within five degrees of each other share one. Those nearest to the first horizontal axis
/// come first; each points along its nearest axis. `around`: the beam elements of the node.
std::vector<std::array<double, 3>> JointPlanes(const T_MODEL& model, std::span<const int> around,
                                               int node);

/// What meets at a node in one of its planes.
struct T_JOINT_MEMBERS {
    int above = 0;          // column; 0: none
    int column = 0;         // below, else above; 0: no column with a beam, so no joint
    std::vector<int> beams; // in the plane
};
T_JOINT_MEMBERS MembersOfJoint(const T_MODEL& model, std::span<const int> around, int node,
                               const std::array<double, 3>& along);

/// The joint at a node in the plane of a direction (JointPlanes). Rectangular columns and beams of
/// concrete with bars, the column's sides along and across the plane, one column above and below,
/// all beams in line or at right angles; no walls. 1 done; 0 with the reason in words, `out`
/// unchanged.
[[nodiscard]] int ReadJoint(const T_MODEL& model, std::span<const int> around, int node,
                            const std::array<double, 3>& along, HINGE_CODE code, T_JOINT& out,
                            std::string& reason);

struct T_JOINT_DEMAND {
    double beamMoments = 0.0; // sum of the beams' end moments that turn the joint the same way
    double columnShear =
        0.0;            // of the column above, against the force of the bars: one sign with them
    double axial = 0.0; // of the column above, compression positive
};
struct T_JOINT_CHECK {
    double shear = 0.0;                        // Vj = |beam moments / lever - column shear|
    double demand = 0.0, capacity = 0.0;       // forces; Circolare: the governing stress, its limit
    T_DIM dim{};                               // of these
    std::optional<T_CODE_PLASTIC> rotations{}; // ASCE 41 Table 10-11: shear angles
    std::vector<T_CODE_TRACE> trace;
    std::vector<T_CODE_WARNING> warnings;

    double Ratio() const { return demand / capacity; }
};
/// ASCE 41-17 Table 10-12 with the lower-bound strength (41-13, FEMA 356: the same rows), EN 1998-1
/// 5.5.3.3 without hoops, Circolare 2019 [C8.7.2.11], [C8.7.2.12]. No hoops are counted in the
/// joint. 1 done; 0 with the reason in words, `out` unchanged.
[[nodiscard]] int CheckJoint(const T_JOINT& joint, const T_JOINT_DEMAND& demand, T_JOINT_CHECK& out,
                             std::string& reason);
