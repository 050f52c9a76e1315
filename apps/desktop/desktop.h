// What the tools of the desktop share: the document, its window and the views of dialogs.
#pragma once

#include "qm_rps/desk/selection.h"
#include "qm_rps/mainframe.h"
#include "qm_ui/form/dialogview.h"

#include <string>

class QWidget;

struct T_DESKTOP {
    CDBDoc& doc;
    CMainFrame& frame;
    const CViewFactory& factory;
    CDialogView& view;             // over the main window
    QWidget* window;               // the main window
    CSelection& selection;         // of every pane
    std::function<void()> changed; // to be called after a tool may have changed the document
};

/// Asks for the name of a file. save: of one to write, else of one to read. filters as Qt wants
/// them. Empty: cancelled. Tests answer by AnswerFileNames.
QString AskFileName(QWidget* parent, bool save, const QString& title, const QString& filters);
/// The next answer of AskFileName, given without a window; "": as the person.
void AnswerFileName(const QString& path);

/// Runs a long operation with a window that shows progress and can cancel it. `work` gets what to
/// call with done and total parts; false from it asks to stop. Returns what the work does.
int RunWithProgress(QWidget* parent, const QString& title,
                    const std::function<int(std::function<bool(std::size_t, std::size_t)>)>& work);
