#include "qm_db/editscope.h"

#include <gtest/gtest.h>

namespace {

/// One node, one storey, one spectrum with its own gravity, in SI.
T_MODEL_CONTENT SmallModel()
{
    T_MODEL_CONTENT c;
    c.model.styp.units = {FORCE_UNIT::kN, LENGTH_UNIT::m};
    c.model.nodes[1] = {1, {0, 0, 3.048}, {1000, 1000, 1000}, {}};
    c.model.storeys[1] = {"1F", 3.048, {1}};
    c.model.spectra[1] = {"U", T_SPFC_USER{{0.0, 1.0}, {0.5, 0.5}, 9.8}};
    return c;
}

void PutNode(CDBDoc& doc, const T_NODE_D& node)
{
    ASSERT_EQ(1, doc.Edit().Begin("node"));
    ASSERT_EQ(1, doc.Edit().Put(node.id, node));
    ASSERT_EQ(1, doc.Edit().Commit());
}

} // namespace

TEST(EditData, StepsAreUndoneAndRedoneWhole)
{
    CDBDoc doc;
    doc.Data().Assign(SmallModel());
    const T_MODEL before = doc.Data().Model();

    ASSERT_EQ(1, doc.Edit().Begin("two things"));
    EXPECT_EQ(0, doc.Edit().Begin("nested"));
    ASSERT_EQ(1, doc.Edit().Put(1, T_NODE_D{1, {1, 2, 3}, {4, 5, 6}, {}})); // replaced twice:
    ASSERT_EQ(1, doc.Edit().Put(1, T_NODE_D{1, {7, 8, 9}, {4, 5, 6}, {}})); // order matters
    ASSERT_EQ(1, doc.Edit().Put(2, T_NODE_D{2, {0, 0, 6}, {}, {}}));
    ASSERT_EQ(1, doc.Edit().Erase<T_STOR_D>(1));
    EXPECT_EQ(0, doc.Edit().Erase<T_STOR_D>(1));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_EQ(0, doc.Edit().Commit());
    const T_MODEL after = doc.Data().Model();
    EXPECT_EQ(7.0, after.nodes.at(1).xyz[0]);
    EXPECT_TRUE(after.nodes.contains(2) && after.storeys.empty());
    EXPECT_TRUE(doc.Data().IsModified());

    EXPECT_EQ("two things", doc.Undo().UndoTitle());
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(before, doc.Data().Model());
    EXPECT_EQ(0, doc.Undo().Undo());
    ASSERT_EQ(1, doc.Undo().Redo());
    EXPECT_EQ(after, doc.Data().Model());
    EXPECT_EQ(0, doc.Undo().Redo());
}

TEST(EditData, ANewEditForgetsWhatWasUndoneAndAnEmptyStepDoesNot)
{
    CDBDoc doc;
    PutNode(doc, {2, {0, 0, 6}, {}, {}});
    ASSERT_EQ(1, doc.Undo().Undo());
    ASSERT_EQ(1, doc.Edit().Begin("nothing"));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_TRUE(doc.Undo().CanRedo() && !doc.Undo().CanUndo());
    PutNode(doc, {3, {0, 0, 9}, {}, {}});
    EXPECT_FALSE(doc.Undo().CanRedo());
}

TEST(EditScope, AnEditThatIsNotCommittedOrHasARefusedChangeIsTakenBack)
{
    CDBDoc doc;
    doc.Data().Assign(SmallModel());
    const T_MODEL before = doc.Data().Model();
    {
        CEditScope edit(doc, "left");
        ASSERT_EQ(1, edit.Put(1, T_NODE_D{1, {1, 1, 1}, {}, {}}));
        ASSERT_EQ(1, edit.Put(1, T_NODE_D{1, {2, 2, 2}, {}, {}}));
        ASSERT_EQ(1, edit.Put(2, T_NODE_D{2, {0, 0, 6}, {}, {}}));
        ASSERT_EQ(1, edit.Erase<T_STOR_D>(1));
    }
    {
        CEditScope edit(doc, "refused");
        ASSERT_EQ(1, edit.Put(2, T_NODE_D{2, {0, 0, 6}, {}, {}}));
        EXPECT_EQ(0, edit.Erase<T_NODE_D>(1)); // of the storey
        EXPECT_EQ(0, edit.Commit());
    }
    EXPECT_EQ(before, doc.Data().Model());
    EXPECT_FALSE(doc.Edit().IsOpen() || doc.Undo().CanUndo());
}

