// Tables of the model's records: what the explorer lists and edits.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/dialog/gridblock.h"
#include "qm_rps/dialog/gridcell.h"

#include <memory>

/// How the rows of a table stand: by key, or by the cells of a column (numbers as numbers), and
/// which of them: those with the text in one of their cells.
struct T_GRID_ORDER {
    int column = -1; // -1: by key
    bool falling = false;
    std::string filter{}; // in any case of letters; empty: all
    bool operator==(const T_GRID_ORDER&) const = default;
};

/// A table of records, one row each, in the document's current units. Edits go to the document as
/// undoable steps; rows follow it.
class CRecordGrid : public zql::frx::MDialog {
public:
    virtual std::size_t Rows() const = 0;
    virtual std::size_t Columns() const = 0;
    /// With the unit: "X (m)".
    virtual std::string ColumnHead(std::size_t column) const = 0;
    virtual CELL_KIND Kind(std::size_t column) const = 0;
    virtual bool CanEdit(std::size_t column) const = 0;
    virtual std::vector<std::string> Choices(std::size_t column) const = 0;
    /// Empty outside the table.
    virtual std::string CellText(std::size_t row, std::size_t column) const = 0;
    /// One edit that can be undone. 0 with a message: no such cell, or the text is no value of it.
    [[nodiscard]] virtual int SetCellText(std::size_t row, std::size_t column,
                                          const std::string& text) = 0;
    /// Lines of tab-separated cells from a cell on, or over a range of the block's size; rows that
    /// are missing are not added. One edit; 0 with a message: nothing is pasted.
    [[nodiscard]] virtual int Paste(const std::string& text, const T_GRID_RANGE& range) = 0;
    /// Key or id of the record in a row; 0: no such row.
    virtual int KeyOf(std::size_t row) const = 0;
    /// Row of a record; -1: none.
    virtual long RowOf(int key) const = 0;
    /// Adds a record with default values under the next key. 0 with a message.
    [[nodiscard]] virtual int OnAdd() = 0;
    /// Key of the record that was added last; 0: none.
    virtual int MadeKey() const = 0;
    virtual void SetOrder(const T_GRID_ORDER& order) = 0;
    virtual const T_GRID_ORDER& Order() const = 0;
    /// Deletes records in one edit. 0 with a message: others use one of them (they are named).
    [[nodiscard]] virtual int OnDelete(const std::vector<std::size_t>& rows) = 0;
};

enum class EXPLORER_TABLE {
    Nodes,
    Elements,
    Sections,
    Materials,
    Storeys,
    LoadCases,
    Combinations,
    Stages,
    Pushovers,
    HingeTypes,
    Hinges,
    Spectra,
    Evaluations,
    UlfConstraints,
    UlfItems,
    UlfStageItems,
    Modes,
    Diaphragms,
    EqualDisplacements,
    InelasticHinges,
    IncrementFunctions,
    LimitStateSteps,
    Count
};

/// Key of a table's title.
const char* TitleKey(EXPLORER_TABLE table);
/// The kind of its records, and the table of a kind; empty: the model has one record of it.
RECORD_KIND KindOfTable(EXPLORER_TABLE table);
std::optional<EXPLORER_TABLE> TableOfKind(RECORD_KIND kind);
/// Number of its records.
std::size_t RecordCount(const CDBDoc& doc, EXPLORER_TABLE table);
bool RecordExists(const CDBDoc& doc, EXPLORER_TABLE table, int key);
/// The document must outlive the grid.
std::unique_ptr<CRecordGrid> MakeRecordGrid(CDBDoc& doc, EXPLORER_TABLE table);
