// What was generated, as rows: one for each end, axis and side of an element.
#pragma once

#include "qm_rps/generate/codehinges.h"

struct T_CODE_ROW_OF_HINGE {
    int element = 0;
    MEMBER_KIND kind = MEMBER_KIND::Beam;
    std::string end; // "I", "J"; "I, J": both are alike; "C": in the middle
    HINGE_COMPONENT component = HINGE_COMPONENT::My;
    std::string side;                // "+", "-" by the signs of an analysis; "+-": both are alike
    double axial = 0.0;              // SI, compression positive; of beams 0
    const T_CODE_SIDE* of = nullptr; // of the hinge, which outlives the row
};
std::vector<T_CODE_ROW_OF_HINGE> HingeRows(const T_CODE_ELEMENT& element);

/// End, axis, side, N, strength, V/Vn and the backbone: a, b, c, IO, LS, CP as plastic
/// deformations; theta_y, DL, SD, NC as total ones (chord). In the given units.
std::vector<std::string> HingeRowHeads(const T_CODE_HINGES& hinges, bool chord,
                                       const T_UNITS& units);
std::vector<std::string> HingeRowCells(const T_CODE_ROW_OF_HINGE& row, bool chord,
                                       const T_UNITS& units);
/// The first element of each type, which stands for the others: they have the same numbers.
std::vector<const T_CODE_ELEMENT*> FirstsOfTypes(const T_CODE_HINGES& hinges);
/// What the types must be known for, each text once, with the first elements of those that have it.
std::vector<std::pair<std::string, std::vector<const T_CODE_ELEMENT*>>>
HingeWarnings(const T_CODE_HINGES& hinges);

/// "computed", "sighted twice" ...
std::string MarkText(CODE_MARK mark);
/// "theta_y = 0.0051; EN 1998-3 (A.10b); ...; sighted once".
std::string TraceLine(const T_CODE_TRACE& line, const T_UNITS& units);
/// "kN m", "kN/m2", "1/m"; empty: without a unit.
std::string UnitText(T_DIM dim, const T_UNITS& units);
