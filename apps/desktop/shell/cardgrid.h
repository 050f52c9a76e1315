// Cards under a heading, as many in a row as there is room for.
#pragma once

#include "shell/modelcard.h"

#include <vector>

class QGridLayout;
class QLabel;

class CCardGrid : public QWidget {
public:
    explicit CCardGrid(QWidget* parent);

    void SetTitle(const QString& title);
    /// What stands there while there is no card.
    void SetNote(const QString& note);
    void Clear();
    CModelCard& Add(const QString& name, const QString& place);
    const std::vector<CModelCard*>& Cards() const { return m_cards; }
    /// To be called after the last card.
    void Arrange();
    /// One column at least; more come with the room.
    QSize minimumSizeHint() const override;

protected:
    void resizeEvent(QResizeEvent* event) override;

private:
    QLabel *m_title, *m_note;
    QGridLayout* m_grid;
    std::vector<CModelCard*> m_cards;
    int m_columns = 0;
};
