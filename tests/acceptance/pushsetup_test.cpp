// Setting a push up by commands: every key set and read back from the case file that is written,
// load cases made at once, increment functions.
#include "program.h"

namespace {

class PushSetup : public CProgramTest {
protected:
    json Exported(const std::string& file) const { return json::parse(Done("export " + file)); }
    static const json& CaseOf(const json& model, const std::string& name)
    {
        for (const json& push : model.at("pushover"))
            if (push.at("name") == name) return push;
        static const json none;
        ADD_FAILURE() << "no load case " << name;
        return none;
    }
};

struct T_KEY {
    const char *pointer, *value;
};

void ExpectKeys(const json& object, std::initializer_list<T_KEY> keys)
{
    for (const T_KEY& key : keys) {
        const json::json_pointer at(key.pointer);
        EXPECT_EQ(json::parse(key.value), object.contains(at) ? object.at(at) : json())
            << key.pointer;
    }
}

TEST_F(PushSetup, EveryKeyIsSetAndTakenBack)
{
    Done("push function @eccentric-building --add slow --rows 1=0.1 2=0.5 4=1 -o f.json");
    Done("push setup f.json --initial-loads G=0.5 --p-delta updated --steps 7 --on-failure stop "
         "--flow associated --hinge-types pier beam --most-events 5 --most-steps 900 -o g.json");
    ExpectKeys(Exported("g.json").at("pushover_control"),
               {{"/initial_loads", R"([{"case": "G", "factor": 0.5}])"},
                {"/p_delta", "\"updated\""},
                {"/steps", "7"},
                {"/on_failure", "\"stop\""},
                {"/flow", "\"associated\""},
                {"/hinge_types", R"(["pier", "beam"])"},
                {"/most_events", "5"},
                {"/most_steps", "900"}});
    Done("push setup g.json --case PX --rename P2 --control-node 332 --direction DY --follow "
         "largest --patterns static:G=0.5 acceleration:DY=-2 --eccentricity -0.1 --largest 0.3 "
         "--function slow --stiffness-ratio 0.02 --angle 90 --initial-loads none --p-delta none "
         "--steps 12 --on-failure leap --drift 0.03 --state CP --fraction-of-peak 0.8 "
         "--additional 0.05 0.1 --additional-evaluations on -o c.json");
    ExpectKeys(CaseOf(Exported("c.json"), "P2"),
               {{"/control_node", "332"},
                {"/direction", "\"DY\""},
                {"/control_option", "2"},
                {"/pattern/kind", "\"static\""},
                {"/patterns", R"([{"kind": "static", "number": 1, "factor": 0.5},
                                  {"kind": "acceleration", "number": 2, "factor": -2}])"},
                {"/eccentricity", "-0.1"},
                {"/control/increment_method", "\"displacement\""},
                {"/control/master_node_control", "false"},
                {"/control/max_trans_displ", "0.3"},
                {"/control/increment_option", "2"},
                {"/control/increment_function", "1"},
                {"/control/stiffness_ratio_limit", "0.02"},
                {"/control/generate_static_angle", "true"},
                {"/control/static_angle", "90"},
                {"/initial_loads", "[]"},
                {"/p_delta", "\"none\""},
                {"/steps", "12"},
                {"/on_failure", "\"leap\""},
                {"/stops", R"({"drift": 0.03, "state": "CP", "fraction_of_peak": 0.8})"},
                {"/additional_displacements", "[0.05, 0.1]"},
                {"/additional_evaluations", "true"}});
    Done("push setup c.json --case P2 --initial-loads global --p-delta global --steps global "
         "--on-failure global --drift none --state none --fraction-of-peak none --angle none "
         "--additional none --additional-evaluations off --function none --follow named "
         "--target -0.2 --initial-case PY -o d.json");
    ExpectKeys(CaseOf(Exported("d.json"), "P2"),
               {{"/initial_loads", "null"},
                {"/p_delta", "null"},
                {"/steps", "null"},
                {"/on_failure", "null"},
                {"/stops", "null"},
                {"/additional_displacements", "null"},
                {"/additional_evaluations", "null"},
                {"/control/increment_option", "null"},
                {"/control/generate_static_angle", "null"},
                {"/control/master_node_control", "null"}, // true when it is left out
                {"/control/master_max_displ", "-0.2"},
                {"/initial_case", "\"PY\""}});
    Done("push setup d.json --case P3 --new --method force --patterns acceleration:DX -o e.json");
    ExpectKeys(CaseOf(Exported("e.json"), "P3"), {{"/control/increment_method", "\"force\""}});
}

