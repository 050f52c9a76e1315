// Model of the preview of a text that can be saved: report, curve table.
#pragma once

#include "qm_base/mdialog.h"

#include <functional>

class CPushOverTextDlg : public zql::frx::MDialog {
public:
    std::string m_title, m_text;
    /// Asks for the name of a file; empty: cancelled.
    std::function<std::string()> m_askPath;

    /// Asks for a name and writes the text; ".txt" is appended to a name without it. 1 written (its
    /// path is SavedPath); 0 cancelled, or with a message: the file can't be created, nothing
    /// written.
    int OnSave();
    const std::string& SavedPath() const { return m_saved; }

private:
    std::string m_saved;
};
