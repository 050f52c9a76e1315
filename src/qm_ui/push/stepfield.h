// Fields of the windows on a push: the slider of its steps, the frame with its hinges.
#pragma once

#include "qm_rps/pushoverhingestatedlg.h"
#include "qm_ui/form/formview.h"

#include <memory>

/// Adds a picture of this wanted size, which takes the room that there is.
CFormField& AddPlot(CFormView& form, std::function<T_PLOT()> plot, QSize wanted);
/// A slider over the steps of the shown result.
std::unique_ptr<CFormField> MakeStepField(CPushOverResultDlg& shown, ChangedFn changed,
                                          QWidget* parent);
/// The displaced frame with the hinges by their states; a click on a hinge chooses it.
std::unique_ptr<CFormField> MakeStateFrame(CPushOverHingeStateDlg& shown, ChangedFn changed,
                                           QWidget* parent);
