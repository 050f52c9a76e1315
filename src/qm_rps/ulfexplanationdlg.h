// Model of the window that explains load factors, or why there are none.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/factors/ulfexplain.h"

class CUlfExplanationDlg : public zql::frx::MDialog {
public:
    /// item: its name; message: of the calculation; may be empty. Told before the explanation of a
    /// solution; without a solution the explanation has it.
    CUlfExplanationDlg(std::string item, std::string message, T_ULF_EXPLAINED explained)
        : m_item(std::move(item)), m_message(std::move(message)), m_explained(std::move(explained))
    {
    }

    const std::string& Item() const { return m_item; }
    /// All of it in words, a paragraph for each statement.
    std::string Text() const
    {
        std::string text = m_explained.solved ? m_message : std::string();
        for (const std::string& line : m_explained.lines)
            text += (text.empty() ? "" : "\n\n") + line;
        return text;
    }

private:
    std::string m_item, m_message;
    T_ULF_EXPLAINED m_explained;
};
