// A raw table of another solver: rows of numbers separated by blanks, tabs, commas or semicolons
// (see recorderform.h), with or without one header line. Lines that start with '#' and blank lines
// don't count as rows. All rows have the same number of cells.
#pragma once

#include "qm_db/file/recorderform.h"
#include "qm_db/fileerror.h"

#include <map>
#include <string>
#include <string_view>
#include <vector>

class CRecorderFile {
public:
    struct T_OPTIONS {
        int skipRows = 0;
        RECORDER_DECIMAL decimal = RECORDER_DECIMAL::Auto;
        bool allowOutside = false; // the file may lie outside the folder
    };
    /// Reads folder/path, a regular file in the folder or below it (links followed). The first
    /// `skipRows` lines are dropped, whatever they hold; a first row without any number is the
    /// header. 1 done; 0 error filled (names `path`, and line and column where the table can be
    /// read in two ways or a row is longer or shorter), nothing loaded.
    [[nodiscard]] int Load(const std::string& folder, const std::string& path,
                           const T_OPTIONS& options, T_FILE_ERROR& error);
    /// The same from text; `name` stands for the file in messages.
    [[nodiscard]] int Parse(std::string_view text, const std::string& name,
                            const T_OPTIONS& options, T_FILE_ERROR& error);

    bool IsLoaded() const { return m_loaded; }
    std::size_t RowCount() const { return m_rowLine.size(); }
    /// Line of the last row, from 1; 0 without rows.
    int LastLine() const { return m_rowLine.empty() ? 0 : m_rowLine.back(); }

    /// Column (from 1) by its name in the header. 1 done; 0 error filled.
    [[nodiscard]] int FindColumn(const std::string& name, int& column, T_FILE_ERROR& error) const;
    /// Adds a column (from 1) to `sum`, which has RowCount() values. 1 done; 0 a row has no such
    /// column or no finite number there: error filled with file, line and column, `sum` as it was.
    [[nodiscard]] int AddColumn(int column, std::vector<double>& sum, T_FILE_ERROR& error) const;

private:
    /// False, with `fault` filled, for a row that does not go with the first one.
    bool AddRow(const std::vector<std::string_view>& cells, int line, const T_RECORDER_FORM& form,
                T_RECORDER_FAULT& fault);
    T_FILE_ERROR ErrorAt(const T_RECORDER_FAULT& fault) const;

    bool m_loaded = false;
    std::string m_name;
    std::vector<std::string> m_header;
    std::vector<double> m_cells; // row after row; NaN marks a cell that is no number
    std::size_t m_width = 0;     // cells of each row
    std::vector<int> m_rowLine;  // line of the row in the file, from 1
    std::map<std::size_t, std::string> m_badCells; // column (from 0): first text that is no number
};