TEST_F(PushSetup, ShowsWhatActs)
{
    Done("push setup @eccentric-building --steps 33 -o g.json");
    Done("push setup g.json --case PX --steps 12 --target 0.4 -o c.json");
    const json shown = Json("push setup c.json");
    const json& px = CaseOf(shown, "PX");
    ExpectKeys(px, {{"/steps", "12"},
                    {"/own", "[\"steps\"]"},
                    {"/p_delta", "\"initial\""}, // of the global control
                    {"/initial_loads", R"([{"case": "G", "factor": 1}])"}});
    EXPECT_EQ(33, CaseOf(shown, "PY").at("steps"));
    ExpectHolds(Done("push setup c.json"), {"G x 1  (global)", "0.4 m", "acceleration:DX x 1"});
}

TEST_F(PushSetup, RefusesWhatIsWrongAndWritesNothing)
{
    const struct {
        const char *arguments, *says;
    } kRows[] = {
        {"--steps 50", "-o"},
        {"-o x.json", "-o"},
        {"--steps 0 -o x.json", "1 to 1000000"},
        {"--steps 1.5 -o x.json", "whole number"},
        {"--p-delta sometimes -o x.json", "none, initial, updated"},
        {"--initial-loads Q -o x.json", "\"Q\""},
        {"--initial-loads G=0 -o x.json", "must not be 0"},
        {"--hinge-types glue -o x.json", "\"glue\""},
        {"--drift 0.1 -o x.json", "--case"},
        {"--case PX --flow rotations -o x.json", "global control"},
        {"--case NO --steps 5 -o x.json", "\"NO\""},
        {"--case PY --new --steps 5 -o x.json", "has this name"},
        {"--case PX --target 0 -o x.json", "aster"},
        {"--case PX --method force --target 0.1 -o x.json", "exclude"},
        {"--case PX --initial-case PX -o x.json", "own end"},
        {"--case PX --patterns mode -o x.json", "KIND:WHAT"},
        {"--case PX --patterns acceleration:DX=0 -o x.json", "cale"},
        {"--case PX --additional 0.9 -o x.json", "dditional"},
        {"--case PX --eccentricity 0.5 -o x.json", "0.5"},
        {"--case PX --control-node 7777 -o x.json", "control node"},
    };
    for (const auto& row : kRows)
        ExpectRefused(std::string("push setup @eccentric-building ") + row.arguments, 2, row.says);
    EXPECT_TRUE(m_folder.Names().empty());
}

// The top storey stands at 9.9 m, its centre of mass at (9, 5); nodes 312 (6, 5) and 322 (12, 5)
// are equally near. 2 % of 9.9 m are 0.198 m.
TEST_F(PushSetup, MakesCasesBothWays)
{
    const std::string said = Done("case generate @eccentric-building --patterns uniform "
                                  "--eccentricity 0.05 -o g.json");
    ExpectHolds(said, {"node 312", "0.198 m"});
    const json model = Exported("g.json");
    const struct {
        const char *name, *direction;
        int number, sign;
        double eccentricity;
    } kRows[] = {{"PX+ uniform e+", "DX", 1, 1, 0.05},  {"PX+ uniform e-", "DX", 1, 1, -0.05},
                 {"PX- uniform e+", "DX", 1, -1, 0.05}, {"PX- uniform e-", "DX", 1, -1, -0.05},
                 {"PY+ uniform e+", "DY", 2, 1, 0.05},  {"PY+ uniform e-", "DY", 2, 1, -0.05},
                 {"PY- uniform e+", "DY", 2, -1, 0.05}, {"PY- uniform e-", "DY", 2, -1, -0.05}};
    EXPECT_EQ(4U + std::size(kRows), model.at("pushover").size()); // behind the four of the example
    for (const auto& row : kRows) {
        const json& push = CaseOf(model, row.name);
        EXPECT_EQ(312, push.at("control_node")) << row.name;
        EXPECT_EQ(row.direction, push.at("direction")) << row.name;
        EXPECT_EQ(row.eccentricity, push.at("eccentricity")) << row.name;
        EXPECT_NEAR(0.198 * row.sign, push.at("control").at("master_max_displ"), 1e-12);
        const json& pattern = push.at("patterns").at(0);
        EXPECT_EQ("acceleration", pattern.at("kind")) << row.name;
        EXPECT_EQ(row.number, pattern.at("number")) << row.name;
        EXPECT_EQ(row.sign, pattern.value("factor", 1.0)) << row.name; // 1 is left out
    }
    ExpectRefused("case generate g.json --eccentricity 0.05 --signs + -o h.json", 2,
                  "PX+ uniform e+");
}

