#include "qm_rps/document/docparts.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/generate/codehingerows.h"

#include <algorithm>

namespace {

bool IsNumber(CELL_KIND kind)
{
    return kind == CELL_KIND::Number;
}

bool IsNothing(const std::string& cell)
{
    return cell.empty() || cell == "0" || cell == "-";
}

/// Without the columns that are empty, or zero, in every row; the first one always stays.
void DropEmpty(T_TEXT_TABLE& table)
{
    for (std::size_t c = table.columns.size(); c-- > 1;) {
        const bool isEmpty =
            std::ranges::all_of(table.rows, [&](const auto& row) { return IsNothing(row[c]); });
        if (!isEmpty) continue;
        const auto at = static_cast<std::ptrdiff_t>(c);
        table.columns.erase(table.columns.begin() + at);
        for (auto& row : table.rows)
            row.erase(row.begin() + at);
    }
}

/// Numbers of grids have every digit that is stored, so that they can be edited.
std::string Rounded(const std::string& cell)
{
    const bool isWhole = cell.find_first_not_of("-0123456789") == std::string::npos;
    const auto value = isWhole ? std::nullopt : ParseFinite(cell);
    return value ? ReportNumber(*value) : cell;
}

std::string CellOf(const CRecordGrid& grid, std::size_t row, std::size_t column)
{
    const std::string text = grid.CellText(row, column);
    if (grid.Kind(column) == CELL_KIND::Flag)
        return text == "1" ? Say("IDS_QM_FACT_YES") : std::string();
    return IsNumber(grid.Kind(column)) ? Rounded(text) : text;
}

/// Values of materials and dimensions of sections that are zero have not been given.
bool ZeroIsNone(EXPLORER_TABLE kind)
{
    return kind == EXPLORER_TABLE::Materials || kind == EXPLORER_TABLE::Sections;
}

std::string RowsText(std::size_t from, std::size_t to, std::size_t all)
{
    return " (" +
           Say("IDS_QM_REPORT_ROWS", std::to_string(from), std::to_string(to),
               std::to_string(all)) +
           ")";
}

} // namespace

std::string ReportNumber(double value)
{
    return FormatText("%.7g", value + 0.0);
}

std::string Capital(std::string text)
{
    if (!text.empty() && text[0] >= 'a' && text[0] <= 'z')
        text[0] = static_cast<char>(text[0] - 'a' + 'A');
    return text;
}

T_DOC_TEXT DocText(std::string text, DOC_TONE tone)
{
    return {std::move(text), tone};
}

bool HasDefinitions(const T_DOC_FACTS& facts)
{
    return std::ranges::any_of(facts.facts, [](const T_FACT& f) { return !f.definition.empty(); });
}

bool HasSymbols(const T_DOC_FACTS& facts)
{
    return std::ranges::any_of(facts.facts, [](const T_FACT& f) { return !f.symbol.empty(); });
}

T_DOC_TABLE DocTable(std::string caption, T_TEXT_TABLE table, T_TABLE_LIMIT limit)
{
    const std::size_t all = table.rows.size();
    if (limit.most > 0 && all > limit.most) {
        const std::size_t last = std::min(limit.last, limit.most);
        const auto first = static_cast<std::ptrdiff_t>(limit.most - last);
        table.rows.erase(table.rows.begin() + first,
                         table.rows.end() - static_cast<std::ptrdiff_t>(last));
        if (limit.most > last) caption += RowsText(1, limit.most - last, all);
        if (last > 0) caption += RowsText(all - last + 1, all, all);
    }
    return {std::move(caption), std::move(table)};
}

T_DOC_TABLE RecordsTable(CDBDoc& doc, EXPLORER_TABLE kind, T_TABLE_LIMIT limit)
{
    const auto grid = MakeRecordGrid(doc, kind);
    T_TEXT_TABLE table;
    for (std::size_t c = 0; c < grid->Columns(); ++c)
        table.columns.push_back({grid->ColumnHead(c), IsNumber(grid->Kind(c))});
    const std::size_t rows = limit.most > 0 ? std::min(limit.most, grid->Rows()) : grid->Rows();
    for (std::size_t r = 0; r < rows; ++r) {
        auto& row = table.rows.emplace_back();
        for (std::size_t c = 0; c < grid->Columns(); ++c)
            row.push_back(CellOf(*grid, r, c));
    }
    DropEmpty(table);
    if (ZeroIsNone(kind))
        for (auto& row : table.rows)
            std::ranges::replace(row, std::string("0"), std::string("-"));
    std::string caption = Say(TitleKey(kind));
    if (rows < grid->Rows()) caption += RowsText(1, rows, grid->Rows());
    return {std::move(caption), std::move(table)};
}

std::vector<T_FACT> FactsOf(const std::vector<T_CODE_TRACE>& trace, const T_UNITS& units)
{
    std::vector<T_FACT> facts;
    for (const T_CODE_TRACE& line : trace) {
        T_FACT& fact = facts.emplace_back();
        fact.symbol = line.symbol;
        fact.clause = line.clause;
        fact.formula = line.text;
        fact.value = FromSi(line.value, units, line.dim);
        fact.unit = UnitText(line.dim, units);
        fact.mark = line.mark;
    }
    return facts;
}
