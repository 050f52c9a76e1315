#include "qm_rps/factors/checks/ulfcombinationchecks.h"

#include "qm_base/ruletable.h"
#include "qm_db/attrctrl.h"

#include <algorithm>

namespace {

struct T_NAME_CHECK {
    const std::string& name;
    const T_MODEL& model;
    int ownKey;
};

bool HasName(const T_NAME_CHECK& c)
{
    return !c.name.empty();
}
bool NameIsFree(const T_NAME_CHECK& c)
{
    return std::ranges::none_of(c.model.combinations, [&](const auto& other) {
        return other.first != c.ownKey && other.second.name == c.name;
    });
}
bool HasRow(const T_LCOM_D& combination)
{
    return !combination.items.empty();
}

constexpr const char* kEmpty = "IDS_QM_UI_LCOM_EMPTY";

// clang-format off
constexpr T_RULE<T_NAME_CHECK> kNameRules[] = {
    {{.message = "IDS_RPS_UNKNOWN_LOAD_NAME_NOTENTERED", .field = "name"}, HasName},
    {{.message = "IDS_RPS_UNKNOWN_LOAD_LCOM_EXIST",      .field = "name"}, NameIsFree, HasName},
};
constexpr T_RULE<T_LCOM_D> kRowRules[] = {
    {{.message = kEmpty, .field = "items"}, HasRow},
};
// clang-format on

} // namespace

std::vector<T_FINDING> CheckCombinationName(const std::string& name, int ownKey,
                                            const T_MODEL& model)
{
    std::vector<T_FINDING> out;
    WalkRules(kNameRules, {name, model, ownKey}, {.name = name}, out);
    return out;
}

std::vector<T_FINDING> CheckCombination(const T_LCOM_D& combination, int ownKey,
                                        const CDataCtrl& data)
{
    std::vector<T_FINDING> out = CheckCombinationName(combination.name, ownKey, data.Model());
    WalkRules(kRowRules, combination, {.name = combination.name}, out);
    T_LCOM_D flat;
    std::string error;
    if (!CAttrCtrl(data).NormalizeLcom(combination, flat, error)) {
        T_FINDING& f = out.emplace_back();
        f.field = "items";
        f.ruleText = f.messageKey = kEmpty;
        f.text = error;
    }
    return out;
}
