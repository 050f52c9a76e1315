#include "qm_rps/desk/propertymodel.h"

#include "qm_base/say.h"
#include "qm_rps/desk/fieldhead.h"
#include "qm_rps/desk/modeltree.h"

#include <algorithm>

namespace {

std::string ValueOf(const T_FIELD_ROW& row)
{
    if (!row.isThere) return {};
    const bool records = row.kind == FIELD_KIND::Group ||
                         (row.kind == FIELD_KIND::List && row.items == FIELD_KIND::Group);
    if (records) return {};
    if (row.kind == FIELD_KIND::List) { // without brackets and quotes
        std::string text;
        for (const char c : row.text)
            if (c != '[' && c != ']' && c != '"') text += c;
        return text;
    }
    return row.target.empty() ? row.text : row.text + "  " + row.target;
}

/// "kN/m2"; empty: a ratio, a text.
std::string UnitOf(const T_FIELD_ROW& row, const T_UNITS& units)
{
    const std::string head = FieldHead({}, row, units); // " (kN/m2)"
    return head.size() < 4 ? std::string() : head.substr(2, head.size() - 3);
}

} // namespace

void CPropertyModel::Choose(RECORD_KIND kind, std::vector<int> keys)
{
    if (kind == m_kind && keys == m_keys) return;
    m_kind = kind;
    m_keys = std::move(keys);
    m_revision = -1;
    m_reason.clear();
}

void CPropertyModel::Follow(const CSelection& selection)
{
    const CSelection::T_KEYS* most = nullptr;
    RECORD_KIND kind = m_kind;
    for (int i = 0; i < static_cast<int>(EXPLORER_TABLE::Count); ++i) {
        const auto table = static_cast<EXPLORER_TABLE>(i);
        const CSelection::T_KEYS& keys = selection.Chosen(table);
        if (keys.empty() || (most && keys.size() <= most->size())) continue;
        most = &keys;
        kind = KindOfTable(table);
    }
    if (most)
        Choose(kind, {most->begin(), most->end()});
    else
        Choose(kind, {});
}

std::string CPropertyModel::Title() const
{
    if (m_keys.empty()) return {};
    const std::string title = TitleOfKind(m_kind);
    if (m_kind == kModelOptionsKind || m_kind == kPushControlKind) return title;
    if (m_keys.size() > 1) return title + ": " + std::to_string(m_keys.size());
    const std::string name = NameOfRecord(m_doc.Data().Model(), m_kind, m_keys.front());
    return title + ": " + (name.empty() ? std::to_string(m_keys.front()) : name);
}

const std::vector<T_PROPERTY>& CPropertyModel::Rows()
{
    const std::string language = zql::lib::MMSGFunction::GetLanguage();
    if (m_revision == m_doc.Data().Revision() && m_language == language) return m_rows;
    m_revision = m_doc.Data().Revision();
    m_language = language;
    m_rows.clear();
    CRecordForm form = Form();
    const std::vector<T_FIELD_ROW> rows = form.Rows();
    if (!form.Reason().empty()) m_reason = form.Reason();
    std::vector<int> compared = m_keys;
    compared.resize(std::min(compared.size(), kMostCompared));
    const std::vector<std::string> various = CRecordForm(m_doc, m_kind, compared).Various(rows);
    const T_UNITS& units = m_doc.Unit().Units();
    std::vector<FIELD_KIND> holders; // of the row, from outside
    for (const T_FIELD_ROW& row : rows) {
        holders.resize(static_cast<std::size_t>(row.depth));
        const bool item = !holders.empty() && holders.back() == FIELD_KIND::List;
        holders.push_back(row.kind);
        const bool differs = std::ranges::find(various, row.path) != various.end();
        const std::string label =
            item ? std::to_string(std::stoul(row.key) + 1) : FieldLabel(row.key);
        m_rows.push_back({label, differs ? Say("IDS_QM_PROP_VARIOUS") : ValueOf(row),
                          UnitOf(row, units), differs, row});
    }
    return m_rows;
}

int CPropertyModel::Keep(int done, const CRecordForm& form)
{
    m_reason = done ? std::string() : form.Reason();
    return done;
}

int CPropertyModel::OnSet(std::size_t row, const std::string& text)
{
    CRecordForm form = Form();
    const T_PROPERTY& property = Rows().at(row);
    // Opened, not changed.
    if (text == property.value || (property.various && text.empty())) return Keep(1, form);
    return Keep(form.Set(property.row.path, text), form);
}

int CPropertyModel::OnAdd(std::size_t row)
{
    CRecordForm form = Form();
    return Keep(form.Add(Rows().at(row).row.path), form);
}

int CPropertyModel::OnRemove(std::size_t row)
{
    CRecordForm form = Form();
    return Keep(form.Remove(Rows().at(row).row.path), form);
}
