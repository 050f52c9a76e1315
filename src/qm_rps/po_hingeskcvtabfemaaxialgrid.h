// Model of the list of axial forces of a FEMA curve that has one backbone per axial force.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/hinge/hingelabels.h"

class CPO_HingeSkcvTabFemaAxialGrid : public zql::frx::MDialog {
public:
    T_HINGE_OWNER m_owner; // for the unit
    double m_entry = 0.0;  // force to be added
    int m_selected = -1;   // chosen row; -1: none

    /// Forces, ascending, each with the index of the curve that it had in Data2Dlg (-1: new).
    struct T_ROW {
        double axial = 0.0;
        int source = -1;
    };

    void Data2Dlg(const std::vector<T_SKEL_AXIAL>& curves);
    /// The list: curves of kept or changed forces as they are, new forces with `fresh`.
    void Dlg2Data(std::vector<T_SKEL_AXIAL>& curves, const T_SIDES<T_SKEL_SIDE>& fresh) const;
    const std::vector<T_ROW>& Rows() const { return m_rows; }

    /// 1 done; 0 refused with a message, the list as it was. Forces are compared exactly; a new
    /// one is finite.
    [[nodiscard]] int AddForce(double axial);
    [[nodiscard]] int ChangeForce(double oldAxial, double axial);
    [[nodiscard]] int RemoveForce(double axial);

    /// AddForce of the entry; RemoveForce of the chosen row (0 without a message: none is chosen).
    [[nodiscard]] int OnAdd() { return AddForce(m_entry); }
    [[nodiscard]] int OnRemove();

private:
    int Find(double axial) const; // index or -1
    bool CheckFinite(double axial);
    void Sort();
    void Refuse(const char* literal, double axial);

    std::vector<T_SKEL_AXIAL> m_given;
    std::vector<T_ROW> m_rows;
};
