// Views of the dialogs of the evaluation window.
#pragma once

#include "qm_ui/form/viewfactory.h"

class CPushOverAdditionalStepDlg;
class CPushOverComparisonDlg;
class CPushOverControlDlg;
class CPushOverCurveDampParamUser;
class CPushOverTextDlg;

void BuildPushOverControl(CFormView& form, CPushOverControlDlg& model);
void BuildAdditionalSteps(CFormView& form, CPushOverAdditionalStepDlg& model);
void BuildUserDamping(CFormView& form, CPushOverCurveDampParamUser& model);
/// Preview of a text with a button that saves it.
void BuildPushOverText(CFormView& form, CPushOverTextDlg& model);
void BuildPushOverComparison(CFormView& form, CPushOverComparisonDlg& model);
