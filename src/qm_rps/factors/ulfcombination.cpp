#include "qm_rps/factors/ulfcombination.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/editscope.h"

#include <algorithm>

using zql::lib::MMSGFunction;

namespace {

constexpr std::size_t kMostEntries = 999;

int Add(CDBDoc& doc, const T_LCOM_D& combination)
{
    const int added = doc.Data().AddLcom(combination) != 0;
    const std::string text = MMSGFunction::Format(added ? "IDS_RPS_UNKNOWN_LOAD_LCOM_SUCCESS"
                                                        : "IDS_RPS_UNKNOWN_LOAD_LCOM_FAIL",
                                                  {combination.name});
    GSaveHistoryFormatNF("%s", text.c_str());
    return added;
}

int AddParts(CDBDoc& doc, const std::string& name, const std::vector<T_LCOM_D>& parts)
{
    T_LCOM_D master{name, {}};
    int all = 1;
    for (const T_LCOM_D& part : parts) {
        int key = 0;
        if (Add(doc, part) && doc.Attr().GetLcomKey(part.name, key))
            master.items.push_back({true, key, 1.0});
        else
            all = 0;
    }
    return Add(doc, master) && all;
}

} // namespace

std::optional<T_LCOM_D> FlatCombination(const CDataCtrl& data, int key)
{
    const CAttrCtrl attr(data);
    T_LCOM_D record, flat;
    if (!attr.GetLcom(key, record) || !attr.NormalizeLcom(record, flat)) return std::nullopt;
    return flat;
}

T_ULF_COMBINATION_PLAN PlanUlfCombinations(const std::string& name, const T_LCOM_D& normalised,
                                           const std::map<int, double>& factors)
{
    const std::vector<T_LCOM_ITEM>& items = normalised.items;
    const auto factorOf = [&](const T_LCOM_ITEM& item) {
        const auto it = factors.find(item.key);
        return it == factors.end() ? item.factor : it->second;
    };
    // 999 entries make two parts, the second of them empty: this is meant.
    const std::size_t count = items.size() / kMostEntries + 1;
    T_ULF_COMBINATION_PLAN plan;
    plan.split = count > 1;
    if (!plan.split) {
        T_LCOM_D single{name, items};
        for (T_LCOM_ITEM& item : single.items)
            item.factor = factorOf(item);
        plan.parts.push_back(std::move(single));
        return plan;
    }
    for (std::size_t part = 0; part < count; ++part) {
        T_LCOM_D made{FormatText("%s-%d", name.c_str(), static_cast<int>(part) + 1), {}};
        const std::size_t end = std::min(items.size(), (part + 1) * kMostEntries);
        for (std::size_t i = part * kMostEntries; i < end; ++i) {
            made.items.push_back(items[i]);
            // Multiplied here, while a single combination has it replaced: this is meant.
            made.items.back().factor *= factorOf(items[i]);
        }
        plan.parts.push_back(std::move(made));
    }
    return plan;
}

int AddUlfCombinations(CDBDoc& doc, const std::string& name, const T_ULF_COMBINATION_PLAN& plan)
{
    CEditScope edit(doc, name);
    if (!edit.IsOpen()) return 0;
    const int all = plan.split ? AddParts(doc, name, plan.parts) : Add(doc, plan.parts.front());
    return edit.Commit() && all;
}
