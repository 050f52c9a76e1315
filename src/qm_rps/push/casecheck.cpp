#include "qm_rps/push/casecheck.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/pushwarnings.h"
#include "qm_rps/push/stopwarnings.h"

namespace {

void Add(const std::string& where, const std::vector<T_FINDING>& findings, bool isWarning,
         std::vector<T_CASE_REMARK>& out)
{
    for (const T_FINDING& finding : findings)
        out.push_back({where, finding, isWarning});
}

void AddWhole(const std::string& text, std::vector<T_CASE_REMARK>& out)
{
    T_CASE_REMARK& remark = out.emplace_back();
    remark.finding.text = text;
    remark.isWarning = true;
}

} // namespace

std::vector<T_CASE_REMARK> CheckCase(CDBDoc& doc)
{
    const T_MODEL& model = doc.Data().Model();
    std::vector<T_CASE_REMARK> out;
    Add(Say("IDS_QM_UI_POGC_TITLE"), PushControlFindings(model.pushControl, model), false, out);
    Add(Say("IDS_QM_UI_TABLE_STOREYS"), StoreyFindings(model), false, out);
    for (const auto& [key, function] : model.incrementFunctions)
        Add(Say("IDS_QM_CASE_FUNCTION", function.name), IncrementFunctionFindings(function), false,
            out);
    bool pushes = false; // without control data the curve is another program's
    for (const auto& [key, record] : model.pushovers) {
        T_POLC_D polc;
        pushes = pushes || record.control.has_value();
        if (!doc.Attr().GetPolc(key, polc)) continue;
        Add(polc.name, LoadCaseFindings(polc, model), false, out);
        Add(polc.name, PatternFindings(polc.patterns), false, out);
        Add(polc.name, StopWarnings(doc, polc), true, out);
    }
    if (const std::string elastic = NoHingeText(model); pushes && !elastic.empty())
        AddWhole(elastic, out);
    for (const std::string& warning : PushWarnings(doc))
        AddWhole(warning, out);
    return out;
}
