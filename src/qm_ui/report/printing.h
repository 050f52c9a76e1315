// Prints a drawing.
#pragma once

#include "qm_ui/report/picturefile.h"

class QPrinter;
class QWidget;

/// Draws it as large as the page allows, in its own proportions. 1 done; 0 the printer refused.
[[nodiscard]] int PaintOn(QPrinter& printer, const T_DRAWING& drawing);

/// Asks for a printer and prints. 0 cancelled, or the printer refused.
[[nodiscard]] int PrintDrawing(QWidget* parent, const T_DRAWING& drawing);
