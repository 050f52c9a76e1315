#include "shell/windowkeeper.h"

#include "shell/helpwindow.h"

#include "qm_ui/form/dialogwindow.h"

#include <QApplication>
#include <QEvent>
#include <QScreen>
#include <QSettings>
#include <QSplitter>

#include <algorithm>
#include <typeinfo>

namespace {

/// The kind of a window that is kept; empty: it is not.
QString KindOf(const QWidget* window)
{
    if (const auto* dialog = dynamic_cast<const CDialogWindow*>(window))
        return "windows/" + QString::fromLatin1(typeid(dialog->Model()).name());
    return dynamic_cast<const CHelpWindow*>(window) ? QString("windows/help") : QString();
}

qint64 AreaOf(const QRect& rect)
{
    return rect.isValid() ? static_cast<qint64>(rect.width()) * rect.height() : 0;
}

void GiveBack(QWidget& window, const QString& kind)
{
    const QRect place = QSettings().value(kind + "/place").toRect();
    if (!place.isValid()) return;
    window.setProperty(kPlacedProperty, true);
    window.setGeometry(OntoScreens(place, ScreensNow()));
    const QList<QSplitter*> splitters = window.findChildren<QSplitter*>();
    for (int i = 0; i < splitters.size(); ++i)
        splitters[i]->restoreState(
            QSettings().value(kind + "/splitter" + QString::number(i)).toByteArray());
}

void Keep(const QWidget& window, const QString& kind)
{
    if (window.isMaximized() || window.isMinimized()) return;
    QSettings().setValue(kind + "/place", window.geometry());
    const QList<QSplitter*> splitters = window.findChildren<QSplitter*>();
    for (int i = 0; i < splitters.size(); ++i)
        QSettings().setValue(kind + "/splitter" + QString::number(i), splitters[i]->saveState());
}

} // namespace

QRect OntoScreens(const QRect& window, const std::vector<QRect>& screens)
{
    const QRect& screen = *std::ranges::max_element(
        screens, {}, [&](const QRect& s) { return AreaOf(s.intersected(window)); });
    QRect out(window.topLeft(), window.size().boundedTo(screen.size()));
    out.moveLeft(std::clamp(out.left(), screen.left(), screen.right() + 1 - out.width()));
    out.moveTop(std::clamp(out.top(), screen.top(), screen.bottom() + 1 - out.height()));
    return out;
}

std::vector<QRect> ScreensNow()
{
    std::vector<QRect> out;
    for (const QScreen* screen : QGuiApplication::screens())
        out.push_back(screen->availableGeometry());
    return out;
}

CWindowKeeper::CWindowKeeper(QObject* parent) : QObject(parent)
{
    qApp->installEventFilter(this);
}

bool CWindowKeeper::eventFilter(QObject* object, QEvent* event)
{
    const bool shows = event->type() == QEvent::Show, hides = event->type() == QEvent::Hide;
    if ((!shows && !hides) || !object->isWidgetType() || event->spontaneous()) return false;
    auto* window = static_cast<QWidget*>(object);
    if (!window->isWindow()) return false;
    const QString kind = KindOf(window);
    if (kind.isEmpty()) return false;
    if (hides)
        Keep(*window, kind);
    else
        GiveBack(*window, kind);
    return false;
}
