// Results of static load cases: superposition, age, units, model file.
#include "modelstoresample.h"
#include "qm_db/dbdoc.h"
#include "qm_db/results/fingerprint.h"

#include <gtest/gtest.h>

namespace {

/// A beam 1, a truss 2 and a link 3 between nodes 1, 2, 5; load cases G (1) and S (2).
T_MODEL SmallModel()
{
    T_MODEL m;
    m.styp.units = {FORCE_UNIT::N, LENGTH_UNIT::m};
    for (const int id : {1, 2, 5})
        m.nodes[id] = {id, {1.0 * id, 0, 0}, {}, {}};
    m.materials[1].name = "S";
    m.materials[1].E = 2e11;
    m.sections[1].name = "B";
    m.sections[1].area = 0.01;
    for (const int id : {1, 2, 3}) {
        m.elements[id] = {id, 1, 2, 1, 1, 0};
        m.elements[id].kind = static_cast<ELEM_KIND>(id - 1);
    }
    m.loadCases[1].name = "G";
    m.loadCases[2].name = "S";
    m.loadCases[2].nodal = {{2, {0, 0, 5, 0, 0, 0}}};
    m.combinations[1] = {"C1", {{false, 1, 2.0}, {true, 2, 0.5}}};
    m.combinations[2] = {"C2", {{false, 2, 4.0}, {false, 1, 1.0}}};
    return m;
}

/// Numbers that tell their node, element and component: value = scale (100 id + 10 position + i).
T_STATIC_DATA Numbers(const T_MODEL& m, int loadCase, double scale)
{
    T_STATIC_DATA data;
    data.fingerprint = FingerprintOfCase(FingerprintOfStructure(m), m.loadCases.at(loadCase));
    for (const auto& entry : m.nodes) {
        data.nodes.push_back(entry.first);
        T_DOF6& u = data.displacement.emplace_back();
        T_DOF6& r = data.reaction.emplace_back();
        for (std::size_t i = 0; i < 6; ++i) {
            u[i] = scale * (100 * entry.first + static_cast<double>(i));
            r[i] = -u[i];
        }
    }
    for (const auto& entry : m.elements) {
        data.elements.push_back(entry.first);
        T_ELEM_FORCES& f = data.force.emplace_back();
        for (std::size_t p = 0; p < 5; ++p) {
            for (std::size_t i = 0; i < 6; ++i)
                f[p][i] = scale * (100 * entry.first + 10.0 * static_cast<double>(p) +
                                   static_cast<double>(i));
        }
    }
    return data;
}

T_MODEL_CONTENT Analysed()
{
    T_MODEL_CONTENT c;
    c.model = SmallModel();
    c.staticResults[1] = MakeStaticResult(Numbers(c.model, 1, 1.0));
    c.staticResults[2] = MakeStaticResult(Numbers(c.model, 2, 1000.0));
    return c;
}

void Edit(CDBDoc& doc, const auto& change)
{
    ASSERT_EQ(1, doc.Edit().Begin("edit"));
    change();
    ASSERT_EQ(1, doc.Edit().Commit());
}

} // namespace

TEST(StaticResult, ReadsSuperposeTheFlattenedCombination)
{
    CDBDoc doc;
    doc.Data().Assign(Analysed());
    CPostCtrl& post = doc.Post();
    T_DOF6 v{};
    double axial = 0.0;
    EXPECT_EQ(0, post.GetDispNew(2, v));
    EXPECT_EQ("No load combination is selected, or it has no load case.", post.Error());

    ASSERT_EQ(1, post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(2)));
    ASSERT_EQ(1, post.GetDispNew(5, v));
    EXPECT_EQ((T_DOF6{500e3, 501e3, 502e3, 503e3, 504e3, 505e3}), v);
    ASSERT_EQ(1, post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(1, -3.0)));
    ASSERT_EQ(1, post.GetReacNew(1, v));
    EXPECT_EQ((T_DOF6{300, 303, 306, 309, 312, 315}), v);

    ASSERT_EQ(1, post.SelectLoadCombNew(1)); // 2 G + 0.5 (4 S + G) = 2.5 G + 2 S: 2002.5 times
    ASSERT_EQ(1, post.GetDispNew(2, v));
    EXPECT_DOUBLE_EQ(2002.5 * 203, v[3]);
    ASSERT_EQ(1, post.GetStrtNew(2, axial));
    EXPECT_DOUBLE_EQ(2002.5 * 200, axial);
    ASSERT_EQ(1, post.GetStrbNew(1, 3, v));
    EXPECT_DOUBLE_EQ(2002.5 * 134, v[4]);
    ASSERT_EQ(1, post.GetStrbNew(1, 0, v));
    EXPECT_DOUBLE_EQ(2002.5 * 100, v[0]);
    EXPECT_EQ("", post.Error());
}

