// What a person most likely did not mean: refused, or said in words, when models are made.
#include "qm_rps/curvewizarddlg.h"
#include "qm_rps/frameguidedlg.h"
#include "qm_rps/storeyguidedlg.h"

#include "qm_rps/create/numberlist.h"
#include "qm_rps/create/spectrumtext.h"
#include "qm_rps/create/spectrumvalues.h"
#include "qm_rps/push/casegenerator.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

bool Has(const std::string& text, const char* part)
{
    return text.find(part) != std::string::npos;
}

T_CURVE_CASE TwoStoreys(const char* text, const char* columns = "V,d")
{
    T_CURVE_CASE in;
    in.curve.text = text;
    in.curve.columns = columns;
    in.units = {FORCE_UNIT::kN, LENGTH_UNIT::mm};
    in.massGiven = MASS_GIVEN::Tonnes;
    in.masses = {100.0, 100.0};
    in.heights = {3000.0, 3000.0};
    T_FINDING fault;
    EXPECT_TRUE(ParseSpectrum("ec8-2004:soil=C,ag=0.25", in.spectrum, fault));
    return in;
}

/// Why it is refused; else its notes.
std::string Outcome(const T_CURVE_CASE& in)
{
    T_MODEL_CONTENT content;
    T_CURVE_FACTS facts;
    T_FINDING fault;
    if (!MakeCurveCase(in, content, facts, fault)) return fault.text;
    std::string notes = "made";
    for (const std::string& note : CurveCaseNotes(in, facts))
        notes += "\n" + note;
    return notes;
}

} // namespace

TEST(NumberList, RefusesACommaThatMayBeTwoThings)
{
    std::string why;
    for (const char* const text : {"3,5 3 3", "2x4,5", "3x3,5 4", "5, 5,4", " 2 4,5 "}) {
        EXPECT_FALSE(ParseNumberList(text, why)) << text;
        EXPECT_TRUE(Has(why, "two ways")) << why;
    }
    using L = std::vector<double>;
    const std::pair<const char*, L> plain[] = {{" 3,5 ", {3.0, 5.0}},
                                               {"3.5,3 4", {3.5, 3.0, 4.0}},
                                               {"2x4,3x5", {4.0, 4.0, 5.0, 5.0, 5.0}},
                                               {"2x4, 5", {4.0, 4.0, 5.0}},
                                               {"5,2x4", {5.0, 4.0, 4.0}},
                                               {"2x4,5;3", {4.5, 4.5, 3.0}}};
    for (const auto& [text, numbers] : plain)
        EXPECT_EQ(numbers, ParseNumberList(text, why)) << text << why;
}

TEST(NewFrame, RefusesWhatNobodyMeans)
{
    using D = CFrameGuideDlg;
    const std::tuple<const char*, const char*, std::function<void(D&)>> rows[] = {
        {"massLive", "from 0 to 1", [](D& d) { d.m_building.liveInMass = 30.0; }},
        {"dead", "finite", [](D& d) { d.m_building.dead = std::nan(""); }},
        {"dead", "negative", [](D& d) { d.m_building.dead = -1.0; }},
        {"braceBays", "twice",
         [](D& d) { d.m_building.braces = BUILDING_BRACES::Cross, d.m_braceBays = "x1, X1"; }},
        {"grade.columns", "S355", [](D& d) { d.m_building.columns = "HEB 200"; }},
        // 101 x 101 x 21 = 214221
        {"storeys", "214221", [](D& d) { d.m_baysX = d.m_baysY = "100x5", d.m_storeys = "20x3"; }},
    };
    for (const auto& [field, words, spoil] : rows) {
        CDBDoc doc;
        CFrameGuideDlg dialog(doc);
        spoil(dialog);
        dialog.OnChange();
        ASSERT_FALSE(dialog.Findings().empty()) << words;
        EXPECT_EQ(field, dialog.Findings().front().field);
        EXPECT_TRUE(Has(dialog.Findings().front().text, words)) << dialog.Findings().front().text;
    }
}

