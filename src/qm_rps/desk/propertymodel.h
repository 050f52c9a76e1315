// Properties of the records that are chosen: their members with names, values and units.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/recordform.h"
#include "qm_rps/desk/selection.h"

struct T_PROPERTY {
    std::string label;    // "Dimensions"
    std::string value;    // as a person reads it
    std::string unit;     // "m"
    bool various = false; // of several records; an edit goes to all
    T_FIELD_ROW row;
};

/// The document must outlive the model.
class CPropertyModel : public zql::frx::MDialog {
public:
    explicit CPropertyModel(CDBDoc& doc) : m_doc(doc) {}

    /// Records of one kind; of many, the first ones are compared.
    void Choose(RECORD_KIND kind, std::vector<int> keys);
    /// The table that has the most records chosen.
    void Follow(const CSelection& selection);
    bool IsEmpty() const { return m_keys.empty(); }
    RECORD_KIND Kind() const { return m_kind; }
    const std::vector<int>& Keys() const { return m_keys; }
    /// "Section column", "Nodes: 12"; empty: nothing is chosen.
    std::string Title() const;

    /// In the order of the case file, each behind what it stands in. Made again after a change.
    const std::vector<T_PROPERTY>& Rows();
    /// Why the last edit was refused, or the record can't be shown; empty: all is well.
    const std::string& Reason() const { return m_reason; }

    // Each is one step that can be undone. 1 done; 0 Reason says what is refused and where.
    [[nodiscard]] int OnSet(std::size_t row, const std::string& text);
    [[nodiscard]] int OnAdd(std::size_t row);
    [[nodiscard]] int OnRemove(std::size_t row);

    static constexpr std::size_t kMostCompared = 200;

private:
    CRecordForm Form() const { return {m_doc, m_kind, m_keys}; }
    int Keep(int done, const CRecordForm& form);

    CDBDoc& m_doc;
    RECORD_KIND m_kind = kModelOptionsKind;
    std::vector<int> m_keys;
    std::vector<T_PROPERTY> m_rows;
    long m_revision = -1;
    std::string m_language;
    std::string m_reason;
};
