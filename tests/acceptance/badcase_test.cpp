// Bad case files through the program: one line that names file and place, nothing written.
#include "program.h"

#include <gtest/gtest.h>

namespace {

struct T_BAD_CASE {
    const char* label;
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
    {"unknown key", "\"title\"", "\"titel\"", "\"titel\""},
    {"wrong type", "\"small frame\"", "7", "title"},
    {"format of another version", "qm-rps case 1", "qm-rps case 2", "format"},
    {"duplicate node id", "\"id\": 2", "\"id\": 1", "nodes[1].id"},
    {"unknown node in a step table", kDisp, "{\"2\": [0.028, 0.07, 0.14], \"9\": [0, 0, 0]}",
     "displacement.\"9\""},
    {"unknown node in a storey", "\"nodes\": [2]", "\"nodes\": [3]", "storeys[0].nodes"},
    {"unknown node in a mode", "{\"2\": [1, 0,", "{\"3\": [1, 0,", "modes[0].shape.\"3\""},
    {"unknown control node", "\"control_node\": 2", "\"control_node\": 8", "control_node"},
    {"1e999", kForce, "[280, 1e999, 336]", "1e999"},
    {"too few reactions", kForce, "[280, 300]", "pushover[0].steps.base_reaction"},
    {"too many displacements", kDisp, "{\"2\": [0.028, 0.07, 0.14, 0.15]}",
     "pushover[0].steps.displacement.\"2\""},
    {"no displacement of the control node", kDisp, "{\"1\": [0, 0, 0]}", "control node 2"},
    {"zero displacement", kDisp, "{\"2\": [0, 0, 0]}", "zero displacement"},
    {"zero force", kForce, "[0, 0, 0]", "zero force"},
    {"no step", kSteps, "\"load_factor\": []", "pushover[0].steps.load_factor"},
    {"negative mass", "[100, 0, 100]", "[-100, 0, 100]", "nodes[1].mass[0]"},
    {"periods not ascending", "[0, 0.5, 2]", "[0, 2, 0.5]", "spectra[1].T[2]"},
    {"equal periods", "[0, 0.5, 2]", "[0, 0.5, 0.5]", "spectra[1].T[2]"},
    {"negative Sa", "[0.4, 1, 0.25]", "[0.4, -1, 0.25]", "spectra[1].Sa[1]"},
    {"spectrum of one point", "\"T\": [0, 0.5, 2], \"Sa\": [0.4, 1, 0.25]",
     "\"T\": [0.5], \"Sa\": [1]", "spectra[1].T"},
    {"spectrum of unequal lengths", "[0.4, 1, 0.25]", "[0.4, 1]", "spectra[1].Sa"},
    {"damping points fall", kEval, "\"behavior\": 3, \"user_damping\": [20, 1, 10, 0.5]",
     "evaluations[0].user_damping"},
    {"damping point not above 0", kEval, "\"behavior\": 3, \"user_damping\": [0, 1, 10, 0.5]",
     "evaluations[0].user_damping"},
    {"two evaluations of one name", "\"ATC\"}\n ]",
     "\"ATC\"},\n  {\"name\": \"E1\", \"push\": \"PX\", \"method\": \"ATC-40\", "
     "\"spectrum\": \"ATC\"}]",
     "evaluations[1].name"},
    {"unknown force unit", "\"kN\"", "\"kip\"", "units.force"},
    {"unknown method", "\"ATC-40\"", "\"ATC40\"", "evaluations[0].method"},
    {"unknown spectrum name", "\"spectrum\": \"ATC\"", "\"spectrum\": \"ATC2\"",
     "evaluations[0].spectrum"},
    {"unknown pushover name", "\"push\": \"PX\"", "\"push\": \"PY\"", "evaluations[0].push"},
    {"missing spectrum", ", \"spectrum\": \"ATC\"", "", "evaluations[0]"},
    {"missing pushover", "\"push\": \"PX\", ", "", "evaluations[0]"},
    {"cut off", "\"evaluations\"", "", "line"},
    {"a comment", "\"storeys\"", "// floors\n \"storeys\"", "line"},
    {"missing recorder file", "\"load_factor\": [1, 2, 3]",
     "\"files\": {}, \"load_factor\": [1, 2, 3]", "pushover[0].steps"},
};
// clang-format on

/// The run was refused with one line that names `place`, and the folder holds the input alone.
void ExpectRefused(const T_RUN& run, const std::string& label, const std::string& place,
                   const CTempFolder& folder)
{
    EXPECT_EQ(3, run.code) << label << ": " << run.err;
    EXPECT_EQ("", run.out) << label;
    EXPECT_EQ(1U, Lines(run.err).size()) << label << ": " << run.err;
    EXPECT_NE(std::string::npos, run.err.find("bad.json")) << label << ": " << run.err;
    EXPECT_NE(std::string::npos, run.err.find(place)) << label << ": " << run.err;
    EXPECT_EQ(std::vector<std::string>{"bad.json"}, folder.Names()) << label;
}

TEST(BadCase, EachIsRefusedWithOneLineAndNothingIsWritten)
{
    const CTempFolder folder, models;
    WriteText(folder / "bad.json", kSmallCase);
    ASSERT_EQ(0, RunProgram({"import", folder / "bad.json", models / "m.qmdb"}).code);
    const std::string before = ReadText(models / "m.qmdb");
    for (const T_BAD_CASE& c : kBadCases) {
        WriteText(folder / "bad.json", SmallCaseWith(c.from, c.to));
        const T_RUN run = RunProgram({"evaluate", folder / "bad.json", "--json", folder / "o.json",
                                      "--report", folder / "o.txt"});
        ExpectRefused(run, c.label, c.place, folder);
        ExpectRefused(RunProgram({"import", folder / "bad.json", models / "m.qmdb"}), c.label,
                      c.place, folder);
        EXPECT_EQ(before, ReadText(models / "m.qmdb")) << c.label;
        EXPECT_EQ(std::vector<std::string>{"m.qmdb"}, models.Names()) << c.label;
    }
}

TEST(BadCase, AnEmptyFileAndOneNested200000DeepAreRefused)
{
    const CTempFolder folder;
    WriteText(folder / "bad.json", "");
    ExpectRefused(RunProgram({"evaluate", folder / "bad.json"}), "empty", "empty", folder);
    const std::size_t depth = 200000;
    WriteText(folder / "bad.json", std::string(depth, '[') + std::string(depth, ']'));
    ExpectRefused(RunProgram({"info", folder / "bad.json"}), "nested", "line 1", folder);
    std::string objects;
    for (std::size_t i = 0; i < depth; ++i)
        objects += "{\"nodes\":";
    WriteText(folder / "bad.json", objects);
    ExpectRefused(RunProgram({"info", folder / "bad.json"}), "nested", "line 1", folder);
}

// What is unusual, but valid.

TEST(BadCase, ASingleStepIsAValidCase)
{
    std::string text = SmallCaseWith("[1, 2, 3]", "[1]");
    const auto replace = [&](const std::string& from, const std::string& to) {
        ASSERT_NE(std::string::npos, text.find(from));
        text.replace(text.find(from), from.size(), to);
    };
    replace("[280, 300, 336]", "[280]");
    replace("[0.028, 0.0653125, 0.14]", "[0.028]");
    const CTempFolder folder;
    WriteText(folder / "one.json", text);
    // The line through one point ends before the elastic demand: an answer, not a bad file.
    const T_RUN strong = RunProgram({"evaluate", folder / "one.json"});
    EXPECT_EQ(1, strong.code);
    EXPECT_NE(std::string::npos, strong.out.find("trial point not found"));
    // A tenth of the spectrum meets it: Sd = 0.06/T g (T/2pi)^2 with T = 2pi sqrt(0.028/2.8).
    replace("\"Ca\": 0.4, \"Cv\": 0.6", "\"Ca\": 0.04, \"Cv\": 0.06");
    WriteText(folder / "one.json", text);
    const T_RUN weak = RunProgram({"evaluate", folder / "one.json"});
    EXPECT_EQ(0, weak.code);
    EXPECT_NE(std::string::npos, weak.out.find("elastic")) << weak.out;
    EXPECT_NE(std::string::npos, weak.out.find("0.00936")) << weak.out;
}

TEST(BadCase, ADecreasingDisplacementIsEvaluatedWithAWarning)
{
    const CTempFolder folder;
    WriteText(folder / "back.json",
              SmallCaseWith("[0.028, 0.0653125, 0.14]", "[0.028, 0.14, 0.13]"));
    const T_RUN run = RunProgram({"evaluate", folder / "back.json"});
    EXPECT_EQ(0, run.code) << run.err;
    EXPECT_NE(std::string::npos, run.out.find("decreases at step 3")) << run.out;
}

TEST(BadCase, ZeroMassHasANamedOutcome)
{
    const CTempFolder folder;
    WriteText(folder / "light.json", SmallCaseWith("[100, 0, 100]", "[0, 0, 0]"));
    const T_RUN run = RunProgram({"evaluate", folder / "light.json"});
    EXPECT_EQ(1, run.code) << run.err;
    EXPECT_NE(std::string::npos, run.out.find("no modal conversion")) << run.out;
}

} // namespace
