#include "casetext.h"
#include "numbers.h"

#include "qm_base/textformat.h"
#include "qm_db/casefile/jsonnumber.h"

#include <random>

namespace {

const std::string& AllMembers()
{
    static const std::string text = CaseText("all_members.json");
    return text;
}

T_PUSH_DATA ResultOf(const T_MODEL_CONTENT& content, int push)
{
    T_PUSH_DATA data;
    std::string error;
    EXPECT_EQ(1, ReadWholeResult(*content.results.at(push), data, error)) << error;
    return data;
}

/// The refusal of a text; checks that it is one line, a fault of the input, and changes nothing.
std::string RefusalOf(const std::string& text)
{
    T_MODEL_CONTENT content;
    content.model.styp.title = "as it was";
    const T_MODEL before = content.model;
    T_FILE_ERROR error;
    EXPECT_EQ(0, CCaseFile::Parse(text, "case.json", "", content, error));
    EXPECT_EQ(FILE_FAULT::BadInput, error.fault);
    EXPECT_EQ(before, content.model);
    EXPECT_TRUE(content.results.empty());
    EXPECT_EQ(std::string::npos, error.text.find('\n')) << error.text;
    EXPECT_LT(error.text.size(), 400U);
    return error.text;
}

TEST(CaseFile, RefusesEachBadInputWithItsPlace)
{
    ExpectRefused(AllMembers(), "refusals.txt");
    std::string text = AllMembers(); // what may be left out, and 2.54e97 m
    for (const auto& [from, to] :
         {std::pair{"\"mass\": [2.6473775, 1.035643, 0.71607127], ", ""}, {"-0.5", "1e99"}})
        text.replace(text.find(from), std::string(from).size(), to);
    ParseGood(text);
}

TEST(CaseFile, NamesLineAndColumnOfTextThatIsNoJson)
{
    struct T_ROW {
        const char* label;
        std::string text;
        const char* start;
    };
    const T_ROW rows[] = {
        {"mark", "\xEF\xBB\xBF{}",
         "case.json: line 1, column 1: the text starts with a byte order"},
        {"not a number", "{\n \"gravity\": NaN}", "case.json: line 2, column 13: "},
        {"overflow", "{\"gravity\": 1e999}",
         "case.json: line 1, column 17: number overflow parsing '1e999'"},
        {"truncated", AllMembers().substr(0, 60), "case.json: line 3, column "},
        {"two documents", "{}\n{}", "case.json: line 2, column 1: "},
        {"a zero byte", std::string("{}\n\0{", 5), "case.json: line 2, column 1: a zero byte"},
        {"bad UTF-8", "{\"title\": \"\xff\"}", "case.json: line 1, column 12: "},
        {"no object", "[]", "case.json: expected an object, found an array"},
        {"a long text", '"' + std::string(100000, 'x'), "case.json: line 1, column 100001: "},
    };
    for (const T_ROW& row : rows)
        EXPECT_EQ(0U, RefusalOf(row.text).find(row.start)) << row.label << RefusalOf(row.text);
}

TEST(CaseFile, ConvertsToSi)
{
    // 1 kip = 4448.2216152605 N, 1 in = 0.0254 m; a mass is force * s2 / length.
    const T_MODEL_CONTENT content = ParseGood(AllMembers());
    const T_MODEL& m = content.model;
    const double kip = 4448.2216152605;
    EXPECT_NEAR(386.2 * 0.0254, m.styp.gravity.value(), 1e-12);
    EXPECT_NEAR(132.94 * 0.0254, m.nodes.at(2).xyz[2], 1e-12);
    EXPECT_NEAR(2.6473775 * kip / 0.0254, m.nodes.at(2).mass[0], 1e-6);
    EXPECT_NEAR(117.06 * 0.0254, m.storeys.at(2).height, 1e-12);
    EXPECT_NEAR(386.4 * 0.0254, std::get<T_SPFC_USER>(m.spectra.at(5).data).gravity.value(), 1e-12);
    const T_PUSH_DATA px = ResultOf(content, 1);
    EXPECT_NEAR(200 * kip, px.baseReaction[1], 1e-6);
    EXPECT_NEAR(2.5 * 0.0254, px.displacement.at(7)[1], 1e-12);
    EXPECT_EQ(1.1, px.loadFactor[2]);
    const T_PUSH_DATA rz = ResultOf(content, 2); // a moment and a rotation
    EXPECT_NEAR(1500 * kip * 0.0254, rz.baseReaction[0], 1e-6);
    EXPECT_EQ(0.01, rz.displacement.at(7)[0]);
}

TEST(CaseFile, PrintsTheTextThatItReadWhenThatIsInPrintedForm)
{
    EXPECT_EQ(AllMembers(), PrintGood(ParseGood(AllMembers())));
}

/// The shortest text of all doubles that are stored as the same value is not longer than the text
/// in the file, and up to 15 digits it is that text.
TEST(CaseFile, PrintsNoMoreDigitsThanTheFileHad)
{
    std::mt19937_64 random(7);
    for (int i = 0; i < 35000; ++i) {
        const T_UNITS units{static_cast<FORCE_UNIT>(i % 7), static_cast<LENGTH_UNIT>(i / 7 % 5)};
        const auto fraction = static_cast<double>(random() >> 11) * 0x1p-53;
        const double value = std::stod(FormatText("%.*e", 12 + i % 5, 1.0 + 9.0 * fraction));
        const std::string text = NumberText(value); // 13 to 17 digits
        const double si = ToSi(value, units, kDimMass);
        const std::string printed = SiText(si, units, kDimMass).value();
        EXPECT_EQ(si, ToSi(std::stod(printed), units, kDimMass));
        EXPECT_LE(printed.size(), text.size());
        if (text.size() <= 16) { // 15 digits and the point
            EXPECT_EQ(text, printed);
        }
    }
    EXPECT_EQ("100000", NumberText(100000));
    EXPECT_EQ("-0.00001", NumberText(-0.00001));
    EXPECT_EQ("1e-06", NumberText(1e-6));
    EXPECT_EQ("1e+15", NumberText(1e15));
    EXPECT_EQ("-0.0", NumberText(-0.0));
}

TEST(CaseFile, RefusesToPrintWhatCouldNotBeRead)
{
    struct T_ROW {
        const char* file;
        const char* message; // its beginning
        void (*spoil)(T_MODEL_CONTENT&);
    };
    const char *const all = "all_members.json", *const structure = "struct_all_members.json",
                      *const hinges = "hinge_all_members.json";
    const T_ROW rows[] = {
        {all, "nodes[1].xyz: item [1] is not a finite number",
         [](T_MODEL_CONTENT& c) { c.model.nodes.at(2).xyz[1] = kNan; }},
        {all, "nodes[0].xyz: item [0] is not a finite number", // 1.7e308 m is no number of inches
         [](T_MODEL_CONTENT& c) { c.model.nodes.at(1).xyz[0] = 1.7e308; }},
        {all, "modes[0]: mode numbers must run 1, 2, 3, ...: found 3",
         [](T_MODEL_CONTENT& c) {
             c.model.modes = {{3, c.model.modes.at(1)}};
         }},
        {all, "title: a text is not valid UTF-8",
         [](T_MODEL_CONTENT& c) { c.model.styp.title.assign(1, '\xff'); }},
        {all, "pushover[1].direction: no name for the value 6",
         [](T_MODEL_CONTENT& c) { c.model.pushovers.at(2).direction = 7; }},
        {all,
         "pushover[1].steps: the load case \"RZ\" has no results, which a case file can't leave",
         [](T_MODEL_CONTENT& c) { c.results.erase(2); }},
        {all, "pushover[0].steps.displacement.\"2\": 1 values, expected 2",
         [](T_MODEL_CONTENT& c) {
             c.results[1] = MakePushResult({{1, 2}, {3, 4}, {{2, {1}}, {7, {1, 2}}}});
         }},
        {structure, "elements[0].material: no name for the key 9",
         [](T_MODEL_CONTENT& c) { c.model.elements.at(1).material = 9; }},
        {structure, "combinations[1].items[0].case: no name for the key 2",
         [](T_MODEL_CONTENT& c) { c.model.combinations.at(2).items[0].key = 2; }},
        {structure, "ulf_constraints[0]", // without any bound
         [](T_MODEL_CONTENT& c) {
             c.model.ulfConstraints.at(1).upper = c.model.ulfConstraints.at(1).lower = {};
         }},
        {hinges, "hinge_types[0].components.Mx: a curve is not of the component's type",
         [](T_MODEL_CONTENT& c) { c.model.hingeTypes.at(1).components[3].type = SKEL_TYPE::Ec8; }},
        {hinges, "hinge_types[0].definition: no name for the value 3",
         [](T_MODEL_CONTENT& c) {
             c.model.hingeTypes.at(1).definition = static_cast<HINGE_DEFINITION>(3);
         }},
        {hinges, "materials[1].name: the name appears twice",
         [](T_MODEL_CONTENT& c) { c.model.materials.at(3).name = "A992"; }},
    };
    for (const T_ROW& row : rows) {
        T_MODEL_CONTENT content = ParseGood(CaseText(row.file));
        row.spoil(content);
        std::string text = "as it was";
        T_FILE_ERROR error;
        EXPECT_EQ(0, CCaseFile::Print(content, text, error)) << row.message;
        EXPECT_TRUE(error.text.starts_with(row.message)) << error.text;
        EXPECT_EQ(FILE_FAULT::BadInput, error.fault);
        EXPECT_EQ("as it was", text);
    }
}

} // namespace
