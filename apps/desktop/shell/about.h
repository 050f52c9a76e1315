// What the program is: version, libraries, licences.
#pragma once

#include <QString>

class QWidget;

/// The text of the box, as rich text.
QString AboutText();
void ShowAbout(QWidget* parent);
