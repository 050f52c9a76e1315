#include "qm_rps/factors/ulfchecks.h"

#include "qm_base/msgfunction.h"

#include <algorithm>
#include <cmath>
#include <set>

using zql::lib::MMSGFunction;

namespace {

template <class T>
bool NameTaken(const T_TABLE<T>& table, const std::string& name, int ownKey)
{
    return std::any_of(table.begin(), table.end(), [&](const auto& row) {
        return row.first != ownKey && row.second.name == name;
    });
}

// ---- constraint ---------------------------------------------------------------------------------

struct T_CONSTRAINT_CHECK {
    const T_ULFC_D& c;
    const T_MODEL& model;
    int ownKey;
};
using C = T_CONSTRAINT_CHECK;

bool KnownType(const C& k)
{
    return k.c.type >= ULFC_TYPE::Reaction && k.c.type <= ULFC_TYPE::Beam;
}
bool OfNode(const C& k)
{
    return k.c.type == ULFC_TYPE::Reaction || k.c.type == ULFC_TYPE::Displacement;
}
bool OfTruss(const C& k)
{
    return k.c.type == ULFC_TYPE::Truss;
}
bool OfBeam(const C& k)
{
    return k.c.type == ULFC_TYPE::Beam;
}
bool OfElem(const C& k)
{
    return OfTruss(k) || OfBeam(k);
}
bool Compared(const C& k)
{
    return !k.c.inequality && !k.c.compareWithValue;
}
bool IsKind(const C& k, int id, ELEM_KIND kind)
{
    const auto it = k.model.elements.find(id);
    return it == k.model.elements.end() ||
           it->second.kind == kind; // a missing one has its own rule
}
bool Finite(const std::optional<double>& value)
{
    return !value || std::isfinite(*value);
}

// clang-format off
const T_RULE<C> kConstraintRules[] = {
    {{.message = "IDS_RPS_No_Constraint_Name_", .field = "name"}, [](const C& k) { return !k.c.name.empty(); }},
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_NAME_EXISTS", .field = "name"},
     [](const C& k) { return k.c.name.empty() || !NameTaken(k.model.ulfConstraints, k.c.name, k.ownKey); }},
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_TYPE", .field = "type"}, KnownType},
    {{.message = "IDS_RPS_the_Node_Id_doesn_t_exist", .field = "id"}, [](const C& k) { return k.model.nodes.contains(k.c.id); }, OfNode},
    {{.message = "IDS_RPS_the_Elem_Id_doesn_t_exist", .field = "id"}, [](const C& k) { return k.model.elements.contains(k.c.id); }, OfElem},
    {{.message = "IDS_RPS_Elem_Id_is_not_of_Truss_", .field = "id"}, [](const C& k) { return IsKind(k, k.c.id, ELEM_KIND::Truss); }, OfTruss},
    {{.message = "IDS_RPS_Elem_Id_is_not_of_Beam_", .field = "id"}, [](const C& k) { return IsKind(k, k.c.id, ELEM_KIND::Beam); }, OfBeam},
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_POSITION", .field = "position"}, [](const C& k) { return k.c.position >= 0 && k.c.position <= 4; }, OfBeam},
    // a truss carries its axial force alone
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_COMPONENT", .field = "component"},
     [](const C& k) { return k.c.component >= 0 && k.c.component <= (OfTruss(k) ? 0 : 5); }, KnownType},
    {{.message = "IDS_RPS_the_Other_Node_Id_doesn_t_exist", .field = "otherId"},
     [](const C& k) { return k.model.nodes.contains(k.c.otherId); }, [](const C& k) { return Compared(k) && OfNode(k); }},
    {{.message = "IDS_RPS_the_Other_Elem_Id_doesn_t_exist", .field = "otherId"},
     [](const C& k) { return k.model.elements.contains(k.c.otherId); }, [](const C& k) { return Compared(k) && OfElem(k); }},
    {{.message = "IDS_RPS_the_Other_Elem_Id_is_not_of_Truss_", .field = "otherId"},
     [](const C& k) { return IsKind(k, k.c.otherId, ELEM_KIND::Truss); }, [](const C& k) { return Compared(k) && OfTruss(k); }},
    {{.message = "IDS_RPS_the_Other_Elem_Id_is_not_of_Beam_", .field = "otherId"},
     [](const C& k) { return IsKind(k, k.c.otherId, ELEM_KIND::Beam); }, [](const C& k) { return Compared(k) && OfBeam(k); }},
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_COMPARED_WITH_ITSELF", .field = "otherId"}, [](const C& k) { return k.c.otherId != k.c.id; }, Compared},
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_VALUE", .field = "value"}, [](const C& k) { return std::isfinite(k.c.value); },
     [](const C& k) { return !k.c.inequality && k.c.compareWithValue; }},
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_NO_BOUND", .field = "upper"}, [](const C& k) { return k.c.upper || k.c.lower; },
     [](const C& k) { return k.c.inequality; }},
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_VALUE", .field = "upper"}, [](const C& k) { return Finite(k.c.upper); }, [](const C& k) { return k.c.inequality; }},
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_VALUE", .field = "lower"}, [](const C& k) { return Finite(k.c.lower); }, [](const C& k) { return k.c.inequality; }},
    {{.message = kUlfConstraintError, .key = "IDS_QM_ULFC_BOUNDS_CROSS", .field = "lower"}, [](const C& k) { return !(*k.c.lower > *k.c.upper); },
     [](const C& k) { return k.c.inequality && k.c.upper && k.c.lower; }},
};
// clang-format on