TEST(StaticResult, RefusalsNameWhatIsWrongAndLeaveTheOutput)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = Analysed();
    c.model.loadCases[3].name = "new";
    doc.Data().Assign(c);
    CPostCtrl& post = doc.Post();
    T_DOF6 v{7, 7, 7, 7, 7, 7};
    double axial = 7.0;
    ASSERT_EQ(1, post.SelectLoadCombNew(1));
    EXPECT_EQ(0, post.SelectLoadCombNew(9)); // the selection stays
    EXPECT_EQ(0, post.GetDispNew(3, v));
    EXPECT_EQ("Load case \"G\" has no results of node 3.", post.Error());
    EXPECT_EQ(0, post.GetStrtNew(1, axial));
    EXPECT_EQ("There is no truss element 1.", post.Error());
    EXPECT_EQ(0, post.GetStrbNew(2, 0, v));
    EXPECT_EQ("There is no beam element 2.", post.Error());
    EXPECT_EQ(0, post.GetStrbNew(4, 0, v));
    EXPECT_EQ(0, post.GetStrbNew(1, 5, v) + post.GetStrbNew(1, -1, v));
    EXPECT_EQ("There is no position -1 of beam forces; they are 0 to 4.", post.Error());

    ASSERT_EQ(1, post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(3)));
    EXPECT_EQ(0, post.GetDispNew(1, v));
    EXPECT_EQ("Load case \"new\" has no results: run the analysis.", post.Error());
    ASSERT_EQ(1, post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(8)));
    EXPECT_EQ(0, post.GetReacNew(1, v));
    ASSERT_EQ(1, post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(2, 1e305)));
    EXPECT_EQ(0, post.GetDispNew(5, v)); // no infinity comes out
    EXPECT_EQ((T_DOF6{7, 7, 7, 7, 7, 7}), v);
    EXPECT_EQ(7.0, axial);
}

TEST(StaticResult, ComesInCurrentUnits)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = Analysed();
    c.model.styp.units = {FORCE_UNIT::kN, LENGTH_UNIT::mm};
    doc.Data().Assign(c);
    CPostCtrl& post = doc.Post();
    T_DOF6 v{};
    double axial = 0.0;
    ASSERT_EQ(1, post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(1)));
    ASSERT_EQ(1, post.GetDispNew(1, v));
    EXPECT_DOUBLE_EQ(102e3, v[2]); // 102 m
    EXPECT_EQ(104.0, v[4]);        // radians
    ASSERT_EQ(1, post.GetReacNew(1, v));
    EXPECT_DOUBLE_EQ(-0.102, v[2]);
    EXPECT_DOUBLE_EQ(-104.0, v[4]); // 104 N m = 104 kN mm
    ASSERT_EQ(1, post.GetStrtNew(2, axial));
    EXPECT_DOUBLE_EQ(0.2, axial);
    ASSERT_EQ(1, post.GetStrbNew(1, 1, v));
    EXPECT_DOUBLE_EQ(0.111, v[1]);
    EXPECT_DOUBLE_EQ(114.0, v[4]);
}

