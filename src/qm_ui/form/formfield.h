// One field of a form: its label, its widget, its mark, and how it is read and written.
#pragma once

#include "qm_ui/form/binding.h"

#include <QString>

class QLabel;
class QWidget;

/// Base of the fields. Widgets belong to their form, which outlives the fields.
class CFormField {
public:
    CFormField() = default;
    CFormField(const CFormField&) = delete;
    CFormField& operator=(const CFormField&) = delete;
    virtual ~CFormField() = default;

    /// As findings name it; a finding whose field begins with it marks this field. May be empty.
    std::string name;
    TextFn caption;                // empty: no label
    std::function<bool()> enabled; // empty: always
    std::function<bool()> shown;   // empty: always

    QLabel* label = nullptr;
    QLabel* unit = nullptr;
    QWidget* widget = nullptr;

    /// Shows the model's value, unless the person is changing it.
    virtual void Show() = 0;
    /// Gives what was typed to the model. False: it can't be read (the field is then marked).
    virtual bool Commit() { return true; }
    /// Texts again, after the language has changed.
    virtual void Retranslate() {}

    /// Frames the widget in red with a tooltip; an empty text takes the mark off, unless what is
    /// typed can't be read.
    void Mark(const std::string& text);
    bool IsMarked() const { return m_marked; }
    /// Label, visibility and whether it can be used.
    void ShowState();

protected:
    void SetFault(const QString& fault); // of what is typed

private:
    void ShowMark();

    QString m_fault, m_finding;
    bool m_marked = false;
};

/// What a field tells its form: its value was changed by the person.
using ChangedFn = std::function<void()>;
