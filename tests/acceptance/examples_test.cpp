// The examples' recorder files, as the program reads them, against the solver's own summary tables.
#include "program.h"

#include <cmath>

namespace {

using Examples = CProgramTest;

const json& StepsOf(const json& document, const std::string& push)
{
    for (const json& p : document.at("pushover")) {
        if (p.at("name") == push) return p.at("steps");
    }
    throw std::runtime_error("no push " + push);
}

struct T_STEP {
    const char* example;
    const char* push;
    std::size_t step;  // from 1
    double loadFactor; // as the summary table prints it
    double V;          // base shear, kips
    const char* node;  // not the control node
    double d;          // its displacement, in; less the state before the push
    const char* control;
    double dControl;
};

// Typed from the tables that the solver's user wrote beside the recorder files: ten digits each.
// Displacements there include the state before the push, which is subtracted here.
// clang-format off
const T_STEP kSteps[] = {
    {"steel-frame-2-storey", "PX_MODE1", 1, 2.83980983, 5.969182323,
     "12", 0.02680178324, "13", 0.05},
    {"steel-frame-2-storey", "PX_MODE1", 100, 142.4320491, 299.387255,
     "32", 2.754598634, "23", 5.0},
    {"steel-frame-2-storey", "PX_MODE1", 648, 53.47967742, 112.4124375,
     "22", 17.79776208, "13", 32.4},
    {"steel-frame-2-storey", "PX_UNIFORM", 100, 118.445468, 325.096313,
     "12", 2.918728865, "33", 5.0},
    {"rc-frame-3-storey", "PX_MODE1", 1, 21.27346771, 20.41868035,
     "21", 0.0714544668 + 0.0003833939671, "41", 0.1014510924 - 0.0006510923811},
    {"rc-frame-3-storey", "PX_MODE1", 100, 444.8343562, 426.9605056,
     "31", 9.832185648 + 0.0001092883652, "41", 10.08065109 - 0.0006510923811},
    {"rc-frame-3-storey", "PX_UNIFORM", 500, 471.161385, 518.3067882,
     "31", 49.94231827 + 0.0001092883652, "41", 50.40065109 - 0.0006510923811},
    {"rc-frame-2-storey", "PX_MODE1", 100, 140.682464, 274.223312,
     "2", 1.580246705 + 0.001277090172, "3", 2.99893356 + 0.001066439673},
    {"rc-frame-2-storey", "PX_UNIFORM", 541, 127.2823515, 379.4753337,
     "2", 9.023843426 + 0.001277090172, "3", 16.22893356 + 0.001066439673},
    {"rc-space-frame-3-storey", "PX_MODE1", 100, 67.11408187, 183.0163341,
     "9", 6.413492372, "19", 8.64},
    {"rc-space-frame-3-storey", "PX_UNIFORM", 300, 59.62495481, 239.9811846,
     "14", 24.99190941, "19", 25.92},
};
// clang-format on

TEST_F(Examples, RecorderFilesGiveTheSolversOwnCurve)
{
    constexpr double kRelative = 1.5e-9; // last of the ten digits that both files print
    const auto near = [](double a, double b) { return std::fabs(a - b) <= kRelative * b + 1.5e-9; };
    std::string name;
    json document;
    for (const T_STEP& s : kSteps) {
        if (name != s.example) {
            name = s.example;
            Done("import @" + name + " m.qmdb --overwrite");
            document = json::parse(Done("export m.qmdb"));
        }
        const json& steps = StepsOf(document, s.push);
        const std::string label = name + " " + s.push + " step " + std::to_string(s.step) + ": ";
        const auto at = [&](const json& series) { return series.at(s.step - 1).get<double>(); };
        const json& d = steps.at("displacement");
        EXPECT_PRED2(near, at(steps.at("load_factor")), s.loadFactor) << label << "load factor";
        EXPECT_PRED2(near, at(steps.at("base_reaction")), s.V) << label << "base shear";
        EXPECT_PRED2(near, at(d.at(s.node)), s.d) << label << "displacement";
        EXPECT_PRED2(near, at(d.at(s.control)), s.dControl) << label << "control node";
    }
}

} // namespace
