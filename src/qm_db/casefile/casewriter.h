// Prints a model with its results as a case file.
#pragma once

#include "qm_db/casefile/jsonwriter.h"
#include "qm_db/modelstore.h"

/// The whole document. A fault (a value that is not finite, a load case without results that has no
/// control, a result that can't be read) is kept by the writer.
void WriteCase(CJsonWriter& out, const T_MODEL_CONTENT& content);

/// "steps" of a load case of that direction (1 to 6).
void WriteSteps(CJsonWriter& out, IPushResult& result, int direction);
