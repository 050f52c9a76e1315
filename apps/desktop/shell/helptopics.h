// Which section of the guide explains a window, and where that section stands.
#pragma once

#include <QString>
#include <QStringList>

class QWidget;

/// The anchor of a heading as it is made on the web: "Hinges that a code gives" ->
/// "hinges-that-a-code-gives".
QString AnchorOf(const QString& heading);

/// The anchor for a window by its title, or for a pane of the main window that has the focus;
/// else the section with the title of the window, else that of the desktop.
QString TopicOf(const QWidget* focused);

/// All of them.
QStringList HelpTopics();

/// Pages of the guide as they are installed, the order of reading.
QStringList GuidePages();
/// The first page that has a heading with this anchor; empty: none has it.
QString PageWith(const QString& anchor);
