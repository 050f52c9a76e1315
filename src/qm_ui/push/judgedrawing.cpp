#include "qm_ui/push/judgedrawing.h"

#include "qm_base/say.h"
#include "qm_rps/judge/judgementtable.h"

#include <memory>

T_FRAME_PICTURE JudgementPicture(const T_FRAME_SCENE& scene, const T_RATIO_BANDS& bands,
                                 const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state)
{
    T_FRAME_PICTURE picture;
    picture.scene = &scene;
    picture.bands = &bands;
    picture.subtitle =
        Say("IDS_QM_JUDGE_PICTURE", judgement.evaluation, StateAtText(judgement, state));
    picture.note = Say("IDS_QM_JUDGE_DOTS");
    return picture;
}

T_DRAWING JudgementDrawing(CDBDoc& doc, const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state)
{
    const auto scene = std::make_shared<T_FRAME_SCENE>(CFrameScene(doc).Scene());
    const auto bands = std::make_shared<T_RATIO_BANDS>(RatioBands(judgement, state, *scene));
    const T_FRAME_PICTURE picture = JudgementPicture(*scene, *bands, judgement, state);
    const T_CAMERA camera = CameraFor(CFrameScene::FlatAxis(*scene));
    const auto draw = [picture, camera, scene, bands](QPainter& painter, const QRectF& rect) {
        CFramePainter().Draw(painter, rect, picture, camera, {.hinges = false});
    };
    return {draw, {960, 720}, scene->title, picture.subtitle};
}
