// The window of the report.
#pragma once

#include "qm_ui/form/viewfactory.h"

void RegisterReportView(CViewFactory& factory);
