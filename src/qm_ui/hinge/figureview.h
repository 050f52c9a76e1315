// Views of the explanatory figures of FEMA hinges and of the table of axial forces.
#pragma once

#include "qm_rps/hinge/femafigure.h"
#include "qm_ui/form/viewfactory.h"

/// The figure as a plot.
T_PLOT FigurePlot(const CFemaFigureDlg& figure);

/// The three figures and the table of axial forces.
void RegisterFigureViews(CViewFactory& factory);
