// Tables of results of what the view shows, or an envelope over all that is analysed.
#pragma once

#include "framepane.h"

#include "qm_rps/view/resulttable.h"

#include <QWidget>

class CResultTableModel;
class QCheckBox;
class QComboBox;
class QLabel;
class QTableView;
class QToolButton;

class CResultsPane : public QWidget {
public:
    /// The frame must outlive the pane.
    explicit CResultsPane(CFramePane& frame, QWidget* parent = nullptr);
    ~CResultsPane() override;

    /// Makes the table again where it is seen.
    void Refresh();
    void Retranslate();
    const T_RESULT_TABLE& Table() const { return m_table; }
    /// The table on the clipboard, with its heads.
    void Copy() const;
    /// Asks for a file and writes it: .csv, .xlsx.
    void Export();

protected:
    void showEvent(QShowEvent* event) override;

private:
    T_RESULT_TABLE_CHOICE Choice() const;

    CFramePane& m_frame;
    CFrameScene m_scene;
    T_RESULT_TABLE m_table;
    CResultTableModel* m_model;
    QComboBox *m_what, *m_of;
    QCheckBox* m_chosen;
    QToolButton *m_copy, *m_export;
    QLabel* m_note;
    QTableView* m_view;
};
