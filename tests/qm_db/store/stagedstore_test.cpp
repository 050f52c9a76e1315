// Results of construction stages in the model file.
#include "modelstoresample.h"
#include "qm_base/textformat.h"
#include "qm_db/casefile.h"
#include "qm_db/dbdoc.h"
#include "qm_db/store/modelreader.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_db/store/sqlitestmt.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <gtest/gtest.h>

namespace {

const int kLoads[] = {kStageLoadSum, kStageLoadDead, kStageLoadErection, 1, 2, 3};

T_MODEL_CONTENT Staged()
{
    T_MODEL_CONTENT c;
    T_FILE_ERROR error;
    EXPECT_EQ(1, CCaseFile::Read(QM_TEST_DATA "/cases/stage_all_members.json", c, error));
    return c;
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
    const auto add = [&](int done, const T_DOF6& v) {
        all.push_back(done ? 1 : -1);
        all.insert(all.end(), v.begin(), v.end());
    };
    for (const auto& [id, node] : doc.Data().Model().nodes) {
        T_DOF6 u{}, r{};
        add(post.GetDspcNew(id, u), u);
        add(post.GetReccNew(id, r), r);
    }
    for (const auto& [id, element] : doc.Data().Model().elements) {
        T_DOF6 f{};
        add(post.GetStrtcNew(id, f[0]), f);
        for (int position = 0; position < 5; ++position) {
            T_DOF6 b{};
            add(post.GetStrbcNew(id, position, b), b);
        }
    }
    return all;
}

void ExpectSame(const std::vector<double>& a, const std::vector<double>& b, const std::string& what)
{
    ASSERT_EQ(a.size(), b.size()) << what;
    double largest = 0.0;
    for (const double v : a)
        largest = std::max(largest, std::fabs(v));
    for (std::size_t i = 0; i < a.size(); ++i) // sums are rounded in another order
        ASSERT_NEAR(a[i], b[i], 1e-13 * largest) << what << ", value " << i;
}

/// Name, type, "not null" and place in the key of every column.
std::vector<std::string> ColumnsOf(const CSqliteDb& db)
{
    std::vector<std::string> all;
    CSqliteStmt rows(db, "SELECT m.name || ' ' || c.name || ' ' || c.type || ' ' || c.\"notnull\" "
                         "|| ' ' || c.pk FROM sqlite_schema m, pragma_table_info(m.name) c "
                         "ORDER BY 1");
    while (rows.Step())
        all.emplace_back(rows.Text(0));
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
        int choices = 0;
        bool anything = false;
        for (const auto& [key, stage] : m_doc.Data().Model().stages) {
            for (int step = 1; step <= stage.steps; ++step) {
                for (const int load : kLoads) {
                    const std::vector<double> memory = Everything(m_doc, {key, step, load});
                    ExpectSame(memory, Everything(again, {key, step, load}),
                               stage.name + FormatText(", step %d, load %d", step, load));
                    anything = anything || std::ranges::any_of(
                                               memory, [](double v) { return std::fabs(v) > 1.0; });
                    ++choices;
                }
            }
        }
        EXPECT_EQ(6 * 6, choices);
        EXPECT_TRUE(anything);
        EXPECT_EQ(m_doc.Data().StagedResult()->Cases(), again.Data().StagedResult()->Cases());
        again.Post().SelectStage(2, kStageLastStep, kStageLoadSum);
        T_DOF6 v{};
        EXPECT_EQ(0, again.Post().GetDspcNew(9, v));
        EXPECT_EQ("Construction stage \"S2\" has no results of node 9.", again.Post().Error());
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
    Poke(data.displacement.at(2)[2]);
    ExpectRefused("results of construction stage 2, step 3, load case 2, displacements, block 1");
    WriteBytes(m_path, good);
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

/// Over 16 MiB a block is checked when it is read, and only then.
TEST_F(StagedStore, LargeFilesReadOnlyWhatIsAsked)
{
    T_MODEL_CONTENT content = Many();
    content.model.stages.at(1).steps = 70;
    Analyse(std::move(content));
    ASSERT_GT(BytesOf(m_path).size(), std::size_t{16} << 20);
    {
        const CSqliteDb db = CSqliteDb::OpenForWriting(m_path);
        db.Exec("UPDATE result_blocks SET checksum = checksum + 1 "
                "WHERE part = 6 AND chunk = 1 AND step = 7");
        WriteChecksums(db);
    }
    ASSERT_EQ(1, m_again.OpenModel(m_path, OPEN_MODE::ReadOnly, m_error)) << m_error.text;
    CPostCtrl& post = m_again.Post();
    T_DOF6 v{};
    for (const int step : {6, 7, 8}) {
        post.SelectStage(1, step, kStageLoadSum);
        EXPECT_EQ(1, post.GetDspcNew(4, v)) << post.Error();
        const int done = post.GetDspcNew(700, v); // of the second block
        EXPECT_EQ(step != 7 ? 1 : 0, done) << step;
        if (!done) {
            EXPECT_NE(std::string::npos,
                      post.Error().find("The results of construction stage \"up\" can't be read."));
            EXPECT_NE(std::string::npos,
                      post.Error().find("results of construction stage 1, step 7, load case 1, "
                                        "displacements, block 2"))
                << post.Error();
        }
        EXPECT_EQ(1, post.GetReccNew(699, v)) << post.Error();
    }
    // A save would lose them: it is refused, and the file stays.
    const std::string before = BytesOf(m_path);
    EXPECT_EQ(0, m_again.SaveModelAs(m_folder.File("copy.qmdb"), m_error));
    EXPECT_NE(std::string::npos, m_error.text.find("step 7")) << m_error.text;
    EXPECT_EQ(std::vector<std::string>{"m.qmdb"}, m_folder.Names());
    EXPECT_TRUE(before == BytesOf(m_path));
}

TEST_F(StagedStore, AFileWithoutResultsSaysSo)
{
    m_doc.Data().Assign(Staged());
    ASSERT_EQ(1, m_doc.SaveModelAs(m_path, m_error)) << m_error.text;
    ASSERT_EQ(1, m_again.OpenModel(m_path, OPEN_MODE::ReadOnly, m_error)) << m_error.text;
    EXPECT_EQ(nullptr, m_again.Data().StagedResult());
    EXPECT_EQ(0, m_again.Post().CheckStagedResult());
    EXPECT_EQ("The construction stages have no results: run the analysis.", m_again.Post().Error());
}

TEST_F(StagedStore, OldResultsStayRefusedAndComeBackWithTheModel)
{
    Analyse(Staged());
    ASSERT_EQ(1, m_doc.Edit().Begin("tension"));
    ASSERT_EQ(1, m_doc.Edit().AddPtns(3, {3, 11.0}));
    ASSERT_EQ(1, m_doc.Edit().Commit());
    ASSERT_EQ(1, m_doc.SaveModel(m_error)) << m_error.text;
    ASSERT_EQ(1, m_again.OpenModel(m_path, OPEN_MODE::ReadOnly, m_error)) << m_error.text;
    T_DOF6 v{7};
    m_again.Post().SelectStage(1, 1, kStageLoadSum);
    EXPECT_EQ(0, m_again.Post().GetDspcNew(2, v));
    EXPECT_EQ(T_DOF6{7}, v);
    EXPECT_EQ("The results of the construction stages are older than the model: run the analysis "
              "again.",
              m_again.Post().Error());
    ASSERT_EQ(1, m_again.Edit().Begin("back"));
    ASSERT_EQ(1, m_again.Edit().AddPtns(3, {3, 10.0}));
    ASSERT_EQ(1, m_again.Edit().Commit());
    EXPECT_EQ(1, m_again.Post().GetDspcNew(2, v)) << m_again.Post().Error();
    EXPECT_LT(v[2], -0.001);
}

// The files were written by the program when it knew that version only.
TEST_F(StagedStore, OlderFilesGetEveryColumnOfToday)
{
    ASSERT_EQ(1, CModelStore().Save(m_path, Staged(), m_error)) << m_error.text;
    const std::vector<std::string> today = ColumnsOf(CSqliteDb::OpenReadOnly(m_path));
    EXPECT_EQ(1, std::ranges::count(today, "model body TEXT 0 0"));
    EXPECT_EQ(1, std::ranges::count(today, "staged_results load_group INTEGER 1 0"));
    for (const int version : {1, 2, 3}) {
        const CSqliteDb old =
            CSqliteDb::OpenReadOnly(QM_TEST_DATA + FormatText("/model-v%d.qmdb", version));
        EXPECT_NE(today, ColumnsOf(old)) << version;
        const CSqliteDb copy = CSqliteDb::MemoryCopyOf(old);
        Migrate(copy, version, CurrentSchema());
        EXPECT_EQ(today, ColumnsOf(copy)) << version;
    }
}
