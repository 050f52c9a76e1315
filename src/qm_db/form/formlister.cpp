#include "qm_db/form/formlister.h"

#include "qm_db/form/anyrecord.h"

#include <algorithm>
#include <charconv>

namespace {

const T_JSON* MemberOf(const T_JSON& at, const std::string& key)
{
    if (const auto* members = std::get_if<T_JSON_MEMBERS>(&at.data)) {
        const auto it = std::ranges::find(*members, key, &T_JSON_MEMBER::key);
        return it == members->end() ? nullptr : &it->value;
    }
    const auto* items = std::get_if<T_JSON_ITEMS>(&at.data);
    std::size_t index = 0;
    std::from_chars(key.data(), key.data() + key.size(), index);
    return items && index < items->size() ? &(*items)[index] : nullptr;
}

std::size_t CountOf(const T_JSON& list)
{
    if (const auto* items = std::get_if<T_JSON_ITEMS>(&list.data)) return items->size();
    const auto* numbers = std::get_if<T_JSON_NUMBERS>(&list.data);
    return numbers ? numbers->size() : 0;
}

std::string TextOf(const T_JSON& value)
{
    const auto* text = std::get_if<std::string>(&value.data);
    return text ? *text : JsonLine(value);
}

} // namespace

const T_JSON* CFormLister::Find(const std::string& key)
{
    if (!m_at) return nullptr;
    const auto* numbers = std::get_if<T_JSON_NUMBERS>(&m_at->data);
    if (!numbers) return MemberOf(*m_at, key);
    if (m_numbers.empty())
        for (const double number : *numbers)
            m_numbers.emplace_back().data = number;
    std::size_t index = 0;
    std::from_chars(key.data(), key.data() + key.size(), index);
    return index < m_numbers.size() ? &m_numbers[index] : nullptr;
}

T_FIELD_ROW& CFormLister::Scalar(const std::string& key, FIELD_KIND kind, bool optional, T_DIM dim)
{
    const T_JSON* const value = Find(key);
    T_FIELD_ROW row{JoinPath(m_place, key), key, kind, dim};
    row.depth = m_depth;
    row.isAcceleration = key == "gravity"; // kDimAccel is no other than kDimLength
    row.isThere = value != nullptr;
    row.canRemove = optional && value;
    if (value) row.text = TextOf(*value);
    return m_to.rows.emplace_back(std::move(row));
}

CFormLister CFormLister::Open(const std::string& key, bool optional, FIELD_KIND kind,
                              bool takesItems)
{
    T_FIELD_ROW& row = Scalar(key, kind, optional);
    row.canAdd = kind == FIELD_KIND::List && takesItems;
    const T_JSON* const value = Find(key);
    return {m_to, value, row.path, m_depth + 1};
}

void CFormLister::Items(const char* key, T_FIELD_ROW item, bool optional)
{
    CFormLister list = Open(key, optional, FIELD_KIND::List);
    const std::size_t at = m_to.rows.size() - 1;
    m_to.rows[at].refers = item.refers;
    m_to.rows[at].choices = item.choices;
    m_to.rows[at].byKey = item.byKey;
    m_to.rows[at].items = item.kind;
    m_to.rows[at].dim = item.dim;
    const std::size_t count = list.m_at ? std::min(CountOf(*list.m_at), m_to.mostItems) : 0;
    for (std::size_t i = 0; i < count; ++i) {
        T_FIELD_ROW& row = list.Scalar(std::to_string(i), item.kind, true, item.dim);
        row.choices = item.choices;
        row.refers = item.refers;
        row.byKey = item.byKey;
    }
}

void CFormLister::NodeTable(const char* key, const std::map<int, T_DOF6>& values)
{
    CFormLister table = Open(key, false);
    m_to.rows.back().canAdd = true;
    std::size_t count = 0;
    for (const auto& [node, components] : values) {
        if (++count > m_to.mostItems) break;
        const std::string id = std::to_string(node);
        table.Fixed(id.c_str(), T_DIMS6{}, true);
    }
}

void CFormLister::Choice(const char* key, std::span<const char* const> names, bool optional)
{
    Scalar(key, FIELD_KIND::Choice, optional).choices.assign(names.begin(), names.end());
}

