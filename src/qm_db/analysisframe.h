// For who feeds the analysis engine himself: the model as its arrays, storeys as drifts are taken
// from them, and what keeps the steps of a push.
#pragma once

#include "qm_db/analysis/analysismodel.h"
#include "qm_db/results/pushrecorder.h"
#include "qm_db/results/storeylevels.h"
