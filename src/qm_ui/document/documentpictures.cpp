#include "qm_ui/document/documentpictures.h"

#include "qm_base/textformat.h"
#include "qm_ui/factors/ulfplot.h"
#include "qm_ui/frame/framepainter.h"
#include "qm_ui/hinge/hingeplot.h"
#include "qm_ui/plot/plotdrawing.h"
#include "qm_ui/push/judgedrawing.h"
#include "qm_ui/push/pushcurveplot.h"
#include "qm_ui/pushover/comparisonplot.h"
#include "qm_ui/pushover/evaluationplot.h"
#include "qm_ui/section/sectionbarsplot.h"

#include <algorithm>
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

/// One line of a thick pen for each bar; its value stands at its end.
T_PLOT BarsPlot(const T_BARS_VIEW& view)
{
    constexpr double kThick = 12.0; // px
    constexpr T_PLOT_COLOR kColor{31, 78, 140};
    T_PLOT plot;
    plot.title = view.title;
    plot.x.title = view.axis;
    const auto count = static_cast<double>(view.bars.size());
    double largest = 0.0;
    for (std::size_t i = 0; i < view.bars.size(); ++i) {
        const auto& [name, value] = view.bars[i];
        const double y = count - static_cast<double>(i);
        T_PLOT_SERIES& bar = plot.series.emplace_back();
        bar.x = {0.0, value};
        bar.y = {y, y};
        bar.line = PLOT_LINE::Solid;
        bar.width = kThick;
        bar.color = kColor;
        bar.marker = PLOT_MARKER::None;
        plot.y.labels.push_back({y, name, FormatText("%.4g", value)});
        largest = std::max(largest, value);
    }
    plot.y.range = T_PLOT_RANGE{0.4, count + 0.6};
    if (largest > 0.0) plot.x.range = T_PLOT_RANGE{0.0, 1.05 * largest};
    return plot;
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
    T_DRAWING operator()(const T_COMPARISON_VIEW& view) const
    {
        T_PLOT plot = ComparisonPlot(*view.comparison);
        plot.title = picture.caption; // these are not all methods that there are
        return Kept(std::move(plot));
    }
    T_DRAWING operator()(const T_BARS_VIEW& view) const
    {
        T_DRAWING drawing = Kept(BarsPlot(view));
        constexpr double kRow = 26.0, kRest = 110.0; // px: a bar; title and axis
        drawing.size.setHeight(kRest + kRow * static_cast<double>(view.bars.size()));
        return drawing;
    }
    T_DRAWING operator()(const T_FACTORS_VIEW& view) const
    {
        T_ULF_PICTURE bars = UlfPictureOf({doc, *view.result});
        bars.notes.clear(); // the factors stand in a table of their own
        return Kept(UlfPlot(bars));
    }
};

} // namespace

T_DRAWING DrawingOf(CDBDoc& doc, const T_DOC_PICTURE& picture)
{
    T_DRAWING drawing = std::visit(T_DRAWN{doc, picture}, picture.view);
    // A narrow picture is drawn smaller, not shrunk: its texts are as large as those of a wide one.
    drawing.size *= picture.width;
    return drawing;
}
