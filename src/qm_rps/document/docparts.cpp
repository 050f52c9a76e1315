#include "qm_rps/document/docparts.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/generate/codehingerows.h"

#include <algorithm>

namespace {

bool IsNumber(CELL_KIND kind)
{
    return kind == CELL_KIND::Number;
}

/// Without the columns that are empty, or zero, in every row; the first one always stays.
void DropEmpty(T_TEXT_TABLE& table)
{
    const auto isNothing = [](const std::string& cell) {
        return cell.empty() || cell == "0" || cell == "-";
    };
    for (std::size_t c = table.columns.size(); c-- > 1;) {
        const bool isEmpty =
            std::ranges::all_of(table.rows, [&](const auto& row) { return isNothing(row[c]); });
        if (!isEmpty) continue;
        const auto at = static_cast<std::ptrdiff_t>(c);
        table.columns.erase(table.columns.begin() + at);
        for (auto& row : table.rows)
            row.erase(row.begin() + at);
    }
}

std::string FlagText(const CRecordGrid& grid, std::size_t row, std::size_t column)
{
    const std::string text = grid.CellText(row, column);
    if (grid.Kind(column) != CELL_KIND::Flag) return text;
    return text == "1" ? Say("IDS_QM_FACT_YES") : std::string();
}

} // namespace

T_DOC_TEXT DocText(std::string text, DOC_TONE tone)
{
    return {std::move(text), tone};
}

T_DOC_TEXT DocMono(std::string text)
{
    while (text.ends_with('\n') || text.ends_with(' '))
        text.pop_back();
    return {std::move(text), DOC_TONE::Plain, true};
}

T_DOC_TABLE DocTable(std::string caption, T_TEXT_TABLE table, T_TABLE_LIMIT limit)
{
    const std::size_t all = table.rows.size();
    if (limit.most > 0 && all > limit.most) {
        table.rows.resize(limit.most);
        caption +=
            " (" + Say("IDS_QM_REPORT_ROWS", std::to_string(limit.most), std::to_string(all)) + ")";
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
            row.push_back(FlagText(*grid, r, c));
    }
    DropEmpty(table);
    std::string caption = Say(TitleKey(kind));
    if (rows < grid->Rows())
        caption += " (" +
                   Say("IDS_QM_REPORT_ROWS", std::to_string(rows), std::to_string(grid->Rows())) +
                   ")";
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
