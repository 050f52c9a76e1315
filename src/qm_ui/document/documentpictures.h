// The pictures of a document, drawn.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/document/docpicture.h"
#include "qm_ui/report/picturefile.h"

/// The drawing refers to nothing but the document of the model, which must outlive it.
T_DRAWING DrawingOf(CDBDoc& doc, const T_DOC_PICTURE& picture);
