// Hinge records of a model as hinges of the engine.
#include "hingesample.h"
#include "qm_rps/push/pushlaws.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace {

/// One member of 3 m in N and m: E I = 4e6 about both axes, so 6EI/L = 8e6.
void Fill(CDBDoc& doc, const T_PHGT_D& type, const std::vector<T_PHGE_D>& hinges,
          T_ELEM_D element = {1, 1, 2, 1, 1})
{
    T_STYP_D styp;
    styp.units = {FORCE_UNIT::N, LENGTH_UNIT::m};
    T_SECT_D section;
    section.area = 0.01, section.J = section.Iyy = section.Izz = 2e-5;
    section.Zy = section.Zz = 4e-4;
    T_MATL_D steel;
    steel.E = 2e11, steel.nu = 0.25, steel.Fy = 250e6;
    auto& edit = doc.Edit();
    ASSERT_EQ(1, edit.Begin("model"));
    ASSERT_EQ(1, edit.PutStyp(styp));
    EXPECT_EQ(2, edit.Put(1, T_NODE_D{1, {0, 0, 0}}) + edit.Put(2, T_NODE_D{2, {0, 0, 3}}));
    EXPECT_EQ(4,
              edit.Put(1, section) + edit.Put(1, steel) + edit.Put(1, type) + edit.Put(1, element));
    int key = 0;
    for (const T_PHGE_D& h : hinges)
        EXPECT_EQ(1, edit.Put(++key, h));
    ASSERT_EQ(1, edit.Commit());
}

T_SKEL_MULTI Flat(double pos, double neg)
{
    T_SKEL_MULTI m;
    m.autoYield = m.symmetric = false;
    m.sides.pos.P1 = pos, m.sides.neg.P1 = neg;
    return m;
}
T_PHGT_D Type(std::initializer_list<HINGE_COMPONENT> components, const T_SKEL_CURVE& curve,
              SKEL_TYPE skel = SKEL_TYPE::Bilinear)
{
    T_PHGT_D t;
    t.name = "T";
    for (const HINGE_COMPONENT c : components)
        At(t, c) = ComponentWith(skel, curve);
    return t;
}
T_PHGE_D Hinge()
{
    T_PHGE_D h;
    h.element = 1, h.hingeType = 1;
    return h;
}

/// The hinges, or what is wrong.
T_PUSH_HINGES Build(const T_PHGT_D& type, std::vector<T_PHGE_D> hinges, std::string& error,
                    T_ELEM_D element = {1, 1, 2, 1, 1}, const T_PUSH_LAW_OPTIONS& options = {})
{
    CDBDoc doc;
    Fill(doc, type, hinges, element);
    const int ids[] = {1};
    T_PUSH_HINGES out;
    error.clear();
    (void)BuildPushHinges(doc, ids, options, out, error);
    return out;
}

using enum HINGE_COMPONENT;

} // namespace

TEST(PushLaws, StandAtBothEndsWithTheSignsOfAnAnalysis)
{
    std::string error;
    T_PHGT_D type = Type({My, Mz, Fx}, Flat(300, 200));
    type.interaction = HINGE_INTERACTION::MyMz;
    const T_PUSH_HINGES h = Build(type, {Hinge()}, error);
    ASSERT_EQ(3u, h.hinges.size()) << error; // I, the middle (Fx once), J
    EXPECT_EQ(0.5, h.hinges[1].at);
    ASSERT_EQ(5u, h.laws.size());
    EXPECT_EQ("I", h.laws[0].end);
    EXPECT_EQ(Mz, h.laws[1].component);
    EXPECT_EQ("C", h.laws[2].end);
    EXPECT_EQ("J", h.laws[4].end);
    EXPECT_TRUE(h.hinges[0].biaxial && h.hinges[2].biaxial && !h.hinges[1].biaxial);
    EXPECT_EQ(300, h.hinges[0].laws[0].positive.points[0].force);
    EXPECT_EQ(200, h.hinges[0].laws[0].negative.points[0].force);
    T_PUSH_LAW_OPTIONS others;
    others.types = {2};
    EXPECT_TRUE(Build(type, {Hinge()}, error, {1, 1, 2, 1, 1}, others).hinges.empty());
    EXPECT_EQ("", error);
}

// An automatic My (+) compresses the side +z: an analysis prints this moment as negative.
TEST(PushLaws, AutomaticStrengthsComeFromTheGeneratedHinge)
{
    T_SKEL_MULTI curve = Flat(0, 0);
    curve.autoYield = true;
    T_PHGE_D h = Hinge();
    std::string error;
    // Z fy = 1e5 both ways: not stale.
    h.yield[4] = {1e5, 1e5};
    T_PUSH_HINGES out = Build(Type({My}, curve), {h}, error);
    ASSERT_EQ(2u, out.hinges.size()) << error;
    EXPECT_EQ(1e5, out.hinges[1].laws[0].positive.points[0].force);
    h.yield[4] = {9e4, 1e5};
    EXPECT_TRUE(Build(Type({My}, curve), {h}, error).hinges.empty());
    EXPECT_NE(std::string::npos, error.find("My(+) 90000, now 100000")) << error;
    h.yield[4] = {};
    EXPECT_TRUE(Build(Type({My}, curve), {h}, error).hinges.empty());
    EXPECT_NE(std::string::npos, error.find("--type \"T\" --elements 1")) << error;
}

