#include "qm_ui/document/pagesview.h"

#include <QKeyEvent>
#include <QPainter>
#include <QScrollBar>

#include <algorithm>
#include <cmath>

namespace {

constexpr double kGap = 12.0; // around pages, px

} // namespace

CPagesView::CPagesView(QWidget* parent) : QAbstractScrollArea(parent)
{
    setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setFocusPolicy(Qt::StrongFocus);
}

void CPagesView::SetPages(std::shared_ptr<const CDocumentPages> pages)
{
    m_pages = std::move(pages);
    UpdateBar();
    viewport()->update();
}

double CPagesView::Scale() const
{
    return std::max(0.1, (viewport()->width() - 2.0 * kGap) / CDocumentPages::SizePx().width());
}

double CPagesView::PageHeight() const
{
    return Scale() * CDocumentPages::SizePx().height() + kGap;
}

void CPagesView::UpdateBar()
{
    const double all = kGap + static_cast<double>(Count()) * PageHeight();
    const int height = viewport()->height();
    verticalScrollBar()->setRange(0, std::max(0, static_cast<int>(std::ceil(all)) - height));
    verticalScrollBar()->setPageStep(static_cast<int>(PageHeight()));
    constexpr int kLine = 40;
    verticalScrollBar()->setSingleStep(kLine);
}

void CPagesView::resizeEvent(QResizeEvent* event)
{
    QAbstractScrollArea::resizeEvent(event);
    UpdateBar();
}

void CPagesView::keyPressEvent(QKeyEvent* event)
{
    const bool next = event->key() == Qt::Key_PageDown;
    if (!next && event->key() != Qt::Key_PageUp) return QAbstractScrollArea::keyPressEvent(event);
    verticalScrollBar()->triggerAction(next ? QAbstractSlider::SliderPageStepAdd
                                            : QAbstractSlider::SliderPageStepSub);
}

void CPagesView::paintEvent(QPaintEvent*)
{
    QPainter painter(viewport());
    painter.fillRect(viewport()->rect(), palette().color(QPalette::Mid));
    painter.setRenderHint(QPainter::Antialiasing);
    if (Count() == 0) {
        constexpr int kSide = 40; // of the text, px
        painter.setPen(palette().color(QPalette::WindowText));
        painter.drawText(viewport()->rect().adjusted(kSide, kSide, -kSide, -kSide),
                         Qt::AlignCenter | Qt::TextWordWrap, m_hint);
    }
    const double scale = Scale();
    for (std::size_t page = 0; page < Count(); ++page) {
        const double top =
            kGap + static_cast<double>(page) * PageHeight() - verticalScrollBar()->value();
        if (top > viewport()->height() || top + PageHeight() < 0.0) continue;
        painter.save();
        painter.translate(kGap, top);
        painter.scale(scale, scale);
        const QRectF paper({0.0, 0.0}, CDocumentPages::SizePx());
        painter.fillRect(paper, Qt::white);
        painter.setClipRect(paper);
        m_pages->Draw(painter, page);
        painter.restore();
    }
}
