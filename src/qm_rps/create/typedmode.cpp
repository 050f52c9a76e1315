#include "qm_rps/create/typedmode.h"

#include "qm_rps/create/createfault.h"

#include <algorithm>
#include <cmath>

int MakeTypedMode(const T_MODEL& model, const T_TYPED_MODE& in, T_EIGV_D& out, T_FINDING& fault)
{
    if (model.storeys.empty()) return CreateFault(fault, "shape", "IDS_QM_MODES_NO_STOREYS");
    if (!(in.period > 0.0 && std::isfinite(in.period)))
        return CreateFault(fault, "period", "IDS_QM_CASE_ABOVE_0");
    if (in.shape.size() != model.storeys.size())
        return CreateFault(fault, "shape", "IDS_QM_NEW_SHAPE_COUNT",
                           std::to_string(in.shape.size()), std::to_string(model.storeys.size()));
    if (std::ranges::all_of(in.shape, [](double v) { return v == 0.0; }))
        return CreateFault(fault, "shape", "IDS_QM_MODES_NO_SHAPE");
    T_EIGV_D mode;
    mode.period = in.period;
    std::size_t at = 0;
    for (const auto& [key, storey] : model.storeys) {
        for (const int node : storey.nodes)
            mode.shape[node][static_cast<std::size_t>(in.direction)] = in.shape[at];
        ++at;
    }
    out = std::move(mode);
    return 1;
}
