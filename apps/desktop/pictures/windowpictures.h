// Pictures of every window, for the documents and for looking at them.
#pragma once

#include "desktop.h"

#include "qm_rps/shell/preferences.h"

#include <QSize>
#include <QString>
#include <QStringList>

#include <functional>
#include <memory>
#include <string>
#include <vector>

class CMainWindow;

/// A window to be pictured: made, filled and sized on an open model.
struct T_WINDOW_EXAMPLE {
    std::string name;  // of its file
    std::string model; // case file of the examples that is opened for it: "first-steps"
    /// Makes the window; what it needs must live as long as it does (see KeepWith). Null: the main
    /// window itself.
    std::function<std::unique_ptr<QWidget>(CMainWindow& main)> make{};
};

/// How pictures are made. Scale of the screen and its size are those that the program started with
/// (see COffscreenScreen).
struct T_PICTURE_OPTIONS {
    QString folder;
    QString examples; // folder of the example models
    QStringList languages{"en", "it"};
    THEME theme = THEME::Light;
    QSize size{}; // of the main window, and the most of others; empty: as wanted
    QString only; // windows whose names begin so; empty: all
};

/// Renders windows into the folder, as NAME-LANGUAGE.png. Returns the number of pictures that could
/// not be made; each is named on stderr.
int WriteWindowPictures(const T_PICTURE_OPTIONS& options);

/// A screen in memory for these arguments (--scale 2, --size 1024x700) where --pictures is among
/// them. It is made before the application, which takes it from a file that goes with this object.
class COffscreenScreen {
public:
    COffscreenScreen(int argc, char** argv);
    ~COffscreenScreen();
    COffscreenScreen(const COffscreenScreen&) = delete;
    COffscreenScreen& operator=(const COffscreenScreen&) = delete;

private:
    std::string m_file; // empty: none
};

/// The windows of all tools.
std::vector<T_WINDOW_EXAMPLE> WindowExamples();

/// Keeps an object as long as a window.
template <class T>
T& KeepWith(QWidget& window, std::unique_ptr<T> object)
{
    T& kept = *object;
    // The window's destruction is announced before its children go, but after its own members.
    QObject::connect(&window, &QObject::destroyed,
                     [owner = std::shared_ptr<T>(std::move(object))] { (void)owner; });
    return kept;
}
