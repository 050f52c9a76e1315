// The picture of what a view of results shows, for window, file and printer.
#pragma once

#include "qm_rps/view/resultview.h"
#include "qm_ui/frame/framepainter.h"
#include "qm_ui/report/picturefile.h"

/// It refers to the view until that shows something else. phase: of displacements that swing, 1 as
/// they are.
[[nodiscard]] T_FRAME_PICTURE PictureOf(const CResultView& view, const CSelection& selection,
                                        double phase = 1.0);
/// A drawing of it, which refers to the view likewise.
[[nodiscard]] T_DRAWING DrawingOf(const CResultView& view, const CSelection& selection,
                                  const T_CAMERA& camera, const T_FRAME_OPTIONS& options);
