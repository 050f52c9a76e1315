// Letters by which the fields of a form are reached with Alt.
#pragma once

#include "qm_ui/form/formfield.h"

#include <memory>
#include <vector>

/// Gives each field that is shown a letter of its own: in its label, or in the text of its button
/// or check box. Letters that texts bring stay.
void ShowLetters(const std::vector<std::unique_ptr<CFormField>>& fields);

/// Shows a label's text, without taking the letter off one that has it already.
void ShowLabel(QLabel& label, const QString& text);
