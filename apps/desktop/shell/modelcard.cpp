#include "shell/modelcard.h"

#include "shell/icons.h"
#include "shell/theme.h"
#include "shell/thumbnails.h"

#include <QEvent>
#include <QImage>
#include <QKeyEvent>
#include <QPainter>
#include <QToolButton>

namespace {

constexpr int kPad = 8, kCorner = 6;

} // namespace

CModelCard::CModelCard(const QString& name, const QString& place, QWidget* parent)
    : QAbstractButton(parent), m_place(place)
{
    setText(name);
    setToolTip(place);
    setAccessibleName(name);
    setAccessibleDescription(place);
    setFocusPolicy(Qt::StrongFocus);
    setCursor(Qt::PointingHandCursor);
    setAttribute(Qt::WA_Hover);
}

void CModelCard::SetPicture(const QPixmap& picture)
{
    m_picture = picture;
    update();
}

void CModelCard::SetGone(const QString& words, const QString& removeText,
                         std::function<void()> remove)
{
    m_place = words;
    unsetCursor();
    m_remove = new QToolButton(this);
    m_remove->setIcon(DrawnIcon("close"));
    m_remove->setAutoRaise(true);
    m_remove->setToolTip(removeText);
    m_remove->setAccessibleName(removeText + " " + text());
    connect(m_remove, &QToolButton::clicked, this, [remove = std::move(remove)] { remove(); });
}

QSize CModelCard::sizeHint() const
{
    const int lines = fontMetrics().height() * 2 + kPad;
    return {kThumbnailSize.width() + 2 * kPad, kThumbnailSize.height() + lines + 2 * kPad};
}

void CModelCard::resizeEvent(QResizeEvent* event)
{
    QAbstractButton::resizeEvent(event);
    if (!m_remove) return;
    m_remove->adjustSize();
    m_remove->move(width() - m_remove->width() - kPad / 2, kPad / 2);
}

/// One that is gone can be reached by the keyboard, so that it is read out, but not pressed.
bool CModelCard::event(QEvent* event)
{
    const bool isPress =
        event->type() == QEvent::MouseButtonPress || event->type() == QEvent::MouseButtonRelease;
    if (isPress && m_remove) return true;
    if (event->type() == QEvent::KeyPress && m_remove) {
        event->ignore(); // Tab goes on to the button
        return QWidget::event(event);
    }
    if (event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        if (key == Qt::Key_Return || key == Qt::Key_Enter) { // buttons take the space bar alone
            click();
            return true;
        }
    }
    return QAbstractButton::event(event);
}

void CModelCard::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    const QRectF card = QRectF(rect()).adjusted(1, 1, -1, -1);
    const bool marked = hasFocus() || (underMouse() && !m_remove);
    painter.setPen(QPen(palette().color(marked ? QPalette::Highlight : QPalette::Mid),
                        hasFocus() ? 2.0 : 1.0));
    painter.setBrush(palette().color(QPalette::Base));
    painter.drawRoundedRect(card, kCorner, kCorner);
    if (m_remove) painter.setOpacity(0.5);
    if (!m_picture.isNull()) {
        QImage image = m_picture.toImage();
        if (IsDark()) TurnLightness(image);
        painter.drawImage(QRectF(QPointF(kPad, kPad), QSizeF(kThumbnailSize)), image);
    }
    const int left = kPad, room = width() - 2 * kPad, line = fontMetrics().height();
    const int top = kPad + kThumbnailSize.height() + kPad / 2;
    QFont bold = font();
    bold.setBold(true);
    painter.setFont(bold);
    painter.setPen(palette().color(QPalette::Text));
    painter.drawText(QRect(left, top, room, line), Qt::AlignLeft | Qt::AlignVCenter,
                     QFontMetrics(bold).elidedText(text(), Qt::ElideRight, room));
    painter.setFont(font());
    painter.setPen(palette().color(QPalette::PlaceholderText));
    painter.drawText(QRect(left, top + line, room, line), Qt::AlignLeft | Qt::AlignVCenter,
                     fontMetrics().elidedText(m_place, Qt::ElideMiddle, room));
}
