// Connects the lists and editors of hinges with a document. Records come and go in its current
// units; each edit is one undoable step.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/po_hingetypelistdlg.h"
#include "qm_rps/pushoverhingedatatype.h"
#include "qm_rps/pushoverhingelistdlg.h"

/// Hinge types for their list. The document must outlive it.
T_HINGE_LIST_ACCESS HingeTypesOf(CDBDoc& doc);
/// The document behind the list of generated hinges, and behind the older table editor.
void ConnectHinges(CDBDoc& doc, CPushOverHingeListDlg& list);
void ConnectHinges(CDBDoc& doc, CPushOverHingeDataType& table);
