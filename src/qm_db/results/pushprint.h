// Fingerprints of what a push was computed from: when one differs, its results are older than the
// model. The names of records and the units of the document do not count.
#pragma once

#include "qm_db/results/pushrun.h"

/// Of a pushover load case of the model. Structure: as for static results. Hinges: their types,
/// their strengths, which of them act, and what automatic strengths come from. Loads: the static
/// load cases that the case names, masses, modes and storeys. Set-up: everything else that the case
/// and the global control say, and all of the case that it starts from.
T_RUN_PRINT PrintOfPush(const T_MODEL& model, int loadCase);

/// What has changed since, a catalogue key; null: nothing.
const char* ChangeSince(const T_RUN_PRINT& before, const T_RUN_PRINT& now);
