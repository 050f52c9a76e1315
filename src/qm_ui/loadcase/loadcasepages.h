// Pages of the load case window on how the load case is pushed.
#pragma once

#include "qm_ui/form/formview.h"

class CPO_LoadCaseDlg;

/// Initial loads or another case's end, P-Delta, failed hinges.
void BuildLoadCaseStart(CFormView& form, CPO_LoadCaseDlg& dialog);
/// Increments, what ends the push before its target, steps that are asked for.
void BuildLoadCaseStops(CFormView& form, CPO_LoadCaseDlg& dialog);
