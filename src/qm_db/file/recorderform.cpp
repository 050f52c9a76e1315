#include "qm_db/file/recorderform.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/file/jsonplace.h"

#include <algorithm>
#include <charconv>

namespace {

constexpr std::string_view kBlanks = " \t";
constexpr std::string_view kSeparators = " \t,;";

std::string_view Trimmed(std::string_view text)
{
    const auto from = text.find_first_not_of(kBlanks);
    if (from == text.npos) return {};
    return text.substr(from, text.find_last_not_of(kBlanks) - from + 1);
}

bool IsDigit(char c)
{
    return c >= '0' && c <= '9';
}

/// A number in form, also one that is not finite ("nan") or too large.
bool LooksLikeNumber(std::string_view cell)
{
    if (cell.starts_with('+')) cell.remove_prefix(1);
    double value = 0.0;
    const auto result = std::from_chars(cell.data(), cell.data() + cell.size(), value);
    return result.ec != std::errc::invalid_argument && result.ptr == cell.data() + cell.size();
}

/// Calls f(token, separators behind it) for what any separator parts.
template <class F>
void ForEachToken(std::string_view row, const F& f)
{
    for (std::size_t at = row.find_first_not_of(kSeparators); at < row.size();) {
        const std::size_t end = std::min(row.find_first_of(kSeparators, at), row.size());
        const std::size_t next = std::min(row.find_first_not_of(kSeparators, end), row.size());
        f(row.substr(at, end - at), row.substr(end, next - end));
        at = next;
    }
}

/// Where a table shows each sign of its form: the first row, or nothing.
struct T_SIGNS {
    std::optional<T_RECORDER_FAULT> semicolon;
    std::optional<T_RECORDER_FAULT> blank;                  // alone between two numbers
    std::optional<T_RECORDER_FAULT> looseComma, innerComma; // not, or directly, between digits
    std::optional<T_RECORDER_FAULT> point;                  // in a number
};

void Note(std::optional<T_RECORDER_FAULT>& sign, int line, std::size_t column,
          std::string_view seen)
{
    if (!sign) sign = {line, column, std::string(seen)};
}

void NoteSigns(const T_RECORDER_LINE& row, T_SIGNS& signs)
{
    std::size_t column = 0;
    bool isAfterBlank = false; // behind a number
    ForEachToken(row.text, [&](std::string_view token, std::string_view behind) {
        ++column;
        const bool isNumber = LooksLikeNumber(token);
        if (isNumber && isAfterBlank) Note(signs.blank, row.line, column, token);
        if (isNumber && token.find('.') != token.npos) Note(signs.point, row.line, column, token);
        if (behind.find(';') != behind.npos) Note(signs.semicolon, row.line, column, token);
        if (behind.find(',') != behind.npos) {
            const auto from = static_cast<std::size_t>(token.data() - row.text.data());
            const std::size_t next = from + token.size() + 1;
            const bool isInner = behind == "," && IsDigit(token.back()) && next < row.text.size() &&
                                 IsDigit(row.text[next]);
            const std::string_view pair =
                row.text.substr(from, row.text.find_first_of(kSeparators, next) - from);
            Note(isInner ? signs.innerComma : signs.looseComma, row.line, column, pair);
        }
        isAfterBlank = isNumber && !behind.empty() && behind.find_first_of(",;") == behind.npos;
    });
}

std::optional<T_RECORDER_FORM> Refuse(const T_RECORDER_FAULT& at, const char* key,
                                      T_RECORDER_FAULT& fault)
{
    fault = {at.line, at.column, Say(key, QuotedText(at.reason)),
             std::string_view(key) == "IDS_QM_RECORDER_EITHER"};
    return std::nullopt;
}

bool HasNameForEachCell(std::string_view header, std::string_view row)
{
    std::vector<std::string_view> names, cells;
    SplitRecorderRow(header, RECORDER_SEPARATOR::Commas, names);
    SplitRecorderRow(row, RECORDER_SEPARATOR::Commas, cells);
    return names.size() == cells.size();
}

} // namespace

bool IsRecorderHeader(std::string_view row)
{
    bool isHeader = true;
    ForEachToken(row, [&](std::string_view token, std::string_view) {
        isHeader = isHeader && !LooksLikeNumber(token);
    });
    return isHeader;
}