TEST_F(PushSetup, TakesTheModeWithTheLargestMass)
{
    Done("case generate @eccentric-building --patterns mode --target 0.3 -o g.json");
    const json modes = Json("analyse @eccentric-building --modes 12 --no-store").at("modes");
    const json made = Exported("g.json");
    for (const auto& [name, d] : {std::pair("PX- mode", 0), std::pair("PY+ mode", 1)}) {
        int best = 1;
        for (int i = 1; i <= static_cast<int>(modes.size()); ++i) {
            const auto mass = [&, along = d](int mode) {
                return modes.at(static_cast<std::size_t>(mode - 1))
                    .at("mass_percent")
                    .at(static_cast<std::size_t>(along))
                    .get<double>();
            };
            if (mass(i) > mass(best)) best = i;
        }
        const json& row = CaseOf(made, name).at("patterns").at(0);
        EXPECT_EQ("mode x story mass", row.at("kind")) << name;
        EXPECT_EQ(best, row.at("number")) << name;
    }
}

// A model with modes of its own; a plane frame has no direction Y. Load and displacement go the
// same way, so that the load factor is positive.
TEST_F(PushSetup, LoadsGoTheWayOfTheTarget)
{
    Done("case generate @rc-frame-3-storey --target 0.5 -o g.json");
    ExpectRefused("case generate @rc-frame-3-storey --directions Y -o h.json", 2, "restrained");
    EXPECT_EQ(3U + 4U, Exported("g.json").at("pushover").size());
    for (const char* name : {"PX- mode", "PX+ uniform"}) {
        const json run = Json("push g.json --case '" + std::string(name) + "'").at(0);
        const double sign = name[2] == '-' ? -1.0 : 1.0;
        EXPECT_GT(run.at("load_factor").back().get<double>(), 0.0) << name;
        EXPECT_NEAR(0.5 * sign, run.at("displacement").back().get<double>(), 1e-9) << name;
    }
}

TEST_F(PushSetup, IncrementFunctionsAreEdited)
{
    Done("push function @hinge-library --add fast --rows 1=0.5 2=1 -o a.json");
    Done("push function a.json --change fast --rename quick --rows 1=0.25 4=1 -o b.json");
    const json functions = Exported("b.json").at("increment_functions");
    EXPECT_EQ(json::parse(R"({"name": "quick", "step": [1, 4], "factor": [0.25, 1]})"),
              functions.at(1));
    ExpectHolds(Done("push function b.json"), {"slow start", "0.25"});
    Done("push setup b.json --case PX --function quick -o c.json");
    ExpectRefused("push function c.json --delete quick -o d.json", 2, "PX");
    Done("push function b.json --delete quick -o d.json");
    EXPECT_EQ(1U, Exported("d.json").at("increment_functions").size());
    const struct {
        const char *arguments, *says;
    } kBad[] = {{"--add 'slow start' --rows 1=1 -o x.json", "has this name"},
                {"--add new --rows 2=1 1=2 -o x.json", "rise"},
                {"--add new -o x.json", "at least one row"},
                {"--add new --rows 1:2 -o x.json", "STEP=FACTOR"},
                {"--change none --rows 1=1 -o x.json", "\"none\""},
                {"--rows 1=1", "-o"}};
    for (const auto& row : kBad)
        ExpectRefused(std::string("push function @hinge-library ") + row.arguments, 2, row.says);
}

} // namespace
