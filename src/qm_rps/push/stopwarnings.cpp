#include "qm_rps/push/stopwarnings.h"

#include "qm_base/say.h"
#include "qm_rps/push/pushstoreys.h"

#include <algorithm>

std::vector<T_FINDING> StopWarnings(const T_PUSH_STOPS_D& stops, bool hasStoreys,
                                    std::span<const T_PUSH_LAW_PLACE> laws)
{
    std::vector<T_FINDING> out;
    const auto add = [&](const char* field, const char* key) {
        T_FINDING& finding = out.emplace_back();
        finding.field = field;
        finding.messageKey = key;
        finding.text = Say(key);
    };
    if (stops.drift && !hasStoreys) add("stops.drift", "IDS_QM_PUSH_STOP_NO_STOREY");
    if (!stops.state) return out;
    const bool failed = *stops.state == PUSH_STATE_STOP::Failed;
    const auto has = failed ? &T_PUSH_LAW_PLACE::fails : &T_PUSH_LAW_PLACE::criteria;
    if (std::ranges::none_of(laws, has))
        add("stops.state", failed ? "IDS_QM_PUSH_STOP_NO_FAILURE" : "IDS_QM_PUSH_STOP_NO_CRITERIA");
    return out;
}

std::vector<T_FINDING> StopWarnings(CDBDoc& doc, const T_POLC_D& record)
{
    if (!record.control || (!record.stops.drift && !record.stops.state)) return {};
    const T_MODEL& model = doc.Data().Model();
    CAnalysisModel frame(model);
    T_ANALYSIS_ERROR fault;
    T_PUSH_LAW_OPTIONS options;
    options.types = model.pushControl.hingeTypes;
    T_PUSH_HINGES hinges;
    std::string error;
    if (!frame.BuildFrame(fault) ||
        !BuildPushHinges(doc, frame.ElementIds(), options, hinges, error))
        return {};
    return StopWarnings(record.stops, !StoreysOf(model, frame, 0).empty(), hinges.laws);
}
