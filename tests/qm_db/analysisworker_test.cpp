// Analyses in a thread of their own: who is told what and where, and how they end.
#include "casetext.h"

#include "qm_db/dbdoc.h"

#include <gtest/gtest.h>
#include <stdexcept>

namespace {

T_MODEL_CONTENT Staged()
{
    return ParseGood(CaseText("stage_all_members.json"));
}

using PARTS = std::vector<std::size_t>;

/// A document with construction stages, which alone are analysed.
class AnalysisWorker : public testing::Test {
protected:
    AnalysisWorker()
    {
        m_doc.Data().Assign(Staged());
        m_options.allCases = false;
    }
    void Start() { ASSERT_EQ(1, m_doc.StartAnalysis(m_options, m_error)) << m_error.text; }
    void Wait()
    {
        for (int i = 0; i < 1000 && m_doc.PollAnalysis(100); ++i) {
        }
        ASSERT_FALSE(m_doc.IsExcuted());
    }
    void ExpectCancelled()
    {
        EXPECT_EQ(0, m_doc.AnalysisOutcome(m_error));
        EXPECT_EQ(ANALYSIS_FAULT::Cancelled, m_error.fault) << m_error.text;
        EXPECT_EQ(nullptr, m_doc.Data().StagedResult());
    }

    T_ANALYSIS_OPTIONS m_options;
    T_ANALYSIS_ERROR m_error;
    CDBDoc m_doc;
};

} // namespace

TEST_F(AnalysisWorker, TellsEveryPartInOrderInTheThreadThatAsks)
{
    const auto here = std::this_thread::get_id();
    PARTS parts;
    m_options.progress = [&](std::size_t done, std::size_t total) {
        EXPECT_EQ(here, std::this_thread::get_id());
        EXPECT_EQ(6U, total);
        EXPECT_TRUE(m_doc.PollAnalysis()); // not again within
        parts.push_back(done);
        return true;
    };
    Start();
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    EXPECT_TRUE(m_doc.IsExcuted()); // done or not, until somebody looks
    EXPECT_EQ(PARTS{}, parts);
    EXPECT_FALSE(m_doc.IsPostMode());
    Wait();
    EXPECT_EQ((PARTS{1, 2, 3, 4, 5, 6}), parts);
    EXPECT_EQ(1, m_doc.AnalysisOutcome(m_error)) << m_error.text;
    EXPECT_TRUE(m_doc.IsPostMode());
    parts.clear();
    ASSERT_EQ(1, m_doc.RunAnalysis(m_options, m_error)) << m_error.text;
    EXPECT_EQ((PARTS{1, 2, 3, 4, 5, 6}), parts);
}

TEST_F(AnalysisWorker, RefusesASecondRunAndEditsMeanwhile)
{
    ASSERT_EQ(1, m_doc.Edit().Begin("first"));
    ASSERT_EQ(1, m_doc.Edit().AddPtns(3, {3, 12.0}));
    ASSERT_EQ(1, m_doc.Edit().Commit());
    ASSERT_EQ(1, m_doc.Edit().Begin("open"));
    const T_MODEL before = m_doc.Data().Model();
    Start();
    EXPECT_EQ(0, m_doc.StartAnalysis(m_options, m_error));
    EXPECT_EQ(ANALYSIS_FAULT::Failed, m_error.fault);
    EXPECT_EQ("an analysis of this model is running already", m_error.text);
    EXPECT_EQ(0, m_doc.RunAnalysis(m_options, m_error));
    EXPECT_EQ(0, m_doc.Edit().AddPtns(3, {3, 13.0}) + m_doc.Edit().Erase<T_ULSI_D>(1));
    EXPECT_EQ(1, m_doc.Edit().Commit());
    EXPECT_EQ(0, m_doc.Edit().Begin("second") + m_doc.Undo().Undo());
    EXPECT_EQ(before, m_doc.Data().Model());
    Wait();
    ASSERT_EQ(1, m_doc.AnalysisOutcome(m_error)) << m_error.text;
    EXPECT_TRUE(m_doc.IsPostMode());
    EXPECT_EQ(1, m_doc.Undo().Undo());
    EXPECT_EQ(1, m_doc.Edit().Begin("third"));
}

TEST_F(AnalysisWorker, ACancelledRunLeavesNothingEvenIfTheEngineWasFaster)
{
    m_options.allCases = true;
    m_options.modes = 1;
    for (const int sleepMs : {0, 100}) {
        Start();
        std::this_thread::sleep_for(std::chrono::milliseconds(sleepMs));
        m_doc.CancelAnalysis();
        Wait();
        ExpectCancelled();
        EXPECT_TRUE(m_doc.Data().Content().staticResults.empty());
        EXPECT_FALSE(m_doc.Data().IsModified());
    }
    m_doc.CancelAnalysis(); // of none
    m_options.progress = [](std::size_t done, std::size_t) { return done < 3; };
    EXPECT_EQ(0, m_doc.RunAnalysis(m_options, m_error));
    ExpectCancelled();
    m_options = {false, {}, 0, {}};
    EXPECT_EQ(1, m_doc.RunAnalysis(m_options, m_error)) << m_error.text;
}

