#include "qm_rps/section/sectionexport.h"

#include "qm_rps/dialog/csvcell.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"

void AppendOfSection(const std::string& section, const std::string& material,
                     const T_TEXT_TABLE& one, T_TEXT_TABLE& all)
{
    if (all.columns.empty()) {
        all.columns = {{Say("IDS_QM_UI_HEAD_SECTION")}, {Say("IDS_QM_UI_HEAD_MATERIAL")}};
        all.columns.insert(all.columns.end(), one.columns.begin(), one.columns.end());
    }
    for (const std::vector<std::string>& cells : one.rows) {
        std::vector<std::string>& row = all.rows.emplace_back();
        row = {section, material};
        row.insert(row.end(), cells.begin(), cells.end());
    }
}

T_TEXT_TABLE SectionExport(const std::vector<T_SECTION_ANSWER>& answers, const T_UNITS& units)
{
    T_TEXT_TABLE all;
    for (const T_SECTION_ANSWER& answer : answers) {
        const T_TEXT_TABLE one = answer.task == SECTION_TASK::Capacity
                                     ? SectionStates(answer, units)
                                     : SectionPoints(answer, units);
        AppendOfSection(answer.section, answer.material, one, all);
    }
    return all;
}

std::string TableCsv(const T_TEXT_TABLE& table)
{
    std::string text;
    for (std::size_t i = 0; i < table.columns.size(); ++i)
        text += (i ? "," : "") + CsvCell(table.columns[i].head);
    for (const std::vector<std::string>& row : table.rows) {
        text += "\n";
        for (std::size_t i = 0; i < row.size(); ++i)
            text += (i ? "," : "") + CsvCell(row[i]);
    }
    return text + "\n";
}

T_SHEET TableSheet(const T_TEXT_TABLE& table)
{
    T_SHEET sheet;
    for (std::size_t c = 0; c < table.columns.size(); ++c) {
        T_SHEET_CELL& head = sheet.cells[{0, c}];
        head.value = table.columns[c].head;
        head.style.bold = true;
        sheet.widths.push_back({c, c, 16.0});
        for (std::size_t r = 0; r < table.rows.size(); ++r) {
            const std::string& text = table.rows[r][c];
            const std::optional<double> number =
                table.columns[c].number ? ParseFinite(text) : std::nullopt;
            sheet.cells[{r + 1, c}].value = number ? SHEET_VALUE(*number) : SHEET_VALUE(text);
        }
    }
    return sheet;
}
