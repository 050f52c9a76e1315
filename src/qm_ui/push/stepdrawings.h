// Pictures of a step of a push for files: the frame with its hinges, the storeys.
#pragma once

#include "qm_rps/pushoverhingestatedlg.h"
#include "qm_rps/pushoverstoreydlg.h"
#include "qm_ui/frame/framepainter.h"
#include "qm_ui/report/picturefile.h"

/// The displaced frame with the hinges by their states, as window and file show it; scale: of the
/// displacements. It refers to the dialog, until that shows another step.
T_FRAME_PICTURE StatePicture(CPushOverHingeStateDlg& shown, double scale);
/// The same as a drawing, seen as the window shows it first.
T_DRAWING StateDrawing(CPushOverHingeStateDlg& shown);
/// Displacements, drifts and shears over the height, side by side.
T_DRAWING StoreyDrawing(const CPushOverStoreyDlg& shown);
