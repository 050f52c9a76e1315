// Prints a model with its results as a case file.
#pragma once

#include "qm_db/casefile/jsonwriter.h"
#include "qm_db/modelstore.h"

/// The whole document. A fault (a value that is not finite, a load case without results that has no
/// control, a result that can't be read) is kept by the writer.
void WriteCase(CJsonWriter& out, const T_MODEL_CONTENT& content);

/// Its parts; each writes one member of the document, or nothing when its table is empty.
void WriteStructTables(CJsonWriter& out, const T_MODEL& model);
void WriteHingeTables(CJsonWriter& out, const T_MODEL& model);
void WriteSpectra(CJsonWriter& out, const T_MODEL& model);
void WritePushovers(CJsonWriter& out, const T_MODEL_CONTENT& content);
void WriteEvaluations(CJsonWriter& out, const T_MODEL& model);
