// Model of the window of inelastic hinge properties, as time-history analysis takes them: which
// record, which component, and the editors of its curve and of its axial forces. Both editors are
// services of the agency "rps", as other modules of the host ask for them.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/rpsdlgbase.h"

class CPO_InelasticHingeDlg : public CRPSDlgBase {
public:
    std::string m_name;  // of the record
    int m_component = 4; // HINGE_COMPONENT, My

    /// Takes the document and its first record.
    void SetDoc(CDBDoc* doc) override;
    std::vector<std::string> Names() const;
    static std::vector<std::string> Components();
    /// One row per component: its name, whether it has a curve, the number of its axial forces.
    T_TEXT_TABLE Cells() const;

    /// A new record with a free name, chosen; one edit that can be undone.
    int OnNew();
    /// The FEMA curve of the component, and its table of axial forces; what is accepted is stored
    /// as one edit. 0 cancelled, or refused with a message.
    int OnCurve();
    int OnAxialForces();

private:
    int Key() const; // 0: no record is chosen
    int Store(const T_IEHP_D& record);
};
