// The person of the tests of the iterative analysis.
#pragma once

#include "qm_rps/ulfiterationresultdlg.h"

#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <thread>
#include <vector>

/// Accepts result dialogs as often as wanted and answers the question about the report.
class CPerson : public zql::frx::IDialogView {
public:
    int m_accept = 99; // dialogs in which iteration is chosen
    int m_dialogs = 0; // that were shown
    bool m_dontAsk = false;
    bool m_overwrite = false;
    std::vector<std::string> m_asked;
    int m_events = 0;
    void ShowMessage(const std::string& key, const std::string&) override
    {
        m_asked.push_back(key);
    }
    bool AskYesNo(const std::string&, const std::string& text) override
    {
        m_asked.push_back(text);
        return m_overwrite;
    }
    int RunModal(zql::frx::MDialog& child) override
    {
        auto* dialog = dynamic_cast<CUlfIterationResultDlg*>(&child);
        if (!dialog) return 0;
        dialog->m_iterate = m_accept-- > 0;
        dialog->m_dontAsk = m_dontAsk;
        ++m_dialogs;
        return 1;
    }
    void DispatchEvents() override
    {
        ++m_events;
        EXPECT_EQ(m_thread, std::this_thread::get_id());
        if (m_onEvents) m_onEvents();
    }
    std::function<void()> m_onEvents;
    std::thread::id m_thread = std::this_thread::get_id();
};
