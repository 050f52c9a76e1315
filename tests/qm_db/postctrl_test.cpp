#include "qm_db/dbdoc.h"
#include "qm_db/recordfacts.h"
#include "qm_db/storyload.h"

#include <gtest/gtest.h>

namespace {

/// Two storeys of 3 m and 4 m with two nodes each and unequal masses; node 30 is in no storey.
/// Two steps; SI, shown in kN and m.
T_MODEL_CONTENT TwoStoreys()
{
    T_MODEL_CONTENT c;
    T_MODEL& m = c.model;
    m.nodes[11] = {11, {0, 0, 3}, {1000, 1000, 0}, {}};
    m.nodes[12] = {12, {5, 0, 3}, {3000, 1000, 0}, {}};
    m.nodes[21] = {21, {0, 0, 7}, {4000, 1000, 0}, {}};
    m.nodes[22] = {22, {5, 0, 7}, {1000, 1000, 0}, {0, 1, 0, 0, 0, 0}};
    m.nodes[30] = {30, {9, 0, 7}, {8000, 8000, 8000}, {}};
    m.storeys[1] = {"1F", 3.0, {11, 12}};
    m.storeys[2] = {"2F", 4.0, {22, 21}};
    m.pushovers[1].name = "PX";
    c.results[1] = MakePushResult({{1, 2},
                                   {-100e3, -150e3},
                                   {{11, {0.012, -0.030}},
                                    {12, {0.020, -0.042}},
                                    {21, {0.040, -0.060}},
                                    {22, {0.030, -0.070}}}});
    return c;
}

} // namespace

TEST(PostCtrl, ReadsStepsInCurrentUnits)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = TwoStoreys();
    c.model.styp.units = {FORCE_UNIT::N, LENGTH_UNIT::mm};
    doc.Data().Assign(c);
    CPostCtrl& post = doc.Post();
    EXPECT_EQ(0, post.SelectPushover(2));
    ASSERT_EQ(1, post.SelectPushover(1));
    EXPECT_EQ(2, post.GetStepCount());
    double value = -1.0;
    EXPECT_EQ(0, post.GetReacNew(value)); // no step chosen yet
    EXPECT_EQ(0, post.GetDispNew(11, value));
    EXPECT_EQ(0, post.SelectStep(0));
    EXPECT_EQ(0, post.SelectStep(3));
    ASSERT_EQ(1, post.SelectStep(2));
    EXPECT_EQ(0, post.GetDispNew(30, value));
    EXPECT_FALSE(post.ExistNodePost(30));
    EXPECT_EQ(-1.0, value);
    ASSERT_EQ(1, post.GetReacNew(value));
    EXPECT_DOUBLE_EQ(-150e3, value);
    ASSERT_EQ(1, post.GetStepFactor_PO(value));
    EXPECT_EQ(2.0, value);
    ASSERT_EQ(1, post.GetDispNew(11, value));
    EXPECT_DOUBLE_EQ(-30.0, value);
}

