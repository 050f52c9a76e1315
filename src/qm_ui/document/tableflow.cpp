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

QString Q(const std::string& text)
{
    return QString::fromStdString(text);
}

struct T_CELL {
    T_PAGE_TEXT text;
    QColor color = Qt::black;
};

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

/// Widths of columns in a font: what they would like, and the least that keeps words whole.
struct T_WIDTHS {
    std::vector<double> wanted, least;
};

T_WIDTHS WidthsOf(const T_TEXT_TABLE& table, double px)
{
    const QFont font = PageFont(px), bold = PageFont(px, true);
    T_WIDTHS w;
    for (std::size_t c = 0; c < table.columns.size(); ++c) {
        const T_TEXT_COLUMN& column = table.columns[c];
        const QString head = Q(column.head);
        double wanted = WidthOf(head, bold), least = WordWidthOf(head, bold);
        for (const auto& row : table.rows) {
            const QString text = Q(row[c]);
            wanted = std::max(wanted, WidthOf(text, font));
            least = std::max(least, column.number ? WidthOf(text, font) : WordWidthOf(text, font));
        }
        constexpr double kSlack = 0.5 * kPx; // layouts round up
        w.wanted.push_back(wanted + kSlack);
        w.least.push_back(std::min(least, wanted) + kSlack);
    }
    return w;
}

double Sum(const std::vector<double>& values)
{
    return std::accumulate(values.begin(), values.end(), 0.0);
}

/// Between the least and the wanted widths, all by the same share; empty: not even the least fit.
std::vector<double> FitWidths(const T_WIDTHS& w, double width)
{
    const double room = width - 2.0 * kPad * static_cast<double>(w.wanted.size());
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

void AddRows(const T_TEXT_TABLE& table, const std::vector<DOC_TONE>& tones, double px,
             const std::vector<double>& widths, std::vector<T_FLOW_PIECE>& out)
{
    const auto cellsOf = [&](const auto& textOf, const QFont& font, QColor color) {
        std::vector<T_CELL> cells;
        for (std::size_t c = 0; c < widths.size(); ++c) {
            const Qt::Alignment align = table.columns[c].number ? Qt::AlignRight : Qt::AlignLeft;
            cells.push_back({{textOf(c), font, widths[c], align}, color});
        }
        return cells;
    };
    T_FLOW_PIECE head = RowPiece(cellsOf([&](std::size_t c) { return Q(table.columns[c].head); },
                                         PageFont(px, true), Qt::black),
                                 true);
    head.keepWithNext = true;
    const auto kept = std::make_shared<const T_FLOW_PIECE>(head);
    out.push_back(std::move(head));
    for (std::size_t r = 0; r < table.rows.size(); ++r) {
        const DOC_TONE tone = r < tones.size() ? tones[r] : DOC_TONE::Plain;
        out.push_back(RowPiece(cellsOf(
                                   [&](std::size_t c) {
                                       return (c == 0 ? QString::fromUtf8(SignOf(tone))
                                                      : QString()) +
                                              Q(table.rows[r][c]);
                                   },
                                   PageFont(px), ColorOf(tone)),
                               false));
        out.back().head = kept;
    }
}

void AddCaption(const std::string& caption, double width, std::vector<T_FLOW_PIECE>& out)
{
    if (caption.empty()) return;
    constexpr double kCaptionPx = 11.0, kAbove = 9.0 * kPx, kBelow = 2.0 * kPx;
    const T_PAGE_TEXT text{Q(caption), PageFont(kCaptionPx, true), width};
    T_FLOW_PIECE piece{kAbove, HeightOf(text) + kBelow, true};
    piece.draw = [text](QPainter& painter, QPointF at) {
        painter.setPen(Qt::black);
        DrawText(painter, at, text);
    };
    out.push_back(std::move(piece));
}

/// Parts of a table that is too wide in the smallest font: each has the first column.
void AddInParts(const T_TEXT_TABLE& table, const std::vector<DOC_TONE>& tones, double px,
                double width, std::vector<T_FLOW_PIECE>& out)
{
    const T_WIDTHS w = WidthsOf(table, px);
    const auto full = [&](std::size_t c) { return w.least[c] + 2.0 * kPad; };
    for (std::size_t from = 1; from < table.columns.size();) {
        std::vector<std::size_t> which{0};
        double used = full(0);
        do {
            used += full(from);
            which.push_back(from++);
        } while (from < table.columns.size() && used + full(from) <= width);
        const T_TEXT_TABLE part = Columns(table, which);
        T_WIDTHS own = WidthsOf(part, px);
        std::vector<double> widths = FitWidths(own, width);
        AddRows(part, tones, px, widths.empty() ? own.least : widths, out);
    }
}

} // namespace

