// Model of the table of axial forces of a FEMA curve: forces, and the yield strengths of the curve
// of each one.
// Units: as the caller's. State: the forces (key table) and the sides of the curves that were
// edited or added (value table); the caller's rows stay as they are.
#pragma once

#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/po_hingeskcvtabfemaaxialgrid.h"

#include <map>

class CPO_HingeSkcvTabFemaAxialDlg : public zql::frx::MDialog {
public:
    static constexpr std::size_t kMaxKeys = 10;
    static constexpr std::size_t kMaxValues =
        11; // a changed force comes in before its old one goes
    using T_VALUES = std::map<double, T_SIDES<T_SKEL_SIDE>>;

    /// 1 taken; 0 with a message: more than kMaxKeys rows, or a force twice or not finite.
    [[nodiscard]] int Data2Dlg(const std::vector<T_SKEL_AXIAL>& rows);

    /// Forces, ascending.
    std::vector<double> Keys() const;
    /// Sides of the curves that were edited, by force.
    const T_VALUES& Values() const { return m_values; }
    /// Sides of a force of the table: edited, else as given.
    const T_SIDES<T_SKEL_SIDE>& SidesOf(double axial) const;

    // 1 done; 0 refused with a message, the table as it was.

    /// A new force gets the curve of the nearest one, the curve of zeros in an empty table.
    [[nodiscard]] int AddForce(double axial);
    /// The curve goes with the force.
    [[nodiscard]] int ChangeForce(double oldAxial, double axial);
    [[nodiscard]] int RemoveForce(double axial);
    /// Yield strengths are magnitudes: not negative, finite.
    [[nodiscard]] int SetYield(double axial, HINGE_SIDE side, double yield);

    double m_newForce = 0.0; // what a window's button adds
    T_UNITS m_units;         // of the forces and strengths, for the heads

private:
    int PutValue(double axial, const T_SIDES<T_SKEL_SIDE>& sides);
    CPO_HingeSkcvTabFemaAxialGrid& List();

    CPO_HingeSkcvTabFemaAxialGrid m_list;
    T_VALUES m_given, m_values;
};
