// The kinds of fields: edit field, list of choices, check box, note, button, picture.
#pragma once

#include "qm_ui/form/formfield.h"
#include "qm_ui/plot/plotdata.h"

#include <functional>
#include <memory>

class QBoxLayout;

/// Reads a typed text into the model. Empty: taken; else the reason why it can't be read.
using ReadTextFn = std::function<QString(const QString&)>;

/// An edit field over any text; numbers are shown with all digits and the locale's separator.
std::unique_ptr<CFormField> MakeTextField(std::function<QString()> text, ReadTextFn read,
                                          ChangedFn changed, QWidget* parent);
std::unique_ptr<CFormField> MakeNumberField(T_BINDING<double> binding, ChangedFn changed,
                                            QWidget* parent);
/// An empty field is no value.
std::unique_ptr<CFormField> MakeOptionalField(T_BINDING<std::optional<double>> binding,
                                              ChangedFn changed, QWidget* parent);
std::unique_ptr<CFormField> MakeIntegerField(T_BINDING<int> binding, ChangedFn changed,
                                             QWidget* parent);
/// Texts are asked for with each refresh, so that a list may change. An index outside shows none.
std::unique_ptr<CFormField> MakeChoiceField(T_BINDING<int> binding,
                                            std::function<std::vector<std::string>()> texts,
                                            ChangedFn changed, QWidget* parent);
/// The caption stands beside the box.
std::unique_ptr<CFormField> MakeFlagField(T_BINDING<bool> binding, TextFn caption,
                                          ChangedFn changed, QWidget* parent);
/// A text that wraps.
std::unique_ptr<CFormField> MakeNote(TextFn text, QWidget* parent);
std::unique_ptr<CFormField> MakeButton(TextFn caption, std::function<void()> pressed,
                                       ChangedFn changed, QWidget* parent);
/// A plot that is made again with each refresh.
std::unique_ptr<CFormField> MakePicture(std::function<T_PLOT()> plot, QWidget* parent);
