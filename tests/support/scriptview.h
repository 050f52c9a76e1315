// A person without a screen: answers dialogs by script and keeps what was shown.
#pragma once

#include "qm_rps/modelessdlgctrl.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

class CScriptView : public zql::frx::IDialogView {
public:
    std::function<int(zql::frx::MDialog&)> m_run; // what is done in a modal dialog; empty: cancel
    std::vector<std::string> m_messages;          // keys
    int m_shown = 0;                              // modal dialogs

    void ShowMessage(const std::string& key, const std::string&) override
    {
        m_messages.push_back(key);
    }
    bool AskYesNo(const std::string&, const std::string&) override { return false; }
    int RunModal(zql::frx::MDialog& child) override
    {
        ++m_shown;
        return m_run ? m_run(child) : 0;
    }
};

/// A document of an example, with a view.
class FrameTest : public testing::Test {
protected:
    void Open(const char* example)
    {
        T_FILE_ERROR error;
        const std::string path = std::string(QM_PROJECT "/examples/") + example + "/case.json";
        ASSERT_EQ(1, m_doc.ImportCase(path, error)) << error.text;
        CModelessDlgCtrl::Of(m_doc).SetView(&m_view);
    }
    const T_MODEL& Model() const { return m_doc.Data().Model(); }

    CScriptView m_view;
    CDBDoc m_doc;
};
