// Members of a model as hinges of a code are made for them: where they bend, how long they are, and
// the axial force of the initial loads. SI.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/generate/rchinge.h"
#include "qm_rps/hinge/axial/initialaxial.h"

/// One element. Steeper than 45 degrees it is a column, else a beam.
struct T_RC_MEMBER {
    int element = 0, section = 0, material = 0;
    bool column = false;
    double clear = 0.0, length = 0.0;
    T_ENDS<double> axial{};               // compression positive
    std::vector<HINGE_COMPONENT> bending; // about which axes
    T_ENDS<T_DIRS6> release{};
};

/// Columns bend about y and z, beams about y; in a plane model each about the axis that is normal
/// to the plane. 1 done; 0 with the reason: no beam element, section or material missing, one of
/// several elements of a member, nothing left between the offsets.
[[nodiscard]] int ReadMember(const T_MODEL& model, int element, const CInitialAxial& axial,
                             T_RC_MEMBER& out, std::string& reason);

/// The end of a member about an axis as the codes' formulas take it.
T_RC_END EndOf(const T_MODEL& model, const T_RC_MEMBER& member, HINGE_CODE code, bool secondary,
               HINGE_COMPONENT component, double axial);

/// All that a hinge type hangs on, in a fixed order.
std::vector<double> InputsOf(const T_MODEL& model, const T_RC_MEMBER& member);
/// Equal but for rounding; axial forces to 1e-6 of Ag fc.
bool SameInputs(const std::vector<double>& a, const std::vector<double>& b);
