// What a pushover curve window has on show: the latest result, the picture it stands beside, and
// why either is not of the settings.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"

class CShownEvaluation {
public:
    /// A new result. Without a curve to draw the picture stays the one before.
    void Take(const T_PUSH_EVALUATION& result);
    /// Nothing is on show.
    void Clear()
    {
        m_result = m_pictured = {};
        ++m_turn;
    }
    /// The settings are refused for this reason; result and picture stay.
    void Refuse(const std::string& reason)
    {
        m_refused = reason;
        ++m_turn;
    }
    /// Another number when something else is on show.
    long Turn() const { return m_turn; }

    /// Latest result; its values and messages.
    const T_PUSH_EVALUATION& Result() const { return m_result; }
    /// The result that the picture is of: the latest one with a curve.
    const T_PUSH_EVALUATION& Pictured() const { return m_pictured; }
    /// Why picture or values are not of the settings; empty: they are.
    std::string Refusal() const;
    /// Why the settings are refused; empty: they are not.
    const std::string& Refused() const { return m_refused; }

    /// The trial pointed out in the picture, from 1; 0: none.
    int Trial() const { return m_trial; }
    void SetTrial(int trial); // limited to those that there are
    int TrialCount() const { return static_cast<int>(m_pictured.trace.size()); }

    /// Title and pattern of the load case: control node, direction, master load pattern.
    std::string CaseText() const;

private:
    T_PUSH_EVALUATION m_result, m_pictured;
    std::string m_refused;   // the settings
    std::string m_noPicture; // of the result
    int m_trial = 0;
    long m_turn = 0;
};