// Step 1 by hand. Pairs: 1F 0.012/3 and 0.020/3 on the ground, 2F 0.028/4 and 0.010/4.
// Centres of mass: 1F (1*0.012 + 3*0.020)/4 = 0.018, 2F (4*0.040 + 1*0.030)/5 = 0.038; drifts
// 0.006 and 0.005. Step 2: pairs 0.010, 0.014, 0.0075, 0.007; centres -0.039 and -0.062, drifts
// 0.013 and 0.00575.
TEST(PostCtrl, StoreyDriftIsByNodePairsAndByCentreOfMass)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = TwoStoreys();
    c.model.styp.units = {FORCE_UNIT::kips, LENGTH_UNIT::in}; // a ratio has no unit
    const auto expect = [&](int done, int push, int step, double byPair, double byCentre) {
        doc.Data().Assign(c);
        double kind1 = -1.0, kind2 = -1.0;
        EXPECT_EQ(done, doc.Post().GetPushoverStoryDriftRatio(push, step, kind1, kind2)) << step;
        EXPECT_NEAR(byPair, kind1, 1e-15);
        EXPECT_NEAR(byCentre, kind2, 1e-15);
    };
    expect(1, 1, 1, 0.007, 0.006);
    expect(1, 1, 2, 0.014, 0.013);
    expect(0, 2, 1, -1.0, -1.0); // no such load case or step
    expect(0, 1, 0, -1.0, -1.0);
    expect(0, 1, 3, -1.0, -1.0);
    c.model.storeys[1].height = 6.0; // now the upper storey governs
    expect(1, 1, 1, 0.007, 0.005);
    c.model.nodes[21].xyz[0] = 2.5; // no node below it: against the mean 0.016 of the storey below
    expect(1, 1, 1, 0.006, 0.005);

    // Listed from top to bottom, drifts would be between the wrong levels.
    T_MODEL_CONTENT falls = c;
    for (auto& [id, node] : falls.model.nodes)
        node.xyz[2] = id / 10 == 2 ? 3.0 : 7.0;
    std::swap(c, falls);
    expect(0, 1, 1, -1.0, -1.0);
    EXPECT_EQ(1U, StoreyFindings(c.model).size());
    c.model.styp.plane = MODEL_PLANE::XY; // Z says nothing of the height
    expect(1, 1, 1, 0.006, 0.005);
    std::swap(c, falls);

    // A storey without results is not one that stands still: the drift is that of the next known
    // level over the height between.
    c.results[1] = MakePushResult({{1}, {1}, {{11, {0.012}}, {12, {0.012}}}});
    c.model.storeys[1].height = 30.0; // an unmoved second storey would govern
    expect(1, 1, 1, 0.0004, 0.0004);
    c.results[1] = MakePushResult({{1}, {1}, {{22, {-0.051}}}});
    expect(1, 1, 1, 0.0015, 0.0015);                            // 0.051 / (30 + 4)
    c.results[1] = MakePushResult({{1}, {1}, {{30, {0.012}}}}); // no storey is known
    expect(0, 1, 1, -1.0, -1.0);
    c.model.storeys.clear();
    expect(0, 1, 1, -1.0, -1.0);
}

// Three masses 2, 2, 1 (kN s2/m) and the shape 1, 2, 3 in X: L = 2 + 4 + 3 = 9,
// M = 2 + 8 + 9 = 19, total 5; factor 9/19, mass 100 * 81 / (19 * 5) per cent.
TEST(PostCtrl, ParticipationFollowsFromMassesUnlessRecorded)
{
    CDBDoc doc;
    T_MODEL_CONTENT c;
    for (int i = 1; i <= 3; ++i)
        c.model.nodes[i] = {i, {0, 0, 3.0 * i}, {i < 3 ? 2000.0 : 1000.0, 0, 0}, {}};
    c.model.modes[1].shape = {{1, {1}}, {2, {2}}, {3, {3}}};
    c.model.modes[2] = c.model.modes[1];
    c.model.modes[2].participation = T_DOF6{0.5};
    c.model.modes[2].massPercent = T_DOF6{80.0};
    doc.Data().Assign(c);
    T_MPAF_D factor;
    T_MPAM_D percent;
    EXPECT_EQ(2, doc.Post().GetNumEigvPost());
    ASSERT_EQ(1, doc.Post().GetEiMpafNeutral(1, factor));
    ASSERT_EQ(1, doc.Post().GetEiMpam(1, percent));
    EXPECT_DOUBLE_EQ(9.0 / 19.0, factor.factor[0]);
    EXPECT_DOUBLE_EQ(8100.0 / 95.0, percent.percent[0]);
    EXPECT_EQ(0.0, factor.factor[1]);
    ASSERT_EQ(1, doc.Post().GetEiMpafNeutral(2, factor));
    ASSERT_EQ(1, doc.Post().GetEiMpam(2, percent));
    EXPECT_EQ(0.5, factor.factor[0]);
    EXPECT_EQ(80.0, percent.percent[0]);
    EXPECT_EQ(0, doc.Post().GetEiMpafNeutral(3, factor));
    EXPECT_EQ(0, doc.Post().GetEiMpam(0, percent));
}

TEST(StoryLoad, MassesAreThoseOfListedNodesOnceAndFree)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = TwoStoreys();
    c.model.storeys[2].nodes = {22, 21, 99, 21}; // 99 is not in the model
    doc.Data().Assign(c);
    const std::vector<T_NODAL_MASS> masses = CStoryLoad(doc.Data()).Calc_Nodal_Mass();
    ASSERT_EQ(4U, masses.size()); // not 30, not 99, 21 once
    EXPECT_EQ(21, masses[2].node);
    EXPECT_EQ((std::array<double, 3>{4, 1, 0}), masses[2].mass);
    EXPECT_EQ((std::array<double, 3>{1, 0, 0}), masses[3].mass); // restrained in Y

    c.model.storeys.clear();
    doc.Data().Assign(c);
    EXPECT_EQ(5U, CStoryLoad(doc.Data()).Calc_Nodal_Mass().size());
}