std::optional<T_RECORDER_FORM> FindRecorderForm(std::span<const T_RECORDER_LINE> rows,
                                                std::string_view header, RECORDER_DECIMAL decimal,
                                                T_RECORDER_FAULT& fault)
{
    T_SIGNS signs;
    for (const T_RECORDER_LINE& row : rows)
        NoteSigns(row, signs);
    using enum RECORDER_SEPARATOR;
    const bool isAuto = decimal == RECORDER_DECIMAL::Auto;
    const bool hasComma = signs.innerComma || signs.looseComma;
    if (!isAuto) {
        const bool isComma = decimal == RECORDER_DECIMAL::Comma;
        if (signs.semicolon) return T_RECORDER_FORM{Semicolons, isComma, false};
        return T_RECORDER_FORM{hasComma && !isComma ? Commas : Blanks, isComma, false};
    }
    if (signs.semicolon || signs.blank) {
        if (!signs.semicolon && signs.looseComma)
            return Refuse(*signs.looseComma, "IDS_QM_RECORDER_MIXED", fault);
        if (signs.innerComma && signs.point)
            return Refuse(*signs.innerComma, "IDS_QM_RECORDER_COMMA_AND_POINT", fault);
        return T_RECORDER_FORM{signs.semicolon ? Semicolons : Blanks, hasComma && !signs.point};
    }
    if (signs.innerComma && !signs.point && !HasNameForEachCell(header, rows.front().text))
        return Refuse(*signs.innerComma, "IDS_QM_RECORDER_EITHER", fault);
    return T_RECORDER_FORM{hasComma ? Commas : Blanks};
}

void SplitRecorderRow(std::string_view row, RECORDER_SEPARATOR separator,
                      std::vector<std::string_view>& cells)
{
    cells.clear();
    const bool isBlanks = separator == RECORDER_SEPARATOR::Blanks;
    const char mark = separator == RECORDER_SEPARATOR::Commas ? ',' : ';';
    for (std::size_t at = 0; at < row.size();) {
        const std::size_t stop = isBlanks ? row.find_first_of(kBlanks, at) : row.find(mark, at);
        const std::size_t end = std::min(stop, row.size());
        cells.push_back(Trimmed(row.substr(at, end - at)));
        at = isBlanks ? std::min(row.find_first_not_of(kBlanks, end), row.size()) : end + 1;
    }
}

std::vector<std::string> SplitRecorderHeader(std::string_view row, const T_RECORDER_FORM& form)
{
    std::vector<std::string_view> cells;
    const bool hasMark = row.find_first_of(",;") != row.npos;
    if (form.separator != RECORDER_SEPARATOR::Blanks && hasMark) {
        const bool isComma = row.find(';') == row.npos;
        SplitRecorderRow(row, isComma ? RECORDER_SEPARATOR::Commas : form.separator, cells);
    } else if (row.find('\t') != row.npos) {
        for (std::size_t at = 0; at < row.size();) {
            const std::size_t end = std::min(row.find('\t', at), row.size());
            cells.push_back(Trimmed(row.substr(at, end - at)));
            at = std::min(row.find_first_not_of(kBlanks, end), row.size());
        }
    } else {
        SplitRecorderRow(row, hasMark ? RECORDER_SEPARATOR::Commas : form.separator, cells);
    }
    std::vector<std::string> names;
    for (std::string_view cell : cells) {
        if (cell.size() >= 2 && cell.front() == '"' && cell.back() == '"')
            cell = cell.substr(1, cell.size() - 2);
        names.emplace_back(cell);
    }
    return names;
}

std::optional<double> RecorderNumber(std::string_view cell, const T_RECORDER_FORM& form)
{
    if (!form.isDecimalComma) return ParseFinite(cell);
    if (cell.find('.') != cell.npos) return std::nullopt; // between thousands, perhaps
    std::string number(cell);
    std::replace(number.begin(), number.end(), ',', '.');
    return ParseFinite(number);
}

std::optional<std::size_t> FindBlankInNumber(std::span<const std::string_view> cells)
{
    for (std::size_t i = 0; i + 1 < cells.size(); ++i) {
        const std::string_view a = cells[i], b = cells[i + 1];
        if (a.size() > 1 && (a.back() == '.' || a.back() == ',') && IsDigit(a[a.size() - 2]) &&
            std::all_of(b.begin(), b.end(), IsDigit))
            return i;
    }
    return std::nullopt;
}
