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
    const auto row = [scale](int id, double i) { return scale * (100 * id + i); };
    const auto six = [&](int id, double from) {
        return T_DOF6{row(id, from),     row(id, from + 1), row(id, from + 2),
                      row(id, from + 3), row(id, from + 4), row(id, from + 5)};
    };
    for (const auto& [id, node] : m.nodes) {
        data.nodes.push_back(id);
        data.displacement.push_back(six(id, 0));
        data.reaction.push_back(data.displacement.back());
        for (double& r : data.reaction.back())
            r = -r;
    }
    for (const auto& [id, element] : m.elements) {
        data.elements.push_back(id);
        data.force.push_back({six(id, 0), six(id, 10), six(id, 20), six(id, 30), six(id, 40)});
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

// What a change of the model spoils.
TEST(StaticResult, OlderThanTheModelIsRefusedWithTheCaseNamed)
{
    const struct {
        const char* what;
        bool g, s; // are the results of G and of S still good?
        void (*change)(T_MODEL& m);
    } rows[] = {
        {"node", false, false, [](T_MODEL& m) { m.nodes.at(2).xyz[0] = 2.5; }},
        {"support", false, false, [](T_MODEL& m) { m.nodes.at(2).restraint[0] = 1; }},
        {"mass", true, true,
         [](T_MODEL& m) {
             m.nodes.at(2).mass = {3, 3, 3};
         }},
        {"new element", false, false, [](T_MODEL& m) { m.elements[4] = {4, 2, 5, 1, 1, 0}; }},
        {"release", false, false, [](T_MODEL& m) { m.elements.at(1).release.J[4] = true; }},
        {"material", false, false, [](T_MODEL& m) { m.materials.at(1).G = 8e10; }},
        {"yield strength", true, true, [](T_MODEL& m) { m.materials.at(1).Fy = 8e8; }},
        {"section", false, false, [](T_MODEL& m) { m.sections.at(1).Izz = 1e-6; }},
        {"load of S", true, false, [](T_MODEL& m) { m.loadCases.at(2).nodal[0].load[0] = 1; }},
        {"name of G", true, true, [](T_MODEL& m) { m.loadCases.at(1).name = "g"; }},
        {"diaphragm", false, false,
         [](T_MODEL& m) {
             m.diaphragms[1] = {{1, 2}, 2};
         }},
        {"gravity", false, false, [](T_MODEL& m) { m.styp.gravity = 9.81; }},
        {"units", true, true, [](T_MODEL& m) { m.styp.units.force = FORCE_UNIT::kN; }},
    };
    for (const auto& row : rows) {
        T_MODEL_CONTENT c = Analysed();
        row.change(c.model);
        CDBDoc doc;
        doc.Data().Assign(c);
        CPostCtrl& post = doc.Post();
        T_DOF6 v{};
        ASSERT_EQ(1, post.SelectLoadCombNew(1));
        EXPECT_EQ(row.g ? 1 : 0, post.CheckStaticResult(1)) << row.what;
        EXPECT_EQ(row.s ? 1 : 0, post.CheckStaticResult(2)) << row.what;
        EXPECT_EQ(row.g && row.s ? 1 : 0, post.GetDispNew(2, v)) << row.what;
        const std::string text = std::string("The results of load case \"") + (row.g ? "S" : "G") +
                                 "\" are older than the model: run the analysis again.";
        EXPECT_EQ(row.s ? "" : text, post.Error()) << row.what;
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

TEST(StaticResult, ListsThatDoNotFitAreNotSaved)
{
    const CTempFolder folder;
    void (*const spoils[])(T_STATIC_DATA&) = {
        [](T_STATIC_DATA& d) { d.reaction.pop_back(); },
        [](T_STATIC_DATA& d) { d.force.pop_back(); },
        [](T_STATIC_DATA& d) { std::swap(d.nodes[0], d.nodes[1]); },
        [](T_STATIC_DATA& d) { d.force[0][0][0] = 1.0 / 0.0; },
    };
    for (const auto spoil : spoils) {
        T_MODEL_CONTENT c = Analysed();
        T_STATIC_DATA data = Numbers(c.model, 2, 1.0);
        spoil(data);
        c.staticResults[2] = MakeStaticResult(data);
        T_FILE_ERROR error;
        EXPECT_EQ(0, CModelStore().Save(folder.File("m.qmdb"), c, error));
    }
}
