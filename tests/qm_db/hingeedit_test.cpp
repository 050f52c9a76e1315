// Edits of hinges in a document: units, undo, deletion, members, conversion.
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

/// A quantity that is a power of force times a power of length.
struct T_QUANTITY {
    const char* what;
    double value;
    int force, length;
};

/// Of a force component and of a moment component: strength and deformation by the definition.
void AddCurves(const T_PHGT_D& t, bool plastic, std::vector<T_QUANTITY>& all)
{
    const bool rotation = t.definition == HINGE_DEFINITION::MomentRotation;
    for (const std::size_t i : {1U, 4U}) {
        const int moment = i == 4 ? 1 : 0;
        const int deform = rotation ? 1 - moment : -moment;
        const auto& curve = std::get<T_SKEL_FEMA>(t.components[i].curves.J);
        for (const T_SKEL_SIDE& side : {curve.sides.neg, curve.curves[0].sides.pos}) {
            all.push_back({"yield", side.yield, 1, moment});
            all.push_back({"yield deformation", side.yieldDeform, 0, deform});
            all.push_back({"C", side.C.deform, 0, plastic ? deform : 0});
            all.push_back({"LS", side.LS, 0, plastic ? deform : 0});
            all.push_back({"stiffness", side.userStiffness, 1, moment - deform});
            all.push_back({"strength of C", side.C.strength, 0, 0});
            all.push_back({"energy", side.energy[1], 0, 0});
        }
        all.push_back({"axial force", curve.curves[0].axial, 1, 0});
    }
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

} // namespace

// 2.5 of everything, entered in kip and inch, read in kN and mm: 1 kip = 4.4482216152605 kN.
TEST(HingeEdit, AStoredHingeKeepsItsMeaningInOtherUnits)
{
    CDBDoc doc;
    SetUnits(doc, {FORCE_UNIT::kips, LENGTH_UNIT::in});
    for (const int kind : {0, 1, 2, 3}) {
        T_PHGT_D type =
            TypeOf(static_cast<HINGE_DEFINITION>(kind / 2), static_cast<SKEL_MEASURE>(kind % 2));
        type.length.relative = kind == 3;
        Put(doc, kind + 1, type);
    }
    T_SECT_D sect;
    sect.size[0] = sect.area = sect.Iyy = sect.Zy = 2.5;
    T_MATL_D matl{"M", MATL_CLASS::Steel, 2.5, 2.5};
    T_PHGE_D hinge{1, 1, {{{2.5, 0}}}, {{{}, {}, {}, {}, {0, 2.5}}}};
    T_POLC_D push;
    push.control.emplace().maxTransDispl = 2.5;
    T_IEHP_D iehp;
    iehp.components[4].emplace().sides.pos.yield = 2.5;
    Put(doc, 1, sect);
    Put(doc, 1, matl);
    Put(doc, 1, hinge);
    Put(doc, 1, push);
    Put(doc, 1, iehp);
    SetUnits(doc, {FORCE_UNIT::kN, LENGTH_UNIT::mm});
    std::vector<T_QUANTITY> all;
    for (const int kind : {0, 1, 2, 3}) {
        T_PHGT_D t;
        ASSERT_EQ(1, doc.Attr().GetPhgt(kind + 1, t));
        AddCurves(t, kind % 2 == 1, all);
        all.insert(all.end(), {{"tension", t.yieldSurface->yield.tension, 1, 0},
                               {"moment of the surface", t.yieldSurface->yield.y.moment.neg, 1, 1},
                               {"Pmax", t.pmm->Pmax, 1, 0},
                               {"masonry strength", t.masonry->compStrength, 1, -2},
                               {"masonry height", t.masonry->Hp, 0, 1},
                               {"distribution", t.masonry->distribution, 0, 0},
                               {"hinge length", t.length.My.I, 0, kind == 3 ? 0 : 1},
                               {"span", t.length.span, 0, 1}});
    }
    ASSERT_TRUE(doc.Attr().GetSect(1, sect) && doc.Attr().GetMatl(1, matl) &&
                doc.Attr().GetPhge(1, hinge) && doc.Attr().GetPolc(1, push) &&
                doc.Attr().Get(1, iehp));
    all.insert(all.end(), {{"size", sect.size[0], 0, 1},
                           {"area", sect.area, 0, 2},
                           {"inertia", sect.Iyy, 0, 4},
                           {"modulus", sect.Zy, 0, 3},
                           {"E", matl.E, 1, -2},
                           {"nu", matl.nu, 0, 0},
                           {"crack force", hinge.crack[0].pos, 1, 0},
                           {"yield moment", hinge.yield[4].neg, 1, 1},
                           {"displacement", push.control->maxTransDispl, 0, 1},
                           {"inelastic hinge", iehp.components[4]->sides.pos.yield, 1, 1}});
    for (const T_QUANTITY& q : all)
        EXPECT_DOUBLE_EQ(2.5 * std::pow(4.4482216152605, q.force) * std::pow(25.4, q.length),
                         q.value)
            << q.what;
}

TEST(HingeEdit, ATypeInUseIsNotDeleted)
{
    CDBDoc doc;
    Put(doc, 3, TypeOf(HINGE_DEFINITION::MomentRotation, SKEL_MEASURE::Plastic));
    for (const auto& [key, element, type] : {std::array{1, 8, 3}, {2, 5, 3}, {3, 5, 3}, {4, 9, 4}})
        Put(doc, key, T_PHGE_D{element, type, {}, {}});
    const T_MODEL before = doc.Data().Model();
    doc.Data().SetModified(false);

    std::vector<int> users;
    ASSERT_EQ(1, doc.Edit().Begin("delete"));
    EXPECT_EQ(0, doc.Edit().ErasePhgt(3, users));
    EXPECT_EQ((std::vector<int>{5, 8}), users);
    EXPECT_EQ(users, doc.Attr().GetElemsByPhgt(3));
    EXPECT_EQ(0, doc.Edit().Erase<T_PHGT_D>(3)); // no way round
    EXPECT_EQ(0, doc.Edit().ErasePhgt(7, users));
    EXPECT_TRUE(users.empty());
    EXPECT_EQ(before, doc.Data().Model());
    EXPECT_FALSE(doc.Data().IsModified());
    for (const int key : {1, 2, 3})
        ASSERT_EQ(1, doc.Edit().Erase<T_PHGE_D>(key));
    EXPECT_EQ(1, doc.Edit().ErasePhgt(3, users));
    doc.Edit().Rollback();
    EXPECT_EQ(before, doc.Data().Model());
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
