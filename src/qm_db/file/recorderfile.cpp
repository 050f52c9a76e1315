#include "qm_db/file/recorderfile.h"

#include "qm_base/say.h"
#include "qm_db/file/jsonplace.h"
#include "qm_db/filectrl.h"

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <limits>

namespace {

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
constexpr std::string_view kBlanks = " \t";

/// Rows of the text behind the first `skip` lines. A line ends with LF, CR LF or CR.
std::vector<T_RECORDER_LINE> RowsOf(std::string_view text, int skip)
{
    if (text.starts_with(kByteOrderMark)) text.remove_prefix(kByteOrderMark.size());
    std::vector<T_RECORDER_LINE> rows;
    int line = 0;
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t end = std::min(text.find_first_of("\r\n", at), text.size());
        std::string_view row = text.substr(at, end - at);
        at = end + (text.substr(end).starts_with("\r\n") ? 2 : 1);
        const std::size_t from = row.find_first_not_of(kBlanks);
        if (++line <= skip || from == row.npos || row[from] == '#') continue;
        row = row.substr(from, row.find_last_not_of(kBlanks) - from + 1);
        rows.push_back({row, line});
    }
    return rows;
}

/// Links and ".." are followed as far as the path exists.
bool IsInside(const std::filesystem::path& folder, const std::filesystem::path& file)
{
    std::error_code fault, otherFault;
    const auto base = std::filesystem::weakly_canonical(folder.empty() ? "." : folder, fault);
    const auto target = std::filesystem::weakly_canonical(file, otherFault);
    if (fault || otherFault) return false;
    const auto relative = target.lexically_relative(base);
    return !relative.empty() && *relative.begin() != "..";
}

} // namespace

int CRecorderFile::Load(const std::string& folder, const std::string& path,
                        const T_OPTIONS& options, T_FILE_ERROR& error)
{
    std::string text;
    const std::string whole = (std::filesystem::path(folder) / path).string();
    if (!options.allowOutside && !IsInside(folder, whole)) {
        error = {FILE_FAULT::BadInput, Say("IDS_QM_RECORDER_OUTSIDE", path)};
        return 0;
    }
    if (!CFileCtrl::ReadWholeFile(whole, text, error)) return 0;
    return Parse(text, path, options, error);
}

int CRecorderFile::Parse(std::string_view text, const std::string& name, const T_OPTIONS& options,
                         T_FILE_ERROR& error)
{
    CRecorderFile read;
    read.m_name = name;
    const std::vector<T_RECORDER_LINE> all = RowsOf(text, options.skipRows);
    std::span<const T_RECORDER_LINE> rows(all);
    std::string_view header;
    if (!rows.empty() && IsRecorderHeader(rows.front().text)) {
        header = rows.front().text;
        rows = rows.subspan(1);
    }
    T_RECORDER_FAULT fault;
    const auto form = FindRecorderForm(rows, header, options.decimal, fault);
    std::vector<std::string_view> cells;
    bool isRight = form.has_value();
    for (std::size_t i = 0; i < rows.size() && isRight; ++i) {
        SplitRecorderRow(rows[i].text, form->separator, cells);
        isRight = read.AddRow(cells, rows[i].line, *form, fault);
    }
    if (!isRight) {
        error = read.ErrorAt(fault);
        return 0;
    }
    read.m_header = SplitRecorderHeader(header, *form);
    read.m_loaded = true;
    *this = std::move(read);
    return 1;
}

bool CRecorderFile::AddRow(const std::vector<std::string_view>& cells, int line,
                           const T_RECORDER_FORM& form, T_RECORDER_FAULT& fault)
{
    if (m_rowLine.empty()) m_width = cells.size();
    const auto blank = form.isBlankJudged && form.separator == RECORDER_SEPARATOR::Blanks
                           ? FindBlankInNumber(cells)
                           : std::nullopt;
    if (blank) {
        const std::string both = std::string(cells[*blank]) + ' ' + std::string(cells[*blank + 1]);
        fault = {line, *blank + 1, Say("IDS_QM_RECORDER_BLANK_INSIDE", QuotedText(both))};
        return false;
    }
    if (cells.size() != m_width) {
        fault = {line, std::min(cells.size(), m_width) + 1,
                 Say("IDS_QM_RECORDER_ROW_LENGTH", std::to_string(cells.size()),
                     std::to_string(m_width))};
        return false;
    }
    m_rowLine.push_back(line);
    for (std::size_t i = 0; i < cells.size(); ++i) {
        const auto number = RecorderNumber(cells[i], form);
        if (!number) m_badCells.emplace(i, cells[i]);
        m_cells.push_back(number.value_or(std::numeric_limits<double>::quiet_NaN()));
    }
    return true;
}

T_FILE_ERROR CRecorderFile::ErrorAt(const T_RECORDER_FAULT& fault) const
{
    return {FILE_FAULT::BadInput, Say("IDS_QM_RECORDER_AT", m_name, std::to_string(fault.line),
                                      std::to_string(fault.column), fault.reason)};
}

int CRecorderFile::FindColumn(const std::string& name, int& column, T_FILE_ERROR& error) const
{
    const auto it = std::find(m_header.begin(), m_header.end(), name);
    const bool twice =
        it != m_header.end() && std::find(it + 1, m_header.end(), name) != m_header.end();
    if (it == m_header.end() || twice) {
        const char* const reason = m_header.empty() ? "IDS_QM_RECORDER_NO_HEADER"
                                   : twice          ? "IDS_QM_RECORDER_TWO_COLUMNS"
                                                    : "IDS_QM_RECORDER_NO_COLUMN";
        error = {FILE_FAULT::BadInput, Say(reason, m_name, QuotedText(name))};
        return 0;
    }
    column = static_cast<int>(it - m_header.begin()) + 1;
    return 1;
}

int CRecorderFile::AddColumn(int column, std::vector<double>& sum, T_FILE_ERROR& error) const
{
    const auto index = static_cast<std::size_t>(column - 1);
    std::vector<double> total = sum;
    for (std::size_t row = 0; row < RowCount(); ++row) {
        if (index >= m_width) {
            const std::string reason = Say("IDS_QM_RECORDER_SHORT_ROW", std::to_string(m_width));
            error = ErrorAt({m_rowLine[row], index + 1, reason});
            return 0;
        }
        const double value = m_cells[row * m_width + index];
        if (std::isnan(value)) {
            const std::string reason =
                Say("IDS_QM_RECORDER_NOT_FINITE", QuotedText(m_badCells.at(index)));
            error = ErrorAt({m_rowLine[row], index + 1, reason});
            return 0;
        }
        total[row] += value;
    }
    sum = std::move(total);
    return 1;
}
