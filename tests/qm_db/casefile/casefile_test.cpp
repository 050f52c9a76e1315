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

/// The good case with one spot replaced; the first occurrence after `anchor`.
std::string Spoiled(const char* anchor, const char* from, const char* to)
{
    std::string text = AllMembers();
    const std::size_t at = text.find(from, text.find(anchor));
    EXPECT_NE(std::string::npos, text.find(anchor)) << anchor;
    EXPECT_NE(std::string::npos, at) << from;
    return text.replace(at, std::string(from).size(), to);
}

struct T_BAD {
    const char* anchor; // text before the spot
    const char* from;
    const char* to;
    const char* message; // after "case.json: "
};

// clang-format off
const T_BAD kBad[] = {
    // the document
    {"", "\"gravity\"", "\"gravitas\"", "unknown key \"gravitas\""},
    {"", "\"gravity\"", "\"bad\\nkey\"", "unknown key \"bad\\u000akey\""},
    {"", "386.2", "0", "gravity: gravity must be above 0"},
    {"", "386.2", "null", "gravity: expected a number, found null"},
    {"", "\"nodes\"", "\"storeys\"", "key \"storeys\" appears twice"},
    // nodes
    {"\"id\": 2", "2", "0", "nodes[1].id: a node id must be above 0"},
    {"\"id\": 2", "2", "2.5", "nodes[1].id: 2.5 is not an integer"},
    {"\"id\": 2", "2", "4294967298", "nodes[1].id: 4294967298 is not an integer"},
    {"\"id\": 2", "-0.5", "\"a\"", "nodes[1].xyz[1]: expected a number, found a text"},
    {"\"id\": 2", "-0.5, ", "", "nodes[1].xyz: 2 values, expected 3"},
    {"\"id\": 2", "-0.5", "1e308", "OK"}, // becomes 2.54e306 m
    {"\"id\": 2", "2.6473775", "1e308", "nodes[1]: a value is too large"}, // 1.75e313 kg
    {"\"id\": 2", "\"mass\": [2.6473775, 1.035643, 0.71607127], ", "", "OK"},
    {"\"restraint\"", "1, 1, 1", "1, 2, 1", "nodes[0].restraint[1]: a restraint is 0 or 1"},
    // storeys
    {"storeys", "\"1F\"", "\"\"", "storeys[0].name: a name can't be empty"},
    {"storeys", "\"2F\"", "\"1F\"", "storeys[1].name: \"1F\" appears twice"},
    {"storeys", "\"2F\"", "\"2\\tF\"", "storeys[1].name: a name can't have control characters"},
    {"storeys", "117.06", "0", "storeys[1].height: a storey height must be above 0"},
    {"storeys", "[7]", "[7, 7]", "storeys[1].nodes[1]: the node appears twice"},
    // modes
    {"modes", "0.7", "0", "modes[0].period: a period must be above 0"},
    {"modes", "\"7\"", "\"07\"", "modes[0].shape.\"07\": the key must be a node id"},
    // spectra
    {"\"atc40\"", "0.4", "0", "spectra[0].Ca: the value must be above 0"},
    {"\"atc40\"", "\"Ca\": 0.4,", "", "spectra[0]: \"Ca\" is missing"},
    {"\"atc40\"", "false", "0", "spectra[0].floors: expected true or false, found a number"},
    {"\"ec8-2004\"", "\"type\": 2", "\"type\": 3", "spectra[1].type: the type is 1 or 2"},
    {"\"ec8-2004\"", "0.35", "0", "spectra[1].ag: the value must be above 0"},
    {"\"ec8-2004\"", "\"E\"", "\"F\"",
     "spectra[1].soil: unknown soil \"F\"; allowed: A, B, C, D, E"},
    {"\"ec8-2004\"", "\"damping\": 4", "\"damping\": -1",
     "spectra[1].damping: damping can't be negative"},
    {"\"ec8-2004\"", "\"TB\": 0.1", "\"TB\": 0.5", "spectra[1].TC: TC is below TB"},
    {"\"ec8-2004\"", "\"TD\": 2.5", "\"TD\": 0.3", "spectra[1].TD: TD is below TC"},
    {"\"ntc\"", "0.28", "0", "spectra[3].limit_states.SLD.\"TC*\": the value must be above 0"},
    {"\"user\",", "[0, 0.5", "[-1, 0.5", "spectra[4].T[0]: a period can't be negative"},
    {"\"user\",", "386.4", "-1", "spectra[4].gravity: gravity must be above 0"},
    // pushover load cases
    {"pushover", ", \"modes\": [1]", "",
     "pushover[0].pattern: this kind of pattern needs at least one mode number in \"modes\""},
    {"pushover", "[1]", "[2]", "pushover[0].pattern.modes[0]: there is no such mode"},
    {"pushover", "[1]", "[0]", "pushover[0].pattern.modes[0]: mode numbers start at 1"},
    {"pushover", "180", "1e308", "pushover[0].steps.base_reaction: a value is too large"},
    {"pushover", "\"2\"", "\"7\"", "pushover[0].steps.displacement: key \"7\" appears twice"},
    {"pushover", "-2]", "-3]", "pushover[0].limit_state_steps.EC8[2]: a step is -2 or above"},
    // evaluations
    {"evaluations", "FEMA440", "NTC2008",
     "evaluations[0].procedure: only ATC-40 and FEMA440 have procedures"},
    {"evaluations", "\"behavior\": 3", "\"behavior\": 4",
     "evaluations[0].behavior: the behavior is 0, 1, 2 or 3"},
    {"evaluations", "2.5", "-1", "evaluations[0].elastic_damping: damping is 0 to 100 per cent"},
    {"evaluations", "2.5", "101", "evaluations[0].elastic_damping: damping is 0 to 100 per cent"},
    {"evaluations", "\"drift_kind\": 2", "\"drift_kind\": 3",
     "evaluations[0].drift_kind: the drift kind is 1 or 2"},
    {"evaluations", "\"plot_type\": 4", "\"plot_type\": 9",
     "evaluations[0].plot_type: the plot type is 0 to 8"},
    {"evaluations", "\"ntc\"", "\"opcm\"",
     "evaluations[0].bilinear.rule: unknown bilinear rule \"opcm\"; allowed: ec8, ntc, masonry"},
    {"evaluations", "0.75", "0",
     "evaluations[0].bilinear.secant: the fraction is above 0 and up to 1"},
    {"evaluations", "0.8", "1.1",
     "evaluations[0].bilinear.drop: the fraction is above 0 and up to 1"},
};
// clang-format on

TEST(CaseFile, RefusesEachBadInputWithItsPlace)
{
    for (const T_BAD& bad : kBad) {
        SCOPED_TRACE(std::string(bad.from) + " -> " + bad.to);
        const std::string text = Spoiled(bad.anchor, bad.from, bad.to);
        if (std::string("OK") == bad.message)
            ParseGood(text);
        else
            EXPECT_EQ("case.json: " + std::string(bad.message), RefusalOf(text));
    }
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
