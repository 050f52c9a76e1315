// The window of a judgement: table, frame, first passes.
#pragma once

#include "qm_ui/form/viewfactory.h"

/// The window of CPushOverJudgementDlg.
void RegisterJudgementView(CViewFactory& factory);
