#include "qm_rps/judge/judgementsheet.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/section/sectionexport.h"

namespace {

constexpr std::size_t kCountRow = 2, kNoteColumn = 4, kHeadRow = 7, kFirstRow = 8; // from 0
constexpr std::size_t kShift = 1; // the evaluation stands before the columns of the table

using C = JUDGED_COLUMN;

std::size_t ColumnOf(C column)
{
    return kShift + static_cast<std::size_t>(column);
}

/// A ratio as the quotient of its neighbours.
void PutRatio(T_SHEET& sheet, std::size_t row, C demand, C capacity, C ratio)
{
    T_SHEET_CELL& cell = sheet.cells[{row, ColumnOf(ratio)}];
    const double* const value = std::get_if<double>(&cell.value);
    if (!value || *value == 0.0) return;
    cell.value = T_SHEET_FORMULA{"=" + SheetAddress(row, ColumnOf(demand)) + "/" +
                                     SheetAddress(row, ColumnOf(capacity)),
                                 *value};
    cell.style.numberFormat = "0.000";
}

void PutRow(T_SHEET& sheet, std::size_t row, const T_JUDGEMENT& j, const T_JUDGED_CELLS& cells)
{
    sheet.cells[{row, 0}].value = j.evaluation;
    for (std::size_t c = 0; c < cells.size(); ++c) {
        SHEET_VALUE& value = sheet.cells[{row, kShift + c}].value;
        if (cells[c].number)
            value = *cells[c].number;
        else if (!cells[c].text.empty())
            value = cells[c].text;
    }
    PutRatio(sheet, row, C::Theta, C::ThetaCapacity, C::ThetaRatio);
    PutRatio(sheet, row, C::Shear, C::ShearCapacity, C::ShearRatio);
    PutRatio(sheet, row, C::Other, C::OtherCapacity, C::OtherRatio);
}

void PutHeads(T_SHEET& sheet, const T_UNITS& units)
{
    const auto put = [&](std::size_t column, const std::string& text) {
        T_SHEET_CELL& cell = sheet.cells[{kHeadRow, column}];
        cell.value = text;
        cell.style.bold = cell.style.centred = true;
    };
    put(0, Say("IDS_QM_JUDGE_EVALUATION"));
    const auto heads = JudgedHeads(units);
    for (std::size_t c = 0; c < heads.size(); ++c)
        put(kShift + c, heads[c]);
    EdgeBelow(sheet, {kHeadRow, 0, kHeadRow, kShift + heads.size() - 1}, SHEET_EDGE::Double);
}

/// How many rows have each verdict.
void PutCounts(T_SHEET& sheet, std::size_t end, const std::array<std::size_t, 3>& count)
{
    const std::string column = SheetColumn(ColumnOf(C::Verdict));
    for (std::size_t v = 0; v < count.size(); ++v) {
        const std::string word = VerdictText(static_cast<VERDICT>(v));
        sheet.cells[{kCountRow + v, 0}].value = word;
        sheet.cells[{kCountRow + v, 1}].value =
            T_SHEET_FORMULA{"=COUNTIF(" + column + std::to_string(kFirstRow + 1) + ":" + column +
                                std::to_string(std::max(end, kFirstRow + 1)) + ",\"" + word + "\")",
                            static_cast<double>(count[v])};
    }
}

} // namespace

T_SHEET JudgementSheet(std::span<const T_JUDGEMENT> judgements)
{
    T_SHEET sheet;
    sheet.name = "Judgement";
    sheet.cells[{0, 0}].value = Say("IDS_QM_JUDGE_SHEET");
    sheet.cells[{0, 0}].style.bold = true;
    if (judgements.empty()) return sheet;
    PutHeads(sheet, judgements.front().units);
    std::array<std::size_t, 3> count{};
    std::size_t row = kFirstRow, note = 1;
    for (const T_JUDGEMENT& j : judgements) {
        for (const T_JUDGED_STATE& state : j.states)
            for (const T_JUDGED_ROW& judged : state.rows) {
                if (row >= kSheetRows) break;
                PutRow(sheet, row++, j, CellsOf(j, state, judged));
                ++count[static_cast<std::size_t>(judged.verdict)];
            }
        const std::vector<std::string> notes =
            j.note.empty() ? JudgementNotes(j) : std::vector{j.evaluation + ": " + j.note};
        for (const std::string& text : notes)
            if (note + 1 < kHeadRow) sheet.cells[{note++, kNoteColumn}].value = text;
    }
    PutCounts(sheet, row, count);
    sheet.widths = {{0, 0, 16.0}, {ColumnOf(C::Governing), ColumnOf(C::Reason), 18.0}};
    return sheet;
}

std::string JudgementCsv(std::span<const T_JUDGEMENT> judgements)
{
    if (judgements.empty()) return {};
    T_TEXT_TABLE table;
    table.columns.push_back({Say("IDS_QM_JUDGE_EVALUATION"), false});
    for (const std::string& head : JudgedHeads(judgements.front().units))
        table.columns.push_back({head, false});
    for (const T_JUDGEMENT& j : judgements)
        for (const T_JUDGED_STATE& state : j.states)
            for (const T_JUDGED_ROW& judged : state.rows) {
                std::vector<std::string>& cells = table.rows.emplace_back();
                cells.push_back(j.evaluation);
                for (const T_JUDGED_CELL& cell : CellsOf(j, state, judged))
                    cells.push_back(cell.number ? FormatText("%.9g", *cell.number) : cell.text);
            }
    return TableCsv(table);
}
