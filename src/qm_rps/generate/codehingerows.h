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

/// "computed", "sighted twice" ...
std::string MarkText(CODE_MARK mark);
/// "kN m", "kN/m2", "1/m"; empty: without a unit.
std::string UnitText(T_DIM dim, const T_UNITS& units);
