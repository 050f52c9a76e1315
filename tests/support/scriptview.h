// A person without a screen: answers dialogs by script and keeps what was shown.
#pragma once

#include "qm_base/mdialog.h"

#include <functional>
#include <string>
#include <vector>

class CScriptView : public zql::frx::IDialogView {
public:
    std::function<int(zql::frx::MDialog&)> m_run; // what is done in a modal dialog; empty: cancel
    bool m_yes = false;                           // the answer to every question
    std::vector<std::string> m_messages;          // keys
    int m_shown = 0;                              // modal dialogs

    void ShowMessage(const std::string& key, const std::string&) override
    {
        m_messages.push_back(key);
    }
    bool AskYesNo(const std::string&, const std::string&) override { return m_yes; }
    int RunModal(zql::frx::MDialog& child) override
    {
        ++m_shown;
        return m_run ? m_run(child) : 0;
    }
};