TEST_F(AnalysisWorker, AModelThatChangedAllTheSameGetsNoResults)
{
    Start();
    m_doc.Data().ModelForEdit().loadCases.at(3).pretension.at(0).force = 1.0;
    Wait();
    EXPECT_EQ(0, m_doc.AnalysisOutcome(m_error));
    EXPECT_EQ("the model was changed during the analysis", m_error.text);
    EXPECT_EQ(nullptr, m_doc.Data().StagedResult());
}

TEST_F(AnalysisWorker, EndsWithItsDocumentAndWithItsModel)
{
    const auto token = std::make_shared<int>(0);
    T_ANALYSIS_OPTIONS options = m_options;
    options.progress = [token](std::size_t, std::size_t) { return ++*token > 0; };
    const long own = token.use_count();
    {
        CDBDoc doc;
        doc.Data().Assign(Staged());
        ASSERT_EQ(1, doc.StartAnalysis(options, m_error)) << m_error.text;
        EXPECT_GT(token.use_count(), own);
    }
    EXPECT_EQ(own, token.use_count());
    EXPECT_EQ(0, *token);

    T_FILE_ERROR fault;
    Start();
    ASSERT_EQ(1, m_doc.ImportCase(QM_TEST_DATA "/cases/stage_all_members.json", fault));
    EXPECT_FALSE(m_doc.IsExcuted());
    ExpectCancelled();

    // Also from within its own progress.
    m_options.progress = [&](std::size_t, std::size_t) {
        EXPECT_EQ(1, m_doc.ImportCase(QM_TEST_DATA "/cases/stage_all_members.json", fault));
        return true;
    };
    EXPECT_EQ(0, m_doc.RunAnalysis(m_options, m_error));
    EXPECT_EQ(ANALYSIS_FAULT::Cancelled, m_error.fault);
    EXPECT_EQ(1, m_doc.Edit().Begin("free"));
}

TEST_F(AnalysisWorker, WhatTheProgressThrowsEndsTheRun)
{
    m_options.progress = [](std::size_t, std::size_t) -> bool { throw std::runtime_error("stop"); };
    EXPECT_THROW((void)m_doc.RunAnalysis(m_options, m_error), std::runtime_error);
    EXPECT_FALSE(m_doc.IsExcuted());
    EXPECT_EQ(1, m_doc.Edit().Begin("free"));
    m_options.progress = {};
    EXPECT_EQ(1, m_doc.RunAnalysis(m_options, m_error)) << m_error.text;
}

TEST(AnalysisJob, CancelsAndJoinsAJobThatWouldNeverEnd)
{
    std::atomic<bool> ended = false;
    const auto here = std::this_thread::get_id();
    {
        CAnalysisWorker worker([&](const auto& progress, auto&, auto&) {
            EXPECT_NE(here, std::this_thread::get_id());
            while (progress(1, 2))
                std::this_thread::sleep_for(std::chrono::milliseconds(1));
            std::this_thread::sleep_for(std::chrono::milliseconds(20));
            ended = true;
            return 0;
        });
        std::vector<CAnalysisWorker::T_PART> parts;
        EXPECT_FALSE(worker.TakeParts(10000, parts));
        EXPECT_FALSE(parts.empty());
    }
    EXPECT_TRUE(ended);
}

TEST(AnalysisJob, WhatTheJobThrowsBecomesAnError)
{
    struct T_ROW {
        CAnalysisWorker::JobFn job;
        ANALYSIS_FAULT fault;
        const char* text;
    };
    const T_ROW rows[] = {
        {[](const auto&, auto&, auto&) -> int { throw std::bad_alloc(); }, ANALYSIS_FAULT::NoMemory,
         "the analysis failed: not enough memory"},
        {[](const auto&, auto&, auto&) -> int { throw 3; }, ANALYSIS_FAULT::Failed,
         "the analysis failed: unknown reason"},
    };
    for (const T_ROW& row : rows) {
        CAnalysisWorker worker(row.job);
        T_ANALYSIS_RESULTS results;
        T_ANALYSIS_ERROR error;
        EXPECT_EQ(0, worker.Finish(results, error));
        EXPECT_EQ(row.fault, error.fault);
        EXPECT_EQ(row.text, error.text);
    }
}
