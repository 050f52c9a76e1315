// Results of construction stages in the model file.
#include "casetext.h"

#include "qm_db/dbdoc.h"
#include "qm_db/store/modelreader.h"
#include "qm_db/store/sqlitedb.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <gtest/gtest.h>

namespace {

T_MODEL_CONTENT Staged()
{
    return ParseGood(CaseText("stage_all_members.json"));
}

/// A model of 1100 cantilevers, more than two blocks: node 2 i + 1 is held, element i is a beam to
/// node 2 i + 2. All stand in stage 1, those after the 600th go in stage 2.
T_MODEL_CONTENT Many()
{
    T_MODEL_CONTENT c = Staged();
    T_MODEL& m = c.model;
    const T_ELEM_D beam = m.elements.at(1);
    m.nodes.clear();
    m.elements.clear();
    m.stages.clear();
    m.ulfConstraints.clear();
    m.ulfStageItems.clear();
    m.styp.stageControl = {};
    m.loadCases.at(1).nodal.clear();
    m.stages[1].name = "up";
    m.stages[2].name = "part";
    m.stages.at(1).activate.loads = {{1, 1}};
    for (int i = 1; i <= 1100; ++i) {
        const int held = 2 * i + 1, tip = 2 * i + 2;
        m.nodes[held] = {held, {0, 0, 1.0 * i}, {}, {1, 1, 1, 1, 1, 1}};
        m.nodes[tip] = {tip, {2, 0, 1.0 * i}, {}, {}};
        m.elements[i] = beam;
        m.elements[i].id = i;
        m.elements[i].nodeI = held;
        m.elements[i].nodeJ = tip;
        m.stages.at(1).activate.elements.push_back(i);
        m.stages.at(1).activate.supports.push_back(held);
        if (i > 600) m.stages.at(2).deactivate.elements.push_back(i);
        if (i <= 600) m.loadCases.at(1).nodal.push_back({tip, {0, 0, -1000.0 * i, 0, 0, 0}});
    }
    return c;
}

/// A document with results in its file, and one that has read them.
class StagedStore : public testing::Test {
protected:
    void Analyse(T_MODEL_CONTENT content)
    {
        m_doc.Data().Assign(std::move(content));
        T_ANALYSIS_OPTIONS options;
        options.allCases = false;
        T_ANALYSIS_ERROR error;
        ASSERT_EQ(1, m_doc.RunAnalysis(options, error)) << error.text;
        EXPECT_TRUE(m_doc.Data().IsModified());
        ASSERT_EQ(1, m_doc.SaveModelAs(m_path, m_error)) << m_error.text;
    }
    /// Damages the file where it has the number.
    void Poke(double value)
    {
        std::string bytes = BytesOf(m_path);
        std::string packed(sizeof value, '\0');
        std::memcpy(packed.data(), &value, sizeof value);
        const std::size_t at = bytes.find(packed);
        ASSERT_NE(std::string::npos, at);
        bytes[at] = static_cast<char>(bytes[at] ^ 4);
        WriteBytes(m_path, bytes);
    }
    void ExpectRefused(const std::string& part)
    {
        T_MODEL_CONTENT none;
        EXPECT_EQ(0, CModelStore().Open(m_path, OPEN_MODE::ReadOnly, none, m_error));
        EXPECT_EQ(FILE_FAULT::BadInput, m_error.fault);
        EXPECT_NE(std::string::npos, m_error.text.find(part)) << m_error.text;
        EXPECT_NE(std::string::npos, m_error.text.find(m_path)) << m_error.text;
    }

    CTempFolder m_folder;
    std::string m_path = m_folder.File("m.qmdb");
    T_FILE_ERROR m_error;
    CDBDoc m_doc, m_again;
};

/// Every value of a choice, in one list; -1 in front of what is refused.
std::vector<double> Everything(CDBDoc& doc, const T_STAGE_CHOICE& c)
{
    CPostCtrl& post = doc.Post();
    post.SelectStage(c.stage, c.step, c.load);
    std::vector<double> all;
    const auto add = [&](auto read) {
        T_DOF6 v{};
        all.push_back(read(v) ? 1 : -1);
        all.insert(all.end(), v.begin(), v.end());
    };
    for (const auto& [id, node] : doc.Data().Model().nodes) {
        add([&](T_DOF6& v) { return post.GetDspcNew(id, v); });
        add([&](T_DOF6& v) { return post.GetReccNew(id, v); });
    }
    for (const auto& [id, element] : doc.Data().Model().elements) {
        add([&](T_DOF6& v) { return post.GetStrtcNew(id, v[0]); });
        for (int position = 0; position < 5; ++position)
            add([&](T_DOF6& v) { return post.GetStrbcNew(id, position, v); });
    }
    return all;
}

} // namespace