// Pmax 1000; the entered strengths hold at no axial force. (+) is half of its largest at 500 of
// compression and at 250 of tension; (-) falls to nothing at 250 of compression.
TEST(PushLaws, InteractionGivesStrengthsByAxialForce)
{
    T_PHGT_D type = Type({My}, Flat(300, 200));
    type.interaction = HINGE_INTERACTION::User;
    T_PMM_TABLE& t = type.pmm.emplace();
    t.Pmax = 1000;
    t.negative.emplace();
    auto &pos = t.curves[0], &neg = (*t.negative)[0];
    pos.fill({-0.5, 0}), neg.fill({-0.5, 1});
    pos[0] = {1, 0}, pos[1] = {0.5, 0.5}, pos[2] = {0, 1}, pos[3] = {-0.25, 0.5};
    neg[0] = {1, 0}, neg[1] = {0.25, 0}, neg[2] = {0, 1};
    const double expected[][3] = {{-1000, 0, 0}, {-500, 150, 0},  {-250, 225, 0},
                                  {0, 300, 200}, {250, 150, 200}, {500, 0, 200}};
    const auto check = [&](const T_PHGT_D& of, bool mirrored) {
        std::string error;
        const T_PUSH_HINGES h = Build(of, {Hinge()}, error);
        ASSERT_EQ(2u, h.hinges.size()) << error;
        const auto& rows = h.hinges[0].laws[0].byAxial;
        ASSERT_EQ(6u, rows.size());
        for (std::size_t i = 0; i < rows.size(); ++i) {
            EXPECT_NEAR(expected[i][0], rows[i].axial, 1e-9) << i;
            EXPECT_NEAR(expected[i][mirrored ? 2 : 1], rows[i].positive, 1e-9) << i;
            EXPECT_NEAR(expected[i][mirrored ? 1 : 2], rows[i].negative, 1e-9) << i;
        }
    };
    check(type, false);
    // The same as a yield surface, whose My (+) compresses +z: it is what an analysis calls (-).
    T_PHGT_D surface = type;
    surface.interaction = HINGE_INTERACTION::PMM;
    T_YIELD_LEVEL& level = surface.yieldSurface.emplace().yield;
    level.compression = 1000;
    level.y.momentMax = {300, 200};
    std::copy_n(pos.begin(), 10, level.y.curves.pos.begin());
    std::copy_n(neg.begin(), 10, level.y.curves.neg.begin());
    check(surface, true);
    for (T_PM_POINT& p : level.y.curves.neg)
        p.m = -p.m; // with the sign of its side
    check(surface, true);
    level.y.curves.neg[4].m = 0.5; // of both signs
    std::string why;
    EXPECT_TRUE(Build(surface, {Hinge()}, why).hinges.empty());
    EXPECT_NE(std::string::npos, why.find("element 1, type \"T\", My I: strengths by axial"))
        << why;
    type.pmm.reset();
    std::string error;
    EXPECT_TRUE(Build(type, {Hinge()}, error).hinges.empty());
    EXPECT_NE(std::string::npos, error.find("there is no interaction curve")) << error;
}

TEST(PushLaws, RefuseWhatDoesNotFitNamingElementTypeAndComponent)
{
    const T_PHGT_D my = Type({My}, Flat(300, 200));
    T_PHGT_D truss = Type({My}, Flat(1, 1)), shear = Type({Fy, Fz}, Flat(1, 1));
    truss.element = HINGE_ELEMENT::Truss;
    shear.interaction = HINGE_INTERACTION::VyVz;
    T_ELEM_D beam{1, 1, 2, 1, 1}, released = beam, bar = beam;
    released.release.J[4] = true;
    bar.kind = ELEM_KIND::Truss;
    T_SKEL_MULTI softens = Flat(300, 200), trilinear = Flat(300, 200);
    softens.sides.neg.alpha1 = -0.5;
    for (T_SKEL_MULTI_SIDE* side : {&trilinear.sides.pos, &trilinear.sides.neg})
        side->P2 = 400, side->alpha1 = 0.3, side->alpha2 = -0.1;
    T_SKEL_FEMA disordered;
    disordered.autoYield = false;
    disordered.sides.pos.IO = 6, disordered.sides.pos.LS = 4, disordered.sides.pos.CP = 7;
    T_SKEL_FEMA byAxial; // in the curve of one axial force only
    byAxial.autoYield = false, byAxial.multiCurve = true;
    byAxial.curves.resize(2);
    byAxial.curves[1].axial = 1, byAxial.curves[1].sides.pos.LS = 2;
    const struct {
        T_PHGT_D type;
        std::vector<T_PHGE_D> hinges;
        T_ELEM_D element;
        const char* text;
    } cases[] = {
        {my, {Hinge(), Hinge()}, beam, "element 1, type \"T\", My I: another hinge"},
        {my, {Hinge()}, released, "element 1, type \"T\", My J: the element is released"},
        {my, {Hinge()}, bar, "another kind of element"},
        {truss, {Hinge()}, bar, "does not have this component"},
        {shear, {Hinge()}, beam, "Vy-Vz"},
        {Type({My}, Flat(300, 0)), {Hinge()}, beam, "the strength of the side (-)"},
        {Type({My}, softens), {Hinge()}, beam, "My I: sides.neg.alpha1: "},
        {Type({My}, trilinear, SKEL_TYPE::Trilinear), {Hinge()}, beam, "sides.pos.alpha2: "},
        {Type({My}, disordered, SKEL_TYPE::Fema),
         {Hinge()},
         beam,
         "My I: sides.pos.LS: Hinge properties of component My are wrong. This rule is not kept: "
         "IO <= LS."},
        {Type({My}, byAxial, SKEL_TYPE::Fema), {Hinge()}, beam, "curves[1].sides.pos.CP: "},
    };
    for (const auto& c : cases) {
        std::string error;
        EXPECT_TRUE(Build(c.type, c.hinges, error, c.element).hinges.empty()) << c.text;
        EXPECT_NE(std::string::npos, error.find(c.text)) << error;
    }
}
