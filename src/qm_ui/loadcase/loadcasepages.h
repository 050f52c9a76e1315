// Pages of the load case window on how the load case is pushed.
#pragma once

#include "qm_rps/push/pushquantity.h"
#include "qm_ui/form/formview.h"

class CPO_LoadCaseDlg;

/// What displacements of the load case are measured in: by its direction a length or rad.
T_PUSH_QUANTITY LoadCaseDisplacement(const CPO_LoadCaseDlg& dialog);

/// Initial loads or another case's end, P-Delta, failed hinges.
void BuildLoadCaseStart(CFormView& form, CPO_LoadCaseDlg& dialog);
/// Increments, what ends the push before its target, steps that are asked for.
void BuildLoadCaseStops(CFormView& form, CPO_LoadCaseDlg& dialog);