TEST(NewFrame, SaysThatItsUnitsLookWrong)
{
    const std::tuple<LENGTH_UNIT, const char*, const char*, bool> rows[] = {
        {LENGTH_UNIT::m, "2x6", "3.5, 3", false},
        {LENGTH_UNIT::mm, "2x6", "3000", true}, // a building of 12 mm
        {LENGTH_UNIT::m, "6", "1.4", true},
        {LENGTH_UNIT::mm, "6000", "20001", true},
        {LENGTH_UNIT::ft, "20", "10", false}};
    for (const auto& [length, bays, storeys, isOdd] : rows) {
        CDBDoc doc;
        CFrameGuideDlg dialog(doc);
        dialog.m_building.units.length = length;
        dialog.m_building.columns = dialog.m_building.beams = length == LENGTH_UNIT::mm //
                                                                  ? "400x400"
                                                                  : "0.4x0.4";
        dialog.m_baysX = bays;
        dialog.m_baysY = "";
        dialog.m_storeys = storeys;
        dialog.OnChange();
        EXPECT_EQ(isOdd, Has(dialog.NotesText(), "check the units")) << dialog.NotesText();
    }
}

TEST(NewFrame, SaysWhichModeItsPushesTake)
{
    CDBDoc doc;
    CFrameGuideDlg dialog(doc); // one storey, a plane frame: one sway mode with all of the mass
    dialog.m_baysX = "5";
    dialog.m_baysY = "";
    dialog.m_storeys = "3";
    dialog.m_modes = 1;
    dialog.OnChange();
    ASSERT_TRUE(dialog.OnOK());
    EXPECT_TRUE(dialog.IsWhole());
    EXPECT_TRUE(Has(dialog.PushText(), "Mode along X: mode 1")) << dialog.PushText();
    T_CASE_BASIS basis;
    basis.mode = {3, 1};
    for (const auto& [percent, isLow] : {std::pair(49.9, true), {50.0, false}}) {
        basis.massPercent = {percent, 80.0};
        EXPECT_EQ(isLow, HasLowMass(basis));
        EXPECT_EQ(isLow, Has(ModeBasisText(basis), "Along X less than half")) << percent;
        EXPECT_FALSE(Has(ModeBasisText(basis), "Along Y less"));
    }
}

TEST(CurveCase, ReadsTheUnitsOfTheHeader)
{
    const std::tuple<const char*, const char*, const char*> rows[] = {
        {"V (kN)\td (mm)\n0\t0\n72\t3.6\n720\t36\n", "V,d", "made"},
        {"Base shear in a step, d\n0\t0\n72\t3.6\n720\t36\n", "V,d", "made"}, // no inches
        {"V (kips) d (in)\n0 0\n72 3.6\n720 36\n", "V,d", "line 1: the header says \"kips\""},
        {"# x\nV [kN]; d [M]\n0;0\n72;3.6\n720;36\n", "V,d", "line 2: the header says \"m\""},
        {"V d\nkN cm\n0 0\n72 3.6\n720 36\n", "V,d", "line 2: the header says \"cm\""},
        {"V\tdrift (%)\n0\t0\n72\t0.6\n720\t1\n", "V,d", "line 1: a column in %"},
        {"V (kN)\tdrift (%)\td (mm)\n0\t0\t0\n72\t0.6\t3.6\n720\t1\t36\n", "V,-,d", "made"}};
    for (const auto& [text, columns, outcome] : rows) {
        const std::string is = Outcome(TwoStoreys(text, columns));
        EXPECT_TRUE(Has(is, outcome)) << text << is;
    }
}

TEST(CurveCase, RefusesAControlNodeThatIsNotTheTop)
{
    const std::pair<const char*, const char*> rows[] = {
        {"0 0 0 0\n72 3.6 1.8 3.59\n720 36 18 36\n", "made"}, // rounded
        {"0 0 0 0\n72 3.6 1.8 3.6\n720 36 18 40\n", "line 3: d is 36, d2 of the top storey 40"}};
    for (const auto& [text, outcome] : rows) {
        const std::string is = Outcome(TwoStoreys(text, "V,d,d1,d2"));
        EXPECT_TRUE(Has(is, outcome)) << is;
    }
}

