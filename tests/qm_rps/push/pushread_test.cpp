// Results of a push as they are read back from a model file.
#include "qm_db/editscope.h"
#include "qm_rps/push/pushended.h"
#include "qm_rps/push/pushrun.h"
#include "tempfolder.h"

#include <gtest/gtest.h>

TEST(PushRead, SaysHowItEndedAsItWasSaid)
{
    const struct {
        const char *file, *place; // named by the vertices of tests/data/push
        T_PUSH_STOPS_D stops;
        PUSH_FAILURE onFailure;
    } kRows[] = {{"pc_two_storey", "Storey: S", {0.02, {}, {}}, PUSH_FAILURE::Drop},
                 {"bb_two_storey_unloading", "Hinge: element ", {}, PUSH_FAILURE::Stop}};
    for (const auto& row : kRows) {
        SCOPED_TRACE(row.file);
        const CTempFolder folder;
        const std::string path = folder.File("m.qmdb");
        CDBDoc doc, opened;
        T_FILE_ERROR fault;
        std::string error;
        ASSERT_EQ(1, doc.ImportCase(std::string(QM_TEST_DATA "/push/") + row.file + ".json", fault))
            << fault.text;
        const int key = doc.Data().Model().pushovers.begin()->first;
        T_POLC_D record = doc.Data().Model().pushovers.at(key);
        record.stops = row.stops;
        record.onFailure = row.onFailure;
        CEditScope edit(doc, "stop");
        ASSERT_TRUE(edit.Put(key, record) && edit.Commit());
        std::vector<T_PUSH_RUN> runs;
        CPushRun push(doc);
        ASSERT_EQ(1, push.Run(key, {}, runs, error)) << error;
        const std::string advice = runs[0].advice;
        EXPECT_NE(std::string::npos, advice.find(row.place)) << advice;
        EXPECT_EQ(PUSH_STATUS::Stopped, runs[0].status);
        push.Keep(runs);
        ASSERT_EQ(1, doc.SaveModelAs(path, fault)) << fault.text;
        ASSERT_EQ(1, opened.OpenModel(path, OPEN_MODE::ReadOnly, fault)) << fault.text;
        T_PUSH_RUN read;
        ASSERT_EQ(1, CPushRun(opened).Read(key, 0, read, error)) << error;
        EXPECT_EQ(advice, read.advice);
    }
}

// The engine hands on several steps at once, and vertices as it passes them.
TEST(PushRead, ABrokenPushEndsAtItsLastStep)
{
    CDBDoc doc;
    T_FILE_ERROR fault;
    std::string error;
    ASSERT_EQ(1, doc.ImportCase(QM_TEST_DATA "/push/pc_two_storey.json", fault)) << fault.text;
    const int key = doc.Data().Model().pushovers.begin()->first;
    std::vector<T_PUSH_RUN> whole;
    CPushRun push(doc);
    ASSERT_EQ(1, push.Run(key, {}, whole, error)) << error;
    ASSERT_GT(whole[0].events.size(), 2U);
    const double second = whole[0].events[1].displacement;
    for (std::size_t last = 1; last <= whole[0].displacement.size(); ++last) {
        const double end = whole[0].displacement[last - 1];
        std::vector<T_PUSH_RUN> runs;
        ASSERT_EQ(1, push.Run(
                         key, [&](const auto& p) { return p.done < last; }, runs, error));
        const T_PUSH_RUN& run = runs[0];
        ASSERT_TRUE(run.cancelled);
        EXPECT_EQ(last, run.displacement.size());
        const auto reached = std::ranges::count_if(
            whole[0].events, [&](const auto& e) { return e.displacement <= end * (1.0 + 1e-9); });
        EXPECT_EQ(reached, std::ssize(run.events)) << end;
        EXPECT_EQ(reached, std::ssize(run.data.events));
        EXPECT_EQ(whole[0].loadFactor[last - 1], run.data.head.end.loadFactor);
        if (end > second) break;
    }
    EXPECT_EQ(std::string::npos,
              PushOutcomeAdvice(solver::PUSH_OUTCOME::Cancelled, 0.0, {}, false).find("hold"));
}

// What the model says today is not what the run was pushed by.
TEST(PushRead, AnOldRunEndedAsItDidThen)
{
    CDBDoc doc;
    T_FILE_ERROR fault;
    std::string error;
    ASSERT_EQ(1, doc.ImportCase(QM_TEST_DATA "/push/pc_two_storey.json", fault)) << fault.text;
    const int key = doc.Data().Model().pushovers.begin()->first;
    std::vector<T_PUSH_RUN> runs;
    CPushRun push(doc);
    ASSERT_EQ(1, push.Run(key, {}, runs, error)) << error;
    push.Keep(runs);
    T_POLC_D record = doc.Data().Model().pushovers.at(key), first = record;
    first.name = record.initialCase = "first";
    record.direction = record.direction == 1 ? 2 : 1;
    record.stops.drift = 0.001;
    CEditScope edit(doc, "start elsewhere");
    ASSERT_TRUE(edit.Put(key + 1, first) && edit.Put(key, record) && edit.Commit());
    const auto ended = PushEndedOf(doc, key);
    ASSERT_TRUE(ended && doc.Post().IsStale(key, error));
    EXPECT_EQ(PUSH_STATUS::Reached, ended->status);
    EXPECT_FALSE(ended->earlier);
    EXPECT_FALSE(PushRemark(doc, record.name));
}
