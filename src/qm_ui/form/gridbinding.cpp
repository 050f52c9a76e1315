#include "qm_ui/form/gridbinding.h"

#include <memory>

T_GRID_BINDING GridOf(CNumberGrid& grid)
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

T_GRID_BINDING GridOf(std::function<T_TEXT_TABLE()> make)
{
    const auto table = std::make_shared<T_TEXT_TABLE>(make());
    T_GRID_BINDING b;
    for (std::size_t c = 0; c < table->columns.size(); ++c)
        b.columns.push_back({[table, c] { return table->columns[c].head; },
                             table->columns[c].number ? CELL_KIND::Number : CELL_KIND::Text});
    b.rows = [table, make = std::move(make)] { // asked for with each refresh, before the cells
        *table = make();
        return table->rows.size();
    };
    b.text = [table](std::size_t r, std::size_t c) {
        return r < table->rows.size() ? table->rows[r].at(c) : std::string();
    };
    return b;
}

void TellWhenTaken(T_GRID_BINDING& grid, const std::function<void()>& tell)
{
    const auto add = [&tell](auto& take) {
        if (!take) return;
        take = [before = take, tell](auto&&... given) {
            const int done = before(given...);
            if (done) tell();
            return done;
        };
    };
    add(grid.set);
    add(grid.paste);
}
