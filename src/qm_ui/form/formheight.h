// The height that a form needs before it has to be scrolled.
#pragma once

class QWidget;

/// Tables and pictures at their least, wrapped texts whole. Layouts alone would keep room for all
/// as they would like to be as soon as one text of the form wraps.
int LeastFormHeight(const QWidget& form, int width);
