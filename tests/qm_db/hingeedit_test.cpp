// Edits of hinges in a document: units, undo, deletion, members, conversion.
#include "qm_db/casefile/caseput.h"
#include "qm_db/dbdoc.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

/// Every quantity of one dimension for every record that has some, 2.5 in current units.
T_PHGT_D TypeOf(HINGE_DEFINITION definition, SKEL_MEASURE measure)
{
    T_PHGT_D type;
    type.name = "T";
    type.definition = definition;
    T_SKEL_SIDE side;
    side.yield = side.yieldDeform = side.C.deform = side.LS = side.userStiffness = 2.5;
    side.C.strength = side.energy[1] = 2.5;
    for (T_HINGE_COMPONENT& c : type.components) {
        T_SKEL_FEMA fema;
        fema.measure = measure;
        fema.sides = {side, side};
        fema.curves = {{2.5, {side, side}}};
        c.type = SKEL_TYPE::Fema;
        c.curves = {fema, fema};
    }
    type.yieldSurface.emplace().yield.tension = 2.5;
    type.yieldSurface->yield.y.moment.neg = 2.5;
    type.pmm.emplace().Pmax = 2.5;
    type.masonry.emplace();
    type.masonry->compStrength = type.masonry->Hp = type.masonry->distribution = 2.5;
    type.length.My.I = type.length.span = 2.5;
    return type;
}

double Factor(const T_UNITS& from, const T_UNITS& to, int force, int length)
{
    return std::pow(NewtonsPer(from.force) / NewtonsPer(to.force), force) *
           std::pow(MetresPer(from.length) / MetresPer(to.length), length);
}

struct T_EXPECTED { // powers of force and length
    int strength[2], deform[2];
};

// Components Fx to Fz and Mx to Mz.
constexpr T_EXPECTED kRotation[2] = {{{1, 0}, {0, 1}}, {{1, 1}, {0, 0}}};
constexpr T_EXPECTED kCurvature[2] = {{{1, 0}, {0, 0}}, {{1, 1}, {0, -1}}};

void ExpectConverted(const T_PHGT_D& t, const T_UNITS& a, const T_UNITS& b, bool plastic)
{
    const bool rotation = t.definition == HINGE_DEFINITION::MomentRotation;
    const auto f = [&](int force, int length) { return 2.5 * Factor(a, b, force, length); };
    for (std::size_t i = 0; i < 6; ++i) {
        const T_EXPECTED& e = rotation ? kRotation[i / 3] : kCurvature[i / 3];
        const auto& curve = std::get<T_SKEL_FEMA>(t.components[i].curves.J);
        const int measure = plastic ? e.deform[1] : 0;
        for (const T_SKEL_SIDE& side : {curve.sides.neg, curve.curves[0].sides.pos}) {
            EXPECT_DOUBLE_EQ(f(e.strength[0], e.strength[1]), side.yield);
            EXPECT_DOUBLE_EQ(f(0, e.deform[1]), side.yieldDeform);
            EXPECT_DOUBLE_EQ(f(0, measure), side.C.deform);
            EXPECT_DOUBLE_EQ(f(0, measure), side.LS);
            EXPECT_DOUBLE_EQ(f(e.strength[0], e.strength[1] - e.deform[1]), side.userStiffness);
            EXPECT_EQ(2.5, side.C.strength);
            EXPECT_EQ(2.5, side.energy[1]);
        }
        EXPECT_DOUBLE_EQ(f(1, 0), curve.curves[0].axial);
    }
    EXPECT_DOUBLE_EQ(f(1, 0), t.yieldSurface->yield.tension);
    EXPECT_DOUBLE_EQ(f(1, 1), t.yieldSurface->yield.y.moment.neg);
    EXPECT_DOUBLE_EQ(f(1, 0), t.pmm->Pmax);
    EXPECT_DOUBLE_EQ(f(1, -2), t.masonry->compStrength);
    EXPECT_DOUBLE_EQ(f(0, 1), t.masonry->Hp);
    EXPECT_EQ(2.5, t.masonry->distribution);
    EXPECT_DOUBLE_EQ(t.length.relative ? 2.5 : f(0, 1), t.length.My.I);
    EXPECT_DOUBLE_EQ(f(0, 1), t.length.span);
}

void SetUnits(CDBDoc& doc, const T_UNITS& units)
{
    T_STYP_D styp;
    styp.units = units;
    ASSERT_EQ(1, doc.Edit().Begin("units"));
    ASSERT_EQ(1, doc.Edit().PutStyp(styp));
    ASSERT_EQ(1, doc.Edit().Commit());
}

