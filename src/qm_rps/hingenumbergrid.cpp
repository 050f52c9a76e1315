#include "qm_rps/hingenumbergrid.h"

#include "qm_base/textformat.h"

#include <algorithm>
#include <cmath>
#include <string_view>

namespace {

using T_BLOCK = std::vector<std::vector<std::string>>;

std::vector<std::string> Split(std::string_view text, char separator)
{
    std::vector<std::string> parts;
    for (std::size_t from = 0;;) {
        const std::size_t to = text.find(separator, from);
        parts.emplace_back(text.substr(from, to - from));
        if (to == std::string_view::npos) return parts;
        from = to + 1;
    }
}

/// Rows and cells of a copied block; line ends of either kind.
T_BLOCK BlockOf(std::string text)
{
    std::erase(text, '\r');
    if (!text.empty() && text.back() == '\n') text.pop_back();
    T_BLOCK block;
    if (text.empty()) return block;
    for (const std::string& line : Split(text, '\n'))
        block.push_back(Split(line, '\t'));
    return block;
}

bool Ragged(const T_BLOCK& block)
{
    return std::any_of(block.begin(), block.end(),
                       [&](const auto& row) { return row.size() != block.front().size(); });
}

/// Message key of what keeps a block from the range of a grid; null when it fits.
const char* WrongShape(const T_BLOCK& block, const T_GRID_RANGE& r, std::size_t rows,
                       std::size_t columns)
{
    constexpr const char* kMismatch = "IDS_CMD_PASTE_RANGE_MISMATCH";
    if (block.empty() || Ragged(block) || r.row >= rows || r.column >= columns) return kMismatch;
    const std::size_t height = block.size(), width = block.front().size();
    const bool oneCell = r.rows == 1 && r.columns == 1;
    if (!oneCell && (height != r.rows || width != r.columns)) return kMismatch;
    if (width > columns - r.column) return "IDS_CMD_PASTE_EXCEED_COLUMN";
    if (height > rows - r.row) return "IDS_CMD_PASTE_EXCEED_ROW";
    return nullptr;
}

std::string_view Trim(std::string_view text)
{
    const std::size_t from = text.find_first_not_of(' ');
    if (from == std::string_view::npos) return {};
    return text.substr(from, text.find_last_not_of(' ') - from + 1);
}

} // namespace

std::string CHingeNumberGrid::CellText(std::size_t row, std::size_t column) const
{
    if (row >= Rows() || column >= Columns()) return {};
    return Format(*CellOf(row, column) * ScaleOf(row, column));
}

bool CHingeNumberGrid::Read(const std::string& text, std::size_t row, std::size_t column,
                            double& value) const
{
    const std::optional<double> number = ParseFinite(Trim(text));
    const double scale = ScaleOf(row, column);
    if (!number || !(scale > 0.0)) return false;
    value = *number / scale;
    return std::isfinite(value);
}

int CHingeNumberGrid::SetCellText(std::size_t row, std::size_t column, const std::string& text)
{
    double value = 0.0;
    if (row >= Rows() || column >= Columns() || !Read(text, row, column, value)) return 0;
    *CellOf(row, column) = value;
    return 1;
}

int CHingeNumberGrid::Paste(const std::string& text, const T_GRID_RANGE& range)
{
    const T_BLOCK block = BlockOf(text);
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