// Each edit spoils the results of what it touches, and undoing it brings them back.
TEST(StaticResult, OlderThanTheModelIsRefusedWithTheCaseNamed)
{
    using Change = void (*)(CDBDoc & doc);
    const struct {
        const char* what;
        bool g, s; // are the results of G and of S still good?
        Change change;
    } rows[] = {
        {"node", false, false,
         [](CDBDoc& d) {
             (void)d.Edit().Put(2, T_NODE_D{2, {2.5, 0, 0}, {}, {}});
         }},
        {"support", false, false,
         [](CDBDoc& d) {
             (void)d.Edit().Put(2, T_NODE_D{2, {2, 0, 0}, {}, {1}});
         }},
        {"mass", true, true,
         [](CDBDoc& d) {
             (void)d.Edit().Put(2, T_NODE_D{2, {2, 0, 0}, {3, 3, 3}, {}});
         }},
        {"new element", false, false,
         [](CDBDoc& d) {
             (void)d.Edit().Put(4, T_ELEM_D{4, 2, 5, 1, 1, 0});
         }},
        {"release", false, false,
         [](CDBDoc& d) {
             T_ELEM_D e = d.Data().Model().elements.at(1);
             e.release.J[4] = true;
             (void)d.Edit().Put(1, e);
         }},
        {"material", false, false,
         [](CDBDoc& d) {
             T_MATL_D m = d.Data().Model().materials.at(1);
             m.G = 8e10;
             (void)d.Edit().Put(1, m);
         }},
        {"yield strength", true, true,
         [](CDBDoc& d) {
             T_MATL_D m = d.Data().Model().materials.at(1);
             m.Fy = 8e8;
             (void)d.Edit().Put(1, m);
         }},
        {"section", false, false,
         [](CDBDoc& d) {
             T_SECT_D s = d.Data().Model().sections.at(1);
             s.Izz = 1e-6;
             (void)d.Edit().Put(1, s);
         }},
        {"load of S", true, false,
         [](CDBDoc& d) {
             T_STLD_D s = d.Data().Model().loadCases.at(2);
             s.nodal[0].load[0] = 1.0;
             (void)d.Edit().Put(2, s);
         }},
        {"name of G", true, true,
         [](CDBDoc& d) {
             T_STLD_D g = d.Data().Model().loadCases.at(1);
             g.name = "g";
             (void)d.Edit().Put(1, g);
         }},
        {"diaphragm", false, false,
         [](CDBDoc& d) {
             (void)d.Edit().Put(1, T_DIAP_D{{1, 2}, 2});
         }},
        {"gravity", false, false,
         [](CDBDoc& d) {
             T_STYP_D s = d.Data().Model().styp;
             s.gravity = 9.81;
             (void)d.Edit().PutStyp(s);
         }},
        {"units", true, true,
         [](CDBDoc& d) {
             T_STYP_D s = d.Data().Model().styp;
             s.units = {FORCE_UNIT::kN, LENGTH_UNIT::m};
             (void)d.Edit().PutStyp(s);
         }},
    };
    CDBDoc doc;
    doc.Data().Assign(Analysed());
    CPostCtrl& post = doc.Post();
    ASSERT_EQ(1, post.SelectLoadCombNew(1));
    for (const auto& row : rows) {
        T_DOF6 v{};
        ASSERT_EQ(1, post.GetDispNew(2, v)) << row.what;
        Edit(doc, [&] { row.change(doc); });
        EXPECT_EQ(row.g ? 1 : 0, post.CheckStaticResult(1)) << row.what;
        EXPECT_EQ(row.s ? 1 : 0, post.CheckStaticResult(2)) << row.what;
        EXPECT_EQ(row.g && row.s ? 1 : 0, post.GetDispNew(2, v)) << row.what;
        const std::string name = row.g ? "S" : "G";
        if (!row.s) {
            EXPECT_EQ("The results of load case \"" + name +
                          "\" are older than the model: run the analysis again.",
                      post.Error())
                << row.what;
        }
        ASSERT_EQ(1, doc.Undo().Undo());
    }
}