TEST(EditScope, AStepThatIsOpenIsJoinedOrLeftAlone)
{
    CDBDoc doc;
    doc.Data().Assign(SmallModel());
    CEditScope outer(doc, "outer");
    {
        CEditScope own(doc, "own");
        EXPECT_FALSE(own.IsOpen());
        EXPECT_EQ(0, own.Put(2, T_NODE_D{2, {0, 0, 6}, {}, {}}));
        EXPECT_EQ(0, own.Commit());
    }
    {
        CEditScope joined(doc, "joined", EDIT_STEP::Join);
        ASSERT_EQ(1, joined.Put(3, T_NODE_D{3, {0, 0, 9}, {}, {}}));
        ASSERT_EQ(1, joined.Commit());
    }
    EXPECT_FALSE(doc.Undo().CanUndo());
    ASSERT_EQ(1, outer.Commit());
    EXPECT_EQ("outer", doc.Undo().UndoTitle());
    EXPECT_FALSE(doc.Data().Model().nodes.contains(2));
    EXPECT_TRUE(doc.Data().Model().nodes.contains(3));
}

// A refused edit must not make the document ask to be saved.
TEST(EditData, RefusesWithoutAnOpenStepAndChangesNothing)
{
    CDBDoc doc;
    doc.Data().Assign(SmallModel());
    const long revision = doc.Data().Revision();
    EXPECT_EQ(0, doc.Edit().Put(9, T_NODE_D{}));
    EXPECT_EQ(0, doc.Edit().PutStyp({}));
    EXPECT_EQ(0, doc.Edit().Erase<T_NODE_D>(1));
    EXPECT_EQ(SmallModel().model, doc.Data().Model());
    EXPECT_FALSE(doc.Data().IsModified() || doc.Undo().CanUndo());
    EXPECT_EQ(revision, doc.Data().Revision());
}

TEST(EditData, ChangingUnitsChangesNoStoredValueAndEveryGivenOne)
{
    CDBDoc doc;
    doc.Data().Assign(SmallModel());
    ASSERT_EQ(1, doc.Edit().Begin("units"));
    ASSERT_EQ(1, doc.Edit().PutStyp({"", {FORCE_UNIT::kips, LENGTH_UNIT::ft}, 32.0}));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_DOUBLE_EQ(32.0 * 0.3048, *doc.Data().Model().styp.gravity);
    EXPECT_NEAR(32.17405, doc.Init().DefaultGravity(), 5e-6); // standard gravity in ft/s2
    T_NODE_D node;
    ASSERT_EQ(1, doc.Attr().GetNode(1, node));
    EXPECT_DOUBLE_EQ(10.0, node.xyz[2]);         // 3.048 m
    EXPECT_NEAR(0.06852177, node.mass[0], 5e-9); // 1000 kg in kip s2/ft (a slug is 14.59390 kg)
    T_SPFC_D spectrum;
    ASSERT_EQ(1, doc.Attr().GetSpfc(1, spectrum));
    EXPECT_DOUBLE_EQ(9.8 / 0.3048, *std::get<T_SPFC_USER>(spectrum.data).gravity);
    PutNode(doc, {2, {0, 0, 20}, {}, {}}); // values are taken in current units
    EXPECT_DOUBLE_EQ(6.096, doc.Data().Model().nodes.at(2).xyz[2]);
}