TEST_F(StagedStore, GivesBackEveryChoiceAfterReopening)
{
    Analyse(Staged());
    for (int saves = 0; saves < 2; ++saves) { // the second time from the lazy source
        CDBDoc again;
        ASSERT_EQ(1, again.OpenModel(m_path, OPEN_MODE::ReadOnly, m_error)) << m_error.text;
        EXPECT_TRUE(again.IsPostMode());
        EXPECT_FALSE(again.Data().IsModified());
        const auto cases = m_doc.Data().StagedResult()->Cases();
        EXPECT_EQ(cases, again.Data().StagedResult()->Cases());
        double largest = 0.0;
        for (const auto& [at, group] : cases)
            for (const int load : {at.load, kStageLoadSum, kStageLoadDead, kStageLoadErection}) {
                SCOPED_TRACE(testing::Message() << at.stage << ' ' << at.step << ' ' << load);
                const std::vector<double> a = Everything(m_doc, {at.stage, at.step, load}),
                                          b = Everything(again, {at.stage, at.step, load});
                ASSERT_EQ(a.size(), b.size());
                largest = std::max(largest, *std::max_element(a.begin(), a.end()));
                for (std::size_t i = 0; i < a.size(); ++i) // sums are rounded in another order
                    ASSERT_NEAR(a[i], b[i], 1e-13 * largest) << "value " << i;
            }
        EXPECT_GT(largest, 1.0);
        ASSERT_EQ(1, again.SaveModelAs(m_folder.File("copy.qmdb"), m_error)) << m_error.text;
        m_path = m_folder.File("copy.qmdb");
        ASSERT_EQ(1, CModelStore::CheckWhole(m_path, m_error)) << m_error.text;
    }
}

// P L3 / (3 E I) under the load of each cantilever; those that have gone have no numbers at all.
TEST_F(StagedStore, ReadsAcrossBlocksWhatStandsAndZerosElsewhere)
{
    Analyse(Many());
    ASSERT_EQ(1, m_again.OpenModel(m_path, OPEN_MODE::ReadOnly, m_error)) << m_error.text;
    CPostCtrl& post = m_again.Post();
    for (const int stage : {1, 2}) {
        for (const int load : {1, kStageLoadDead}) {
            post.SelectStage(stage, 1, load);
            for (const int i : {1, 255, 256, 257, 511, 512, 513, 600, 601, 1100}) {
                const double force = i <= 600 ? i : 0.0; // kN
                T_DOF6 v{};
                ASSERT_EQ(1, post.GetDspcNew(2 * i + 2, v)) << post.Error();
                EXPECT_NEAR(-force * 8 / (3 * 1e4), v[2], 1e-12 * (1 + force)) << i;
                ASSERT_EQ(1, post.GetReccNew(2 * i + 1, v)) << post.Error();
                EXPECT_NEAR(force, v[2], 1e-9 * (1 + force)) << i;
                ASSERT_EQ(1, post.GetStrbcNew(i, 2, v)) << post.Error();
                EXPECT_NEAR(force, std::fabs(v[4]), 1e-9 * (1 + force)) << i; // 1 m from the tip
            }
        }
        post.SelectStage(stage, 1, kStageLoadErection); // no case belongs to it
        T_DOF6 v{7};
        ASSERT_EQ(1, post.GetDspcNew(4, v)) << post.Error();
        EXPECT_EQ(T_DOF6{}, v);
    }
}

TEST_F(StagedStore, DamageIsRefusedWithItsPlace)
{
    Analyse(Staged());
    const std::string good = BytesOf(m_path);
    T_STATIC_DATA data;
    std::vector<std::shared_ptr<IStaticResult>> terms;
    ASSERT_EQ(1, m_doc.Data().StagedResult()->Open({2, 3, 2}, terms));
    ASSERT_EQ(1, terms.at(0)->ReadAll(data));
    Poke(data.force.at(1)[2][4]);
    ExpectRefused("results of construction stage 2, step 3, load case 2, element forces, block 1");

    constexpr const char* kSwap =
        "UPDATE result_blocks SET step = -step WHERE part = 6 AND pushover = 1;"
        "UPDATE result_blocks SET step = CASE step WHEN -1 THEN 4 WHEN -4 THEN 1 ELSE -step END "
        "WHERE part = 6 AND pushover = 1";
    const struct {
        const char* sql;
        const char* place; // with the sums of the tables made anew
    } rows[] = {
        {"DELETE FROM result_blocks WHERE part = 8 AND step = 1", "construction stage 1, step 1"},
        {"DELETE FROM staged_results WHERE key = 18", "result_blocks"},
        {"DELETE FROM staged_results WHERE key = 1", "construction stage 2, step 1"},
        {kSwap, "construction stage 1, step 1, load case 1, displacements"},
        {"UPDATE staged_results SET step = 2 WHERE key = 4", "staged_results"}, // twice
        {"UPDATE staged_results SET fingerprint = 1 WHERE key = 2", "staged_results"},
        {"UPDATE staged_results SET stage = 0 WHERE key = 2", "staged_results"},
    };
    for (const auto& row : rows) {
        WriteBytes(m_path, good);
        CSqliteDb::OpenForWriting(m_path).Exec(row.sql);
        ExpectRefused("");
        WriteChecksums(CSqliteDb::OpenForWriting(m_path));
        ExpectRefused(row.place);
    }
    WriteBytes(m_path, good); // a sum of its own
    CSqliteDb::OpenForWriting(m_path).Exec("UPDATE staged_results SET load_group = 1");
    ExpectRefused("staged_results");
}

TEST_F(StagedStore, OldResultsStayRefusedAndComeBackWithTheModel)
{
    Analyse(Staged());
    const auto pull = [](CDBDoc& doc, double kilonewtons) {
        ASSERT_EQ(1, doc.Edit().Begin("tension"));
        ASSERT_EQ(1, doc.Edit().AddPtns(3, {3, kilonewtons}));
        ASSERT_EQ(1, doc.Edit().Commit());
    };
    pull(m_doc, 11.0);
    ASSERT_EQ(1, m_doc.SaveModel(m_error)) << m_error.text;
    ASSERT_EQ(1, m_again.OpenModel(m_path, OPEN_MODE::ReadOnly, m_error)) << m_error.text;
    EXPECT_FALSE(m_again.IsPostMode());
    pull(m_again, 10.0);
    EXPECT_TRUE(m_again.IsPostMode());
}
