#include "qm_ui/document/pageflow.h"

#include "qm_ui/document/pagetext.h"
#include "qm_ui/document/tableflow.h"

#include <QColor>
#include <QPainter>

#include <algorithm>

namespace {

constexpr double kPx = kPageUnitsPerPx;
constexpr double kBodyPx = 11.0;
constexpr std::array<double, 3> kHeadingPx{18.0, 14.0, 12.0};

T_FLOW_PIECE TextPiece(T_PAGE_TEXT text, double above, QColor color = Qt::black)
{
    T_FLOW_PIECE piece{above, HeightOf(text)};
    piece.draw = [text = std::move(text), color](QPainter& painter, QPointF at) {
        painter.setPen(color);
        DrawText(painter, at, text);
    };
    return piece;
}

/// A picture with its caption.
struct T_FIGURE {
    std::shared_ptr<const T_DRAWING> drawing;
    T_PAGE_TEXT caption;
    double x = 0.0, scale = 1.0;

    double Height() const { return scale * drawing->size.height(); }
};

void DrawFigure(QPainter& painter, QPointF at, const T_FIGURE& figure, double captionAt)
{
    const QRectF rect({0.0, 0.0}, figure.drawing->size);
    painter.save();
    painter.translate(at + QPointF(figure.x, 0.0));
    painter.scale(figure.scale, figure.scale);
    painter.setClipRect(rect);
    figure.drawing->draw(painter, rect);
    painter.restore();
    painter.setPen(QColor(90, 98, 110));
    DrawText(painter, at + QPointF(figure.x, captionAt), figure.caption);
}

/// Pictures beside each other, their captions on one line below them.
T_FLOW_PIECE FiguresPiece(std::vector<T_FIGURE> figures)
{
    constexpr double kAbove = 8.0 * kPx, kGap = 2.0 * kPx, kLeast = 0.8;
    double pictures = 0.0, captions = 0.0;
    for (const T_FIGURE& figure : figures) {
        pictures = std::max(pictures, figure.Height());
        captions = std::max(captions, kGap + HeightOf(figure.caption));
    }
    T_FLOW_PIECE piece{kAbove, pictures + captions};
    piece.draw = [figures, at = pictures + kGap](QPainter& painter, QPointF corner) {
        for (const T_FIGURE& figure : figures)
            DrawFigure(painter, corner, figure, at);
    };
    piece.least = kLeast * pictures + captions;
    piece.shrunk = [figures, pictures, captions](double height) {
        std::vector<T_FIGURE> smaller = figures;
        for (T_FIGURE& figure : smaller)
            figure.scale *= (height - captions) / pictures;
        return FiguresPiece(std::move(smaller));
    };
    return piece;
}

class CFlowWriter {
public:
    CFlowWriter(const T_DOC_WORDS& words, const DOC_DRAW_FN& drawing, double width, double height)
        : m_words(words), m_drawing(drawing), m_width(width), m_height(height)
    {
    }

    void operator()(const T_DOC_TEXT& t)
    {
        static const std::array colors{QColor(Qt::black), QColor(20, 110, 50), QColor(170, 30, 25),
                                       QColor(125, 80, 0)};
        constexpr std::array signs{"", "\u2713 ", "\u2717 ", "! "};
        const auto tone = static_cast<std::size_t>(t.tone);
        constexpr double kAbove = 6.0 * kPx;
        EndFigures();
        m_out.push_back(TextPiece(
            Fit({QString::fromUtf8(signs[tone]) + PageString(t.text), PageFont(kBodyPx), m_width}),
            kAbove, colors[tone]));
    }
    void operator()(const T_DOC_TABLE& t)
    {
        EndFigures();
        AddTable(t, m_words, m_width, m_out);
    }
    void operator()(const T_DOC_FACTS& t)
    {
        EndFigures();
        AddFacts(t, m_words, m_width, m_out);
    }
    /// Narrow ones wait for the next one, to stand beside it.
    void operator()(const T_DOC_PICTURE& p)
    {
        if (!m_drawing) return;
        const bool narrow = p.width <= kHalfPage;
        if (!narrow) EndFigures();
        constexpr double kHighest = 0.55, kCaptionPx = 9.0; // of the page
        T_FIGURE figure;
        figure.drawing = std::make_shared<const T_DRAWING>(m_drawing(p));
        const QSizeF size = figure.drawing->size;
        const double width = p.width * m_width;
        figure.scale = std::min(width / size.width(), kHighest * m_height / size.height());
        figure.x = m_figures.empty() ? 0.0 : m_width - width;
        figure.caption = Fit({PageString(p.caption), PageFont(kCaptionPx), width});
        m_figures.push_back(std::move(figure));
        if (!narrow || m_figures.size() == 2) EndFigures();
    }

