// For who feeds the analysis engine himself: the model as its arrays, and storeys as drifts are
// taken from them.
#pragma once

#include "qm_db/analysis/analysismodel.h"
#include "qm_db/results/storeylevels.h"
