#include "qm_db/casefile/casereader.h"
#include "qm_db/casefile/jsonnames.h"
#include "qm_db/records/structnames.h"

namespace {

void ReadHead(CJsonReader& root, T_STYP_D& styp)
{
    std::string format;
    root.Get("format", format);
    if (format != kCaseFormat)
        root.FailAt("format", QuotedText(format) + ", expected " + QuotedText(kCaseFormat));
    root.GetIf("title", styp.title);

    CJsonReader units = root.Member("units");
    units.Keys({"force", "length"});
    styp.units.force = static_cast<FORCE_UNIT>(units.Choice("force", kForceNames, "unit"));
    styp.units.length = static_cast<LENGTH_UNIT>(units.Choice("length", kLengthNames, "unit"));

    root.Get("gravity", styp.gravity);
    root.CheckIf("gravity", styp.gravity, IsAboveZero, "gravity must be above 0");
    if (root.Has("plane"))
        styp.plane = static_cast<MODEL_PLANE>(root.Choice("plane", kPlaneNames, "plane"));
    RecordToSiChecked(root, styp, styp.units);
}

void ReadNode(CJsonReader& in, T_MODEL& model)
{
    T_NODE_D node;
    in.Keys({"id", "xyz", "mass", "restraint"});
    in.Get("id", node.id);
    in.Check("id", node.id > 0, "a node id must be above 0");
    in.Get("xyz", node.xyz);
    in.GetIf("mass", node.mass);
    in.CheckEach("mass", node.mass, IsZeroOrAbove, "a mass can't be negative");
    in.GetIf("restraint", node.restraint);
    in.CheckEach(
        "restraint", node.restraint, [](int r) { return r == 0 || r == 1; },
        "a restraint is 0 or 1");
    RecordToSiChecked(in, node, model.styp.units);
    if (!model.nodes.emplace(node.id, node).second)
        in.FailAt("id", "node " + std::to_string(node.id) + " appears twice");
}

void ReadStorey(CJsonReader& in, std::size_t index, T_MODEL& model, std::set<std::string>& taken)
{
    T_STOR_D storey;
    in.Keys({"name", "height", "nodes"});
    in.GetName("name", storey.name, taken);
    in.Get("height", storey.height);
    in.Check("height", storey.height > 0.0, "a storey height must be above 0");
    in.Get("nodes", storey.nodes);
    std::set<int> seen;
    in.CheckEach(
        "nodes", storey.nodes, [&](int n) { return model.nodes.contains(n); },
        "there is no such node");
    in.CheckEach(
        "nodes", storey.nodes, [&](int n) { return seen.insert(n).second; },
        "the node appears twice");
    RecordToSiChecked(in, storey, model.styp.units);
    model.storeys[static_cast<int>(index) + 1] = std::move(storey);
}

void ReadMode(CJsonReader& in, std::size_t index, T_MODEL& model)
{
    T_EIGV_D mode;
    in.Keys({"period", "shape", "participation", "mass_percent"});
    in.Get("period", mode.period);
    in.Check("period", mode.period > 0.0, "a period must be above 0");
    in.Member("shape").ForEachNode([&](CJsonReader& values, int node) {
        if (!model.nodes.contains(node)) values.Fail("there is no such node");
        values.Read(mode.shape[node]);
    });
    in.Get("participation", mode.participation);
    in.Get("mass_percent", mode.massPercent);
    model.modes[static_cast<int>(index) + 1] = std::move(mode);
}

} // namespace

void ReadCase(CJsonReader& root, const std::string& folder, T_MODEL_CONTENT& content)
{
    T_MODEL& model = content.model;
    root.Keys({"format",
               "title",
               "units",
               "gravity",
               "plane",
               "nodes",
               "storeys",
               "modes",
               "design_codes",
               "hinge_options",
               "materials",
               "sections",
               "elements",
               "diaphragms",
               "equal_displacements",
               "load_cases",
               "combinations",
               "stage_control",
               "stages",
               "ulf_constraints",
               "ulf_items",
               "ulf_stage_items",
               "increment_functions",
               "hinge_types",
               "hinges",
               "inelastic_hinges",
               "spectra",
               "pushover",
               "evaluations"});
    ReadHead(root, model.styp);
    root.Member("nodes").ForEachItem(
        [&](CJsonReader& item, std::size_t) { ReadNode(item, model); });
    std::set<std::string> storeyNames;
    ForEachRecord(root, "storeys", [&](CJsonReader& item, std::size_t index) {
        ReadStorey(item, index, model, storeyNames);
    });
    ForEachRecord(root, "modes",
                  [&](CJsonReader& item, std::size_t index) { ReadMode(item, index, model); });
    ReadStructTables(root, model);
    ReadHingeTables(root, model);
    ReadSpectra(root, model);
    ReadPushovers(root, folder, content);
    ReadEvaluations(root, model);
}
