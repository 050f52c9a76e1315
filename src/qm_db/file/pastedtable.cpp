#include "qm_db/pastedtable.h"

#include "qm_base/say.h"
#include "qm_db/file/recorderform.h"

#include <algorithm>
#include <span>

namespace {

int Fail(T_PASTED_FAULT& fault, int line, std::string text)
{
    fault = {line, std::move(text)};
    return 0;
}

std::string_view Trimmed(std::string_view text)
{
    constexpr std::string_view kBlanks = " \t\r";
    const auto from = text.find_first_not_of(kBlanks);
    if (from == text.npos) return {};
    return text.substr(from, text.find_last_not_of(kBlanks) - from + 1);
}

/// Lines that count, without blanks at their ends.
std::vector<T_RECORDER_LINE> LinesOf(std::string_view text)
{
    constexpr std::string_view kMark = "\xEF\xBB\xBF"; // that a text is UTF-8
    if (text.starts_with(kMark)) text.remove_prefix(kMark.size());
    std::vector<T_RECORDER_LINE> lines;
    for (int line = 1; !text.empty(); ++line) {
        const std::size_t end = std::min(text.find('\n'), text.size());
        const std::string_view row = Trimmed(text.substr(0, end));
        if (!row.empty() && row.front() != '#') lines.push_back({row, line});
        text.remove_prefix(std::min(end + 1, text.size()));
    }
    return lines;
}

/// More words than numbers: "Load case 1". A row of data with a bad cell is none.
bool IsHeader(std::string_view row)
{
    std::vector<std::string_view> cells;
    std::size_t words = 0, numbers = 0;
    for (std::size_t at = 0; at < row.size();) {
        const std::size_t end = std::min(row.find_first_of(" \t,;", at), row.size());
        if (end > at) ++(IsRecorderHeader(row.substr(at, end - at)) ? words : numbers);
        at = end + 1;
    }
    return words > numbers;
}

/// Cells of a row as numbers; the first one that is none is named.
int ReadRow(const T_RECORDER_LINE& row, const T_RECORDER_FORM& form, T_PASTED_TABLE& out,
            T_PASTED_FAULT& fault)
{
    std::vector<std::string_view> cells;
    SplitRecorderRow(row.text, form.separator, cells);
    if (form.isBlankJudged && FindBlankInNumber(cells))
        return Fail(fault, row.line, Say("IDS_QM_NEW_TABLE_BLANK", row.text));
    T_PASTED_ROW read{row.line};
    for (const std::string_view cell : cells) {
        const std::optional<double> value = RecorderNumber(cell, form);
        if (!value) return Fail(fault, row.line, Say("IDS_QM_NEW_TABLE_NUMBER", cell));
        out.hasPoint = out.hasPoint || cell.find_first_of(".,") != cell.npos;
        read.cells.push_back(*value);
    }
    const std::size_t width = out.rows.empty() ? read.cells.size() : out.rows[0].cells.size();
    if (read.cells.size() != width)
        return Fail(fault, row.line,
                    Say("IDS_QM_NEW_TABLE_WIDTH", std::to_string(read.cells.size()),
                        std::to_string(width)));
    out.rows.push_back(std::move(read));
    return 1;
}

/// "1,500": what is written alike with three decimals and with a separator of thousands.
bool MayPartThousands(std::string_view cell)
{
    constexpr std::size_t kGroup = 3;
    if (cell.starts_with('-') || cell.starts_with('+')) cell.remove_prefix(1);
    const std::size_t mark = cell.find_first_of(".,");
    const auto isDigit = [](char c) { return c >= '0' && c <= '9'; };
    return mark != cell.npos && mark >= 1 && mark <= kGroup && cell.front() != '0' &&
           cell.size() == mark + 1 + kGroup && std::ranges::all_of(cell.substr(0, mark), isDigit) &&
           std::ranges::all_of(cell.substr(mark + 1), isDigit);
}

/// The first cell with a mark where all that have one may part thousands; "": some number tells.
std::string_view FindThousands(std::span<const T_RECORDER_LINE> rows, const T_RECORDER_FORM& form)
{
    std::string_view first;
    std::vector<std::string_view> cells;
    for (const T_RECORDER_LINE& row : rows) {
        cells.clear();
        SplitRecorderRow(row.text, form.separator, cells);
        for (const std::string_view cell : cells) {
            if (cell.find_first_of(".,") == cell.npos) continue;
            if (!MayPartThousands(cell)) return {};
            if (first.empty()) first = cell;
        }
    }
    return first;
}

} // namespace

int ReadPastedTable(std::string_view text, PASTED_DECIMAL decimal, T_PASTED_TABLE& out,
                    T_PASTED_FAULT& fault)
{
    const std::vector<T_RECORDER_LINE> lines = LinesOf(text);
    T_PASTED_TABLE table;
    std::size_t first = 0;
    std::string_view header;
    for (; first < lines.size() && IsHeader(lines[first].text); ++first) {
        table.headers.push_back(lines[first].line);
        header = lines[first].text;
    }
    const std::span rows = std::span(lines).subspan(first);
    if (rows.empty()) return Fail(fault, 0, Say("IDS_QM_NEW_TABLE_EMPTY"));
    T_RECORDER_FAULT why;
    const auto form = FindRecorderForm(rows, header, static_cast<RECORDER_DECIMAL>(decimal), why);
    if (!form)
        return Fail(fault, why.line, why.isEither ? Say("IDS_QM_NEW_TABLE_EITHER") : why.reason);
    if (!header.empty()) table.names = SplitRecorderHeader(header, *form);
    table.separator = static_cast<PASTED_SEPARATOR>(form->separator);
    table.isDecimalComma = form->isDecimalComma;
    for (const T_RECORDER_LINE& row : rows)
        if (!ReadRow(row, *form, table, fault)) return 0;
    if (decimal == PASTED_DECIMAL::Auto)
        if (const auto cell = FindThousands(rows, *form); !cell.empty())
            return Fail(fault, 0, Say("IDS_QM_NEW_TABLE_THOUSANDS", cell));
    out = std::move(table);
    return 1;
}
