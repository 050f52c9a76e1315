// Results of a push of our own: recorded, kept in the model file, read in part, judged as too old.
#include "casetext.h"
#include "numbers.h"

#include "qm_base/say.h"
#include "qm_db/dbdoc.h"
#include "qm_db/results/pushrecorder.h"
#include "qm_db/store/modelreader.h"
#include "qm_db/store/runblocksource.h"
#include "qm_db/store/sqlitedb.h"

#include <gtest/gtest.h>

namespace {

using O = solver::PUSH_OUTCOME;
using H = solver::HINGE_TURN;

/// 170 nodes (10, 20 ...) and 140 components, so that both go over more than one block.
T_RUN_DATA LongRun(int steps)
{
    T_RUN_DATA run;
    run.head = {
        0, 0.0, {0, 0, 0, 0, 0, 0}, -3.5, {1, 2, 3, ~0ULL}, {O::SnapBack, 1, -0.0, 0.25, 7, 14, 2}};
    run.head.control[1] = 1.0;
    for (int n = 1; n <= 170; ++n) {
        run.nodes.push_back(10 * n);
        run.start.push_back({0, 0.125 * n, -1.0 * n, 0, 0, 0});
    }
    for (int h = 0; h < 140; ++h)
        run.hinges.push_back({h / 2 + 1, 0.5 * (h % 3), h % 6});
    for (int s = 1; s <= steps; ++s) {
        const double v = s;
        run.steps.push_back(
            {s % 2, v / 8, v / 4, -v, {v, -v, 3, 4, 5, 6}, 1e-12 * v, s % 2 == 0, s == 4});
        auto& shape = run.displacement.emplace_back();
        for (int n = 0; n < 170; ++n)
            shape.push_back({v, 1000.0 * n + v, -0.0, 1.0 / (n + 1), 5, 6});
        auto& states = run.states.emplace_back();
        for (int h = 0; h < 140; ++h)
            states.push_back({0.001 * h, v * h, -5.0, h % 7 - 3});
    }
    run.events = {
        {-1, 0.5, 0.0, 0.0, {}, {}},
        {0, 1.5, 0.25, 2.0, {1, 2, 3, 4, 5, 6}, {{139, H::Point, 2, false}, {0, H::Unload}}},
        {1, 2.5, 0.5, 3.0, {}, {{3, H::Reload, 0, true}}}};
    return run;
}

T_RUN_DATA Whole(IPushResult& source)
{
    T_RUN_DATA data;
    std::string error = "not a run";
    EXPECT_TRUE(source.Run() && ReadWholeRun(*source.Run(), data, error)) << error;
    return data;
}

T_MODEL_CONTENT PushText()
{
    return ParseGood(CaseText("push_all_members.json"));
}

} // namespace

