#include "qm_db/casefile/casewriter.h"
#include "qm_db/casefile/jsonnames.h"

namespace {

using T_SERIES = std::vector<double>;

/// One value per step, or a fault.
void WriteSeries(CJsonWriter& out, const std::string& key, const T_SERIES& values, T_DIM dim,
                 const IPushResult& result, int read)
{
    out.Key(key);
    if (!read) return out.Fail("IDS_QM_CASE_RESULT_NOT_READ", result.Error());
    if (values.size() != static_cast<std::size_t>(result.StepCount()))
        return out.Fail("IDS_QM_JSON_COUNT", std::to_string(values.size()),
                        std::to_string(result.StepCount()));
    out.Value(values, dim);
}

} // namespace

void WriteSteps(CJsonWriter& out, IPushResult& result, int direction)
{
    T_SERIES values;
    out.BeginObject();
    int read = result.ReadLoadFactors(values);
    WriteSeries(out, "load_factor", values, kDimNone, result, read);
    read = result.ReadBaseReactions(values);
    WriteSeries(out, "base_reaction", values, ReactionDim(direction), result, read);
    out.Key("displacement");
    out.BeginObject();
    for (const int node : result.NodeIds()) {
        if (out.Failed()) return;
        read = result.ReadDisplacements(node, values);
        WriteSeries(out, std::to_string(node), values, DisplacementDim(direction), result, read);
    }
    out.EndObject();
    out.EndObject();
}
