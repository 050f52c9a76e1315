#include "shell/cardgrid.h"

#include <QGridLayout>
#include <QLabel>
#include <QVBoxLayout>

#include <algorithm>

CCardGrid::CCardGrid(QWidget* parent)
    : QWidget(parent), m_title(new QLabel(this)), m_note(new QLabel(this)), m_grid(new QGridLayout)
{
    QFont large = font();
    large.setPointSizeF(large.pointSizeF() * 1.2);
    large.setBold(true);
    m_title->setFont(large);
    m_note->setWordWrap(true);
    m_grid->setSpacing(12);
    m_grid->setAlignment(Qt::AlignLeft | Qt::AlignTop);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(m_title);
    layout->addWidget(m_note);
    layout->addLayout(m_grid);
}

void CCardGrid::SetTitle(const QString& title)
{
    m_title->setText(title);
}

void CCardGrid::SetNote(const QString& note)
{
    m_note->setText(note);
}

void CCardGrid::Clear()
{
    for (CModelCard* card : m_cards)
        card->deleteLater(); // the list may be made anew by a button of a card
    for (CModelCard* card : m_cards)
        card->hide();
    m_cards.clear();
    m_columns = 0;
}

CModelCard& CCardGrid::Add(const QString& name, const QString& place)
{
    m_cards.push_back(new CModelCard(name, place, this));
    return *m_cards.back();
}

void CCardGrid::Arrange()
{
    m_note->setVisible(m_cards.empty() && !m_note->text().isEmpty());
    if (m_cards.empty()) return;
    const QSize card = m_cards.front()->sizeHint();
    const int room = std::max(width(), card.width());
    const int columns =
        std::max(1, (room + m_grid->spacing()) / (card.width() + m_grid->spacing()));
    if (columns == m_columns) return;
    m_columns = columns;
    for (std::size_t i = 0; i < m_cards.size(); ++i) {
        m_cards[i]->setFixedSize(card);
        m_grid->addWidget(m_cards[i], static_cast<int>(i) / columns, static_cast<int>(i) % columns);
        m_cards[i]->show();
    }
}

QSize CCardGrid::minimumSizeHint() const
{
    const int width = m_cards.empty() ? 0 : m_cards.front()->sizeHint().width();
    return {width, layout()->totalMinimumSize().height()};
}

void CCardGrid::resizeEvent(QResizeEvent* event)
{
    QWidget::resizeEvent(event);
    Arrange();
}
