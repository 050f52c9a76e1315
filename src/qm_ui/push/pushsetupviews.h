// Views of what sets a push up: global control, increment functions, load cases made at once; and
// the table of initial loads, which a load case has too.
#pragma once

#include "qm_rps/rpsdlgbase.h"
#include "qm_ui/form/viewfactory.h"

void RegisterPushSetupForms(CViewFactory& factory);

/// A table of initial loads of a dialog, with an empty row to add one. The list is asked for each
/// time; null: there is none, and no row.
T_GRID_BINDING
InitialLoadGrid(const CRPSDlgBase& dialog,
                std::function<std::vector<T_PUSH_INITIAL_LOAD>*()> loads);

/// Words of the choices, in the order of the enumerations.
std::vector<std::string> PDeltaTexts();
std::vector<std::string> FailureTexts();
