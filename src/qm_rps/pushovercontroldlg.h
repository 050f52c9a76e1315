// Model of the control options of an evaluation: the storey drift that decides on capacities, the
// weight that stands in where the model has no vertical mass, and further monitored nodes.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"

class CPushOverControlDlg : public CCheckedDialog {
public:
    /// The document must outlive the dialog.
    explicit CPushOverControlDlg(CDBDoc& doc) : m_doc(doc) {}

    int m_driftKind = 1;                            // 1 or 2, see CPostCtrl
    std::optional<double> m_weight;                 // force unit of the document
    std::array<int, kMostMonitoredNodes> m_nodes{}; // 0: none

    void Data2Dlg(const T_EVAL_D& evaluation);
    void Dlg2Data(T_EVAL_D& evaluation) const;

    /// The control node of the load case, and whether it is named or found.
    std::string ControlText() const;
    T_UNITS Units() const { return m_doc.Data().Units(); }

    std::vector<T_FINDING> Findings() const override;

private:
    CDBDoc& m_doc;
    T_EVAL_D m_read;
};