// ---- item ---------------------------------------------------------------------------------------

struct T_ITEM_CHECK {
    const T_ULFI_D& item;
    const T_MODEL& model;
    int ownKey;
    const std::optional<std::vector<T_LCOM_ITEM>>& cases;
};
using I = T_ITEM_CHECK;

bool HasCombinations(const I& k)
{
    return !k.model.combinations.empty();
}
bool InCombination(const I& k, int loadCase)
{
    return std::any_of(k.cases->begin(), k.cases->end(),
                       [&](const T_LCOM_ITEM& c) { return c.key == loadCase; });
}
template <class T, class KEY>
bool AllDiffer(const std::vector<T>& list, KEY key)
{
    std::set<std::decay_t<decltype(key(list.front()))>> seen;
    return std::all_of(list.begin(), list.end(),
                       [&](const T& entry) { return seen.insert(key(entry)).second; });
}

// clang-format off
const T_RULE<I> kItemRules[] = {
    {{.message = "IDS_RPS_No_Item_Name_", .field = "name"}, [](const I& k) { return !k.item.name.empty(); }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_NAME_EXISTS", .field = "name"},
     [](const I& k) { return k.item.name.empty() || (!NameTaken(k.model.ulfItems, k.item.name, k.ownKey) && !NameTaken(k.model.ulfStageItems, k.item.name, 0)); }},
    {{.message = "IDS_RPS_No_General_Load_Combination_exist_", .field = "combination"}, HasCombinations},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_COMBINATION", .field = "combination"}, [](const I& k) { return k.cases.has_value(); }, HasCombinations},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_OBJECTIVE", .field = "objective"}, [](const I& k) { return k.item.objective >= 0 && k.item.objective <= 2; }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_SIGN", .field = "sign"}, [](const I& k) { return k.item.sign >= 0 && k.item.sign <= 2; }},
    {{.message = "IDS_RPS_No_Unknown_Load_Factor_defined_", .field = "unknowns"}, [](const I& k) { return !k.item.unknowns.empty(); }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_NOT_IN_COMBINATION", .field = "unknowns"},
     [](const I& k) { return std::all_of(k.item.unknowns.begin(), k.item.unknowns.end(), [&](const T_ULFI_UNKNOWN& u) { return InCombination(k, u.loadCase); }); },
     [](const I& k) { return k.cases.has_value(); }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_TWICE", .field = "unknowns"},
     [](const I& k) { return AllDiffer(k.item.unknowns, [](const T_ULFI_UNKNOWN& u) { return u.loadCase; }); }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_WEIGHT", .field = "unknowns"},
     [](const I& k) { return std::all_of(k.item.unknowns.begin(), k.item.unknowns.end(), [](const T_ULFI_UNKNOWN& u) { return std::isfinite(u.weight) && u.weight >= 0; }); }},
    {{.message = "IDS_RPS_No_constraint_defined_for_the_unknowns_", .field = "constraints"}, [](const I& k) { return !k.item.constraints.empty(); }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_NO_SUCH_CONSTRAINT", .field = "constraints"},
     [](const I& k) { return std::all_of(k.item.constraints.begin(), k.item.constraints.end(), [&](const std::string& n) { return FindUlfConstraint(k.model, n) != 0; }); }},
    {{.message = kUlfItemError, .key = "IDS_QM_ULFI_TWICE", .field = "constraints"},
     [](const I& k) { return AllDiffer(k.item.constraints, [](const std::string& n) { return n; }); }},
};
// clang-format on

/// Fills {1} name, {2} rule, {3} number, {4} other number.
void FillTexts(std::vector<T_FINDING>& findings, const std::string& name, int id = 0, int other = 0)
{
    for (T_FINDING& f : findings) {
        const std::string rule = MMSGFunction::GetValue(f.ruleText);
        f.text = MMSGFunction::Format(f.messageKey,
                                      {name, rule, std::to_string(id), std::to_string(other)});
    }
}

} // namespace

std::vector<T_FINDING> CheckUlfConstraint(const T_ULFC_D& constraint, int ownKey,
                                          const T_MODEL& model)
{
    std::vector<T_FINDING> out;
    WalkRules(kConstraintRules, {constraint, model, ownKey}, {}, out);
    FillTexts(out, constraint.name, constraint.id, constraint.otherId);
    return out;
}

std::vector<T_FINDING> CheckUlfItem(const T_ULFI_D& item, int ownKey, const T_MODEL& model,
                                    const std::optional<std::vector<T_LCOM_ITEM>>& cases)
{
    std::vector<T_FINDING> out;
    WalkRules(kItemRules, {item, model, ownKey, cases}, {}, out);
    FillTexts(out, item.name);
    for (const std::string& name : item.constraints)
        AddConstraintFindings(name, model, out);
    return out;
}

void AddConstraintFindings(const std::string& name, const T_MODEL& model,
                           std::vector<T_FINDING>& out)
{
    const int key = FindUlfConstraint(model, name);
    if (key == 0) return;
    for (T_FINDING& f : CheckUlfConstraint(model.ulfConstraints.at(key), key, model)) {
        f.field = "constraints[" + name + "]." + f.field;
        out.push_back(std::move(f));
    }
}

int FindUlfConstraint(const T_MODEL& model, const std::string& name)
{
    const auto it = std::find_if(model.ulfConstraints.begin(), model.ulfConstraints.end(),
                                 [&](const auto& row) { return row.second.name == name; });
    return it == model.ulfConstraints.end() ? 0 : it->first;
}
