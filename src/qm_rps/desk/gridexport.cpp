#include "qm_rps/desk/gridexport.h"

#include "qm_db/filectrl.h"
#include "qm_rps/section/sectionexport.h"

T_TEXT_TABLE TableOfGrid(const CRecordGrid& grid)
{
    T_TEXT_TABLE table;
    for (std::size_t c = 0; c < grid.Columns(); ++c)
        table.columns.push_back({grid.ColumnHead(c), grid.Kind(c) == CELL_KIND::Number});
    for (std::size_t r = 0; r < grid.Rows(); ++r) {
        std::vector<std::string>& cells = table.rows.emplace_back();
        for (std::size_t c = 0; c < grid.Columns(); ++c)
            cells.push_back(grid.CellText(r, c));
    }
    return table;
}

int ExportGrid(const CRecordGrid& grid, const std::string& path, std::string& error)
{
    const T_TEXT_TABLE table = TableOfGrid(grid);
    T_FILE_ERROR fault;
    const int done = path.ends_with(".xlsx")
                         ? WriteSheet(path, TableSheet(table), fault)
                         : CFileCtrl::WriteWholeFile(path, TableCsv(table), fault);
    error = fault.text;
    return done;
}
