// The table of the records of the model: sorted by its heads, shown with so many decimals, copied
// with heads, left by Tab at its end.
#pragma once

#include "qm_ui/form/gridview.h"

#include <set>

class CRecordTableView : public CGridView {
public:
    /// The grid must outlive the view.
    CRecordTableView(CRecordGrid& grid, T_GRID_BINDING binding, ChangedFn changed, QWidget* parent);

    /// -1: all digits. What is stored stays; a copy has all digits.
    void SetDecimals(int decimals);
    int Decimals() const { return m_decimals; }
    /// The next click on a head turns the order round: rising, falling, by key.
    void SortBy(int column);
    /// The chosen cells with the heads of their columns above.
    QString ChosenTextWithHeads() const;
    /// Keys of the rows in which a cell is chosen.
    std::set<int> ChosenKeys() const;
    /// Chooses these rows; others are not.
    void ChooseKeys(const std::set<int>& keys);

protected:
    void keyPressEvent(QKeyEvent* event) override;
    bool focusNextPrevChild(bool next) override;

private:
    CRecordGrid& m_grid;
    int m_decimals = -1;
};
