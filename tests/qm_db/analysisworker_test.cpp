// Analyses in a thread of their own: who is told what and where, and how they end.
#include "modelstoresample.h"
#include "qm_db/casefile.h"
#include "qm_db/dbdoc.h"

#include <gtest/gtest.h>
#include <stdexcept>

namespace {

T_MODEL_CONTENT Staged()
{
    T_MODEL_CONTENT c;
    T_FILE_ERROR error;
    EXPECT_EQ(1, CCaseFile::Read(QM_TEST_DATA "/cases/stage_all_members.json", c, error));
    return c;
}

T_ANALYSIS_OPTIONS StagesOnly()
{
    T_ANALYSIS_OPTIONS options;
    options.allCases = false;
    return options;
}

void WaitFor(CDBDoc& doc)
{
    for (int i = 0; i < 1000 && doc.PollAnalysis(100); ++i) {
    }
    ASSERT_FALSE(doc.IsExcuted());
}

using PARTS = std::vector<std::size_t>;

} // namespace

TEST(AnalysisWorker, TellsEveryPartInOrderInTheThreadThatAsks)
{
    CDBDoc doc;
    doc.Data().Assign(Staged());
    const auto here = std::this_thread::get_id();
    PARTS parts;
    T_ANALYSIS_OPTIONS options = StagesOnly();
    options.progress = [&](std::size_t done, std::size_t total) {
        EXPECT_EQ(here, std::this_thread::get_id());
        EXPECT_EQ(6U, total);
        EXPECT_TRUE(doc.PollAnalysis()); // not again within
        parts.push_back(done);
        return true;
    };
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.StartAnalysis(options, error)) << error.text;
    EXPECT_TRUE(doc.IsExcuted());
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    EXPECT_TRUE(doc.IsExcuted()); // done or not, until somebody looks
    EXPECT_EQ(PARTS{}, parts);
    EXPECT_FALSE(doc.IsPostMode());
    WaitFor(doc);
    EXPECT_EQ((PARTS{1, 2, 3, 4, 5, 6}), parts);
    EXPECT_EQ(1, doc.AnalysisOutcome(error)) << error.text;
    EXPECT_TRUE(doc.IsPostMode());
    parts.clear();
    ASSERT_EQ(1, doc.RunAnalysis(options, error)) << error.text;
    EXPECT_EQ((PARTS{1, 2, 3, 4, 5, 6}), parts);
}

TEST(AnalysisWorker, RefusesASecondRunAndEditsMeanwhile)
{
    CDBDoc doc;
    doc.Data().Assign(Staged());
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.Edit().Begin("first"));
    ASSERT_EQ(1, doc.Edit().AddPtns(3, {3, 12.0}));
    ASSERT_EQ(1, doc.Edit().Commit());
    ASSERT_EQ(1, doc.Edit().Begin("open"));
    const T_MODEL before = doc.Data().Model();
    ASSERT_EQ(1, doc.StartAnalysis(StagesOnly(), error)) << error.text;
    EXPECT_EQ(0, doc.StartAnalysis(StagesOnly(), error));
    EXPECT_EQ(ANALYSIS_FAULT::Failed, error.fault);
    EXPECT_EQ("an analysis of this model is running already", error.text);
    EXPECT_EQ(0, doc.RunAnalysis(StagesOnly(), error));
    EXPECT_EQ(0, doc.Edit().AddPtns(3, {3, 13.0}));
    EXPECT_EQ(0, doc.Edit().Erase<T_ULSI_D>(1));
    EXPECT_EQ(1, doc.Edit().Commit());
    EXPECT_EQ(0, doc.Edit().Begin("second"));
    EXPECT_EQ(0, doc.Undo().Undo());
    EXPECT_EQ(before, doc.Data().Model());
    WaitFor(doc);
    ASSERT_EQ(1, doc.AnalysisOutcome(error)) << error.text;
    EXPECT_TRUE(doc.IsPostMode());
    EXPECT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(1, doc.Edit().Begin("third"));
}