template <class T>
void Put(CDBDoc& doc, int key, const T& record)
{
    ASSERT_EQ(1, doc.Edit().Begin("put"));
    ASSERT_EQ(1, doc.Edit().Put(key, record));
    ASSERT_EQ(1, doc.Edit().Commit());
}

T_UNITS UnitsOf(int i)
{
    return {static_cast<FORCE_UNIT>(i % 7), static_cast<LENGTH_UNIT>(i / 7)};
}

std::string BodyOf(const T_PHGT_D& type)
{
    CJsonWriter out(kSiUnits);
    CCasePut put(out);
    out.BeginObject();
    CaseFields(put, type);
    out.EndObject();
    EXPECT_FALSE(out.Failed()) << out.Error().text;
    return out.TakeText();
}

} // namespace

// Entered in one unit system, read in another one: all 35 x 35 pairs.
TEST(HingeEdit, AStoredHingeKeepsItsMeaningInAllPairsOfUnits)
{
    CDBDoc doc;
    for (int a = 0; a < 35; ++a) {
        SetUnits(doc, UnitsOf(a));
        for (const int kind : {0, 1, 2, 3}) {
            T_PHGT_D type = TypeOf(static_cast<HINGE_DEFINITION>(kind / 2),
                                   static_cast<SKEL_MEASURE>(kind % 2));
            type.length.relative = kind == 3;
            Put(doc, kind + 1, type);
        }
        T_SECT_D given;
        given.size[0] = given.area = given.Iyy = given.Zy = 2.5;
        Put(doc, 1, given);
        Put(doc, 1, T_MATL_D{"M", MATL_CLASS::Steel, 2.5, 2.5});
        Put(doc, 1, T_PHGE_D{1, 1, {{{2.5, 0}}}, {{{}, {}, {}, {}, {0, 2.5}}}});
        T_POLC_D push;
        push.control.emplace().maxTransDispl = 2.5;
        Put(doc, 1, push);
        T_IEHP_D iehp;
        iehp.components[4].emplace().sides.pos.yield = 2.5;
        Put(doc, 1, iehp);
        for (int b = 0; b < 35; ++b) {
            SCOPED_TRACE(std::to_string(a) + " to " + std::to_string(b));
            SetUnits(doc, UnitsOf(b));
            for (const int kind : {0, 1, 2, 3}) {
                T_PHGT_D type;
                ASSERT_EQ(1, doc.Attr().GetPhgt(kind + 1, type));
                ExpectConverted(type, UnitsOf(a), UnitsOf(b), kind % 2 == 1);
            }
            const auto f = [&](int n, int l) { return 2.5 * Factor(UnitsOf(a), UnitsOf(b), n, l); };
            T_SECT_D sect;
            T_MATL_D matl;
            T_PHGE_D hinge;
            ASSERT_TRUE(doc.Attr().GetSect(1, sect) && doc.Attr().GetMatl(1, matl) &&
                        doc.Attr().GetPhge(1, hinge) && doc.Attr().GetPolc(1, push) &&
                        doc.Attr().Get(1, iehp));
            EXPECT_DOUBLE_EQ(f(0, 1), sect.size[0]);
            EXPECT_DOUBLE_EQ(f(0, 2), sect.area);
            EXPECT_DOUBLE_EQ(f(0, 4), sect.Iyy);
            EXPECT_DOUBLE_EQ(f(0, 3), sect.Zy);
            EXPECT_DOUBLE_EQ(f(1, -2), matl.E);
            EXPECT_EQ(2.5, matl.nu);
            EXPECT_DOUBLE_EQ(f(1, 0), hinge.crack[0].pos);
            EXPECT_DOUBLE_EQ(f(1, 1), hinge.yield[4].neg);
            EXPECT_DOUBLE_EQ(f(0, 1), push.control->maxTransDispl);
            EXPECT_DOUBLE_EQ(f(1, 1), iehp.components[4]->sides.pos.yield);
            if (testing::Test::HasFailure()) return;
        }
    }
}