TEST(PushRun, TakesTheEngineStepByStepInTheIdsOfTheModel)
{
    solver::T_PUSH_MODEL engine;
    engine.hinges.resize(2);
    engine.hinges[0].element = 1;
    engine.hinges[0].at = 1.0;
    engine.hinges[0].laws.resize(2);
    engine.hinges[0].laws[0].component = 4;
    engine.hinges[1].laws.resize(1);
    T_RUN_HEAD head;
    head.control = {0.6, 0.8, 0, 0, 0, 0}; // pushed at an angle
    const T_MODEL model = PushText().model;
    const int nodes[] = {5, 9}, elements[] = {3, 8};
    CPushRecorder recorder(model, 2, head, engine, nodes, elements);

    solver::T_PUSH_STEP step;
    step.stage = 1;
    step.loadFactor = 0.5;
    step.base = {-10, -20, 100, 0, 0, 7};
    step.nodes = {{1, 2, 0, 0, 0, 0}, {3, 4, 0, 0, 0, 0}};
    step.hinges = {{0.1, 1, 2}, {0.2, 2, -1}, {0.3, 3, 0}};
    step.axial = {-50, 60};
    recorder.Add(step);
    recorder.Add(solver::T_PUSH_EVENT{-1, 0.25, 0.0, step.base, {{1, 0, H::Point, 1, true}}});
    recorder.Add(solver::T_PUSH_EVENT{0, 0.5, 0.1, {}, {{0, 1, H::Unload, 0, false}}});
    EXPECT_EQ(1u, recorder.Data().steps.size()); // there to be kept, whatever comes
    recorder.End({O::Cancelled, 1, 0.5, 0.1, 0, -1});

    const T_RUN_DATA run = recorder.Take();
    EXPECT_EQ(PrintOfPush(model, 2), run.head.print);
    EXPECT_EQ((T_RUN_END{O::Cancelled, 1, 0.5, 0.1, 8, 1, 0}), run.head.end);
    EXPECT_EQ((std::vector<T_RUN_HINGE>{{8, 1.0, 4}, {8, 1.0, 5}, {3, 0.0, 5}}), run.hinges);
    EXPECT_EQ((std::vector<T_RUN_STATE>{{0.1, 1, -50, 2}, {0.2, 2, -50, -1}, {0.3, 3, 60, 0}}),
              run.states.at(0));
    EXPECT_EQ(22.0, run.steps.at(0).baseReaction); // 0.6 * 10 + 0.8 * 20, against the supports
    ASSERT_EQ(2u, run.events.size());
    EXPECT_EQ(22.0, run.events[0].baseReaction);
    EXPECT_EQ((T_RUN_TURN{2, H::Point, 1, true}), run.events[0].turns.at(0));
    EXPECT_EQ((T_RUN_TURN{1, H::Unload, 0, false}), run.events[1].turns.at(0));
    std::vector<double> along;
    EXPECT_EQ(1, MakePushRun(run)->ReadDisplacements(9, along));
    EXPECT_EQ(std::vector{0.6 * 3 + 0.8 * 4}, along);
}

TEST(PushRun, ComesBackFromTheModelFileWholeAndInPart)
{
    T_MODEL_CONTENT content = PushText(), opened;
    const T_RUN_DATA run = LongRun(5);
    T_RUN_DATA turned = LongRun(2);
    turned.head.turn = 3;
    turned.head.angle = 67.5;
    content.results[1] = MakePushRun(run);
    content.turnedResults[{1, 3}] = MakePushRun(turned);
    const std::string text = PrintGood(content); // computed again: not part of a case file
    EXPECT_EQ(CaseText("push_all_members.json"), text);

    const CTempFolder folder;
    const std::string path = folder.File("m.qmdb");
    T_FILE_ERROR error;
    CModelStore store;
    ASSERT_EQ(1, store.Save(path, content, error)) << error.text;
    ASSERT_EQ(1, CModelStore::CheckWhole(path, error)) << error.text;
    ASSERT_EQ(1, store.Open(path, OPEN_MODE::Edit, opened, error)) << error.text;
    ASSERT_EQ(1, store.Save(path, opened, error)) << error.text; // over the file it comes from
    ASSERT_EQ(1, store.Open(path, OPEN_MODE::Edit, opened, error)) << error.text;
    EXPECT_EQ(run, Whole(*opened.results.at(1)));
    EXPECT_EQ(turned, Whole(*opened.turnedResults.at({1, 3})));
    EXPECT_EQ(nullptr, opened.results.at(3)->Run()); // another program's

    for (const auto& source : {content.results.at(1), opened.results.at(1)}) {
        IPushRun& r = *source->Run();
        std::vector<T_DOF6> u;
        std::vector<T_RUN_STATE> s;
        std::vector<double> along, base;
        ASSERT_EQ(1, r.ReadDisplacements(1690, along)); // in the third block, in Y
        // less 169 / 8 that it had moved before the first step
        EXPECT_EQ((std::vector<double>{167979.875, 167980.875, 167981.875, 167982.875, 167983.875}),
                  along);
        ASSERT_EQ(1, r.ReadBaseReactions(base));
        EXPECT_EQ((std::vector<double>{2.5, 1.5, 0.5, -0.5, -1.5}), base); // beyond -3.5
        ASSERT_EQ(1, r.ReadHinge(128, s));
        EXPECT_EQ((T_RUN_STATE{0.001 * 128, 4.0 * 128, -5.0, -1}), s.at(3));
        ASSERT_EQ(1, r.ReadStates(2, s));
        EXPECT_EQ(run.states[1], s);
        ASSERT_EQ(1, r.ReadShape(5, u));
        EXPECT_EQ(run.displacement[4], u);
        EXPECT_EQ(0, r.ReadShape(6, u));
        EXPECT_TRUE(u.empty());
        EXPECT_EQ(0, r.ReadStates(0, s));
        EXPECT_EQ(0, r.ReadHinge(140, s));
        EXPECT_EQ(0, r.ReadNode(11, u));
        EXPECT_FALSE(r.HasNode(11));
    }
}

