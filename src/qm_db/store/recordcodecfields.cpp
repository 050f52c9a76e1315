#include "qm_db/store/recordcodecfields.h"

#include "qm_db/casefile/jsonparser.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/sqlitestmt.h"

#include <limits>

namespace {

constexpr const char* kText = "body";      // column, or name in "arrays", of a record's text
constexpr const char* kBlankText = "{}\n"; // no member has been written

} // namespace

std::string TextOwner(const std::string& table)
{
    return "more " + table;
}

CTablePlaces::CTablePlaces(std::string_view table)
{
    for (const T_MEMBER_PLACE& place : MemberPlaces())
        if (place.table == table) m_places.push_back(place);
}

CTablePlaces::CTablePlaces(const CSqliteDb& db, const std::string& table)
    : CTablePlaces(std::string_view(table))
{
    CSqliteStmt rows(db, "SELECT name, type, \"notnull\" FROM pragma_table_info('" + table + "')");
    while (rows.Step())
        m_columns[std::string(rows.Text(0))] = {rows.Text(1) == "TEXT", rows.Int(2) != 0};
}

const char* CTablePlaces::Find(std::string_view member, MEMBER_PLACE place) const
{
    for (const T_MEMBER_PLACE& row : m_places)
        if (row.place == place && row.member == member) return row.name;
    return nullptr;
}

void CRowPut::Finish()
{
    m_text.EndObject();
    if (m_text.Failed()) {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_BAD_RECORD",
                          m_row.Table() + ' ' + std::to_string(m_row.Key()) + ' ' +
                              m_text.Error().text);
    }
    std::string text = m_text.TakeText();
    const bool hasColumn = places.HasColumn(kText);
    const bool isNeeded = hasColumn ? places.IsRequired(kText) : places.IsAlone();
    if (text == kBlankText && !isNeeded) return;
    if (hasColumn)
        m_row.Put(kText, std::move(text));
    else
        m_arrays.Put(TextOwner(m_row.Table()), m_row.Key(), kText, std::string_view(text));
}

void CRowPut::PutList(const char* name, const std::map<int, T_DOF6>& byNode)
{
    std::vector<int> nodes;
    std::vector<double> all;
    for (const auto& [node, components] : byNode) {
        nodes.push_back(node);
        all.insert(all.end(), components.begin(), components.end());
    }
    PutNumbers((std::string(name) + "_nodes").c_str(), std::span<const int>(nodes));
    PutNumbers(name, std::span<const double>(all));
}

CRowGet::CRowGet(const CRecordRow& row, const CPackedArrays& arrays, const CTablePlaces& where)
    : places(where), m_row(row), m_arrays(arrays), m_document(TextOf())
{
}

T_JSON CRowGet::TextOf() const
{
    T_JSON document{T_JSON_MEMBERS{}};
    T_FILE_ERROR error;
    std::string text;
    if (places.HasColumn(kText) && !IsNull(kText))
        Get(kText, text);
    else if (!places.HasColumn(kText))
        text = m_arrays.Text(TextOwner(m_row.Table()), m_row.Key(), kText);
    if (!text.empty() && !ParseJson(text, document, error)) m_row.ThrowBadCell(kText);
    return document;
}

void CRowGet::Finish()
{
    m_body.Finish();
    if (m_in.Failed()) m_row.ThrowBadCell(kText);
}

void CRowGet::Get(const std::string& column, int& value) const
{
    const auto whole = Take<std::int64_t>(column);
    if (whole < std::numeric_limits<int>::min() || whole > std::numeric_limits<int>::max())
        m_row.ThrowBadCell(column);
    value = static_cast<int>(whole);
}

void CRowGet::Get(const std::string& column, bool& value) const
{
    const auto whole = Take<std::int64_t>(column);
    if (whole != 0 && whole != 1) m_row.ThrowBadCell(column);
    value = whole == 1;
}

void CRowGet::Get(const std::string& column, char& value) const
{
    const auto& text = Take<std::string>(column);
    if (text.size() != 1) m_row.ThrowBadCell(column);
    value = text.front();
}

void CRowGet::GetList(const char* name, std::map<int, T_DOF6>& byNode) const
{
    const std::vector<int> nodes =
        m_arrays.Ints(m_row.Table(), m_row.Key(), (std::string(name) + "_nodes").c_str());
    const std::vector<double> all = m_arrays.Doubles(m_row.Table(), m_row.Key(), name);
    if (all.size() != nodes.size() * std::tuple_size_v<T_DOF6>) m_row.ThrowBadCell(name);
    auto from = all.begin();
    for (const int node : nodes) {
        T_DOF6& components = byNode.emplace_hint(byNode.end(), node, T_DOF6{})->second;
        std::copy_n(from, components.size(), components.begin());
        from += static_cast<std::ptrdiff_t>(components.size());
    }
}

int CRowGet::CodeOf(const std::string& column, int first, std::span<const char* const> names) const
{
    int code = 0;
    if (places.IsText(column)) {
        const auto it = std::ranges::find(names, Take<std::string>(column));
        code = static_cast<int>(it - names.begin()) + first;
    } else {
        Get(column, code);
    }
    if (code < first || code >= first + static_cast<int>(names.size())) m_row.ThrowBadCell(column);
    return code;
}