TEST(HingeEdit, EveryRecordIsPutErasedAndUndone)
{
    CDBDoc doc;
    const T_MODEL blank = doc.Data().Model();
    ASSERT_EQ(1, doc.Edit().Begin("all"));
    ASSERT_EQ(1, doc.Edit().Put(1, T_MATL_D{}));
    ASSERT_EQ(1, doc.Edit().Put(1, T_SECT_D{}));
    ASSERT_EQ(1, doc.Edit().Put(1, T_ELEM_D{1, 1, 2, 1, 1, 0}));
    ASSERT_EQ(1, doc.Edit().Put(1, TypeOf({}, {})));
    ASSERT_EQ(1, doc.Edit().Put(1, T_PHGE_D{1, 2, {}, {}}));
    ASSERT_EQ(1, doc.Edit().Put(1, T_IEHP_D{}));
    ASSERT_EQ(1, doc.Edit().Put(1, T_POFC_D{"f", {0, 1}, {0, 1}}));
    ASSERT_EQ(1, doc.Edit().Commit());
    const T_MODEL full = doc.Data().Model();
    EXPECT_EQ(1U, full.hingeTypes.size() * full.hinges.size() * full.elements.size());
    T_SECT_D sect;
    T_MATL_D matl;
    EXPECT_EQ(1, doc.Attr().GetSectMatlByElem(1, sect, matl));

    ASSERT_EQ(1, doc.Edit().Begin("erase"));
    EXPECT_EQ(0, doc.Edit().Erase<T_MATL_D>(1)); // the element uses it
    EXPECT_EQ(0, doc.Edit().Erase<T_ELEM_D>(1)); // the hinge uses it
    ASSERT_EQ(1, doc.Edit().Erase<T_PHGE_D>(1));
    ASSERT_EQ(1, doc.Edit().Erase<T_ELEM_D>(1));
    ASSERT_EQ(1, doc.Edit().Erase<T_MATL_D>(1));
    ASSERT_EQ(1, doc.Edit().Erase<T_PHGT_D>(1));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_TRUE(doc.Data().Model().hingeTypes.empty());
    EXPECT_EQ(0, doc.Attr().GetSectMatlByElem(1, sect, matl));
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(full, doc.Data().Model());
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(blank, doc.Data().Model());
    ASSERT_EQ(1, doc.Undo().Redo());
    EXPECT_EQ(full, doc.Data().Model());
}

TEST(HingeEdit, ATypeInUseIsNotDeletedAndStaysByteForByte)
{
    CDBDoc doc;
    Put(doc, 3, TypeOf(HINGE_DEFINITION::MomentRotation, SKEL_MEASURE::Plastic));
    Put(doc, 1, T_PHGE_D{8, 3, {}, {}});
    Put(doc, 2, T_PHGE_D{5, 3, {}, {}});
    Put(doc, 3, T_PHGE_D{5, 3, {}, {}});
    Put(doc, 4, T_PHGE_D{9, 4, {}, {}});
    const std::string before = BodyOf(doc.Data().Model().hingeTypes.at(3));
    doc.Data().SetModified(false);

    std::vector<int> users;
    ASSERT_EQ(1, doc.Edit().Begin("delete"));
    EXPECT_EQ(0, doc.Edit().ErasePhgt(3, users));
    EXPECT_EQ((std::vector<int>{5, 8}), users);
    EXPECT_EQ(users, doc.Attr().GetElemsByPhgt(3));
    EXPECT_EQ(0, doc.Edit().Erase<T_PHGT_D>(3)); // no way round
    EXPECT_EQ(0, doc.Edit().ErasePhgt(7, users));
    EXPECT_TRUE(users.empty());
    EXPECT_EQ(before, BodyOf(doc.Data().Model().hingeTypes.at(3)));
    EXPECT_FALSE(doc.Data().IsModified());
    for (const int key : {1, 2, 3})
        ASSERT_EQ(1, doc.Edit().Erase<T_PHGE_D>(key));
    EXPECT_EQ(1, doc.Edit().ErasePhgt(3, users));
    doc.Edit().Rollback();
    EXPECT_EQ(before, BodyOf(doc.Data().Model().hingeTypes.at(3)));
    EXPECT_EQ(4U, doc.Data().Model().hinges.size());
}

TEST(HingeEdit, InelasticHingesBecomeTypesAndComeBack)
{
    T_IEHP_D iehp, back;
    iehp.components[4].emplace().sides.neg.IO = -3.0;
    T_PHGT_D type;
    EXPECT_EQ(0, CAttrCtrl::Convert_IehpToPhgt_FEMA(iehp, 6, type));
    EXPECT_EQ(T_PHGT_D{}, type);
    ASSERT_EQ(1, CAttrCtrl::Convert_IehpToPhgt_FEMA(iehp, 4, type));
    ASSERT_EQ(1, CAttrCtrl::Convert_PhgtToIehp_FEMA(type, 4, back));
    EXPECT_EQ(iehp.components, back.components);
    const T_IEHP_D before = back;
    EXPECT_EQ(0, CAttrCtrl::Convert_PhgtToIehp_FEMA(type, 3, back)); // no FEMA curve
    EXPECT_EQ(before, back);
}
