#include "qm_db/casefile/casewriter.h"

#include "qm_db/casefile/caseput.h"
#include "qm_db/casefile/jsonnames.h"

#include <set>

namespace {

/// What the case file has beside the members of a record.
template <class R>
void WriteMore(CJsonWriter&, const T_MODEL_CONTENT&, int, const R&)
{
}
/// Results of another solver; our own are computed again.
bool HasSteps(const T_MODEL_CONTENT& content, int key)
{
    const auto it = content.results.find(key);
    return it != content.results.end() && it->second && !it->second->Run() &&
           it->second->StepCount() > 0;
}
void WriteMore(CJsonWriter& out, const T_MODEL_CONTENT& content, int key, const T_POLC_D& push)
{
    const bool hasSteps = HasSteps(content, key);
    if (!hasSteps && push.control && push.steps) out.Member("steps", *push.steps);
    if (hasSteps || !push.control) out.Key("steps");
    if (hasSteps)
        WriteSteps(out, *content.results.at(key), push.direction);
    else if (!push.control)
        out.Fail("IDS_QM_CASE_NO_RESULTS", push.name);
    const auto own = content.results.find(key);
    if (own != content.results.end() && own->second && own->second->Run())
        return; // limit states number steps that the file does not hold
    const auto steps = content.model.poverSteps.find(key);
    if (out.Failed() || steps == content.model.poverSteps.end()) return;
    CCasePut put(out);
    put.NeedPart("limit_state_steps", steps->second);
}

/// The members that stand under their own keys.
template <class R>
const R& OwnMembers(const T_MODEL_CONTENT&, int, const R& record)
{
    return record;
}
T_POLC_D OwnMembers(const T_MODEL_CONTENT& content, int key, T_POLC_D push)
{
    if (push.control && !HasSteps(content, key)) push.steps.reset(); // they are in "steps"
    return push;
}

template <class R>
void WriteName(CJsonWriter& out, const R& record, std::set<std::string>& taken, CASE_KEY key)
{
    out.Member("name", record.name);
    if (key != CASE_KEY::Stated) return;
    if (record.name.empty()) out.Fail("IDS_QM_JSON_NAME_EMPTY");
    if (!taken.insert(record.name).second) out.Fail("IDS_QM_CASE_NAME_TWICE");
}

template <class R>
void WriteTable(CJsonWriter& out, const CCaseNames& names, const T_RECORD_ROW<R>& row,
                const T_MODEL_CONTENT& content)
{
    const T_TABLE<R>& table = content.model.*row.table;
    if (!row.member || (table.empty() && !std::is_same_v<R, T_NODE_D>)) return;
    out.Key(row.member);
    out.BeginArray();
    long long next = 1; // behind the largest key there is no other
    std::set<std::string> taken;
    for (const auto& [key, record] : table) {
        if (out.Failed()) return;
        out.BeginObject(kIsOneLine<R>);
        if (row.key == CASE_KEY::Stated && key != next) out.Member("key", key);
        if constexpr (kHasName<R>) WriteName(out, record, taken, row.key);
        CCasePut put(out, &names);
        CaseFields(put, OwnMembers(content, key, record));
        WriteMore(out, content, key, record);
        out.EndObject();
        // The place of a mode in the array is its number, which load patterns name.
        if (std::is_same_v<R, T_EIGV_D> && key != next)
            out.Fail("IDS_QM_CASE_MODE_NUMBERS", std::to_string(key));
        next = static_cast<long long>(key) + 1;
    }
    out.EndArray();
}

} // namespace

void WriteCase(CJsonWriter& out, const T_MODEL_CONTENT& content)
{
    const CCaseNames names(content.model);
    CCasePut model(out, &names);
    out.BeginObject();
    out.Member("format", kCaseFormat);
    HeadFields(model, content.model.styp);
    ForEachKind([&]<class R>(const T_RECORD_ROW<R>& row) {
        if (std::is_same_v<R, T_MATL_D>) OptionFields(model, content.model.styp);
        if (std::is_same_v<R, T_POLC_D>) model.Part(kPushControlMember, content.model.pushControl);
        WriteTable(out, names, row, content);
    });
    out.EndObject();
}
