#include "qm_ui/push/stepdrawings.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_ui/form/localnumber.h"
#include "qm_ui/plot/plot.h"
#include "qm_ui/push/storeyplot.h"

#include <memory>

T_FRAME_PICTURE StatePicture(CPushOverHingeStateDlg& shown, double scale)
{
    T_FRAME_PICTURE picture;
    picture.scene = &shown.Scene();
    picture.subtitle = shown.TitleText();
    if (shown.Step() < 1) return picture;
    picture.subtitle += ", " + shown.StepName();
    picture.note = Say("IDS_QM_UI_SHAPE_NOTE", LocalNumberText(ShortestText(scale)).toStdString(),
                       picture.scene->lengthUnit);
    picture.displacement = &shown.Moves();
    picture.scale = scale;
    if (!shown.Marks().hinges.empty()) picture.marks = &shown.Marks();
    return picture;
}

T_DRAWING StateDrawing(CPushOverHingeStateDlg& shown)
{
    // A file has one step: it is shown large, and no hinge is looked at.
    const auto marks = std::make_shared<T_HINGE_MARKS>(shown.Marks());
    for (T_HINGE_MARK& mark : marks->hinges)
        mark.chosen = false;
    T_FRAME_PICTURE picture =
        StatePicture(shown, CFrameScene::RoundScale(shown.Scene(), shown.Moves()));
    if (picture.marks) picture.marks = marks.get();
    const T_CAMERA camera = CameraFor(CFrameScene::FlatAxis(*picture.scene));
    const auto draw = [picture, camera, marks](QPainter& painter, const QRectF& rect) {
        CFramePainter().Draw(painter, rect, picture, camera, {});
    };
    return {draw, {960, 720}, picture.scene->title, picture.subtitle};
}

T_DRAWING StoreyDrawing(const CPushOverStoreyDlg& shown)
{
    const auto plots = std::make_shared<std::vector<T_PLOT>>();
    for (const auto value : {STOREY_VALUE::Displacement, STOREY_VALUE::Drift, STOREY_VALUE::Shear})
        plots->push_back(StoreyPlot(shown, value));
    const auto draw = [plots](QPainter& painter, const QRectF& rect) {
        const double width = rect.width() / static_cast<double>(plots->size());
        QRectF part(rect.left(), rect.top(), width, rect.height());
        for (const T_PLOT& plot : *plots) {
            CPlot::Draw(painter, part, plot, {});
            part.translate(width, 0.0);
        }
    };
    return {draw, {1260, 480}, shown.TitleText(), shown.StepName()};
}
