#include "qm_ui/document/pageflow.h"

#include "qm_ui/document/pagetext.h"
#include "qm_ui/document/tableflow.h"

#include <QColor>
#include <QPainter>

#include <algorithm>

namespace {

constexpr double kPx = kPageUnitsPerPx;
constexpr double kBodyPx = 11.0, kMonoPx = 8.5, kSmallestMonoPx = 5.5;
constexpr std::array<double, 3> kHeadingPx{18.0, 14.0, 12.0};

QString Q(const std::string& text)
{
    return QString::fromStdString(text);
}

T_FLOW_PIECE TextPiece(T_PAGE_TEXT text, double above, QColor color = Qt::black)
{
    T_FLOW_PIECE piece{above, HeightOf(text)};
    piece.draw = [text = std::move(text), color](QPainter& painter, QPointF at) {
        painter.setPen(color);
        DrawText(painter, at, text);
    };
    return piece;
}

class CFlowWriter {
public:
    CFlowWriter(const DOC_DRAW_FN& drawing, double width, double height)
        : m_drawing(drawing), m_width(width), m_height(height)
    {
    }

    void operator()(const T_DOC_TEXT& t)
    {
        static const std::array colors{QColor(Qt::black), QColor(20, 110, 50), QColor(170, 30, 25),
                                       QColor(125, 80, 0)};
        constexpr std::array signs{"", "\u2713 ", "\u2717 ", "! "};
        const auto tone = static_cast<std::size_t>(t.tone);
        if (t.mono) return Mono(t.text);
        constexpr double kAbove = 6.0 * kPx;
        m_out.push_back(
            TextPiece({QString::fromUtf8(signs[tone]) + Q(t.text), PageFont(kBodyPx), m_width},
                      kAbove, colors[tone]));
    }
    void operator()(const T_DOC_TABLE& t) { AddTable(t, m_width, m_out); }
    void operator()(const T_DOC_FACTS& t) { AddFacts(t, m_width, m_out); }
    void operator()(const T_DOC_PICTURE& p)
    {
        if (!m_drawing) return;
        const auto drawing = std::make_shared<const T_DRAWING>(m_drawing(p));
        const QSizeF size = drawing->size;
        constexpr double kHighest = 0.55; // of the page
        const double scale =
            std::min(p.width * m_width / size.width(), kHighest * m_height / size.height());
        constexpr double kAbove = 8.0 * kPx;
        T_FLOW_PIECE piece{kAbove, scale * size.height(), true};
        piece.draw = [drawing, scale, size](QPainter& painter, QPointF at) {
            painter.save();
            painter.translate(at);
            painter.scale(scale, scale);
            painter.setClipRect(QRectF({0, 0}, size));
            drawing->draw(painter, QRectF({0, 0}, size));
            painter.restore();
        };
        m_out.push_back(std::move(piece));
        constexpr double kCaptionPx = 9.0;
        m_out.push_back(TextPiece({Q(p.caption), PageFont(kCaptionPx), m_width}, 2.0 * kPx,
                                  QColor(90, 98, 110)));
    }

    void Chapter(const T_DOC_CHAPTER& chapter, std::vector<std::size_t> place)
    {
        const std::string number = ChapterNumber(place);
        const std::size_t level = std::min(place.size(), kHeadingPx.size());
        constexpr double kAbove = 16.0 * kPx;
        T_FLOW_PIECE piece = TextPiece(
            {Q(number + " " + chapter.title), PageFont(kHeadingPx[level - 1], true), m_width},
            kAbove, QColor(31, 78, 140));
        piece.keepWithNext = true;
        piece.opensChapter = level == 1;
        piece.level = static_cast<int>(level);
        piece.title = number + " " + chapter.title;
        m_out.push_back(std::move(piece));
        for (const T_DOC_BLOCK& block : chapter.blocks)
            std::visit(*this, block);
        place.push_back(0);
        for (const T_DOC_CHAPTER& part : chapter.parts) {
            ++place.back();
            Chapter(part, place);
        }
    }

    void TitleBlock(const T_DOCUMENT& d)
    {
        constexpr double kTitlePx = 24.0, kSubtitlePx = 13.0;
        m_out.push_back(TextPiece({Q(d.title), PageFont(kTitlePx, true), m_width}, 0.0));
        if (!d.subtitle.empty())
            m_out.push_back(TextPiece({Q(d.subtitle), PageFont(kSubtitlePx), m_width}, 4.0 * kPx,
                                      QColor(90, 98, 110)));
        T_FLOW_PIECE gap{12.0 * kPx, 0.0, true};
        gap.draw = [](QPainter&, QPointF) {};
        m_out.push_back(std::move(gap));
        AddPairs(d.head, m_width, 0.0, m_out);
    }

    void SignOff(const T_DOCUMENT& d)
    {
        constexpr double kRow = 42.0 * kPx, kHeading = 14.0;
        T_FLOW_PIECE head = TextPiece({Q(d.signOffTitle), PageFont(kHeading, true), m_width},
                                      24.0 * kPx, QColor(31, 78, 140));
        head.keepWithNext = true;
        head.level = 1;
        head.onNewPage = d.chapters.empty(); // the first page is that of the title block
        head.title = d.signOffTitle;
        m_out.push_back(std::move(head));
        std::vector<T_DOC_HEAD_ROW> rows;
        for (const std::string& who : d.signOff)
            rows.push_back({who, {}});
        const std::size_t first = m_out.size();
        AddPairs(rows, m_width, kRow, m_out);
        for (std::size_t i = first; i + 1 < m_out.size(); ++i)
            m_out[i].keepWithNext = true;
    }

    std::vector<T_FLOW_PIECE> Take() { return std::move(m_out); }

private:
    /// Lines as they are, in a font in which the longest one fits.
    void Mono(const std::string& text)
    {
        const QString all = Q(text);
        const double natural = WidthOf(all, PageMonoFont(kMonoPx));
        const double px =
            std::max(kSmallestMonoPx, kMonoPx * std::min(1.0, m_width / std::max(natural, 1.0)));
        bool first = true;
        for (const QString& line : all.split(QLatin1Char('\n'))) {
            m_out.push_back(
                TextPiece({line.isEmpty() ? QStringLiteral(" ") : line, PageMonoFont(px), m_width},
                          first ? 6.0 * kPx : 0.0));
            first = false;
        }
    }

    const DOC_DRAW_FN& m_drawing;
    double m_width, m_height;
    std::vector<T_FLOW_PIECE> m_out;
};

} // namespace

std::vector<T_FLOW_PIECE> FlowOf(const T_DOCUMENT& document, const DOC_DRAW_FN& drawing,
                                 double width, double height)
{
    CFlowWriter writer(drawing, width, height);
    writer.TitleBlock(document);
    std::vector<std::size_t> place{0};
    for (const T_DOC_CHAPTER& chapter : document.chapters) {
        ++place.back();
        writer.Chapter(chapter, place);
    }
    writer.SignOff(document);
    return writer.Take();
}
