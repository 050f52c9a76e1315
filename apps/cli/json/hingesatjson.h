// Hinges at the points of an evaluation as JSON.
#pragma once

#include "qm_rps/push/pushatpoint.h"
#include "json/jsontext.h"

/// The members "hinges_at" and, where points have no values, "hinges_not_at". Nothing where the
/// push is of another program.
void WriteHingesAt(CJsonText& writer, const T_HINGES_AT& hinges);