TEST(AnalysisWorker, ACancelledRunLeavesNothingEvenIfTheEngineWasFaster)
{
    CDBDoc doc;
    doc.Data().Assign(Staged());
    T_ANALYSIS_OPTIONS options = StagesOnly();
    options.allCases = true;
    options.modes = 1;
    T_ANALYSIS_ERROR error;
    for (const int sleepMs : {0, 100}) {
        ASSERT_EQ(1, doc.StartAnalysis(options, error)) << error.text;
        std::this_thread::sleep_for(std::chrono::milliseconds(sleepMs));
        doc.CancelAnalysis();
        WaitFor(doc);
        EXPECT_EQ(0, doc.AnalysisOutcome(error));
        EXPECT_EQ(ANALYSIS_FAULT::Cancelled, error.fault) << error.text;
        EXPECT_EQ(nullptr, doc.Data().StagedResult());
        EXPECT_TRUE(doc.Data().Content().staticResults.empty());
        EXPECT_FALSE(doc.Data().IsModified());
    }
    doc.CancelAnalysis(); // of none
    EXPECT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
}

TEST(AnalysisWorker, AModelThatChangedAllTheSameGetsNoResults)
{
    CDBDoc doc;
    doc.Data().Assign(Staged());
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.StartAnalysis(StagesOnly(), error)) << error.text;
    doc.Data().ModelForEdit().loadCases.at(3).pretension.at(0).force = 1.0;
    WaitFor(doc);
    EXPECT_EQ(0, doc.AnalysisOutcome(error));
    EXPECT_EQ("the model was changed during the analysis", error.text);
    EXPECT_EQ(nullptr, doc.Data().StagedResult());
}

TEST(AnalysisWorker, EndsWithItsDocumentAndWithItsModel)
{
    const auto token = std::make_shared<int>(0);
    T_ANALYSIS_OPTIONS options = StagesOnly();
    options.progress = [token](std::size_t, std::size_t) { return ++*token > 0; };
    T_ANALYSIS_ERROR error;
    const long own = token.use_count();
    {
        CDBDoc doc;
        doc.Data().Assign(Staged());
        ASSERT_EQ(1, doc.StartAnalysis(options, error)) << error.text;
        EXPECT_GT(token.use_count(), own);
    }
    EXPECT_EQ(own, token.use_count());
    EXPECT_EQ(0, *token);

    CDBDoc doc;
    doc.Data().Assign(Staged());
    T_FILE_ERROR fault;
    ASSERT_EQ(1, doc.StartAnalysis(options, error)) << error.text;
    ASSERT_EQ(1, doc.ImportCase(QM_TEST_DATA "/cases/stage_all_members.json", fault));
    EXPECT_FALSE(doc.IsExcuted());
    EXPECT_EQ(0, doc.AnalysisOutcome(error));
    EXPECT_EQ(ANALYSIS_FAULT::Cancelled, error.fault);
    EXPECT_EQ(nullptr, doc.Data().StagedResult());
    EXPECT_EQ(own, token.use_count());

    // Also from within its own progress.
    options.progress = [&](std::size_t, std::size_t) {
        EXPECT_EQ(1, doc.ImportCase(QM_TEST_DATA "/cases/stage_all_members.json", fault));
        return true;
    };
    EXPECT_EQ(0, doc.RunAnalysis(options, error));
    EXPECT_EQ(ANALYSIS_FAULT::Cancelled, error.fault);
    EXPECT_EQ(1, doc.Edit().Begin("free"));
}

TEST(AnalysisWorker, WhatTheProgressThrowsEndsTheRun)
{
    CDBDoc doc;
    doc.Data().Assign(Staged());
    T_ANALYSIS_OPTIONS options = StagesOnly();
    options.progress = [](std::size_t, std::size_t) -> bool { throw std::runtime_error("stop"); };
    T_ANALYSIS_ERROR error;
    EXPECT_THROW((void)doc.RunAnalysis(options, error), std::runtime_error);
    EXPECT_FALSE(doc.IsExcuted());
    EXPECT_EQ(1, doc.Edit().Begin("free"));
    EXPECT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
}

TEST(AnalysisWorker, CancelsAndJoinsAJobThatWouldNeverEnd)
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

TEST(AnalysisWorker, WhatTheJobThrowsBecomesAnError)
{
    struct T_ROW {
        CAnalysisWorker::JobFn job;
        const char* text;
    };
    const T_ROW rows[] = {
        {[](const auto&, auto&, auto&) -> int { throw std::bad_alloc(); },
         "the analysis failed: std::bad_alloc"},
        {[](const auto&, auto&, auto&) -> int { throw 3; }, "the analysis failed: unknown reason"},
    };
    for (const T_ROW& row : rows) {
        CAnalysisWorker worker(row.job);
        T_ANALYSIS_RESULTS results;
        T_ANALYSIS_ERROR error;
        EXPECT_EQ(0, worker.Finish(results, error));
        EXPECT_EQ(ANALYSIS_FAULT::Failed, error.fault);
        EXPECT_EQ(row.text, error.text);
    }
}
