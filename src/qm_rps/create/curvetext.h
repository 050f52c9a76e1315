// A capacity curve from a pasted text: base shear over displacement, and the displacements of
// storeys where further columns have them.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/pastedtable.h"

#include <string>
#include <vector>

/// How a text is to be read.
struct T_CURVE_TEXT {
    std::string text{};
    PASTED_DECIMAL decimal = PASTED_DECIMAL::Auto;
    /// What the columns are, from the left: V, d (of the control node), d1, d2 ... (of the storeys,
    /// bottom to top), - (not read). Empty: told from header and numbers where these show it.
    std::string columns{};
    bool addOrigin = false;    // the text starts behind (0, 0)
    bool reverseForce = false; // V has the sign of the reactions
};

struct T_CURVE_POINT {
    int line = 0; // of the text; 0: the origin that was added
    double force = 0.0, displacement = 0.0;
    std::vector<double> storeys{}; // displacements, bottom to top
};

struct T_CURVE_READ {
    std::vector<T_CURVE_POINT> points; // the origin first
    std::string columns;               // as they were read: "V,d"
    std::size_t storeys = 0;           // columns of storeys
    T_PASTED_TABLE table;
    bool columnsFromHeader = false, columnsFromNumbers = false; // where nobody has said them
};

/// 1 done; 0 `fault` says what and in which line (field "text" or "columns"), `out` as it was: a
/// text that is no table, columns that nothing tells apart, fewer than two points beside the
/// origin, a curve that does not start at (0, 0), displacements that fall, a first step without
/// stiffness, negative forces.
[[nodiscard]] int ReadCurve(const T_CURVE_TEXT& in, T_CURVE_READ& out, T_FINDING& fault);

/// What was taken for separator, decimal point, header and columns, a sentence each.
std::vector<std::string> CurveReadNotes(const T_CURVE_READ& read);
