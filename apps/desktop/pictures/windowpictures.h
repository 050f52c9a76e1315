// Pictures of every window, for the documents and for looking at them.
#pragma once

#include "desktop.h"

#include <QString>

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

/// Renders every window in both languages into a folder, as NAME-LANGUAGE.png, at this scale of
/// the screen. examples: folder of the example models. Returns the number of pictures that could
/// not be made; each is named on stderr.
int WriteWindowPictures(const QString& folder, const QString& examples);

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
