#include "qm_ui/plot/plotfile.h"

#include "qm_ui/plot/plot.h"
#include "qm_ui/plot/plotdrawing.h"

T_DRAWING DrawingOf(const T_PLOT& plot)
{
    constexpr double kWidth = 960.0;      // px at 96 dpi
    constexpr double kMaxHeight = 8000.0; // px; a higher page is cut
    const bool usable = plot.pageHeight >= 1.0 && plot.pageHeight <= kMaxHeight;
    const double height = usable ? static_cast<int>(plot.pageHeight) : kMaxHeight;
    const auto draw = [&plot](QPainter& painter, const QRectF& rect) {
        CPlot::Draw(painter, rect, plot, {});
    };
    return {draw, {kWidth, height}, plot.title, plot.subtitle};
}

int WritePlotFile(const T_PLOT& plot, const std::string& path, std::string& error)
{
    return WritePictureFile(DrawingOf(plot), path, error);
}
