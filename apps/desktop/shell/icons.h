// The drawn icons of the program: one set, 24 px grid, lines of 1.5 px in the colour of the text.
#pragma once

#include <QIcon>

/// The icon shell/icons/NAME.svg, in the colour of the palette's text whenever it is drawn, so that
/// it follows the theme. Null where there is none of this name.
QIcon DrawnIcon(const QString& name);

/// The name of a command's icon by the key of its text; empty: it has none.
QString IconOf(const QString& commandKey);
