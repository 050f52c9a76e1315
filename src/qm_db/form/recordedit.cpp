#include "qm_db/form/recordedit.h"

#include "qm_base/say.h"
#include "qm_db/form/jsontree.h"

#include <algorithm>

int CRecordEdit::Refuse(std::string reason)
{
    m_reason = std::move(reason);
    return 0;
}

int CRecordEdit::Print(const T_UNITS& units, T_JSON& object)
{
    return PrintAny(m_place, m_record, units, object, m_reason);
}

int CRecordEdit::Read(T_JSON object, const T_UNITS& units)
{
    return ReadAny(m_place, std::move(object), units, m_record, m_reason);
}

int CRecordEdit::Check()
{
    T_JSON object;
    return Print(kSiUnits, object) && Read(std::move(object), kSiUnits);
}

int CRecordEdit::Rows(std::vector<T_FIELD_ROW>& rows, std::size_t mostItems)
{
    T_JSON object;
    if (!Print(Units(), object)) return 0;
    rows = ListAny(m_place.model, m_record, object, mostItems);
    return 1;
}

int CRecordEdit::Find(const std::string& path, std::optional<T_FIELD_ROW>& row)
{
    std::vector<T_FIELD_ROW> rows;
    if (!Rows(rows, CRecordForm::kMostItems)) return 0;
    const auto it = std::ranges::find(rows, path, &T_FIELD_ROW::path);
    if (it != rows.end()) row = std::move(*it);
    return 1;
}

/// What depends on the choice gets its defaults: the choice alone was refused.
int CRecordEdit::Turn(const std::string& path, const std::string& choice)
{
    const std::string refused = m_reason;
    const T_ANY_RECORD before = m_record;
    if (!TurnAny(m_record, path, choice)) return Refuse(refused);
    if (std::holds_alternative<T_SPFC_D>(m_record)) PresetAny(m_place.model, m_place.key, m_record);
    if (!FillAny(m_place.model, m_record) && Check()) return 1;
    m_record = before;
    return Refuse(refused);
}

int CRecordEdit::SetOne(const CRecordForm::T_SETTING& setting)
{
    std::optional<T_FIELD_ROW> row;
    if (!Find(setting.path, row)) return 0;
    if (row && row->isThere && row->text == setting.text) return 1; // not one digit changes
    const bool takesEmpty = row && row->kind == FIELD_KIND::Text && !row->canRemove;
    if (row && setting.text.empty() && !takesEmpty) return row->isThere ? Remove(setting.path) : 1;
    // A value by itself goes in as SI, so that the others keep every bit.
    const bool scalar = row && row->kind != FIELD_KIND::List && row->kind != FIELD_KIND::Group;
    const T_UNITS units = scalar ? kSiUnits : Units();
    T_JSON object, value;
    if (!Print(units, object)) return 0;
    const std::string fault = scalar ? ValueOfText(m_place.model, *row, setting.text, true, value)
                                     : PartOfText(row, setting.text, value);
    if (!fault.empty()) return Refuse(setting.path + ": " + fault);
    DropOthers(m_kind, setting.path, object);
    if (!PutJson(object, setting.path, std::move(value)))
        return Refuse(Say("IDS_QM_FORM_NO_PATH", setting.path));
    if (Read(std::move(object), units)) return 1;
    return row && row->kind == FIELD_KIND::Choice ? Turn(setting.path, setting.text) : 0;
}

/// Lists of one length, bounds that would cross: what only fits together.
int CRecordEdit::SetTogether(std::span<const CRecordForm::T_SETTING> settings)
{
    T_JSON object;
    if (!Print(Units(), object)) return 0;
    for (const auto& setting : settings) {
        std::optional<T_FIELD_ROW> row;
        T_JSON value;
        if (!Find(setting.path, row)) return 0;
        const bool scalar = row && row->kind != FIELD_KIND::List && row->kind != FIELD_KIND::Group;
        const std::string fault = scalar
                                      ? ValueOfText(m_place.model, *row, setting.text, false, value)
                                      : PartOfText(row, setting.text, value);
        if (!fault.empty()) return Refuse(setting.path + ": " + fault);
        DropOthers(m_kind, setting.path, object);
        if (!PutJson(object, setting.path, std::move(value)))
            return Refuse(Say("IDS_QM_FORM_NO_PATH", setting.path));
    }
    return Read(std::move(object), Units());
}

int CRecordEdit::Set(std::span<const CRecordForm::T_SETTING> settings)
{
    std::vector<CRecordForm::T_SETTING> rest;
    for (const auto& setting : settings)
        if (!SetOne(setting)) rest.push_back(setting);
    if (rest.empty()) return 1;
    return rest.size() == 1 ? SetOne(rest.front()) : SetTogether(rest);
}

int CRecordEdit::Add(const std::string& path)
{
    std::optional<T_FIELD_ROW> row;
    T_JSON object, made;
    if (!Find(path, row) || !Print(kSiUnits, object)) return 0;
    if (!row || !row->canAdd) return Refuse(Say("IDS_QM_FORM_NO_ADD", path));
    std::string reason;
    if (!NewPart(m_place.model, m_record, path, made, reason)) {
        if (!reason.empty()) return Refuse(reason);
        if (!NewValue(m_place.model, *row, made)) return Refuse(Say("IDS_QM_FORM_NO_ADD", path));
    }
    std::string at = path;
    if (row->kind == FIELD_KIND::List)
        at = JoinPath(path, std::to_string(CountAt(object, path)));
    else if (row->isThere)
        at = JoinPath(path, FreeNode(m_place.model, object, path));
    if (const std::string twin = TwinOf(path, object); !twin.empty()) {
        std::optional<T_FIELD_ROW> other;
        T_JSON beside;
        if (Find(twin, other) && other && NewValue(m_place.model, *other, beside))
            (void)PutJson(object, JoinPath(twin, std::to_string(CountAt(object, twin))),
                          std::move(beside));
    }
    if (!PutJson(object, at, std::move(made))) return Refuse(Say("IDS_QM_FORM_NO_PATH", path));
    return Read(std::move(object), kSiUnits);
}

int CRecordEdit::Remove(const std::string& path)
{
    T_JSON object;
    if (!Print(kSiUnits, object)) return 0;
    const std::size_t slash = path.rfind('/');
    const std::string twin =
        slash == std::string::npos ? std::string() : TwinOf(path.substr(0, slash), object);
    if (!RemoveJson(object, path)) return Refuse(Say("IDS_QM_FORM_NO_PATH", path));
    if (!twin.empty()) (void)RemoveJson(object, twin + path.substr(slash));
    return Read(std::move(object), kSiUnits);
}
