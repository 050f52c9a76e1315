// Windows of sections and materials.
#pragma once

#include "qm_ui/form/viewfactory.h"

void RegisterStructureForms(CViewFactory& factory);