    void Chapter(const T_DOC_CHAPTER& chapter, std::vector<std::size_t> place)
    {
        const std::string number = ChapterNumber(place);
        const std::size_t level = std::min(place.size(), kHeadingPx.size());
        constexpr double kAbove = 16.0 * kPx;
        const QString title = Shortened(PageString(number + " " + chapter.title), kLongestTitle);
        EndFigures();
        T_FLOW_PIECE piece = TextPiece({title, PageFont(kHeadingPx[level - 1], true), m_width},
                                       kAbove, QColor(31, 78, 140));
        piece.keepWithNext = true;
        piece.opensChapter = level == 1;
        piece.level = static_cast<int>(level);
        piece.title = title;
        m_out.push_back(std::move(piece));
        for (const T_DOC_BLOCK& block : chapter.blocks)
            std::visit(*this, block);
        EndFigures();
        place.push_back(0);
        for (const T_DOC_CHAPTER& part : chapter.parts) {
            ++place.back();
            Chapter(part, place);
        }
    }

    void TitleBlock(const T_DOCUMENT& d)
    {
        constexpr double kTitlePx = 24.0, kSubtitlePx = 13.0;
        m_out.push_back(TextPiece(
            {Shortened(PageString(d.title), kLongestTitle), PageFont(kTitlePx, true), m_width},
            0.0));
        if (!d.subtitle.empty())
            m_out.push_back(TextPiece({PageString(d.subtitle), PageFont(kSubtitlePx), m_width},
                                      4.0 * kPx, QColor(90, 98, 110)));
        T_FLOW_PIECE gap{12.0 * kPx, 0.0, true};
        gap.draw = [](QPainter&, QPointF) {};
        m_out.push_back(std::move(gap));
        AddPairs(d.head, m_words, m_width, 0.0, m_out);
    }

    void SignOff(const T_DOCUMENT& d)
    {
        constexpr double kRow = 42.0 * kPx, kHeading = 14.0;
        T_FLOW_PIECE head =
            TextPiece({PageString(d.signOffTitle), PageFont(kHeading, true), m_width}, 24.0 * kPx,
                      QColor(31, 78, 140));
        head.keepWithNext = true;
        head.level = 1;
        head.onNewPage = d.chapters.empty(); // the first page is that of the title block
        head.title = PageString(d.signOffTitle);
        m_out.push_back(std::move(head));
        std::vector<T_DOC_HEAD_ROW> rows;
        for (const std::string& who : d.signOff)
            rows.push_back({who, {}});
        const std::size_t first = m_out.size();
        AddPairs(rows, m_words, m_width, kRow, m_out);
        for (std::size_t i = first; i + 1 < m_out.size(); ++i)
            m_out[i].keepWithNext = true;
    }

    std::vector<T_FLOW_PIECE> Take() { return std::move(m_out); }

private:
    static constexpr int kLongestTitle = 240; // characters

    void EndFigures()
    {
        if (!m_figures.empty()) m_out.push_back(FiguresPiece(std::move(m_figures)));
        m_figures.clear();
    }
    T_PAGE_TEXT Fit(T_PAGE_TEXT text) const
    {
        constexpr double kMost = 0.9; // of the page
        return Fitted(std::move(text), kMost * m_height, PageString(m_words.cut));
    }

    const T_DOC_WORDS& m_words;
    const DOC_DRAW_FN& m_drawing;
    double m_width, m_height;
    std::vector<T_FIGURE> m_figures; // that wait for one beside them
    std::vector<T_FLOW_PIECE> m_out;
};

} // namespace

std::vector<T_FLOW_PIECE> FlowOf(const T_DOCUMENT& document, const DOC_DRAW_FN& drawing,
                                 double width, double height)
{
    CFlowWriter writer(document.words, drawing, width, height);
    writer.TitleBlock(document);
    std::vector<std::size_t> place{0};
    for (const T_DOC_CHAPTER& chapter : document.chapters) {
        ++place.back();
        writer.Chapter(chapter, place);
    }
    writer.SignOff(document);
    return writer.Take();
}
