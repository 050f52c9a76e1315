// Linear static analysis of load cases and eigen analysis of the document's model.
#pragma once

#include "qm_db/analysisoptions.h"
#include "qm_db/editdata.h"

/// Feeds the model to the analysis engine and keeps the results: of each load case with the
/// fingerprint of what it was computed from; modes, when they are asked for, in place of the
/// model's modes, as an edit that can be undone.
class CAnalysisRun {
public:
    CAnalysisRun(CDataCtrl& data, CEditData& edit) : m_data(data), m_edit(edit) {}

    /// One factorisation serves all load cases and the modes; construction stages have their own.
    /// 1 done; 0 error filled and neither results nor modes
    /// changed.
    [[nodiscard]] int Run(const T_ANALYSIS_OPTIONS& options, T_ANALYSIS_ERROR& error);

private:
    [[nodiscard]] int KeepModes(std::vector<T_EIGV_D> modes);

    CDataCtrl& m_data;
    CEditData& m_edit;
};
