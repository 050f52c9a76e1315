// What is written once about records: what a window, a case file and an evaluation refuse, and the
// names of the codes in them.
#pragma once

#include "qm_db/records/evaluationrules.h"
#include "qm_db/records/hingenames.h"
#include "qm_db/records/loadcaserules.h"
#include "qm_db/records/modelfault.h"
#include "qm_db/records/pushcontrol.h"
#include "qm_db/records/pushnames.h"
#include "qm_db/records/storeyrules.h"
#include "qm_db/records/structnames.h"