// Written by the program when it knew that version only: a frame stopped by a drift.
TEST(PushRun, OfAnOlderFileDoesNotSayWhereItEnded)
{
    const CTempFolder folder;
    const std::string path = folder.File("model.qmdb");
    WriteBytes(path, BytesOf(QM_TEST_DATA "/model-v5.qmdb"));
    ASSERT_EQ(5, BytesOf(path)[63]); // user_version, last byte
    T_MODEL_CONTENT content;
    T_FILE_ERROR error;
    CModelStore store;
    ASSERT_EQ(1, store.Open(path, OPEN_MODE::Edit, content, error)) << error.text;
    const T_RUN_DATA run = Whole(*content.results.at(1));
    EXPECT_EQ(O::DriftStop, run.head.end.outcome);
    EXPECT_NEAR(0.13284, run.head.end.displacement, 5e-6); // as it was printed
    EXPECT_EQ(0, run.head.end.hinge);
    EXPECT_EQ(0, run.head.end.storey);
    ASSERT_EQ(1, store.Save(path, content, error)) << error.text;
    EXPECT_EQ(6, BytesOf(path)[63]);
    ASSERT_EQ(1, store.Open(path, OPEN_MODE::Edit, content, error)) << error.text;
    EXPECT_EQ(run, Whole(*content.results.at(1)));
}

// What is not asked for is not read: a damaged block elsewhere does not matter.
TEST(PushRun, ReadsTheBlocksOfWhatIsAskedForAlone)
{
    const CTempFolder folder;
    const std::string path = folder.File("m.qmdb");
    T_MODEL_CONTENT content = PushText();
    content.results = {{1, MakePushRun(LongRun(4))}};
    WriteBytes(path, "");
    WriteModelFile(path, content);
    auto db = std::make_shared<CSqliteDb>(CSqliteDb::OpenForWriting(path));
    const auto spoil = [&](BLOCK_PART part, int chunk, int step) {
        db->Exec("UPDATE result_blocks SET checksum = checksum + 1 WHERE part = " +
                 std::to_string(static_cast<int>(part)) + " AND chunk = " + std::to_string(chunk) +
                 " AND step = " + std::to_string(step));
    };
    spoil(BLOCK_PART::RunDisplacement, 1, 2); // nodes 810 to 1600 in step 3
    spoil(BLOCK_PART::RunState, 0, 0);        // components 0 to 127 in step 1
    T_TABLE_SUMS sums;
    const std::vector<T_RUN_ROW> rows = ReadRunRows(*db, sums);
    ASSERT_EQ(1u, rows.size());
    CBlockPushRun run(db, path, rows[0]);
    std::vector<T_DOF6> u;
    std::vector<T_RUN_STATE> s;
    std::vector<T_RUN_STEP> steps;
    std::vector<T_RUN_EVENT> events;
    EXPECT_TRUE(run.ReadNode(800, u) && run.ReadNode(1610, u) && run.ReadShape(2, u));
    EXPECT_TRUE(run.ReadHinge(128, s) && run.ReadStates(2, s));
    EXPECT_TRUE(run.ReadSteps(steps) && run.ReadEvents(events));
    const auto damage = [&](const char* part, const char* chunk, const char* step) {
        const std::string block = Say("IDS_QM_DB_DAMAGE_BLOCK", "1", Say(part), chunk, step);
        return Say("IDS_QM_DB_FILE_DAMAGED", path, block);
    };
    EXPECT_EQ(0, run.ReadNode(810, u));
    EXPECT_EQ(damage("IDS_QM_DB_PART_DISPLACEMENTS", "2", "3"), run.Error());
    EXPECT_EQ(0, run.ReadShape(3, u));
    EXPECT_TRUE(u.empty());
    EXPECT_EQ(0, run.ReadHinge(127, s));
    EXPECT_EQ(damage("IDS_QM_DB_PART_HINGE_STATES", "1", "1"), run.Error());
    EXPECT_EQ(0, run.ReadStates(1, s));

    spoil(BLOCK_PART::RunState, 0, 0);
    T_FILE_ERROR error;
    EXPECT_EQ(0, CModelStore::CheckWhole(path, error));

    T_RUN_DATA bad = LongRun(2);
    bad.states[1][3].force = kNan;
    content.results[1] = MakePushRun(bad);
    EXPECT_EQ(0, CModelStore().Save(folder.File("bad.qmdb"), content, error));
    EXPECT_EQ((std::vector<std::string>{"m.qmdb"}), folder.Names());
}

