// The service of this library that other modules of the host reach under the name "rps".
#pragma once

#include "qm_base/serviceheadoffice.h"
#include "qm_db/records.h"

#include <map>
#include <vector>

class CServiceAgencyRps : public CServiceAgency {
public:
    /// Sides of a curve by its axial force.
    using T_AXIAL_VALUES = std::map<double, T_SIDES<T_SKEL_SIDE>>;

    /// By request.kind; dialogs are modal, in the view of the current document (CModelessDlgCtrl):
    /// 1 the FEMA editor in time-history mode on component request.index of the T_IEHP_D that
    ///   request.record points to;
    /// 2 the table of axial forces of the std::vector<T_SKEL_AXIAL> that request.rows points to;
    /// 3, 4, 5 the explanatory figures: strength loss without and with cyclic degradation,
    ///   unloading stiffness.
    /// 1 accepted, the caller's record or rows are changed; 0 cancelled, or a figure was shown.
    /// Another kind, a null pointer or a component outside 0 to 5 raises the release assertion and
    /// gives 0.
    int Service(const T_SERVICE_REQUEST& request) override;

    /// Rows of the forces in `keys`, each with its value in `edited`, else in `old`; a force that
    /// is in neither raises the release assertion and gets no row.
    static std::vector<T_SKEL_AXIAL> RebuildRows(const std::vector<double>& keys,
                                                 const T_AXIAL_VALUES& edited,
                                                 const T_AXIAL_VALUES& old);
};
