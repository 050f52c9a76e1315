// The entries of this library: how the host opens its dialogs and finds its service.
#pragma once

#include "qm_rps/rpsdlgbase.h"

/// Ids of modeless dialogs.
inline constexpr int IDD_PO_LOADCASE_ITEM = 5675; // CPO_LoadCaseDlg
inline constexpr int IDD_PO_LOADCASE_LIST = 5676; // CPO_LoadCaseListDlg

/// The modeless dialog of that id on the document, made where it is not open, and shown.
/// parameter, with the item dialog alone: key of the load case to show (0: a new one), taken with
/// each call. Null: no document, another id, or its window can't be made; then nothing is shown.
/// The document's CModelessDlgCtrl owns it and makes its window.
CRPSDlgBase* CreateOrActivateRPSDlg(CDBDoc* doc, int id, zql::frx::IDialogView* parent,
                                    const int* parameter);

/// Kinds of RPS_DoModal: the selection of a pushover load case.
inline constexpr int kSelectLoadCase = 1;

/// kind 1: the selection of a pushover load case of the current document, modal, in the view that
/// is installed for it. data: null, or the key that is chosen at first; on OK it gets the chosen
/// one. Every other kind does nothing.
void RPS_DoModal(int kind, int* data);

/// Registers the service "rps" at the head office, once. A linker may leave out objects of a static
/// library that nothing names, so the host calls this. 1 it is registered now; 0 another agency has
/// the name.
[[nodiscard]] int RegisterRPSService();
