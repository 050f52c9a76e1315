#include "qm_ui/gridbinding.h"

T_GRID_BINDING GridOf(CHingeNumberGrid& grid)
{
    T_GRID_BINDING b;
    for (std::size_t c = 0; c < grid.Columns(); ++c)
        b.columns.push_back({[&grid, c] { return grid.ColumnHead(c); }, CELL_KIND::Number, true});
    b.rows = [&grid] { return grid.Rows(); };
    b.text = [&grid](std::size_t r, std::size_t c) { return grid.CellText(r, c); };
    b.set = [&grid](std::size_t r, std::size_t c, const std::string& text) {
        return grid.SetCellText(r, c, text);
    };
    b.rowHead = [&grid](std::size_t r) { return grid.RowHead(r); };
    b.paste = [&grid](const std::string& text, const T_GRID_RANGE& range) {
        return grid.Paste(text, range);
    };
    return b;
}

T_GRID_BINDING GridOf(CRecordGrid& grid)
{
    T_GRID_BINDING b;
    for (std::size_t c = 0; c < grid.Columns(); ++c)
        b.columns.push_back({[&grid, c] { return grid.ColumnHead(c); }, grid.Kind(c),
                             grid.CanEdit(c), [&grid, c] { return grid.Choices(c); }});
    b.rows = [&grid] { return grid.Rows(); };
    b.text = [&grid](std::size_t r, std::size_t c) { return grid.CellText(r, c); };
    b.set = [&grid](std::size_t r, std::size_t c, const std::string& text) {
        return grid.SetCellText(r, c, text);
    };
    b.paste = [&grid](const std::string& text, const T_GRID_RANGE& range) {
        return grid.Paste(text, range);
    };
    return b;
}
