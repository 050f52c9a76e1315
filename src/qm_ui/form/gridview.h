// A table of a view: editing with full precision, copy and paste of blocks.
#pragma once

#include "qm_ui/form/gridmodel.h"

#include <QTableView>

/// Ctrl+C copies the chosen cells as a spreadsheet takes them (tabs and lines), Ctrl+V pastes a
/// block from the current cell on, or over the chosen ones.
class CGridView : public QTableView {
public:
    CGridView(T_GRID_BINDING binding, ChangedFn changed, QWidget* parent);

    /// Tells the person that cells of a pasted block were refused (a message key).
    std::function<void(const char* key)> m_refuse;

    void Refresh();
    /// Chosen cells as text with tabs and line ends, locale's separators.
    QString ChosenText() const;
    /// 1 taken; 0 refused by the model.
    int PasteText(const QString& text);
    CGridModel& Model() { return *m_model; }

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

private:
    T_GRID_RANGE ChosenRange() const;
    int PasteCells(const QString& text, const T_GRID_RANGE& from);
    void FitColumns();
    void CapWidest();
    void FollowChoice();

    CGridModel* m_model;
    ChangedFn m_changed;
    bool m_capped = false; // the widest column had to be
    bool m_quiet = false;  // the model's own choice is being shown
};