TEST(PushRun, SaysWhatHasChangedSince)
{
    const struct {
        const char* change; // null: nothing that it was computed from
        void (*edit)(T_MODEL&);
    } rows[] = {
        {nullptr, [](T_MODEL&) {}},
        {nullptr, [](T_MODEL& m) { m.styp.title = "other"; }},
        {nullptr, [](T_MODEL& m) { m.styp.units = {}; }},
        {nullptr, [](T_MODEL& m) { m.pushovers.at(3).eccentricity = 0.1; }},
        {nullptr, [](T_MODEL& m) { m.pushovers.at(1).additionalEvaluations = false; }},
        {nullptr,
         [](T_MODEL& m) { m.pushovers.at(2).name = m.pushovers.at(1).initialCase = "first"; }},
        {"STRUCTURE", [](T_MODEL& m) { m.nodes.at(2).xyz[2] += 1e-9; }},
        {"HINGES", [](T_MODEL& m) { m.hingeTypes.at(1).length.My.I = 0.2; }},
        {"HINGES",
         [](T_MODEL& m) {
             m.hinges[1] = {1, 1};
         }},
        {"HINGES", [](T_MODEL& m) { m.materials.at(1).Fy = 1; }},
        {"HINGES", [](T_MODEL& m) { m.pushControl.hingeTypes = {}; }},
        {"LOADS", [](T_MODEL& m) { m.nodes.at(2).mass[0] = 2; }},
        {"LOADS", [](T_MODEL& m) { m.loadCases.at(2).selfWeight[2] = -1; }},
        {"LOADS",
         [](T_MODEL& m) {
             m.storeys[1] = {"1", 3.0, {2}};
         }},
        {"SETUP",
         [](T_MODEL& m) { m.pushControl.pDelta = PUSH_P_DELTA::None, m.pushControl.steps = 4; }},
        {"SETUP", [](T_MODEL& m) { m.pushovers.at(1).steps = 8; }},
        {"SETUP", [](T_MODEL& m) { m.pushovers.at(1).stops.drift.reset(); }},
        {"SETUP", [](T_MODEL& m) { m.pushovers.at(2).eccentricity = 0.1; }}, // it starts from there
        {"SETUP", [](T_MODEL& m) { m.incrementFunctions.at(1).factor[0] = 0.4; }},
    };
    for (const auto& row : rows) {
        T_MODEL_CONTENT content = PushText();
        content.model.materials[1].name = "S";
        T_RUN_DATA run = LongRun(1);
        run.head.print = PrintOfPush(content.model, 1);
        row.edit(content.model);
        content.results[1] = MakePushRun(run);
        CDBDoc doc;
        doc.Data().Assign(content);
        std::string reason;
        EXPECT_EQ(row.change != nullptr, doc.Post().IsStale(1, reason)) << &row - rows;
        const std::string what =
            row.change ? Say("IDS_QM_DB_PUSH_OLD_" + std::string(row.change)) : std::string();
        EXPECT_EQ(row.change ? Say("IDS_QM_DB_PUSH_OLD", "second half", what) : what, reason);
        EXPECT_FALSE(doc.Post().IsStale(3, reason)); // another program's results
    }
}