void AddTable(const T_DOC_TABLE& table, double width, std::vector<T_FLOW_PIECE>& out)
{
    AddCaption(table.caption, width, out);
    if (table.table.columns.empty()) return;
    constexpr std::array sizes{10.0, 9.0, 8.0, 7.0}; // px
    for (const double px : sizes) {
        const std::vector<double> widths = FitWidths(WidthsOf(table.table, px), width);
        if (widths.empty()) continue;
        return AddRows(table.table, table.tones, px, widths, out);
    }
    AddInParts(table.table, table.tones, sizes.back(), width, out);
}

void AddFacts(const T_DOC_FACTS& facts, double width, std::vector<T_FLOW_PIECE>& out)
{
    AddCaption(facts.caption, width, out);
    // Lines of a code's trace have no definitions.
    const bool defined =
        std::ranges::any_of(facts.facts, [](const T_FACT& f) { return !f.definition.empty(); });
    const std::array shares = defined ? std::array{0.09, 0.26, 0.15, 0.31, 0.19}
                                      : std::array{0.18, 0.0, 0.18, 0.42, 0.22};
    for (const T_FACT& f : facts.facts) {
        std::string derived = f.formula;
        if (!f.numbers.empty()) derived += "\n= " + f.numbers;
        if (f.value && !f.text.empty()) derived += (derived.empty() ? "" : "\n") + f.text;
        std::string clause = f.clause;
        if (f.mark == CODE_MARK::Recalled) clause += " (" + MarkText(f.mark) + ")";
        const std::array texts{f.symbol, f.definition, f.ValueText(), derived, clause};
        std::vector<T_CELL> cells;
        for (std::size_t c = 0; c < texts.size(); ++c) {
            if (!(shares[c] > 0.0)) continue;
            const bool isValue = c == 2 && f.value;
            cells.push_back({{Q(texts[c]), PageFont(kFactPx), shares[c] * width - 2.0 * kPad,
                              isValue ? Qt::AlignRight : Qt::AlignLeft}});
        }
        if (f.symbol.empty() && !f.value) { // an input: its name and what was taken
            cells.erase(cells.begin());
            cells.resize(2);
            cells[0].text.width = (shares[0] + shares[1]) * width - 2.0 * kPad;
            cells[1].text.width = (shares[2] + shares[3] + shares[4]) * width - 2.0 * kPad;
        }
        out.push_back(RowPiece(std::move(cells), false));
    }
}

void AddPairs(const std::vector<T_DOC_HEAD_ROW>& rows, double width, double rowHeight,
              std::vector<T_FLOW_PIECE>& out)
{
    constexpr double kNames = 0.3; // of the width
    constexpr double kTextPx = 11.0;
    for (const T_DOC_HEAD_ROW& row : rows) {
        T_FLOW_PIECE piece =
            RowPiece({{{Q(row.name), PageFont(kTextPx), kNames * width - 2.0 * kPad}},
                      {{Q(row.value), PageFont(kTextPx), (1.0 - kNames) * width - 2.0 * kPad}}},
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
                         {Q(row.name), PageFont(kTextPx), kNames * width - 2.0 * kPad});
            };
            piece.height = rowHeight;
        }
        out.push_back(std::move(piece));
    }
}
