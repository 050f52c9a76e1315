// Rules of records: what a window, a case file and an evaluation refuse.
#pragma once

#include "qm_db/records/evaluationrules.h"
#include "qm_db/records/loadcaserules.h"