// kips and inches: 4448.2216152605 N, 0.0254 m.
TEST(PushRun, IsReadInCurrentUnits)
{
    CDBDoc doc;
    doc.Data().Assign(PushText());
    T_RUN_DATA run = LongRun(3), turned = run;
    turned.head.turn = 1;
    turned.head.control = {1, 0, 0, 0, 0, 0};
    EXPECT_FALSE(doc.Data().IsModified());
    T_RUN_DATA old = turned;
    old.head.turn = 2;
    doc.Data().SetPushRuns(1, {MakePushRun(old)});
    doc.Data().SetPushRuns(1, {MakePushRun(run), MakePushRun(turned)});
    EXPECT_TRUE(doc.Data().IsModified());
    CPostCtrl& post = doc.Post();
    constexpr double kip = 4448.2216152605, in = 0.0254;
    std::vector<T_RUN_STEP> steps;
    std::vector<T_RUN_EVENT> events;
    std::vector<T_RUN_STATE> s;
    std::vector<T_DOF6> u;
    T_RUN_HEAD head;
    ASSERT_TRUE(post.SelectPushover(1) && post.GetRunHead(head) && post.GetRunSteps(steps) &&
                post.GetRunEvents(events));
    EXPECT_DOUBLE_EQ(0.25 / in, head.end.displacement);
    EXPECT_DOUBLE_EQ(-3 / kip, steps.at(2).baseReaction);
    EXPECT_DOUBLE_EQ(6 / kip / in, steps.at(2).base[5]);
    EXPECT_DOUBLE_EQ(0.75 / in, steps.at(2).displacement);
    EXPECT_DOUBLE_EQ(3 / kip, events.at(1).base[2]);
    ASSERT_EQ(1, post.GetRunHinge(2, s)); // Fz
    EXPECT_DOUBLE_EQ(0.002 / in, s.at(2).deformation);
    EXPECT_DOUBLE_EQ(6 / kip, s.at(2).force);
    ASSERT_EQ(1, post.GetRunStates(3, s));
    EXPECT_DOUBLE_EQ(0.004, s.at(4).deformation); // My
    EXPECT_DOUBLE_EQ(12 / kip / in, s.at(4).force);
    EXPECT_DOUBLE_EQ(-5 / kip, s.at(4).axial);
    ASSERT_TRUE(post.GetRunNode(20, u) && post.GetRunShape(3, u));
    EXPECT_DOUBLE_EQ(1003 / in, u.at(1)[1]);
    EXPECT_EQ(0.5, u.at(1)[3]);

    double displacement = 0.0;
    ASSERT_TRUE(post.SelectStep(2) && post.GetDispNew(20, displacement));
    EXPECT_DOUBLE_EQ(1001.75 / in, displacement); // 0.25 before the first step
    ASSERT_TRUE(post.SelectPushover(1, 1) && post.SelectStep(2) &&
                post.GetDispNew(20, displacement));
    EXPECT_DOUBLE_EQ(2 / in, displacement);
    EXPECT_EQ(0, post.SelectPushover(1, 2)); // gone with the runs before
    ASSERT_EQ(1, post.SelectPushover(3));
    EXPECT_EQ(0, post.GetRunSteps(steps)); // another program's
    EXPECT_TRUE(steps.empty());
}
