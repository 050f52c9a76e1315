#include "qm_ui/document/tableflow.h"

#include "qm_rps/generate/codehingerows.h"
#include "qm_ui/document/pagetext.h"

#include <QColor>
#include <QPainter>

#include <algorithm>
#include <numeric>

namespace {

constexpr double kPx = kPageUnitsPerPx;
constexpr double kPad = 4.0 * kPx;    // between a cell's text and its sides
constexpr double kTopPad = 2.0 * kPx; // likewise above and below
constexpr double kFactPx = 9.5;
const QColor kLine(170, 178, 189), kHead(232, 236, 241);

struct T_CELL {
    T_PAGE_TEXT text;
    QColor color = Qt::black;
};

/// Cells stay on one page.
T_PAGE_TEXT CellText(T_PAGE_TEXT text, const T_DOC_WORDS& words)
{
    constexpr double kHighest = 480.0 * kPx;
    return Fitted(std::move(text), kHighest, PageString(words.cut));
}

/// A line of cells with their frames.
T_FLOW_PIECE RowPiece(std::vector<T_CELL> cells, bool head)
{
    T_FLOW_PIECE piece;
    for (const T_CELL& cell : cells)
        piece.height = std::max(piece.height, HeightOf(cell.text) + 2.0 * kTopPad);
    piece.draw = [cells = std::move(cells), height = piece.height, head](QPainter& painter,
                                                                         QPointF at) {
        double x = at.x();
        for (const T_CELL& cell : cells) {
            const QRectF frame(x, at.y(), cell.text.width + 2.0 * kPad, height);
            painter.setPen(QPen(kLine, 0.5 * kPx));
            painter.setBrush(head ? QBrush(kHead) : QBrush());
            painter.drawRect(frame);
            painter.setPen(cell.color);
            DrawText(painter, {x + kPad, at.y() + kTopPad}, cell.text);
            x += frame.width();
        }
    };
    return piece;
}

QColor ColorOf(DOC_TONE tone)
{
    static const std::array colors{QColor(Qt::black), QColor(20, 110, 50), QColor(170, 30, 25),
                                   QColor(125, 80, 0)};
    return colors[static_cast<std::size_t>(tone)];
}

const char* SignOf(DOC_TONE tone)
{
    constexpr std::array signs{"", "\u2713 ", "\u2717 ", "! "};
    return signs[static_cast<std::size_t>(tone)];
}

/// With what a print in black has in place of the colour.
T_TEXT_TABLE WithSigns(const T_DOC_TABLE& table)
{
    T_TEXT_TABLE out = table.table;
    for (std::size_t r = 0; r < std::min(out.rows.size(), table.tones.size()); ++r)
        if (!out.rows[r].empty()) out.rows[r].front().insert(0, SignOf(table.tones[r]));
    return out;
}

/// Widths of columns in a font: what they would like, what keeps rows (not heads) in one line, and
/// the least that keeps words whole.
struct T_WIDTHS {
    std::vector<double> wanted, oneLine, least;
};

T_WIDTHS WidthsOf(const T_TEXT_TABLE& table, double px)
{
    constexpr double kSlack = 0.5 * kPx;         // layouts round up
    constexpr double kLongestWord = 200.0 * kPx; // longer ones go on in the next line
    constexpr double kWidest = 600.0 * kPx;      // hardly less than a page
    const QFont font = PageFont(px), bold = PageFont(px, true);
    T_WIDTHS w;
    for (std::size_t c = 0; c < table.columns.size(); ++c) {
        const T_TEXT_COLUMN& column = table.columns[c];
        const QString head = PageString(column.head);
        double cells = 0.0, least = WordWidthOf(head, bold);
        const double words = least;
        for (const auto& row : table.rows) {
            const QString text = PageString(row[c]);
            cells = std::max(cells, WidthOf(text, font));
            least = std::max(least, column.number ? WidthOf(text, font) : WordWidthOf(text, font));
        }
        const double wanted = std::max(cells, WidthOf(head, bold));
        w.wanted.push_back(std::min(wanted, kWidest) + kSlack);
        w.oneLine.push_back(std::min(std::max(cells, words), kWidest) + kSlack);
        w.least.push_back(std::min({least, wanted, kLongestWord}) + kSlack);
    }
    return w;
}

double Sum(const std::vector<double>& values)
{
    return std::accumulate(values.begin(), values.end(), 0.0);
}

/// Of a page's width, what texts of columns have.
double RoomFor(const T_WIDTHS& w, double width)
{
    return width - 2.0 * kPad * static_cast<double>(w.wanted.size());
}

/// Between the least and the wanted widths, all by the same share; empty: not even the least fit.
std::vector<double> FitWidths(const T_WIDTHS& w, double width)
{
    const double room = RoomFor(w, width);
    const double wanted = Sum(w.wanted), least = Sum(w.least);
    if (wanted <= room) return w.wanted;
    if (least > room) return {};
    const double share = (room - least) / (wanted - least);
    std::vector<double> out;
    for (std::size_t c = 0; c < w.wanted.size(); ++c)
        out.push_back(w.least[c] + share * (w.wanted[c] - w.least[c]));
    return out;
}

T_TEXT_TABLE Columns(const T_TEXT_TABLE& table, const std::vector<std::size_t>& which)
{
    T_TEXT_TABLE out;
    for (const std::size_t c : which)
        out.columns.push_back(table.columns[c]);
    for (const auto& row : table.rows) {
        auto& cells = out.rows.emplace_back();
        for (const std::size_t c : which)
            cells.push_back(row[c]);
    }
    return out;
}

/// The same for every part of a table.
struct T_TABLE_STYLE {
    const std::vector<DOC_TONE>& tones; // by row; fewer: the others are plain
    const T_DOC_WORDS& words;
    double px = 0.0; // of the font
};

void AddRows(const T_TEXT_TABLE& table, const T_TABLE_STYLE& style,
             const std::vector<double>& widths, std::vector<T_FLOW_PIECE>& out)
{
    const auto& [tones, words, px] = style;
    const auto cellsOf = [&](const auto& textOf, const QFont& font, QColor color) {
        std::vector<T_CELL> cells;
        for (std::size_t c = 0; c < widths.size(); ++c) {
            const Qt::Alignment align = table.columns[c].number ? Qt::AlignRight : Qt::AlignLeft;
            cells.push_back({CellText({textOf(c), font, widths[c], align}, style.words), color});
        }
        return cells;
    };
    T_FLOW_PIECE head =
        RowPiece(cellsOf([&](std::size_t c) { return PageString(table.columns[c].head); },
                         PageFont(px, true), Qt::black),
                 true);
    head.keepWithNext = true;
    const auto kept = std::make_shared<const T_FLOW_PIECE>(head);
    constexpr double kAbove = 6.0 * kPx; // of a table without a caption
    if (!out.empty() && !out.back().keepWithNext) head.above = kAbove;
    out.push_back(std::move(head));
    const QFont font = PageFont(px);
    for (std::size_t r = 0; r < table.rows.size(); ++r) {
        const DOC_TONE tone = r < tones.size() ? tones[r] : DOC_TONE::Plain;
        const auto textOf = [&](std::size_t c) { return PageString(table.rows[r][c]); };
        out.push_back(RowPiece(cellsOf(textOf, font, ColorOf(tone)), false));
        out.back().head = kept;
    }
}

void AddCaption(const std::string& caption, double width, std::vector<T_FLOW_PIECE>& out)
{
    if (caption.empty()) return;
    constexpr double kCaptionPx = 11.0, kAbove = 9.0 * kPx, kBelow = 2.0 * kPx;
    const T_PAGE_TEXT text{PageString(caption), PageFont(kCaptionPx, true), width};
    T_FLOW_PIECE piece{kAbove, HeightOf(text) + kBelow, true};
    piece.draw = [text](QPainter& painter, QPointF at) {
        painter.setPen(Qt::black);
        DrawText(painter, at, text);
    };
    out.push_back(std::move(piece));
}

/// Parts of a table that is too wide in the smallest font: each has the first column.
void AddInParts(const T_TEXT_TABLE& table, const T_TABLE_STYLE& style, double width,
                std::vector<T_FLOW_PIECE>& out)
{
    const T_WIDTHS w = WidthsOf(table, style.px);
    const auto full = [&](std::size_t c) { return w.least[c] + 2.0 * kPad; };
    for (std::size_t from = 1; from < table.columns.size();) {
        std::vector<std::size_t> which{0};
        double used = full(0);
        do {
            used += full(from);
            which.push_back(from++);
        } while (from < table.columns.size() && used + full(from) <= width);
        const T_TEXT_TABLE part = Columns(table, which);
        const T_WIDTHS own = WidthsOf(part, style.px);
        const std::vector<double> widths = FitWidths(own, width);
        AddRows(part, style, widths.empty() ? own.least : widths, out);
    }
}

} // namespace

