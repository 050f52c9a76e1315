#include "qm_db/casefile/casewriter.h"

#include "qm_db/casefile/jsonnames.h"
#include "qm_db/records/structnames.h"

namespace {

void WriteHead(CJsonWriter& out, const T_STYP_D& styp)
{
    out.Member("format", kCaseFormat);
    if (!styp.title.empty()) out.Member("title", styp.title);
    out.Key("units");
    out.BeginObject(true);
    out.Member("force", NameOf(styp.units.force));
    out.Member("length", NameOf(styp.units.length));
    out.EndObject();
    if (styp.gravity) out.Member("gravity", *styp.gravity, kDimAccel);
    if (styp.plane) out.Member("plane", kPlaneNames[static_cast<std::size_t>(*styp.plane)]);
}

void WriteNodes(CJsonWriter& out, const T_MODEL& model)
{
    out.Key("nodes");
    out.BeginArray();
    for (const auto& [id, node] : model.nodes) {
        out.BeginObject(true);
        out.Member("id", id);
        out.Member("xyz", node.xyz, kDimLength);
        out.Member("mass", node.mass, kDimMass);
        out.Member("restraint", node.restraint);
        out.EndObject();
    }
    out.EndArray();
}

void WriteStoreys(CJsonWriter& out, const T_MODEL& model)
{
    if (model.storeys.empty()) return;
    out.Key("storeys");
    out.BeginArray();
    for (const auto& entry : model.storeys) {
        const T_STOR_D& storey = entry.second;
        out.BeginObject();
        out.Member("name", storey.name);
        out.Member("height", storey.height, kDimLength);
        out.Member("nodes", storey.nodes);
        out.EndObject();
    }
    out.EndArray();
}

void WriteMode(CJsonWriter& out, const T_EIGV_D& mode)
{
    out.BeginObject();
    out.Member("period", mode.period);
    out.Key("shape");
    out.BeginObject();
    for (const auto& [node, values] : mode.shape)
        out.Member(std::to_string(node), values);
    out.EndObject();
    out.MemberIf("participation", mode.participation);
    out.MemberIf("mass_percent", mode.massPercent);
    out.EndObject();
}

void WriteModes(CJsonWriter& out, const T_MODEL& model)
{
    if (model.modes.empty()) return;
    out.Key("modes");
    out.BeginArray();
    int next = 1;
    for (const auto& [number, mode] : model.modes) {
        WriteMode(out, mode);
        // The place in the array is the mode number, which load patterns name.
        if (number != next++)
            out.Fail("mode numbers must run 1, 2, 3, ...: found " + std::to_string(number));
    }
    out.EndArray();
}

} // namespace

void WriteCase(CJsonWriter& out, const T_MODEL_CONTENT& content)
{
    out.BeginObject();
    WriteHead(out, content.model.styp);
    WriteNodes(out, content.model);
    WriteStoreys(out, content.model);
    WriteModes(out, content.model);
    WriteStructTables(out, content.model);
    WriteHingeTables(out, content.model);
    WriteSpectra(out, content.model);
    WritePushovers(out, content);
    WriteEvaluations(out, content.model);
    out.EndObject();
}
