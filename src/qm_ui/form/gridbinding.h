// What a table of a view is bound to: rows and columns of texts of a dialog model.
#pragma once

#include "qm_rps/desk/recordgrid.h"
#include "qm_rps/dialog/numbergrid.h"
#include "qm_rps/dialog/texttable.h"
#include "qm_ui/form/binding.h"

struct T_GRID_COLUMN {
    TextFn head;
    CELL_KIND kind = CELL_KIND::Text;
    bool edit = false;
    std::function<std::vector<std::string>()> choices{}; // of a Choice
};

/// Background of a cell that says something: worth a look, or a fault.
enum class CELL_TONE { Plain, Notice, Fault };

struct T_GRID_BINDING {
    std::vector<T_GRID_COLUMN> columns{};
    std::function<std::size_t()> rows{};
    std::function<std::string(std::size_t row, std::size_t column)> text{};
    /// Takes an edited cell: 1 taken, 0 refused (the cell shows its old value again). A choice
    /// gives its text.
    std::function<int(std::size_t row, std::size_t column, const std::string&)> set{};
    std::function<std::string(std::size_t row)> rowHead{}; // empty: numbers from 1
    /// Takes a copied block, whole or not at all, and says why not. Empty: the view gives the
    /// cells to `set` one by one; those that are refused keep their values.
    std::function<int(const std::string& text, const T_GRID_RANGE& range)> paste{};
    /// The chosen row, as it changes; -1 none.
    std::function<void(int row)> select{};
    std::function<int()> selected{};             // the model's choice, shown with each refresh
    std::function<void(std::size_t row)> open{}; // double click, or Enter on a fixed cell
    std::function<std::string(std::size_t row, std::size_t column)> mark{}; // finding of a cell
    /// Colour of a cell whose text says the same in words.
    std::function<CELL_TONE(std::size_t row, std::size_t column)> tone{};
};

/// The whole of a table of records. It must outlive the view.
T_GRID_BINDING GridOf(CRecordGrid& grid);
/// The whole of a number grid of the models. The grid must outlive the view.
T_GRID_BINDING GridOf(CNumberGrid& grid);
/// A table that is only read, made again with each refresh; its number of columns stays.
T_GRID_BINDING GridOf(std::function<T_TEXT_TABLE()> make);
/// Calls back after each cell or block that was taken.
void TellWhenTaken(T_GRID_BINDING& grid, const std::function<void()>& tell);
