// What a member end, a brace or a joint can take, and the share of it that a step takes. SI.
#pragma once

#include "qm_rps/generate/memberend.h"
#include "qm_rps/judge/judgedjoint.h"

#include <memory>

/// What something is judged by.
enum class JUDGE_BASIS {
    Nothing,  // there is a reason
    Code,     // a code, from section and material
    Criteria, // the acceptance criteria of its hinge
};

/// Limit states from the lightest: IO, LS, CP; DL, SD, NC; SLD, SLV, SLC.
inline constexpr std::size_t kLevels = 3;
using T_LEVELS = std::array<const char*, kLevels>;
inline constexpr std::array<T_LEVELS, 3> kLevelNames{
    {{"IO", "LS", "CP"}, {"DL", "SD", "NC"}, {"SLD", "SLV", "SLC"}}};

/// Rotation and shear of member ends, of steel columns the axial force (with bending where no
/// plastic rotation may be counted on); the elongation of braces; the shear of joints.
enum class JUDGE_MODE { Rotation, Shear, Axial, Elongation, Joint };
inline constexpr std::size_t kModes = 5;
inline constexpr std::array<const char*, kModes> kModeNames{"rotation", "shear", "axial_force",
                                                            "elongation", "joint"};

/// Partial factors of brittle checks.
struct T_JUDGE_FACTORS {
    double gammaC = 1.5, gammaS = 1.15; // EN 1998-3, Circolare: strengths in shear, of joints
    double gamma = 1.3;                 // ASCE 41: force-controlled actions
    bool operator==(const T_JUDGE_FACTORS&) const = default;
};

enum class JUDGED_KIND { End, Brace, Joint, Spring };

/// One end of a member about one axis; a whole brace (any truss); a joint in one plane; a link or a
/// spring, which is not judged.
struct T_JUDGED_END {
    JUDGED_KIND kind = JUDGED_KIND::End;
    T_END_PLACE place; // of a joint: its column
    T_MEMBER_AXES axes;
    bool column = false;
    std::string storey; // empty: none
    JUDGE_BASIS basis = JUDGE_BASIS::Nothing;
    std::string why;                    // Nothing: the reason
    T_MEMBER_END member;                // Code, but for joints
    T_SIDES<std::vector<double>> marks; // Criteria: deformations of the hinge at IO, LS, CP
    double spring = 0.0;                // stiffness of its hinge in series, 0: rigid until it flows
    long hinge = -1;                    // of the run
    bool shearHinge = false;            // the member has one: its shear is a matter of deformations
    std::shared_ptr<const T_JUDGED_JOINT> joint{}; // Joint

    /// The code of Code.
    HINGE_CODE By() const { return joint ? joint->joint.code : member.code; }
    const T_LEVELS& Levels() const;
    /// N, M, V of its states are known.
    bool HasForces() const { return joint ? basis != JUDGE_BASIS::Nothing : axes.length > 0.0; }
    std::string Code() const; // "EN1998-3", "hinge type", ""
};

/// Demand and capacity of one check at one limit state.
struct T_CHECK {
    double demand = 0.0, capacity = 0.0;
    /// Empty: no capacity at all is asked for.
    std::optional<double> Ratio() const;
    bool Holds() const { return demand <= capacity; }
};

/// One mode of failure at all limit states.
struct T_MODE_CHECK {
    JUDGE_MODE mode = JUDGE_MODE::Rotation;
    T_DIM dim{}; // of demand and capacity
    std::array<std::optional<T_CHECK>, kLevels> at;
    std::array<std::string, kLevels> clause; // that the capacity comes from
    std::string why;                         // there are no numbers
    std::vector<T_CODE_TRACE> trace;
    CODE_MARK leastSure = CODE_MARK::Computed;
};

/// The checks of something in a state.
struct T_END_CHECKS {
    double LV = 0.0;                 // shear span that the rotations took; 0: none
    double thetaY = 0.0;             // 0: not known
    double ductility = 0.0;          // theta / theta_y; 0: not known
    std::vector<T_MODE_CHECK> modes; // those that apply
    std::vector<T_CODE_WARNING> warnings;

    /// Null: the mode does not apply.
    const T_MODE_CHECK* Of(JUDGE_MODE mode) const;
    T_MODE_CHECK* Of(JUDGE_MODE mode);
    /// Empty: it does not apply, or is not known.
    std::optional<T_CHECK> At(JUDGE_MODE mode, std::size_t level) const;
};

/// What a state is judged with besides itself.
struct T_STATE_CONTEXT {
    T_END_STATE brittle;                  // where demands of brittle checks are read
    std::optional<T_END_STATE> gravity{}; // under the initial loads; empty: not known
    T_JUDGE_FACTORS factors;
};

/// Modes that apply, in their order.
std::vector<JUDGE_MODE> ModesOf(const T_JUDGED_END& end);

/// Rotations: EN 1998-3, Circolare: |chord rotation| against DL, SD, NC at N and LV = M / V of the
/// state. ASCE 41, FEMA 356: plastic rotation against kappa times IO, LS, CP at N (41-17, columns
/// of steel: at N of the initial loads). Masonry: |chord rotation| against the drift of the mode
/// that comes first. Criteria: the deformation of the hinge against its own.
/// LV is at least the depth of the section, or half the clear length of a squat member (a moment
/// that is almost 0 says nothing of either); of rotations at most the clear length.
/// Shear: EN 1998-3 (A.12) with the strengths over CF and gamma_M, at the ductility theta / theta_y
/// of the state, VRd,max of EN 1992-1-1; steel EN 1993-1-1 6.2.6. ASCE 41-17 7.5.3.2: gamma chi
/// (V - VG) + VG against kappa times the strength with lower-bound strengths.
/// Axial force of steel columns: buckling; where the code counts on no rotation with the moments,
/// AISC 360 H1-1 or EN 1993-1-1 6.2.9 and 6.3.3, and what the hinge has turned against 0. Joints:
/// CheckJoint.
T_END_CHECKS CheckEnd(const T_JUDGED_END& end, const T_END_STATE& state,
                      const T_STATE_CONTEXT& with);