TEST(CurveCase, RefusesWhatMayBeThousandsAndSaysWhatLooksOdd)
{
    T_CURVE_CASE in = TwoStoreys("V\td\n0\t0\n1,000\t1\n1,500\t2\n");
    EXPECT_TRUE(Has(Outcome(in), "\"1,000\" and all numbers like it"));
    in.curve.decimal = PASTED_DECIMAL::Comma;
    EXPECT_TRUE(Has(Outcome(in), "made"));
    in = TwoStoreys("V\td\n0\t0\n1.000\t0.125\n1.500\t2\n"); // 0.125 tells
    EXPECT_TRUE(Has(Outcome(in), "made"));
    in = TwoStoreys("0 0\n72 3.6\n720 36\n");
    in.shape = SHAPE_GIVEN::Typed;
    // (m + m/2)2 / (m + m/4) / 2m = 0.9; (-m/2 + m)2 / (m + m/4) / 2m = 0.1
    in.typedShape = {0.5, 1.0};
    EXPECT_FALSE(Has(Outcome(in), "effective mass ratio is below"));
    in.typedShape = {-0.5, 1.0};
    EXPECT_TRUE(Has(Outcome(in), "effective mass ratio is below"));
    EXPECT_FALSE(Has(Outcome(in), "ag is above"));
    std::get<T_SPFC_EURO2003>(in.spectrum.data).ag = 3.5;
    EXPECT_TRUE(Has(Outcome(in), "ag is above"));
}

TEST(SpectrumText, DoubtsOtherUnitsAndNamesTheTypedWord)
{
    const std::pair<const char*, bool> rows[] = {{"ec8-1994:soil=A,ag=1.5", false},
                                                 {"ec8-1994:soil=A,ag=1.6", true},
                                                 {"atc40:Ca=0.4,Cv=0.6", false},
                                                 {"atc40:Ca=4,Cv=6", true},
                                                 {"ntc:soil=C,SLV=0.26/2.36/0.35", false},
                                                 {"ntc:soil=C,SLV=2.6/2.36/0.35", true},
                                                 {"user:T=0/1,Sa=5/1", false},
                                                 {"user:T=0/1,Sa=10/1", true}};
    T_SPFC_D spectrum;
    T_FINDING fault;
    for (const auto& [text, isOdd] : rows) {
        ASSERT_TRUE(ParseSpectrum(text, spectrum, fault)) << fault.text;
        EXPECT_EQ(isOdd, !SpectrumDoubt(spectrum).empty()) << text;
    }
    EXPECT_FALSE(ParseSpectrum("ntc:soil=C,topography=T5,SLV=0.2/2.4/0.3", spectrum, fault));
    EXPECT_TRUE(Has(fault.text, "\"T5\"")) << fault.text;
    T_SPFC_USER table;
    EXPECT_FALSE(UserSpectrum("T Sa\n", table, fault));
    EXPECT_FALSE(Has(fault.text, "line 0")) << fault.text;
}

TEST(StoreyLevels, SayThatALevelMayBeTwoFloors)
{
    CDBDoc doc;
    T_MODEL_CONTENT content;
    const double heights[] = {0.0, 3.0, 3.4, 6.0};
    for (int id = 1; id <= 4; ++id)
        content.model.nodes[id] = {id, {0.0, 0.0, heights[id - 1]}, {}, {}};
    doc.Data().Assign(content);
    CStoreyGuideDlg dialog(doc);
    dialog.OnTolerance(0.4 + 1e-9); // 3 and 3.4 m
    EXPECT_EQ("", dialog.DoubtText());
    dialog.OnTolerance(3.2); // ground and first floor
    EXPECT_TRUE(Has(dialog.DoubtText(), "span 3 m")) << dialog.DoubtText();
    dialog.OnTolerance(std::nan(""));
    EXPECT_TRUE(Has(dialog.Findings().at(0).text, "finite"));
}
