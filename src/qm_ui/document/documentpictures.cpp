#include "qm_ui/document/documentpictures.h"

#include "qm_ui/frame/framepainter.h"
#include "qm_ui/hinge/hingeplot.h"
#include "qm_ui/plot/plotdrawing.h"
#include "qm_ui/push/judgedrawing.h"
#include "qm_ui/push/pushcurveplot.h"
#include "qm_ui/pushover/evaluationplot.h"
#include "qm_ui/section/sectionbarsplot.h"

#include <memory>

namespace {

/// A drawing that keeps its plot.
T_DRAWING Kept(T_PLOT plot)
{
    const auto kept = std::make_shared<const T_PLOT>(std::move(plot));
    T_DRAWING drawing = DrawingOf(*kept);
    drawing.draw = [kept, draw = drawing.draw](QPainter& painter, const QRectF& rect) {
        draw(painter, rect);
    };
    return drawing;
}

struct T_DRAWN {
    CDBDoc& doc;
    const T_DOC_PICTURE& picture;

    T_DRAWING operator()(const T_FRAME_VIEW& view) const
    {
        const auto scene = std::make_shared<CFrameScene>(doc);
        T_FRAME_OPTIONS options;
        options.nodeNumbers = options.elementNumbers = view.numbers;
        T_DRAWING drawing;
        drawing.title = picture.caption;
        drawing.draw = [scene, options](QPainter& painter, const QRectF& rect) {
            T_FRAME_PICTURE frame;
            frame.scene = &scene->Scene();
            const T_CAMERA& camera = CameraFor(CFrameScene::FlatAxis(scene->Scene()));
            CFramePainter().Draw(painter, rect, frame, camera, options);
        };
        return drawing;
    }
    T_DRAWING operator()(const T_SECTION_VIEW& view) const
    {
        return Kept(SectionBarsPlot(view.section, view.units));
    }
    T_DRAWING operator()(const T_BACKBONE_VIEW& view) const
    {
        const auto& component = view.type->components[static_cast<std::size_t>(view.component)];
        const std::string page = component.sameEnds ? "" : view.atJ ? "J" : "I";
        return Kept(HingeBackbonePlot(*view.type, view.component,
                                      view.atJ ? component.curves.J : component.curves.I, page));
    }
    T_DRAWING operator()(const T_PUSH_VIEW& view) const
    {
        return Kept(PushCurvePlot(*view.runs, view.units, view.title));
    }
    T_DRAWING operator()(const T_EVALUATION_VIEW& view) const
    {
        return Kept(EvaluationPlot(*view.result));
    }
    T_DRAWING operator()(const T_JUDGEMENT_VIEW& view) const
    {
        const auto judgement = view.judgement;
        T_DRAWING drawing = JudgementDrawing(doc, *judgement, judgement->states.at(view.state));
        drawing.draw = [judgement, draw = drawing.draw](QPainter& painter, const QRectF& rect) {
            draw(painter, rect);
        };
        return drawing;
    }
};

} // namespace

T_DRAWING DrawingOf(CDBDoc& doc, const T_DOC_PICTURE& picture)
{
    return std::visit(T_DRAWN{doc, picture}, picture.view);
}
