#include "shell/theme.h"

#include "qm_ui/frame/frameview.h"
#include "qm_ui/plot/plotwidget.h"

#include <QApplication>
#include <QEvent>
#include <QGraphicsEffect>
#include <QImage>
#include <QPainter>
#include <QPalette>
#include <QProxyStyle>
#include <QStyleOption>
#include <QToolTip>

#include <algorithm>
#include <array>

namespace {

using ROLE = QPalette::ColorRole;

struct T_COLOR_ROW {
    ROLE role;
    QRgb light, dark;
};
constexpr T_COLOR_ROW kColors[] = {
    {QPalette::Window, 0xfff3f4f6, 0xff25282c},
    {QPalette::WindowText, 0xff1d2126, 0xffe4e6e9},
    {QPalette::Base, 0xffffffff, 0xff1b1d20},
    {QPalette::AlternateBase, 0xfff5f8fb, 0xff212428},
    {QPalette::Text, 0xff1d2126, 0xffe4e6e9},
    {QPalette::Button, 0xffebedf0, 0xff33373c},
    {QPalette::ButtonText, 0xff1d2126, 0xffe4e6e9},
    {QPalette::BrightText, 0xffffffff, 0xffffffff},
    {QPalette::Highlight, 0xff1f5fae, 0xff3d7fd6},
    {QPalette::HighlightedText, 0xffffffff, 0xffffffff},
    {QPalette::ToolTipBase, 0xfffffbe6, 0xff3a3e44},
    {QPalette::ToolTipText, 0xff1d2126, 0xffe4e6e9},
    {QPalette::Link, 0xff1f5fae, 0xff7fb4f5},
    {QPalette::LinkVisited, 0xff6b3fa0, 0xffc39bf0},
    {QPalette::PlaceholderText, 0xff6e7680, 0xff969da6},
    {QPalette::Light, 0xffffffff, 0xff4a4f56},
    {QPalette::Midlight, 0xfff0f2f4, 0xff3e4248},
    {QPalette::Mid, 0xffb9bfc7, 0xff15171a},
    {QPalette::Dark, 0xff9aa1aa, 0xff101214},
    {QPalette::Shadow, 0xff6a717a, 0xff000000},
};
constexpr QRgb kDisabledLight = 0xff878e97, kDisabledDark = 0xff757c85;
constexpr int kDarkGround = 27; // of 255: that of QPalette::Base, where white comes to lie

QPalette PaletteOf(bool dark)
{
    QPalette palette;
    for (const T_COLOR_ROW& row : kColors)
        palette.setColor(row.role, QColor(dark ? row.dark : row.light));
    for (const ROLE role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText})
        palette.setColor(QPalette::Disabled, role, QColor(dark ? kDisabledDark : kDisabledLight));
    return palette;
}

/// The palette that the platform gave, asked for before the first change.
const QPalette& SystemPalette()
{
    static const QPalette palette = QApplication::palette();
    return palette;
}

bool IsDarkPalette(const QPalette& palette)
{
    return palette.color(QPalette::Window).lightness() <
           palette.color(QPalette::WindowText).lightness();
}

class CDarkEffect : public QGraphicsEffect {
protected:
    void draw(QPainter* painter) override
    {
        QPoint offset;
        QImage image = sourcePixmap(Qt::LogicalCoordinates, &offset, NoPad).toImage();
        TurnLightness(image);
        painter->drawImage(offset, image);
    }
};

/// The plain look of every platform: buttons of dialogs without pictures, and boxes of check marks
/// that can be seen on dark ground.
class CPlainStyle : public QProxyStyle {
public:
    CPlainStyle() : QProxyStyle("Fusion") {}
    int styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                  QStyleHintReturn* data) const override
    {
        if (hint == SH_DialogButtonBox_ButtonsHaveIcons) return 0;
        return QProxyStyle::styleHint(hint, option, widget, data);
    }
    void drawPrimitive(PrimitiveElement element, const QStyleOption* option, QPainter* painter,
                       const QWidget* widget) const override
    {
        QProxyStyle::drawPrimitive(element, option, painter, widget);
        if (element != PE_IndicatorCheckBox && element != PE_IndicatorItemViewItemCheck) return;
        if (!IsDarkPalette(option->palette)) return;
        painter->setPen(option->palette.color(QPalette::PlaceholderText));
        painter->setBrush(Qt::NoBrush);
        painter->drawRect(QRectF(option->rect).adjusted(0.5, 0.5, -0.5, -0.5));
    }
};

bool IsDrawing(const QWidget* widget)
{
    return dynamic_cast<const CPlotWidget*>(widget) || dynamic_cast<const CFrameView*>(widget);
}

void FitDrawing(QWidget& widget)
{
    const bool has = widget.graphicsEffect() != nullptr;
    if (has == IsDark()) return;
    widget.setGraphicsEffect(has ? nullptr : new CDarkEffect); // owned by the widget
}

/// Drawings that come up while windows are dark.
class CDrawingWatch : public QObject {
public:
    using QObject::QObject;
    bool eventFilter(QObject* object, QEvent* event) override
    {
        if (event->type() != QEvent::Polish || !IsDark()) return false;
        if (auto* widget = qobject_cast<QWidget*>(object); widget && IsDrawing(widget))
            FitDrawing(*widget);
        return false;
    }
};

QRgb TurnedPixel(QRgb pixel)
{
    const int r = qRed(pixel), g = qGreen(pixel), b = qBlue(pixel);
    // Lightness of HSL is the mean of the largest and the smallest channel.
    const int shift = 255 - std::max({r, g, b}) - std::min({r, g, b});
    const auto turned = [shift](int channel) {
        return kDarkGround + (channel + shift) * (255 - kDarkGround) / 255;
    };
    return qRgb(turned(r), turned(g), turned(b));
}

} // namespace

bool IsDark()
{
    return IsDarkPalette(QApplication::palette());
}

void ApplyTheme(THEME theme)
{
    constexpr const char* kWatch = "drawingWatch";
    (void)SystemPalette(); // before it changes
    const bool dark =
        theme == THEME::Dark || (theme == THEME::System && IsDarkPalette(SystemPalette()));
    if (!qApp->findChild<QObject*>(kWatch)) {
        auto* watch = new CDrawingWatch(qApp);
        watch->setObjectName(kWatch);
        qApp->installEventFilter(watch);
        QApplication::setStyle(new CPlainStyle); // the application owns it
    }
    const QPalette palette = PaletteOf(dark);
    if (palette == QApplication::palette()) return;
    QApplication::setPalette(palette);
    QToolTip::setPalette(palette);
    for (QWidget* widget : QApplication::allWidgets())
        if (IsDrawing(widget)) FitDrawing(*widget);
}

void TurnLightness(QImage& image)
{
    image.convertTo(QImage::Format_ARGB32_Premultiplied);
    QRgb before = 0xffffffff, after = TurnedPixel(before); // most pixels are as the one before
    for (int y = 0; y < image.height(); ++y) {
        auto* line = reinterpret_cast<QRgb*>(image.scanLine(y));
        for (int x = 0; x < image.width(); ++x) {
            if (line[x] != before) {
                before = line[x];
                after = TurnedPixel(before);
            }
            line[x] = after;
        }
    }
}