std::vector<std::string> CFormLister::NamesOfKind(RECORD_KIND kind) const
{
    if (kind == KindOf<T_POLC_D>()) return PushNames(m_to.model);
    std::vector<std::string> names;
    for (const int key : KeysOf(m_to.model, kind))
        names.push_back(NameOfRecord(m_to.model, kind, key));
    return names;
}

void CFormLister::Named(const char* key, RECORD_KIND kind, bool optional)
{
    T_FIELD_ROW& row = Scalar(key, FIELD_KIND::Reference, optional);
    row.refers = kind;
    row.choices = NamesOfKind(kind);
}

void CFormLister::NamedItems(const char* key, RECORD_KIND kind)
{
    T_FIELD_ROW item{.kind = FIELD_KIND::Reference, .choices = NamesOfKind(kind)};
    item.refers = kind;
    Items(key, item, true);
}

void CFormLister::Keyed(const char* key, int target, RECORD_KIND kind, bool optional)
{
    T_FIELD_ROW& row = Scalar(key, FIELD_KIND::Reference, optional);
    row.refers = kind;
    row.byKey = true;
    row.target = NameOfRecord(m_to.model, kind, target);
    constexpr std::size_t kMostOffered = 500; // elements are typed
    const std::vector<int> keys = KeysOf(m_to.model, kind);
    for (std::size_t i = 0; i < keys.size() && keys.size() <= kMostOffered; ++i)
        row.choices.push_back(std::to_string(keys[i]));
}

void CFormLister::Id(const char* key, RECORD_KIND kind)
{
    T_FIELD_ROW& row = Scalar(key, FIELD_KIND::Reference, false);
    row.refers = kind;
    row.byKey = true;
}

void CFormLister::Ids(const char* key, RECORD_KIND kind, bool optional)
{
    T_FIELD_ROW item{.kind = FIELD_KIND::Reference};
    item.refers = kind;
    item.byKey = true;
    Items(key, item, optional);
}

void CFormLister::NodePair(const char* key, int, int, std::size_t count, const char*)
{
    CFormLister list = Open(key, false, FIELD_KIND::List, false);
    m_to.rows.back().items = FIELD_KIND::Reference;
    m_to.rows.back().byKey = true;
    for (std::size_t i = 0; i < count; ++i)
        list.Id(std::to_string(i).c_str(), KindOf<T_NODE_D>());
}

// ---- alternatives -------------------------------------------------------------------------------

void CFormLister::More(const T_LCOM_ITEM& item)
{
    if (item.combination)
        Named("case", KindOf<T_STLD_D>(), true);
    else
        Named("combination", KindOf<T_LCOM_D>(), true);
}

void CFormLister::More(const T_ULFC_D& r)
{
    const T_DIM dim = UlfcDim(r.type, r.component);
    const bool isEqual = !r.inequality && r.compareWithValue;
    const bool isSame = !r.inequality && !r.compareWithValue;
    if (!r.inequality)
        for (const char* const key : {"upper", "lower"})
            Scalar(key, FIELD_KIND::Number, true, dim);
    if (!isEqual) Scalar("equal", FIELD_KIND::Number, true, dim);
    if (!isSame) Scalar("same_as", FIELD_KIND::Integer, true);
}

void CFormLister::More(const T_HINGE_COMPONENTS&)
{
    for (const char* const key : kComponentNames)
        if (!Find(key)) Scalar(key, FIELD_KIND::Group, true).canAdd = true;
}

// ---- the rows of a record -----------------------------------------------------------------------

std::vector<T_FIELD_ROW> ListAny(const T_MODEL& model, const T_ANY_RECORD& record,
                                 const T_JSON& object, std::size_t mostItems)
{
    CFormLister::T_SHARED shared{model, mostItems};
    std::visit(
        [&]<class R>(const R& r) {
            if constexpr (!std::is_same_v<R, std::monostate>) {
                CFormLister list(shared, &object, {}, 0);
                if constexpr (kHasName<R>) list.Name(r.name);
                CaseFields(list, r);
                list.More(r);
            }
        },
        record);
    return std::move(shared.rows);
}
