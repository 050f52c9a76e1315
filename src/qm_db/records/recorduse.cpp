#include "qm_db/records/recorduse.h"

#include "qm_base/msgfunction.h"

#include <algorithm>

namespace {

/// Adds the keys of the records of a table for which `uses` holds.
template <class T, class F>
void Collect(const T_TABLE<T>& table, RECORD_KIND kind, T_RECORD_USERS& out, const F& uses)
{
    for (const auto& [key, record] : table) {
        if (uses(record)) out.push_back({kind, key});
    }
}

template <class R, class P>
bool Any(const R& all, const P& is)
{
    return std::any_of(all.begin(), all.end(), is);
}

bool Contains(const std::vector<int>& ids, int id)
{
    return std::find(ids.begin(), ids.end(), id) != ids.end();
}

constexpr int kStaticPattern = 0; // kind of a pushover pattern that names a static load case

// By RECORD_KIND.
constexpr std::array<const char*, 14> kKindKeys{
    "IDS_QM_DB_USER_ELEMENT",        "IDS_QM_DB_USER_DIAPHRAGM",      "IDS_QM_DB_USER_EQUAL",
    "IDS_QM_DB_USER_LOAD_CASE",      "IDS_QM_DB_USER_LCOM",           "IDS_QM_DB_USER_ULF_ITEM",
    "IDS_QM_DB_USER_STOREY",         "IDS_QM_DB_USER_HINGE",          "IDS_QM_DB_USER_HINGE_TYPE",
    "IDS_QM_DB_USER_PUSHOVER",       "IDS_QM_DB_USER_ULF_CONSTRAINT", "IDS_QM_DB_USER_STAGE",
    "IDS_QM_DB_USER_ULF_STAGE_ITEM", "IDS_QM_DB_USER_EVALUATION"};

/// Adds the stages of which a part, what comes or what goes, fulfils `uses`.
template <class F>
void CollectStages(const T_MODEL& model, T_RECORD_USERS& out, const F& uses)
{
    Collect(model.stages, RECORD_KIND::Stage, out,
            [&](const T_STAG_D& s) { return uses(s.activate) || uses(s.deactivate); });
}

/// Adds the items of construction stages of which a row fulfils `uses`.
template <class F>
void CollectStageItems(const T_MODEL& model, T_RECORD_USERS& out, const F& uses)
{
    Collect(model.ulfStageItems, RECORD_KIND::UlfStageItem, out,
            [&](const T_ULSI_D& item) { return Any(item.rows, uses); });
}

template <class T>
std::string Quoted(const T_TABLE<T>& table, int key)
{
    const auto it = table.find(key);
    return it == table.end() ? std::to_string(key) : '"' + it->second.name + '"';
}

} // namespace

template <>
T_RECORD_USERS UsersOf<T_NODE_D>(const T_MODEL& model, int id)
{
    T_RECORD_USERS users;
    const auto atNode = [&](const auto& load) { return load.node == id; };
    Collect(model.elements, RECORD_KIND::Element, users,
            [&](const T_ELEM_D& e) { return e.nodeI == id || e.nodeJ == id; });
    Collect(model.diaphragms, RECORD_KIND::Diaphragm, users,
            [&](const T_DIAP_D& d) { return Contains(d.nodes, id); });
    Collect(model.equalDisplacements, RECORD_KIND::EqualDisplacement, users,
            [&](const T_EQDS_D& e) { return Contains(e.nodes, id); });
    Collect(model.loadCases, RECORD_KIND::LoadCase, users,
            [&](const T_STLD_D& c) { return Any(c.nodal, atNode) || Any(c.settlement, atNode); });
    Collect(model.storeys, RECORD_KIND::Storey, users,
            [&](const T_STOR_D& s) { return Contains(s.nodes, id); });
    CollectStages(model, users, [&](const T_STAG_PART& p) { return Contains(p.supports, id); });
    return users;
}

template <>
T_RECORD_USERS UsersOf<T_ELEM_D>(const T_MODEL& model, int id)
{
    T_RECORD_USERS users;
    const auto onElement = [&](const auto& load) { return load.element == id; };
    Collect(model.loadCases, RECORD_KIND::LoadCase, users, [&](const T_STLD_D& c) {
        return Any(c.beam, onElement) || Any(c.temperature, onElement) ||
               Any(c.pretension, onElement);
    });
    Collect(model.hinges, RECORD_KIND::Hinge, users, onElement);
    CollectStages(model, users, [&](const T_STAG_PART& p) { return Contains(p.elements, id); });
    return users;
}

template <>
T_RECORD_USERS UsersOf<T_MATL_D>(const T_MODEL& model, int key)
{
    T_RECORD_USERS users;
    Collect(model.elements, RECORD_KIND::Element, users,
            [&](const T_ELEM_D& e) { return e.material == key; });
    Collect(model.hingeTypes, RECORD_KIND::HingeType, users,
            [&](const T_PHGT_D& t) { return t.sectionMaterial == key; });
    return users;
}

template <>
T_RECORD_USERS UsersOf<T_SECT_D>(const T_MODEL& model, int key)
{
    T_RECORD_USERS users;
    Collect(model.elements, RECORD_KIND::Element, users,
            [&](const T_ELEM_D& e) { return e.section == key; });
    Collect(model.hingeTypes, RECORD_KIND::HingeType, users,
            [&](const T_PHGT_D& t) { return t.section == key; });
    return users;
}