TEST(StaticResult, IsReadBackFromTheModelFileBlockByBlock)
{
    T_MODEL_CONTENT c;
    c.model = SmallModel();
    for (int id = 10; id <= 1700; ++id) // more than three blocks
        c.model.nodes[id] = {id, {1.0 * id, 0, 0}, {}, {}};
    for (int id = 20; id <= 620; ++id)
        c.model.elements[id] = {id, id, id + 1, 1, 1, 0};
    c.model.loadCases[4].name = "not analysed";
    const T_STATIC_DATA g = Numbers(c.model, 1, 1.0), s = Numbers(c.model, 2, -0.125);
    c.staticResults[1] = MakeStaticResult(g);
    c.staticResults[2] = MakeStaticResult(s);
    c.staticResults[9] = MakeStaticResult(g); // of a load case that was deleted
    const CTempFolder folder;
    const std::string path = folder.File("m.qmdb");
    CDBDoc doc;
    T_FILE_ERROR error;
    ASSERT_EQ(1, CModelStore().Save(path, c, error)) << error.text;
    ASSERT_EQ(1, doc.OpenModel(path, OPEN_MODE::Edit, error)) << error.text;
    EXPECT_EQ(2U, doc.Data().Content().staticResults.size());
    EXPECT_FALSE(doc.Data().IsModified());

    CPostCtrl& post = doc.Post();
    ASSERT_EQ(1, post.SelectLoadCombNew(1)); // 2.5 G + 2 S: 2.25 times
    T_DOF6 v{};
    for (const int id : {1, 5, 10, 518, 519, 1031, 1700}) { // on both sides of block borders
        ASSERT_EQ(1, post.GetDispNew(id, v)) << post.Error();
        EXPECT_DOUBLE_EQ(2.25 * (100 * id + 2), v[2]);
        ASSERT_EQ(1, post.GetReacNew(id, v));
        EXPECT_DOUBLE_EQ(-2.25 * (100 * id + 5), v[5]);
    }
    for (const int id : {1, 20, 620}) {
        ASSERT_EQ(1, post.GetStrbNew(id, 4, v)) << post.Error();
        EXPECT_DOUBLE_EQ(2.25 * (100 * id + 45), v[5]);
    }
    EXPECT_EQ(0, post.GetDispNew(9, v) + post.GetDispNew(1701, v));

    // A save from the lazy sources, over the file that they read.
    ASSERT_EQ(1, doc.SaveModel(error)) << error.text;
    ASSERT_EQ(1, CModelStore::CheckWhole(path, error)) << error.text;
    T_MODEL_CONTENT again;
    T_STATIC_DATA back;
    ASSERT_EQ(1, CModelStore().Open(path, OPEN_MODE::ReadOnly, again, error)) << error.text;
    ASSERT_EQ(1, again.staticResults.at(2)->ReadAll(back));
    EXPECT_EQ(s, back);
}

TEST(StaticResult, DamageInABlockIsFound)
{
    const CTempFolder folder;
    const std::string path = folder.File("m.qmdb");
    T_MODEL_CONTENT c = Analysed();
    T_STATIC_DATA marked = Numbers(c.model, 1, 1.0);
    marked.force[1][2][3] = 1234567.0;
    c.staticResults[1] = MakeStaticResult(marked);
    T_FILE_ERROR error;
    ASSERT_EQ(1, CModelStore().Save(path, c, error)) << error.text;
    std::string bytes = BytesOf(path);
    const double value = 1234567.0;
    const std::string needle(reinterpret_cast<const char*>(&value), sizeof value);
    const std::size_t at = bytes.find(needle);
    ASSERT_NE(std::string::npos, at);
    bytes[at] ^= 1;
    WriteBytes(path, bytes);
    T_MODEL_CONTENT none;
    EXPECT_EQ(0, CModelStore().Open(path, OPEN_MODE::ReadOnly, none, error));
    EXPECT_NE(std::string::npos, error.text.find("load case 1, element forces")) << error.text;
}

TEST(StaticResult, ListsThatDoNotFitAreNotSaved)
{
    const CTempFolder folder;
    const std::string path = folder.File("m.qmdb");
    const auto saves = [&](const auto& spoil) {
        T_MODEL_CONTENT c = Analysed();
        T_STATIC_DATA data = Numbers(c.model, 2, 1.0);
        spoil(data);
        c.staticResults[2] = MakeStaticResult(data);
        T_FILE_ERROR error;
        return CModelStore().Save(path, c, error);
    };
    EXPECT_EQ(1, saves([](T_STATIC_DATA&) {}));
    EXPECT_EQ(0, saves([](T_STATIC_DATA& d) { d.reaction.pop_back(); }));
    EXPECT_EQ(0, saves([](T_STATIC_DATA& d) { d.force.pop_back(); }));
    EXPECT_EQ(0, saves([](T_STATIC_DATA& d) { std::swap(d.nodes[0], d.nodes[1]); }));
    EXPECT_EQ(0, saves([](T_STATIC_DATA& d) { d.force[0][0][0] = 1.0 / 0.0; }));
}
