#include "qm_db/form/anyrecord.h"

#include "qm_db/casefile/caseput.h"
#include "qm_db/casefile/jsonparser.h"

namespace {

/// The words of commands, by the kinds of the registry.
constexpr std::array kKindWords{"node",
                                "storey",
                                "mode",
                                "material",
                                "section",
                                "element",
                                "diaphragm",
                                "equal_displacement",
                                "load_case",
                                "combination",
                                "stage",
                                "ulf_constraint",
                                "ulf_item",
                                "ulf_stage_item",
                                "increment_function",
                                "hinge_type",
                                "hinge",
                                "inelastic_hinge",
                                "spectrum",
                                "pushover",
                                "limit_state_step",
                                "evaluation",
                                "pushover_control",
                                "model"};
static_assert(kKindWords.size() == std::tuple_size_v<decltype(kRecords)> + 2);

bool IsOnce(RECORD_KIND kind)
{
    return kind == kModelOptionsKind || kind == kPushControlKind;
}

} // namespace

const char* KindWord(RECORD_KIND kind)
{
    return kKindWords.at(static_cast<std::size_t>(kind));
}

std::optional<RECORD_KIND> KindOfWord(std::string_view word)
{
    std::optional<RECORD_KIND> found;
    for (std::size_t i = 0; i < kKindWords.size(); ++i)
        if (word == kKindWords[i]) found = RECORD_KIND{i};
    std::size_t at = 0;
    ForEachKind([&](const auto& row) {
        if (word == row.store || (row.member && word == row.member)) found = RECORD_KIND{at};
        ++at;
    });
    return found;
}

std::vector<RECORD_KIND> AllKinds()
{
    std::vector<RECORD_KIND> kinds{kModelOptionsKind};
    for (std::size_t i = 0; i < std::tuple_size_v<decltype(kRecords)>; ++i) {
        if (RECORD_KIND{i} == KindOf<T_POLC_D>()) kinds.push_back(kPushControlKind);
        kinds.push_back(RECORD_KIND{i});
    }
    return kinds;
}

std::vector<int> KeysOf(const T_MODEL& model, RECORD_KIND kind)
{
    if (IsOnce(kind)) return {0};
    std::vector<int> keys;
    WithKind(kind, [&](const auto& row) {
        for (const auto& entry : model.*row.table)
            keys.push_back(entry.first);
    });
    return keys;
}

std::string NameOfRecord(const T_MODEL& model, RECORD_KIND kind, int key)
{
    std::string name;
    WithKind(kind, [&]<class R>(const T_RECORD_ROW<R>& row) {
        if constexpr (kHasName<R>) {
            const auto it = (model.*row.table).find(key);
            if (it != (model.*row.table).end()) name = it->second.name;
        }
    });
    return name;
}

std::optional<int> FindRecord(const T_MODEL& model, RECORD_KIND kind, const std::string& which)
{
    for (const int key : KeysOf(model, kind))
        if (!which.empty() && NameOfRecord(model, kind, key) == which) return key;
    for (const int key : KeysOf(model, kind))
        if (std::to_string(key) == which) return key;
    return {};
}

T_ANY_RECORD FindAny(const T_MODEL& model, RECORD_KIND kind, int key)
{
    if (kind == kModelOptionsKind) return model.styp;
    if (kind == kPushControlKind) return model.pushControl;
    T_ANY_RECORD found;
    WithKind(kind, [&](const auto& row) {
        const auto it = (model.*row.table).find(key);
        if (it != (model.*row.table).end()) found = it->second;
    });
    return found;
}

T_ANY_RECORD BlankAny(RECORD_KIND kind)
{
    if (kind == kModelOptionsKind) return T_STYP_D{};
    if (kind == kPushControlKind) return T_POGC_D{};
    T_ANY_RECORD blank;
    WithKind(kind, [&]<class R>(const T_RECORD_ROW<R>&) { blank = R{}; });
    return blank;
}

std::string* NameIn(T_ANY_RECORD& record)
{
    return std::visit(
        []<class R>(R& r) -> std::string* {
            if constexpr (kHasName<R>) return &r.name;
            return nullptr;
        },
        record);
}

int* IdIn(T_ANY_RECORD& record)
{
    if (auto* const node = std::get_if<T_NODE_D>(&record)) return &node->id;
    auto* const element = std::get_if<T_ELEM_D>(&record);
    return element ? &element->id : nullptr;
}

int PrintAny(const T_FORM_PLACE& place, const T_ANY_RECORD& record, const T_UNITS& units,
             T_JSON& out, std::string& reason)
{
    const CCaseNames names(place.model);
    CJsonWriter text(units);
    text.BeginObject();
    std::visit(
        [&]<class R>(const R& r) {
            if constexpr (!std::is_same_v<R, std::monostate>) {
                if constexpr (kHasName<R>) text.Member("name", r.name);
                CCasePut put(text, &names);
                CaseFields(put, r);
            }
        },
        record);
    text.EndObject();
    T_FILE_ERROR error = text.Error();
    if (!text.Failed() && ParseJson(text.TakeText(), out, error)) return 1;
    reason = error.text;
    return 0;
}

int PutAny(CDBDoc& doc, CEditScope& edit, int key, const T_ANY_RECORD& record)
{
    const T_UNITS& units = doc.Unit().Units();
    return std::visit(
        [&]<class R>(R r) {
            if constexpr (std::is_same_v<R, std::monostate>) {
                return 0;
            } else if constexpr (std::is_same_v<R, T_POGC_D>) {
                return edit.IsOpen() ? doc.Edit().PutPogc(std::move(r)) : 0;
            } else if constexpr (std::is_same_v<R, T_STYP_D>) {
                RecordFromSi(r, T_UNITS(r.units));
                return edit.PutStyp(std::move(r));
            } else { // values that come back from these units bit by bit
                ForEachQuantity(r, [&](double& v, T_DIM d) { v = ShortFromSi(v, units, d); });
                return edit.Put(key, std::move(r));
            }
        },
        record);
}
