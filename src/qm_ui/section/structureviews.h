// Windows of sections and materials.
#pragma once

#include "qm_ui/form/viewfactory.h"

void RegisterStructureForms(CViewFactory& factory);
void RegisterMaterialForm(CViewFactory& factory); // of these, the one of materials
