// One record while it is being changed: a copy, which goes back into the document when it keeps
// the rules.
#pragma once

#include "qm_db/form/fieldtext.h"

class CRecordEdit {
public:
    CRecordEdit(const T_MODEL& model, RECORD_KIND kind, int key, T_ANY_RECORD record)
        : m_place{model, key}, m_kind(kind), m_record(std::move(record))
    {
    }

    RECORD_KIND Kind() const { return m_kind; }
    const T_ANY_RECORD& Record() const { return m_record; }
    const std::string& Reason() const { return m_reason; }

    int Rows(std::vector<T_FIELD_ROW>& rows, std::size_t mostItems);
    /// One after the other, or where that is refused together, as far as they are no choices.
    int Set(std::span<const CRecordForm::T_SETTING> settings);
    int Add(const std::string& path);
    int Remove(const std::string& path);
    /// By the rules of a case file.
    int Check();

private:
    int SetOne(const CRecordForm::T_SETTING& setting);
    int SetTogether(std::span<const CRecordForm::T_SETTING> settings);
    int Find(const std::string& path, std::optional<T_FIELD_ROW>& row);
    int Turn(const std::string& path, const std::string& choice);
    int Print(const T_UNITS& units, T_JSON& object);
    int Read(T_JSON object, const T_UNITS& units);
    int Refuse(std::string reason);
    const T_UNITS& Units() const { return m_place.model.styp.units; }

    T_FORM_PLACE m_place;
    RECORD_KIND m_kind;
    T_ANY_RECORD m_record;
    std::string m_reason;
};