void AddTable(const T_DOC_TABLE& table, const T_DOC_WORDS& words, double width,
              std::vector<T_FLOW_PIECE>& out)
{
    AddCaption(table.caption, width, out);
    if (table.table.columns.empty()) return;
    const T_TEXT_TABLE shown = WithSigns(table);
    constexpr std::array sizes{10.0, 9.0, 8.0, 7.0};   // px
    constexpr std::array oneLine{10.0, 9.0, 8.0, 7.5}; // sizes of a row in one line
    // A little smaller is better than in two lines; much smaller is not.
    for (const double px : oneLine) {
        T_WIDTHS w = WidthsOf(shown, px);
        w.least = w.oneLine;
        const std::vector<double> widths = FitWidths(w, width);
        if (!widths.empty()) return AddRows(shown, {table.tones, words, px}, widths, out);
    }
    for (const double px : sizes) {
        const std::vector<double> widths = FitWidths(WidthsOf(shown, px), width);
        if (widths.empty()) continue;
        return AddRows(shown, {table.tones, words, px}, widths, out);
    }
    AddInParts(shown, {table.tones, words, sizes.back()}, width, out);
}

namespace {

constexpr std::size_t kValue = 2; // of the columns of facts

/// Widths of columns; 0: it is left out.
std::array<double, 5> FactWidths(bool defined, double width)
{
    // Lines of a code's trace have no definitions.
    std::array<double, 5> widths = defined ? std::array{0.09, 0.26, 0.15, 0.31, 0.19}
                                           : std::array{0.18, 0.0, 0.18, 0.42, 0.22};
    for (double& w : widths)
        w *= width;
    return widths;
}

/// An input: its name and what was taken.
T_FLOW_PIECE InputRow(const T_FACT& f, const T_DOC_WORDS& words, double width)
{
    constexpr double kName = 0.35;
    const QFont font = PageFont(kFactPx);
    return RowPiece(
        {{CellText({PageString(f.definition), font, kName * width - 2.0 * kPad}, words)},
         {CellText({PageString(f.text), font, (1.0 - kName) * width - 2.0 * kPad}, words)}},
        false);
}

T_FLOW_PIECE FactRow(const std::array<std::string, 5>& texts, const std::array<double, 5>& widths,
                     const T_DOC_WORDS& words, bool head)
{
    std::vector<T_CELL> cells;
    for (std::size_t c = 0; c < texts.size(); ++c)
        if (widths[c] > 0.0)
            cells.push_back(
                {CellText({PageString(texts[c]), PageFont(kFactPx, head), widths[c] - 2.0 * kPad,
                           c == kValue ? Qt::AlignRight : Qt::AlignLeft},
                          words)});
    return RowPiece(std::move(cells), head);
}

std::array<std::string, 5> TextsOf(const T_FACT& f)
{
    std::string derived = f.formula;
    if (!f.numbers.empty()) derived += "\n= " + f.numbers;
    if (f.value && !f.text.empty()) derived += (derived.empty() ? "" : "\n") + f.text;
    std::string clause = f.clause;
    if (f.mark == CODE_MARK::Recalled) clause += " (" + MarkText(f.mark) + ")";
    return {f.symbol, f.definition, f.ValueText(), derived, clause};
}

} // namespace

