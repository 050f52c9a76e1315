// Members of a model as hinges of a code are made for them: where they bend, how long they are, and
// the axial force of the initial loads. SI.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/generate/codeside.h"
#include "qm_rps/hinge/axial/initialaxial.h"

/// One element.
struct T_HINGE_MEMBER {
    int element = 0, section = 0, material = 0;
    MEMBER_KIND kind = MEMBER_KIND::Beam;
    double clear = 0.0, length = 0.0;     // between the rigid offsets, from node to node
    T_ENDS<double> axial{};               // compression positive
    std::vector<HINGE_COMPONENT> bending; // about which axes
    T_ENDS<T_DIRS6> release{};
    std::vector<double> pushed{}; // as T_GENERATED has it
    /// Of a steel beam with a connection; see ReadSteelJoints.
    std::optional<T_ENDS<T_STEEL_JOINT>> joints{};

    bool HasAxial() const { return IsUpright(kind); }
};

/// A truss, and a beam element of steel whose both ends turn freely, is a brace. Steeper than 45
/// degrees a member is a column (masonry: pier), else a beam (spandrel); a column whose section is
/// that of a wall and bends about its strong axis is a wall.
/// Columns bend about y and z, beams about the axis that lies horizontal, walls and piers about
/// their strong axis; in a plane model each about the axis that is normal to the plane. 1 done; 0
/// with the reason: no such element, section or material missing, one of several elements of a
/// member, nothing left between the offsets, a beam of which neither axis lies horizontal within 10
/// degrees.
[[nodiscard]] int ReadMember(const T_MODEL& model, int element, const CInitialAxial& axial,
                             T_HINGE_MEMBER& out, std::string& reason);

/// An end of a member about an axis as the codes' formulas take it, under an axial force.
T_MEMBER_END EndOf(const T_MODEL& model, const T_HINGE_MEMBER& member,
                   const T_CODE_OPTIONS& options, HINGE_COMPONENT component, bool atI,
                   double axial);

/// All that a hinge type hangs on, in a fixed order; the edition of the rules among it.
std::vector<double> InputsOf(const T_MODEL& model, const T_HINGE_MEMBER& member);
/// Equal but for rounding; axial forces to 1e-6 of the squash load.
bool SameInputs(const std::vector<double>& a, const std::vector<double>& b);

/// Ends the inputs of a generated type with what it was asked for with, as the record has it: code,
/// level, axial forces, connection.
void PutSeal(T_GENERATED& made);
/// How the inputs that a generated type has stand to those of the model today.
enum class INPUT_STATE { Same, Stale, Edited };
/// Edited: the record is not what it was sealed with.
INPUT_STATE InputStateOf(const T_GENERATED& made, const std::vector<double>& today);
