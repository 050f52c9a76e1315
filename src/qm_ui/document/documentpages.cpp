#include "qm_ui/document/documentpages.h"

#include "qm_ui/document/pagetext.h"

#include <QColor>
#include <QFontMetricsF>
#include <QPainter>

#include <algorithm>

namespace {

constexpr double kPx = kPageUnitsPerPx;
constexpr double kSide = 56.0, kTop = 70.0, kBottom = 64.0; // margins, px
const double kTextWidth = (CDocumentPages::SizePx().width() - 2.0 * kSide) * kPx;
const double kTextHeight = (CDocumentPages::SizePx().height() - kTop - kBottom) * kPx;
constexpr double kContentsPx = 11.0;

/// Height of a piece with those that must stay with it.
double HeightOfGroup(const std::vector<T_FLOW_PIECE>& flow, std::size_t i)
{
    const auto least = [](const T_FLOW_PIECE& p) { return p.least > 0.0 ? p.least : p.height; };
    double height = least(flow[i]);
    while (flow[i].keepWithNext && i + 1 < flow.size()) {
        ++i;
        height += flow[i].above + least(flow[i]);
    }
    return height;
}

T_FLOW_PIECE ContentsLine(const T_PAGE_MARK& mark, std::size_t number)
{
    const double indent = 18.0 * kPx * (mark.level - 1);
    const QFont font = PageFont(kContentsPx, mark.level == 1);
    const double pageWidth = 40.0 * kPx;
    const T_PAGE_TEXT title{mark.title, font, kTextWidth - indent - pageWidth};
    const T_PAGE_TEXT page{QString::number(number), font, pageWidth, Qt::AlignRight};
    T_FLOW_PIECE piece{(mark.level == 1 ? 6.0 : 2.0) * kPx, HeightOf(title)};
    piece.draw = [=](QPainter& painter, QPointF at) {
        painter.setPen(Qt::black);
        DrawText(painter, at + QPointF(indent, 0.0), title);
        DrawText(painter, at + QPointF(kTextWidth - pageWidth, 0.0), page);
    };
    return piece;
}

} // namespace

CDocumentPages::CDocumentPages(const T_DOCUMENT& document, const DOC_DRAW_FN& drawing)
    : m_title(PageString(document.title)), m_program(PageString(document.program)),
      m_pageText(PageString(document.words.page))
{
    Compose(FlowOf(document, drawing, kTextWidth, kTextHeight));
    AddContents(document);
}

void CDocumentPages::Compose(std::vector<T_FLOW_PIECE> flow)
{
    double y = kTextHeight + 1.0; // no page yet
    for (std::size_t i = 0; i < flow.size(); ++i) {
        const bool fits =
            y + flow[i].above + std::min(HeightOfGroup(flow, i), kTextHeight) <= kTextHeight;
        const bool isTop = !m_pages.empty() && m_pages.back().empty();
        constexpr double kEnough = 0.6; // of the page: a chapter may still begin
        const bool wantsNew = flow[i].onNewPage ||
                              (flow[i].opensChapter && y > kEnough * kTextHeight) ||
                              (flow[i].opensChapter && m_pages.size() == 1);
        if (m_pages.empty() || ((wantsNew || !fits) && !isTop)) {
            m_pages.emplace_back();
            y = 0.0;
            if (flow[i].head) {
                m_pages.back().push_back({flow[i].head, 0.0});
                y = flow[i].head->height;
            }
        }
        if (y > 0.0) y += flow[i].above;
        if (flow[i].shrunk && y + flow[i].height > kTextHeight)
            flow[i] = flow[i].shrunk(kTextHeight - y);
        const double height = flow[i].height;
        if (flow[i].level > 0)
            m_marks.push_back({flow[i].level, flow[i].title, m_pages.size() - 1, kTop + y / kPx});
        m_pages.back().push_back({std::make_shared<const T_FLOW_PIECE>(std::move(flow[i])), y});
        y += height;
    }
}

/// Behind the title block, on pages of their own where they need more.
void CDocumentPages::AddContents(const T_DOCUMENT& document)
{
    constexpr double kHeadPx = 14.0;
    const T_PAGE_TEXT head{PageString(document.contents), PageFont(kHeadPx, true), kTextWidth};
    std::vector<T_FLOW_PIECE> lines;
    T_FLOW_PIECE title{24.0 * kPx, HeightOf(head) + 4.0 * kPx, true};
    title.draw = [head](QPainter& painter, QPointF at) {
        painter.setPen(QColor(31, 78, 140));
        DrawText(painter, at, head);
    };
    // The lines are as high whatever their numbers: pages first, then the numbers.
    const auto pagesFor = [&](double y) {
        std::size_t pages = 0;
        y += title.above + title.height;
        for (const T_PAGE_MARK& mark : m_marks) {
            const T_FLOW_PIECE line = ContentsLine(mark, 0);
            y += line.above + line.height;
            if (y > kTextHeight) {
                ++pages;
                y = line.height;
            }
        }
        return pages;
    };
    const auto& first = m_pages.front();
    double y = first.empty() ? 0.0 : first.back().y + first.back().piece->height;
    const std::size_t more = pagesFor(y);
    m_pages.insert(m_pages.begin() + 1, more, T_PAGE{});
    for (T_PAGE_MARK& mark : m_marks)
        if (mark.page > 0) mark.page += more;
    std::size_t page = 0;
    const auto put = [&](T_FLOW_PIECE piece) {
        y += piece.above;
        if (y + piece.height > kTextHeight) {
            ++page;
            y = 0.0;
        }
        const double height = piece.height;
        m_pages[page].push_back({std::make_shared<const T_FLOW_PIECE>(std::move(piece)), y});
        y += height;
    };
    put(std::move(title));
    for (const T_PAGE_MARK& mark : m_marks)
        put(ContentsLine(mark, mark.page + 1));
}

void CDocumentPages::DrawFrame(QPainter& painter, std::size_t page) const
{
    constexpr double kSmallPx = 8.5;
    const QColor soft(90, 98, 110);
    const double width = SizePx().width() * kPx, height = SizePx().height() * kPx;
    const double left = kSide * kPx;
    painter.setPen(soft);
    const QFont font = PageFont(kSmallPx);
    const double top = 36.0 * kPx, bottom = height - 42.0 * kPx;
    const double half = 0.5 * kTextWidth;
    QString number = m_pageText;
    number.replace(QStringLiteral("{1}"), QString::number(page + 1));
    number.replace(QStringLiteral("{2}"), QString::number(Count()));
    const QString title = QFontMetricsF(font).elidedText(m_title, Qt::ElideRight, half);
    DrawText(painter, {left, top}, {title, font, half});
    DrawText(painter, {left + half, top}, {m_program, font, half, Qt::AlignRight});
    DrawText(painter, {left, bottom}, {number, font, kTextWidth, Qt::AlignRight});
    painter.setPen(QPen(soft, 0.5 * kPx));
    painter.drawLine(QPointF(left, top + 16.0 * kPx), QPointF(width - left, top + 16.0 * kPx));
}

void CDocumentPages::Draw(QPainter& painter, std::size_t page) const
{
    painter.save();
    painter.scale(1.0 / kPx, 1.0 / kPx);
    DrawFrame(painter, page);
    for (const T_PLACED& placed : m_pages.at(page))
        placed.piece->draw(painter, {kSide * kPx, kTop * kPx + placed.y});
    painter.restore();
}
