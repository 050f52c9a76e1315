// Model of the list of axial forces of a FEMA curve that has one backbone per axial force.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/hinge/axialforcelist.h"
#include "qm_rps/hinge/hingelabels.h"

class CPO_HingeSkcvTabFemaAxialGrid : public zql::frx::MDialog {
public:
    T_HINGE_OWNER m_owner; // for the unit
    double m_entry = 0.0;  // force to be added
    int m_selected = -1;   // chosen row; -1: none

    void Data2Dlg(const std::vector<T_SKEL_AXIAL>& curves,
                  std::optional<CAxialForceList::T_RANGE> range = {})
    {
        m_forces = CAxialForceList(curves, range);
    }
    /// The list: curves of kept or changed forces as they are, new forces with `fresh`.
    void Dlg2Data(std::vector<T_SKEL_AXIAL>& curves, const T_SIDES<T_SKEL_SIDE>& fresh) const
    {
        curves = m_forces.Curves(fresh);
    }
    /// Forces, ascending.
    const std::vector<CAxialForceList::T_ROW>& Rows() const { return m_forces.Rows(); }

    /// 1 done; 0 refused with a message, the list as it was.
    [[nodiscard]] int AddForce(double axial) { return Done(m_forces.Add(axial)); }
    [[nodiscard]] int ChangeForce(double oldAxial, double axial)
    {
        return Done(m_forces.Change(oldAxial, axial));
    }
    [[nodiscard]] int RemoveForce(double axial) { return Done(m_forces.Remove(axial)); }

    /// AddForce of the entry; RemoveForce of the chosen row (0 without a message: none is chosen).
    [[nodiscard]] int OnAdd() { return AddForce(m_entry); }
    [[nodiscard]] int OnRemove();

private:
    int Done(const CAxialForceList::REFUSAL& refusal);

    CAxialForceList m_forces;
};