void AddFacts(const T_DOC_FACTS& facts, const T_DOC_WORDS& words, double width,
              std::vector<T_FLOW_PIECE>& out)
{
    AddCaption(facts.caption, width, out);
    const std::array<double, 5> widths = FactWidths(HasDefinitions(facts), width);
    std::shared_ptr<const T_FLOW_PIECE> head;
    if (HasSymbols(facts)) {
        out.push_back(FactRow(words.factHeads, widths, words, true));
        out.back().keepWithNext = true;
        head = std::make_shared<const T_FLOW_PIECE>(out.back());
    }
    for (const T_FACT& f : facts.facts) {
        const bool isInput = f.symbol.empty() && !f.value;
        out.push_back(isInput ? InputRow(f, words, width)
                              : FactRow(TextsOf(f), widths, words, false));
        out.back().head = head;
    }
}

void AddPairs(const std::vector<T_DOC_HEAD_ROW>& rows, const T_DOC_WORDS& words, double width,
              double rowHeight, std::vector<T_FLOW_PIECE>& out)
{
    constexpr double kNames = 0.3; // of the width
    constexpr double kTextPx = 11.0;
    for (const T_DOC_HEAD_ROW& row : rows) {
        T_FLOW_PIECE piece =
            RowPiece({{{PageString(row.name), PageFont(kTextPx), kNames * width - 2.0 * kPad}},
                      {CellText({PageString(row.value), PageFont(kTextPx),
                                 (1.0 - kNames) * width - 2.0 * kPad},
                                words)}},
                     false);
        if (piece.height < rowHeight) {
            // The frame is drawn as high as the row.
            piece.draw = [row, width, rowHeight](QPainter& painter, QPointF at) {
                painter.setPen(QPen(kLine, 0.5 * kPx));
                painter.setBrush({});
                painter.drawRect(QRectF(at.x(), at.y(), kNames * width, rowHeight));
                painter.drawRect(
                    QRectF(at.x() + kNames * width, at.y(), (1.0 - kNames) * width, rowHeight));
                painter.setPen(Qt::black);
                DrawText(painter, at + QPointF(kPad, kTopPad),
                         {PageString(row.name), PageFont(kTextPx), kNames * width - 2.0 * kPad});
            };
            piece.height = rowHeight;
        }
        out.push_back(std::move(piece));
    }
}
