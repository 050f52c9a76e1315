// Hinges, and what they refer to, in the case file and in the model file.
#include "casetext.h"
#include "numbers.h"

#include "qm_base/msgfunction.h"
#include "qm_db/records/hingetype.h"

#include <gtest/gtest.h>

namespace {

std::string RichText()
{
    return CaseText("hinge_all_members.json");
}

T_HINGE_COMPONENT& Component(T_MODEL_CONTENT& content, HINGE_COMPONENT c)
{
    return content.model.hingeTypes.at(1).components[static_cast<std::size_t>(c)];
}

T_SKEL_FEMA& FemaI(T_MODEL_CONTENT& content)
{
    return std::get<T_SKEL_FEMA>(Component(content, HINGE_COMPONENT::My).curves.I);
}

} // namespace

TEST(HingeCase, TheTextOfEveryMemberComesBackLetterForLetter)
{
    const T_MODEL_CONTENT content = ParseGood(RichText());
    EXPECT_EQ(RichText(), PrintGood(content));
    ExpectRoundTrips(content, "rich");
}

// 1 in = 0.0254 m, 1 kip = 4448.2216152605 N.
TEST(HingeCase, ReadsMembersIntoTheirFieldsInSi)
{
    T_MODEL_CONTENT content = ParseGood(RichText());
    const T_MODEL& m = content.model;
    constexpr double kip = 4448.2216152605, in = 0.0254;
    EXPECT_DOUBLE_EQ(29000 * kip / in / in, m.materials.at(1).E);
    EXPECT_EQ(MATL_CLASS::Concrete, m.materials.at(3).type); // its stated key
    EXPECT_DOUBLE_EQ(284 * in * in * in * in, m.sections.at(1).Iyy);
    EXPECT_DOUBLE_EQ(1.56 * in * in, m.sections.at(2).bars[1].area);

    const T_SKEL_FEMA& my = FemaI(content); // a curvature hinge: 1 / length
    EXPECT_DOUBLE_EQ(1200 * kip * in, my.sides.pos.yield);
    EXPECT_DOUBLE_EQ(-0.0002 / in, my.sides.neg.yieldDeform);
    EXPECT_DOUBLE_EQ(3e6 * kip * in * in, my.sides.pos.userStiffness);
    const auto& other = std::get<T_SKEL_FEMA>(Component(content, HINGE_COMPONENT::My).curves.J);
    EXPECT_EQ(1.0, other.sides.pos.B.deform); // D / Dy
    const T_HINGE_COMPONENT& fx = Component(content, HINGE_COMPONENT::Fx);
    EXPECT_EQ(0.001, std::get<T_SKEL_MULTI>(fx.curves.I).sides.pos.D1); // a strain

    const T_PHGT_D& type = m.hingeTypes.at(1);
    EXPECT_DOUBLE_EQ(210 * kip * in, type.yieldSurface->crack->y.momentMax.neg);
    EXPECT_EQ((std::array<double, 6>{7 * in, 8 * in, 0, 0, 0, 0}), type.length.components.J);
    EXPECT_DOUBLE_EQ(0.1 * kip / in / in, type.masonry->shearStrength);
    EXPECT_EQ(0.1, m.hingeTypes.at(5).length.My.I); // a fraction of the member length
    EXPECT_DOUBLE_EQ(0.5 * in, m.inelasticHinges.at(1).components[1]->sides.pos.C.deform);

    const T_POLC_D& run = m.pushovers.at(1);
    EXPECT_EQ((T_POLC_CONTROL{0, 2, 1, 0.1, true, 2.5, false, -4 * in, 8 * in}), *run.control);
}

