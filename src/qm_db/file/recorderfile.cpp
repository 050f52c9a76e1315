#include "qm_db/file/recorderfile.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/file/jsonplace.h"
#include "qm_db/filectrl.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <filesystem>
#include <limits>

namespace {

constexpr std::string_view kBlanks = " \t\r";

std::string_view Trimmed(std::string_view text)
{
    const auto from = text.find_first_not_of(kBlanks);
    if (from == text.npos) return {};
    return text.substr(from, text.find_last_not_of(kBlanks) - from + 1);
}

/// Cells of a row: a separator is a run of blanks with at most one comma in it.
void SplitRow(std::string_view line, std::vector<std::string_view>& cells)
{
    cells.clear();
    for (std::size_t at = 0; at < line.size();) {
        const std::size_t end = std::min(line.find_first_of(" \t\r,", at), line.size());
        cells.push_back(line.substr(at, end - at));
        at = std::min(line.find_first_not_of(kBlanks, end), line.size());
        if (at < line.size() && line[at] == ',')
            at = std::min(line.find_first_not_of(kBlanks, at + 1), line.size());
    }
}

/// Names of a header: with commas a name may have blanks; quotes around a name are dropped.
std::vector<std::string> SplitHeader(std::string_view line)
{
    std::vector<std::string_view> cells;
    if (line.find(',') == line.npos) {
        SplitRow(line, cells);
    } else {
        for (std::size_t at = 0; at <= line.size();) {
            const std::size_t end = std::min(line.find(',', at), line.size());
            cells.push_back(Trimmed(line.substr(at, end - at)));
            at = end + 1;
        }
    }
    std::vector<std::string> names;
    for (std::string_view cell : cells) {
        if (cell.size() >= 2 && cell.front() == '"' && cell.back() == '"')
            cell = cell.substr(1, cell.size() - 2);
        names.emplace_back(cell);
    }
    return names;
}

/// A number in form, also one that is not finite ("nan") or too large.
bool LooksLikeNumber(std::string_view cell)
{
    if (cell.starts_with('+')) cell.remove_prefix(1);
    double value = 0.0;
    const auto result = std::from_chars(cell.data(), cell.data() + cell.size(), value);
    return result.ec != std::errc::invalid_argument && result.ptr == cell.data() + cell.size();
}

} // namespace

int CRecorderFile::Load(const std::string& folder, const std::string& path, int skipRows,
                        T_FILE_ERROR& error)
{
    std::string text;
    const std::string whole = (std::filesystem::path(folder) / path).string();
    if (!CFileCtrl::ReadWholeFile(whole, text, error)) return 0;
    Parse(text, path, skipRows);
    return 1;
}

void CRecorderFile::Parse(std::string_view text, const std::string& name, int skipRows)
{
    *this = CRecorderFile();
    m_loaded = true;
    m_name = name;
    std::vector<std::string_view> cells;
    bool isFirst = true;
    int line = 0;
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t end = std::min(text.find('\n', at), text.size());
        const std::string_view row = Trimmed(text.substr(at, end - at));
        at = end + 1;
        if (++line <= skipRows || row.empty() || row.front() == '#') continue;
        SplitRow(row, cells);
        if (isFirst && std::none_of(cells.begin(), cells.end(), LooksLikeNumber))
            m_header = SplitHeader(row);
        else
            AddRow(cells, line);
        isFirst = false;
    }
}

void CRecorderFile::AddRow(const std::vector<std::string_view>& cells, int line)
{
    m_rowStart.push_back(m_cells.size());
    m_rowLine.push_back(line);
    for (std::size_t i = 0; i < cells.size(); ++i) {
        const auto number = ParseFinite(cells[i]);
        if (!number) m_badCells.emplace(i, cells[i]);
        m_cells.push_back(number.value_or(std::numeric_limits<double>::quiet_NaN()));
    }
}

std::size_t CRecorderFile::CellCount(std::size_t row) const
{
    const std::size_t end = row + 1 < m_rowStart.size() ? m_rowStart[row + 1] : m_cells.size();
    return end - m_rowStart[row];
}

T_FILE_ERROR CRecorderFile::ErrorAt(std::size_t row, std::size_t column,
                                    const std::string& reason) const
{
    return {FILE_FAULT::BadInput, Say("IDS_QM_RECORDER_AT", m_name, std::to_string(m_rowLine[row]),
                                      std::to_string(column + 1), reason)};
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
        const std::size_t count = CellCount(row);
        if (index >= count) {
            error = ErrorAt(row, index, Say("IDS_QM_RECORDER_SHORT_ROW", std::to_string(count)));
            return 0;
        }
        const double value = m_cells[m_rowStart[row] + index];
        if (std::isnan(value)) {
            error = ErrorAt(row, index,
                            Say("IDS_QM_RECORDER_NOT_FINITE", QuotedText(m_badCells.at(index))));
            return 0;
        }
        total[row] += value;
    }
    sum = std::move(total);
    return 1;
}
