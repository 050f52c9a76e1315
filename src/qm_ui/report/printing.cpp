#include "qm_ui/report/printing.h"

#include <QPainter>
#include <QPrintDialog>
#include <QPrinter>

#include <algorithm>

int PaintOn(QPrinter& printer, const T_DRAWING& drawing)
{
    const bool wide = drawing.size.width() > drawing.size.height();
    printer.setPageOrientation(wide ? QPageLayout::Landscape : QPageLayout::Portrait);
    QPainter painter;
    if (!painter.begin(&printer)) return 0;
    const QRectF page = printer.pageLayout().paintRectPixels(printer.resolution());
    const double scale =
        std::min(page.width() / drawing.size.width(), page.height() / drawing.size.height());
    painter.scale(scale, scale);
    drawing.draw(painter, QRectF({0, 0}, drawing.size));
    return painter.end() ? 1 : 0;
}

int PrintDrawing(QWidget* parent, const T_DRAWING& drawing)
{
    QPrinter printer(QPrinter::HighResolution);
    QPrintDialog dialog(&printer, parent);
    return dialog.exec() == QDialog::Accepted ? PaintOn(printer, drawing) : 0;
}
