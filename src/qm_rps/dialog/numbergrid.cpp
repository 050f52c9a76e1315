#include "qm_rps/dialog/numbergrid.h"

#include "qm_base/textformat.h"

#include <algorithm>
#include <cmath>
#include <string_view>

namespace {

std::string_view Trim(std::string_view text)
{
    const std::size_t from = text.find_first_not_of(' ');
    if (from == std::string_view::npos) return {};
    return text.substr(from, text.find_last_not_of(' ') - from + 1);
}

} // namespace

std::string CNumberGrid::CellText(std::size_t row, std::size_t column) const
{
    if (row >= Rows() || column >= Columns()) return {};
    return Format(*CellOf(row, column) * ScaleOf(row, column));
}

bool CNumberGrid::Read(const std::string& text, std::size_t row, std::size_t column,
                       double& value) const
{
    const std::optional<double> number = ParseFinite(Trim(text));
    const double scale = ScaleOf(row, column);
    if (!number || !(scale > 0.0)) return false;
    value = *number / scale;
    return std::isfinite(value);
}

int CNumberGrid::SetCellText(std::size_t row, std::size_t column, const std::string& text)
{
    double value = 0.0;
    if (row >= Rows() || column >= Columns() || !Read(text, row, column, value)) return 0;
    *CellOf(row, column) = value;
    return 1;
}

int CNumberGrid::Paste(const std::string& text, const T_GRID_RANGE& range)
{
    const T_GRID_BLOCK block = BlockOfText(text);
    if (const char* key = WrongShape(block, range, Rows(), Columns())) {
        ShowMessage(key);
        return 0;
    }
    const std::size_t width = block.front().size();
    std::vector<double> values(block.size() * width);
    for (std::size_t i = 0; i < values.size(); ++i)
        if (!Read(block[i / width][i % width], range.row + i / width, range.column + i % width,
                  values[i])) {
            ShowMessage("IDS_QM_PASTE_NOT_A_NUMBER");
            return 0;
        }
    for (std::size_t i = 0; i < values.size(); ++i)
        *CellOf(range.row + i / width, range.column + i % width) = values[i];
    return 1;
}
