// Results of a push as they are read back from a model file.
#include "qm_db/editscope.h"
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
