// Picture of a frame with its member ends by the ratio of demand to capacity.
#pragma once

#include "qm_rps/judge/ratiobands.h"
#include "qm_ui/frame/framepainter.h"
#include "qm_ui/report/picturefile.h"

/// The picture refers to scene and bands.
T_FRAME_PICTURE JudgementPicture(const T_FRAME_SCENE& scene, const T_RATIO_BANDS& bands,
                                 const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state);
/// The same as a drawing, seen as a window shows it first.
T_DRAWING JudgementDrawing(CDBDoc& doc, const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state);
