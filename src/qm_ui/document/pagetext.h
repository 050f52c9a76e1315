// A text in a box of given width, measured and drawn alike on screen and paper.
#pragma once

#include <QFont>
#include <QPointF>
#include <QString>

#include <string>

class QPainter;

/// Lengths of pages and their texts are quarters of a px at 96 dpi, so that fonts, whose sizes are
/// whole numbers, come in steps of a quarter; the painter is scaled to them.
inline constexpr double kPageUnitsPerPx = 4.0;

struct T_PAGE_TEXT {
    QString text;
    QFont font;
    double width = 0.0;
    Qt::Alignment align = Qt::AlignLeft;
};

/// Sans serif of the documents, without hinting, so that every device has the same line breaks.
QFont PageFont(double px, bool bold = false);
/// CleanText for pages.
QString PageString(const std::string& text);

double HeightOf(const T_PAGE_TEXT& text);
/// Width of the longest line, and of the longest word.
double WidthOf(const QString& text, const QFont& font);
double WordWidthOf(const QString& text, const QFont& font);
/// The text where it is no higher than that; else as much of its beginning as is, with `cut`
/// behind it, where {1} is the number of its characters.
T_PAGE_TEXT Fitted(T_PAGE_TEXT text, double height, const QString& cut);
/// At most so many characters, the last ones dots where some are left out.
QString Shortened(const QString& text, int most);
void DrawText(QPainter& painter, QPointF topLeft, const T_PAGE_TEXT& text);
