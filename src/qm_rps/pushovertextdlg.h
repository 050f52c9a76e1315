// Model of the preview of a text that can be saved: report, curve table.
#pragma once

#include "qm_base/mdialog.h"

#include <functional>

class CPushOverTextDlg : public zql::frx::MDialog {
public:
    std::string m_title, m_text;
    std::string m_intro;     // stands before the text; empty: there is none
    bool m_withIntro = true; // false: the text alone, byte for byte as other programs read it
    /// Asks for the name of a file; empty: cancelled.
    std::function<std::string()> m_askPath;

    /// The text as it is shown and written.
    std::string Text() const { return (m_withIntro ? m_intro : std::string()) + m_text; }

    /// Asks for a name and writes the text; ".txt" is appended to a name without it. 1 written (its
    /// path is SavedPath); 0 cancelled, or with a message: the file can't be created, nothing
    /// written.
    int OnSave();
    const std::string& SavedPath() const { return m_saved; }

private:
    std::string m_saved;
};
