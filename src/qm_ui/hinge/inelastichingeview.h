// View of the window of inelastic hinge properties.
#pragma once

#include "qm_ui/form/viewfactory.h"

void RegisterInelasticHingeView(CViewFactory& factory);