template <>
T_RECORD_USERS UsersOf<T_STLD_D>(const T_MODEL& model, int key)
{
    T_RECORD_USERS users;
    Collect(model.combinations, RECORD_KIND::Combination, users, [&](const T_LCOM_D& c) {
        return Any(c.items, [&](const T_LCOM_ITEM& i) { return !i.combination && i.key == key; });
    });
    Collect(model.ulfItems, RECORD_KIND::UlfItem, users, [&](const T_ULFI_D& item) {
        return Any(item.unknowns, [&](const T_ULFI_UNKNOWN& u) { return u.loadCase == key; });
    });
    Collect(model.pushovers, RECORD_KIND::Pushover, users, [&](const T_POLC_D& p) {
        return Any(p.patterns, [&](const T_POLC_PATTERN& row) {
            return row.kind == kStaticPattern && row.number == key;
        });
    });
    const auto ofCase = [&](const auto& row) { return row.loadCase == key; };
    CollectStages(model, users, [&](const T_STAG_PART& p) { return Any(p.loads, ofCase); });
    CollectStageItems(model, users, ofCase);
    return users;
}

template <>
T_RECORD_USERS UsersOf<T_LCOM_D>(const T_MODEL& model, int key)
{
    T_RECORD_USERS users;
    Collect(model.combinations, RECORD_KIND::Combination, users, [&](const T_LCOM_D& c) {
        return Any(c.items, [&](const T_LCOM_ITEM& i) { return i.combination && i.key == key; });
    });
    Collect(model.ulfItems, RECORD_KIND::UlfItem, users,
            [&](const T_ULFI_D& item) { return item.combination == key; });
    return users;
}

template <>
T_RECORD_USERS UsersOf<T_STAG_D>(const T_MODEL& model, int key)
{
    T_RECORD_USERS users;
    const auto inStage = [&](const auto& record) { return record.stage == key; };
    Collect(model.ulfConstraints, RECORD_KIND::UlfConstraint, users, inStage);
    CollectStageItems(model, users, inStage);
    return users;
}

template <>
T_RECORD_USERS UsersOf<T_PHGT_D>(const T_MODEL& model, int key)
{
    T_RECORD_USERS users;
    Collect(model.hinges, RECORD_KIND::Hinge, users,
            [&](const T_PHGE_D& hinge) { return hinge.hingeType == key; });
    return users;
}

/// Name of a record that is there.
template <class T>
std::string NameOfKey(const T_TABLE<T>& table, int key)
{
    const auto it = table.find(key);
    return it == table.end() ? std::string() : it->second.name;
}

template <>
T_RECORD_USERS UsersOf<T_SPFC_D>(const T_MODEL& model, int key)
{
    T_RECORD_USERS users;
    Collect(
        model.evaluations, RECORD_KIND::Evaluation, users,
        [name = NameOfKey(model.spectra, key)](const T_EVAL_D& e) { return e.spectrum == name; });
    return users;
}

template <>
T_RECORD_USERS UsersOf<T_POLC_D>(const T_MODEL& model, int key)
{
    T_RECORD_USERS users;
    Collect(model.evaluations, RECORD_KIND::Evaluation, users,
            [name = NameOfKey(model.pushovers, key)](const T_EVAL_D& e) { return e.push == name; });
    return users;
}

template <>
T_RECORD_USERS UsersOf<T_ULFC_D>(const T_MODEL& model, int key)
{
    T_RECORD_USERS users;
    const auto names = [name = NameOfKey(model.ulfConstraints, key)](const auto& item) {
        return std::find(item.constraints.begin(), item.constraints.end(), name) !=
               item.constraints.end();
    };
    Collect(model.ulfItems, RECORD_KIND::UlfItem, users, names);
    Collect(model.ulfStageItems, RECORD_KIND::UlfStageItem, users, names);
    return users;
}

std::string DescribeUser(const T_MODEL& model, const T_RECORD_USER& user)
{
    std::string which = std::to_string(user.key);
    if (user.kind == RECORD_KIND::LoadCase) which = Quoted(model.loadCases, user.key);
    if (user.kind == RECORD_KIND::Combination) which = Quoted(model.combinations, user.key);
    if (user.kind == RECORD_KIND::UlfItem) which = Quoted(model.ulfItems, user.key);
    if (user.kind == RECORD_KIND::Storey) which = Quoted(model.storeys, user.key);
    if (user.kind == RECORD_KIND::HingeType) which = Quoted(model.hingeTypes, user.key);
    if (user.kind == RECORD_KIND::Pushover) which = Quoted(model.pushovers, user.key);
    if (user.kind == RECORD_KIND::UlfConstraint) which = Quoted(model.ulfConstraints, user.key);
    if (user.kind == RECORD_KIND::Stage) which = Quoted(model.stages, user.key);
    if (user.kind == RECORD_KIND::UlfStageItem) which = Quoted(model.ulfStageItems, user.key);
    if (user.kind == RECORD_KIND::Evaluation) which = Quoted(model.evaluations, user.key);
    return zql::lib::MMSGFunction::Format(kKindKeys[static_cast<std::size_t>(user.kind)], {which});
}
