// The person of the tests of the iterative analysis.
#pragma once

#include "qm_rps/factors/ulfiteration.h"

#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <thread>
#include <vector>

/// Wants iterations as often as said and answers the question about the report.
class CPerson : public IUlfIterationPerson {
public:
    int m_accept = 99;      // questions to which iteration is the answer
    int m_questions = 0;    // that were asked
    bool m_unasked = false; // the answer is meant for the rest of the run
    bool m_overwrite = false;
    std::vector<std::string> m_reports;                   // that were asked about
    std::function<bool(int done, int required)> m_goesOn; // empty: yes

    void Solved(const T_ULF_ITER_STEP&, const std::optional<T_FINDING>&) override {}
    ULF_ITER_WISH Wish(const T_ULF_ITER_STEP&) override
    {
        ++m_questions;
        if (m_accept-- <= 0) return ULF_ITER_WISH::Stop;
        return m_unasked ? ULF_ITER_WISH::IterateUnasked : ULF_ITER_WISH::Iterate;
    }
    bool MayOverwrite(const std::string& report) override
    {
        m_reports.push_back(report);
        return m_overwrite;
    }
    bool MayReplace(const std::string& copy) override
    {
        m_reports.push_back(copy);
        return m_overwrite;
    }
    bool GoesOn(int done, int required) override
    {
        EXPECT_EQ(m_thread, std::this_thread::get_id());
        return !m_goesOn || m_goesOn(done, required);
    }

private:
    std::thread::id m_thread = std::this_thread::get_id();
};
