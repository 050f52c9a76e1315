#include "qm_ui/document/pagetext.h"

#include "qm_rps/document/document.h"

#include <QFontMetricsF>
#include <QPainter>
#include <QTextLayout>
#include <QTextOption>

#include <algorithm>
#include <cmath>

namespace {

/// Lays the text out in lines of its width; its height.
double LayOut(QTextLayout& layout, const T_PAGE_TEXT& text)
{
    QTextOption option(text.align);
    // A name in a script from right to left leaves the page as it is.
    option.setTextDirection(Qt::LeftToRight);
    option.setWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
    layout.setTextOption(option);
    layout.beginLayout();
    double y = 0.0;
    for (QTextLine line = layout.createLine(); line.isValid(); line = layout.createLine()) {
        line.setLineWidth(text.width);
        line.setPosition({0.0, y});
        y += line.height();
    }
    layout.endLayout();
    return y;
}

/// Line ends of the text are those of a layout.
QString WithLineSeparators(QString text)
{
    return text.replace(QLatin1Char('\n'), QChar::LineSeparator);
}

QFont FontOf(const char* family, double px, bool bold)
{
    QFont font(QString::fromLatin1(family));
    font.setPixelSize(static_cast<int>(std::lround(px * kPageUnitsPerPx)));
    font.setBold(bold);
    font.setHintingPreference(QFont::PreferNoHinting);
    font.setStyleStrategy(QFont::PreferOutline);
    return font;
}

} // namespace

QFont PageFont(double px, bool bold)
{
    return FontOf("DejaVu Sans", px, bold);
}

QString PageString(const std::string& text)
{
    return QString::fromStdString(CleanText(text));
}

T_PAGE_TEXT Fitted(T_PAGE_TEXT text, double height, const QString& cut)
{
    constexpr qsizetype kSurelyFits = 200; // characters, of which few texts have more
    if (text.text.size() <= kSurelyFits || HeightOf(text) <= height) return text;
    const QString whole = text.text;
    QString rest = QLatin1Char(' ') + cut;
    rest.replace(QStringLiteral("{1}"), QString::number(whole.size()));
    qsizetype fits = 0, tooMany = whole.size();
    while (tooMany - fits > 1) {
        const qsizetype tried = (fits + tooMany) / 2;
        text.text = whole.left(tried) + rest;
        (HeightOf(text) <= height ? fits : tooMany) = tried;
    }
    text.text = whole.left(fits) + rest;
    return text;
}

QString Shortened(const QString& text, int most)
{
    return text.size() <= most ? text : text.left(most - 3) + QStringLiteral("...");
}

double HeightOf(const T_PAGE_TEXT& text)
{
    QTextLayout layout(WithLineSeparators(text.text), text.font);
    return LayOut(layout, text);
}

double WidthOf(const QString& text, const QFont& font)
{
    const QFontMetricsF metrics(font);
    double width = 0.0;
    for (const QString& line : text.split(QLatin1Char('\n')))
        width = std::max(width, metrics.horizontalAdvance(line));
    return width;
}

double WordWidthOf(const QString& text, const QFont& font)
{
    const QFontMetricsF metrics(font);
    double width = 0.0;
    for (const QString& word : text.simplified().split(QLatin1Char(' ')))
        width = std::max(width, metrics.horizontalAdvance(word));
    return width;
}

void DrawText(QPainter& painter, QPointF topLeft, const T_PAGE_TEXT& text)
{
    QTextLayout layout(WithLineSeparators(text.text), text.font);
    (void)LayOut(layout, text);
    layout.draw(&painter, topLeft);
}
