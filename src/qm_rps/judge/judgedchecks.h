// What the checks by materials share; for the files of judgedend.h alone. SI.
#pragma once

#include "qm_rps/judge/judgedend.h"

/// Something to be judged in a state, and where its checks go.
struct T_CHECKING {
    const T_JUDGED_END& end;
    const T_END_STATE& state;
    const T_STATE_CONTEXT& with;
    T_END_CHECKS& out;

    T_MODE_CHECK& Of(JUDGE_MODE mode) const { return *out.Of(mode); }
};

/// The side of the section that the moment compresses.
bool IsPositiveSide(const T_JUDGED_END& end, const T_END_STATE& s);
/// The end at the axial force of a state. Rotations go with the chord: it is no longer than the
/// clear length.
T_MEMBER_END RotationEnd(const T_JUDGED_END& end, const T_END_STATE& s, CCodeSheet& sheet);
/// The same for shear: of a moment without shear so long that no formula sees its end.
T_MEMBER_END ShearEnd(const T_JUDGED_END& end, const T_END_STATE& s, CCodeSheet& sheet);

/// What `hinge generate` makes of an end, on the side that the state compresses.
std::optional<T_CODE_SIDE> GeneratedSide(const T_MEMBER_END& member, bool positive,
                                         std::string& reason);

/// The clause of the last line with one of these symbols, the first that there is.
std::string ClauseOf(const std::vector<T_CODE_TRACE>& trace,
                     std::initializer_list<std::string_view> symbols);
/// Takes a sheet's lines behind those that stand, and its warnings.
void Keep(const CCodeSheet& sheet, T_MODE_CHECK& check, T_END_CHECKS& out);

/// Of concrete and steel: the angle between the end and its chord to the end of the shear span, on
/// the sheet. EN 1998-3 A.3.1.
double SpanChordDemand(const T_CHECKING& c, const T_MEMBER_END& member, CCodeSheet& sheet);
/// Of masonry: the rotation of the end less that of the chord of the member; 0 at a free or pinned
/// end, which turns without being bent.
double ChordDemand(const T_CHECKING& c, const T_MEMBER_END& member, CCodeSheet& sheet);
/// |chord rotation| against DL, SD, NC of the hinge that the code gives.
void GeneratedChord(const T_CHECKING& c);
/// Of a hinge beyond yield, without what turns elastically in series; 0: rounding.
double PlasticRotationOf(const T_JUDGED_END& end, const T_END_STATE& s);
/// Plastic rotation against kappa times IO, LS, CP of the hinge that the code gives at an axial
/// force.
void PlasticRotations(const T_CHECKING& c, double axial);

/// Of the knowledge level; a material without one counts as the least known.
double KappaOf(const T_MATL_D& material, CCodeSheet& sheet);
/// gamma chi (QUF - QG) + QG at IO, LS, CP on the sheet; a force or a moment.
std::array<double, kLevels> ForceDemands(const char* symbol, double force, double gravity,
                                         T_DIM dim, double gamma, CCodeSheet& sheet);
inline constexpr const char* kForceClause = "ASCE 41-17 7.5.3.2";

/// Fill the modes of an end of this material by its code.
void CheckConcrete(const T_CHECKING& c);
void CheckSteel(const T_CHECKING& c);
void CheckBrace(const T_CHECKING& c);
void CheckMasonry(const T_CHECKING& c);
void CheckJointOf(const T_CHECKING& c);
