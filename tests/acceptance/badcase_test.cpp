// Bad case files through the program: one line that names file and place, nothing written.
#include "program.h"

namespace {

struct T_BAD_CASE {
    const char* from; // in the small case
    const char* to;
    const char* place; // must stand in the message
};

constexpr const char* kSteps = "\"load_factor\": [1, 2, 3]";
constexpr const char* kForce = "[280, 300, 336]";
constexpr const char* kDisp = "{\"2\": [0.028, 0.0653125, 0.14]}";
constexpr const char* kEval = "\"procedure\": \"A\"";

// clang-format off
const T_BAD_CASE kBadCases[] = {
    {"\"title\"", "\"titel\"", "\"titel\""},
    {"\"small frame\"", "7", "title"},
    {"qm-rps case 1", "qm-rps case 2", "format"},
    {"\"id\": 2", "\"id\": 1", "nodes[1].id"},
    {kDisp, "{\"2\": [0.028, 0.07, 0.14], \"9\": [0, 0, 0]}", "displacement.\"9\""},
    {"\"nodes\": [2]", "\"nodes\": [3]", "storeys[0].nodes"},
    {"{\"2\": [1, 0,", "{\"3\": [1, 0,", "modes[0].shape.\"3\""},
    {"\"control_node\": 2", "\"control_node\": 8", "control_node"},
    {kForce, "[280, 300]", "pushover[0].steps.base_reaction"},
    {kDisp, "{\"2\": [0.028, 0.07, 0.14, 0.15]}", "pushover[0].steps.displacement.\"2\""},
    {kDisp, "{\"1\": [0, 0, 0]}", "control node 2"},
    {kDisp, "{\"2\": [0, 0, 0]}", "zero displacement"},
    {kForce, "[0, 0, 0]", "zero force"},
    {kSteps, "\"load_factor\": []", "pushover[0].steps.load_factor"},
    {"[100, 0, 100]", "[-100, 0, 100]", "nodes[1].mass[0]"},
    {"[0, 0.5, 2]", "[0, 2, 0.5]", "spectra[1].T[2]"},
    {"[0, 0.5, 2]", "[0, 0.5, 0.5]", "spectra[1].T[2]"},
    {"[0.4, 1, 0.25]", "[0.4, -1, 0.25]", "spectra[1].Sa[1]"},
    {"\"T\": [0, 0.5, 2], \"Sa\": [0.4, 1, 0.25]", "\"T\": [0.5], \"Sa\": [1]", "spectra[1].T"},
    {"[0.4, 1, 0.25]", "[0.4, 1]", "spectra[1].Sa"},
    {kEval, "\"behavior\": 3, \"user_damping\": [20, 1, 10, 0.5]", "evaluations[0].user_damping"},
    {kEval, "\"behavior\": 3, \"user_damping\": [0, 1, 10, 0.5]", "evaluations[0].user_damping"},
    {"\"ATC\"}\n ]", "\"ATC\"}, {\"name\": \"E1\", \"push\": \"PX\", \"method\": \"ATC-40\"}]",
     "evaluations[1]"},
    {"\"kN\"", "\"kip\"", "units.force"},
    {"\"ATC-40\"", "\"ATC40\"", "evaluations[0].method"},
    {"\"spectrum\": \"ATC\"", "\"spectrum\": \"ATC2\"", "evaluations[0].spectrum"},
    {"\"push\": \"PX\"", "\"push\": \"PY\"", "evaluations[0].push"},
    {", \"spectrum\": \"ATC\"", "", "evaluations[0]"},
    {"\"push\": \"PX\", ", "", "evaluations[0]"},
    {"\"evaluations\"", "", "line"},
    {kSteps, "\"files\": {}, \"load_factor\": [1, 2, 3]", "pushover[0].steps"},
};
// clang-format on

using BadCase = CProgramTest;
const std::vector<std::string> kInput{"bad.json", "m.qmdb"};

TEST_F(BadCase, EachIsRefusedWithOneLineAndNothingIsWritten)
{
    Write("bad.json", kSmallCase);
    Done("import bad.json m.qmdb");
    const std::string before = Text("m.qmdb");
    for (const T_BAD_CASE& c : kBadCases) {
        SCOPED_TRACE(std::string(c.from) + " -> " + c.to);
        Write("bad.json", With(kSmallCase, c.from, c.to));
        for (const char* line : {"evaluate bad.json --json o.json --report o.txt",
                                 "import bad.json m.qmdb --overwrite"}) {
            ExpectHolds(ExpectRefused(line, 3, c.place), {"bad.json"});
            EXPECT_EQ(before, Text("m.qmdb"));
            EXPECT_EQ(kInput, m_folder.Names());
        }
    }
}

TEST_F(BadCase, AnEmptyFileAndOneNested200000DeepAreRefused)
{
    Write("bad.json", "");
    ExpectRefused("evaluate bad.json", 3, "empty");
    const std::size_t depth = 200000;
    Write("bad.json", std::string(depth, '[') + std::string(depth, ']'));
    ExpectRefused("info bad.json", 3, "line 1");
    std::string objects;
    for (std::size_t i = 0; i < depth; ++i)
        objects += "{\"nodes\":";
    Write("bad.json", objects);
    ExpectRefused("info bad.json", 3, "line 1");
}

// What is unusual, but valid.

TEST_F(BadCase, ASingleStepIsAValidCase)
{
    std::string text = With(kSmallCase, "[1, 2, 3]", "[1]");
    text = With(text, "[280, 300, 336]", "[280]");
    text = With(text, "[0.028, 0.0653125, 0.14]", "[0.028]");
    Write("one.json", text);
    // The line through one point ends before the elastic demand: an answer, not a bad file.
    const T_RUN strong = Run("evaluate one.json");
    EXPECT_EQ(1, strong.code);
    ExpectHolds(strong.out, {"trial point not found"});
    // A tenth of the spectrum meets it: Sd = 0.06/T g (T/2pi)^2 with T = 2pi sqrt(0.028/2.8).
    Write("one.json", With(text, "\"Ca\": 0.4, \"Cv\": 0.6", "\"Ca\": 0.04, \"Cv\": 0.06"));
    ExpectHolds(Done("evaluate one.json"), {"elastic", "0.00936"});
}

} // namespace
