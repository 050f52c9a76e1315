// Model of the result dialog of a construction-stage problem: the factors, and whether to iterate.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/ulfiterationreport.h"

class CUlfIterationResultDlg : public zql::frx::MDialog {
public:
    explicit CUlfIterationResultDlg(T_ULF_ITER_STEP step) : m_step(std::move(step)) {}

    const T_ULF_ITER_STEP& Step() const { return m_step; }
    bool m_iterate = false; // iterative analysis, or one more iteration, is wanted

private:
    T_ULF_ITER_STEP m_step;
};