// What stands beside "positive": {"gap": 4} of a slip curve, and the gap of the negative side, in.
TEST(HingeCase, ASymmetricCurveWithoutANegativeSideHasTheGapOnBoth)
{
    const struct {
        const char *before, *after;
        double gap;
    } kCases[] = {{"", "", 4},
                  {"", ", \"negative\": {}", 0},
                  {"", ", \"negative\": {\"gap\": 3}", 3},
                  {"\"symmetric\": false, ", "", 0}};
    for (const auto& c : kCases) {
        const T_MODEL_CONTENT content = ParseGood(
            std::string(R"({"format": "qm-rps case 1", "units": {"force": "kips", "length": "in"},
            "nodes": [], "hinge_types": [{"name": "T", "element": "beam-column",
            "components": {"Fx": {"type": "slip bilinear", "curve": {)") +
            c.before + R"("positive": {"gap": 4})" + c.after + "}}}}]}");
        const auto& curve = content.model.hingeTypes.at(1).components[0].curves.I;
        EXPECT_DOUBLE_EQ(c.gap * 0.0254, std::get<T_SKEL_MULTI>(curve).sides.neg.gap) << c.after;
        ExpectRoundTrips(content, c.after);
    }
}

TEST(HingeCase, EveryChoiceOfEveryListComesBack)
{
    T_MODEL_CONTENT content = ParseGood(RichText());
    for (int i = 0; i < 7; ++i) {
        T_PHGT_D& type = content.model.hingeTypes.at(1);
        content.model.materials.at(1).type = static_cast<MATL_CLASS>(i % 4);
        content.model.sections.at(1).shape = static_cast<SECT_SHAPE>(i % 6);
        type.element = static_cast<HINGE_ELEMENT>(i);
        type.definition = static_cast<HINGE_DEFINITION>(i % 3);
        type.interaction = static_cast<HINGE_INTERACTION>(i % 5);
        type.material = static_cast<MATL_CLASS>(i % 4);
        T_SKEL_FEMA& fema = FemaI(content);
        fema.measure = static_cast<SKEL_MEASURE>(i % 2);
        fema.initStiffness = static_cast<INIT_STIFFNESS>(i % 5);
        fema.unloadType = static_cast<UNLOAD_TYPE>(i % 5);
        T_HINGE_COMPONENT& fz = Component(content, HINGE_COMPONENT::Fz);
        fz.type = static_cast<SKEL_TYPE>(i);
        fz.location = static_cast<HINGE_LOCATION>(1 + i % 4);
        fz.active = i % 2 == 0;
        fz.sameEnds = i % 3 == 0;
        fz.curves = {MakeSkelCurve(fz.type), MakeSkelCurve(fz.type)};
        if (auto* multi = std::get_if<T_SKEL_MULTI>(&fz.curves.I)) {
            multi->gapSides = static_cast<GAP_SIDES>(i % 3);
            multi->sides.neg.P1 = i;
        }
        ExpectRoundTrips(content, std::to_string(i));
    }
}

TEST(HingeCase, IsLosslessInEveryUnit)
{
    ExpectLosslessInEveryUnit(ParseGood(RichText()));
}

TEST(HingeCase, BadInputNamesThePlace)
{
    ExpectRefused(RichText(), "hinge_refusals.txt");
}

TEST(HingeCase, RefusesToStoreWhatCouldNotBeRead)
{
    T_MODEL_CONTENT content = ParseGood(RichText());
    FemaI(content).sides.pos.yield = kNan;
    const CTempFolder folder;
    const std::string path = folder.File("bad.qmdb");
    T_FILE_ERROR error;
    EXPECT_EQ(0, CModelStore().Save(path, content, error));
    const char* const place =
        "hinge_types 1 components.My.I.positive.yield: the value is not a finite number";
    EXPECT_EQ(zql::lib::MMSGFunction::Format("IDS_QM_DB_FILE_BAD_RECORD", {path, place}),
              error.text);
    EXPECT_TRUE(folder.Names().empty());
}

// What version 2 did not know has its default.
TEST(HingeCase, ATextWithOlderKeysHoldsTheSameModel)
{
    T_MODEL_CONTENT now = ParseGood(RichText());
    now.model.styp.defaultAlpha1 = now.model.styp.defaultAlpha2 = {};
    now.model.styp.report = {};
    for (auto& [key, type] : now.model.hingeTypes) {
        type.fibreSection = type.thicknessSection = 0;
        if (type.pmm) type.pmm->negative.reset(), type.pmm->balanced = false;
        for (T_HINGE_COMPONENT& c : type.components)
            for (T_SKEL_CURVE* curve : {&c.curves.I, &c.curves.J})
                if (auto* fema = std::get_if<T_SKEL_FEMA>(curve)) fema->compliance = true;
    }
    for (auto& [key, hinge] : now.model.hinges)
        hinge.crackJ = hinge.yieldJ = {};
    EXPECT_TRUE(SameContent(now, ParseGood(CaseText("hinge_old_keys.json"))));
}

// The model files were written by the program when it knew that version only, out of the texts.
TEST(HingeCase, FilesOfOlderVersionsOpenAndAreSavedAsTheCurrentVersion)
{
    const char* const texts[] = {"all_members.json", "hinge_old_keys.json",
                                 "struct_all_members.json", "stage_all_members.json"};
    const T_MODEL rich = ParseGood(RichText()).model;
    for (int version = 1; version <= 4; ++version) {
        SCOPED_TRACE(version);
        const CTempFolder folder;
        const std::string path = folder.File("model.qmdb");
        WriteBytes(path, BytesOf(QM_TEST_DATA "/model-v" + std::to_string(version) + ".qmdb"));
        ASSERT_EQ(version, BytesOf(path)[63]); // user_version, last byte
        T_MODEL_CONTENT content, again;
        T_FILE_ERROR error;
        CModelStore store;
        ASSERT_EQ(1, store.Open(path, OPEN_MODE::Edit, content, error)) << error.text;
        EXPECT_TRUE(SameContent(ParseGood(CaseText(texts[version - 1])), content));

        T_MODEL& m = content.model; // takes what its version could not hold
        m.hingeTypes = rich.hingeTypes;
        m.materials = rich.materials;
        m.pushovers[1].name = "PX";
        m.pushovers[1].control = T_POLC_CONTROL{};
        m.styp.gsd = m.styp.stageControl.cableSag = true;
        m.styp.plane = MODEL_PLANE::XZ;
        m.loadCases[1] = {"G", {0, 0, -1}, {}, {}, {}, {}, {}};
        m.stages[1] = {"S1", {{1}, {1}, {{1, -1}}}, {}, 2, 3.0};
        m.pushControl.steps = 7;
        ASSERT_EQ(1, store.Save(path, content, error)) << error.text;
        EXPECT_EQ(6, BytesOf(path)[63]);
        ASSERT_EQ(1, CModelStore::CheckWhole(path, error)) << error.text;
        ASSERT_EQ(1, CModelStore().Open(path, OPEN_MODE::ReadOnly, again, error)) << error.text;
        EXPECT_TRUE(SameContent(content, again));
    }
}
