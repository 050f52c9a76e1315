// The evaluation window: list and settings left, picture and figures right, tables below.
#pragma once

#include "qm_rps/evaluationdeskdlg.h"
#include "qm_ui/form/viewfactory.h"

void BuildEvaluationDesk(CFormView& form, CEvaluationDeskDlg& desk);

/// Part of it: the pages with the settings of the chosen evaluation and of its picture.
void BuildEvaluationSettings(CFormView& form, CEvaluationDeskDlg& desk);
