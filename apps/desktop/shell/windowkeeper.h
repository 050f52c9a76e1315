// Windows come up where they were left, on a screen that is there.
#pragma once

#include <QByteArray>
#include <QObject>
#include <QRect>

#include <vector>

class QWidget;

/// A window's place moved, and made smaller where it must be, so that it lies on the screen that
/// has most of it, or on the first one. screens: the parts that windows may take; not empty.
QRect OntoScreens(const QRect& window, const std::vector<QRect>& screens);
std::vector<QRect> ScreensNow();

/// Watches the application's dialog windows: size, place and splitters of each kind are kept in the
/// settings when it is hidden and given back when it comes up.
class CWindowKeeper : public QObject {
public:
    explicit CWindowKeeper(QObject* parent);
    bool eventFilter(QObject* object, QEvent* event) override;
};
