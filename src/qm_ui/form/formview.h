// A form: fields bound to a dialog model, in groups, columns and pages. A simple dialog's view is a
// list of calls on it, nothing else.
//
// After each change by the person every field is read again from the model, states and pictures
// too, and findings are marked on the fields that they name.
#pragma once

#include "qm_base/finding.h"
#include "qm_ui/form/formfields.h"
#include "qm_ui/form/formheight.h"
#include "qm_ui/form/gridbinding.h"

#include <QWidget>

class CGridView;
class QBoxLayout;
class QGridLayout;
class QTabWidget;

class CFormView : public QWidget {
public:
    explicit CFormView(QWidget* parent = nullptr);
    ~CFormView() override;

    // ---- layout; what is added next goes into the innermost open one ----
    void Group(TextFn title);
    void EndGroup();
    /// Side by side: Columns, fields, NextColumn, fields, EndColumns. stretch above 0: this column
    /// takes the width that is left.
    void Columns(int stretch = 0);
    void NextColumn(int stretch = 0);
    void EndColumns();
    /// Pages of a tab: Page ... Page ... EndPages. `shown` as for fields.
    void Page(TextFn title, std::function<bool()> shown = {});
    void EndPages();

    /// Room that is left goes here: what follows is at the bottom.
    void Space();
    /// A table of fields: each one that follows stands in the next cell, row by row under the
    /// heads. Captions are not shown; screen readers get them.
    void Cells(std::vector<TextFn> heads);
    void EndCells();

    // ---- fields; unit: text after the widget ----
    CFormField& Number(TextFn caption, T_BINDING<double> binding, TextFn unit = {});
    CFormField& Optional(TextFn caption, T_BINDING<std::optional<double>> binding,
                         TextFn unit = {});
    CFormField& Integer(TextFn caption, T_BINDING<int> binding, TextFn unit = {});
    CFormField& Text(TextFn caption, T_BINDING<std::string> binding);
    CFormField& Choice(TextFn caption, T_BINDING<int> binding,
                       std::function<std::vector<std::string>()> texts);
    CFormField& Flag(TextFn caption, T_BINDING<bool> binding);
    CFormField& Note(TextFn text);
    CFormField& Button(TextFn caption, std::function<void()> pressed);
    CFormField& Picture(std::function<T_PLOT()> plot);
    /// A table; the field's widget is a CGridView.
    CFormField& Grid(T_GRID_BINDING binding);
    /// A widget of the caller, made by it with this form (Host) as parent.
    CFormField& Custom(TextFn caption, std::unique_ptr<CFormField> field);
    QWidget* Host() { return this; }
    /// Tells the form that the person has done something; edits: has changed a value.
    ChangedFn Changed(bool edits = false);

    /// Rules that are not kept, asked for with each refresh.
    void SetFindings(std::function<std::vector<T_FINDING>()> findings);
    /// Called after each change by the person, before the fields are read again.
    std::function<void()> m_onChange;
    /// Whether the model has changes that are not stored; empty: whether the person has edited.
    std::function<bool()> m_isChanged;
    /// Shows a message (key) of the form itself.
    std::function<void(const char* key)> m_message;

    /// Reads everything again from the model.
    void Refresh();
    /// Gives what was typed to the model. False: the first field that can't be read has the focus.
    bool Commit();
    /// Focus to the first marked field, on its page.
    void ShowFirstMark();
    /// The person has changed a field or a table, or is typing in one.
    bool IsTouched() const;
    /// Number of marked fields.
    int Marks() const;
    /// What it needs: tables and pictures give room before the form has to be scrolled.
    int heightForWidth(int width) const override { return LeastFormHeight(*this, width); }
    /// The field with that name, or null.
    CFormField* Find(const std::string& name);

protected:
    void changeEvent(QEvent* event) override;

private:
    struct T_BOX {
        QGridLayout* grid = nullptr;
        int row = 0;
        QBoxLayout* columns = nullptr; // of a row of columns
        QTabWidget* tabs = nullptr;
        bool grows = false; // of a row of columns: one of them does
        int cells = 0;      // columns of a table of fields
        int cell = 0;       // the next one
    };
    struct T_TITLE {
        TextFn text;
        std::function<void(const QString&)> show;
        QTabWidget* tabs = nullptr; // of a page
        QWidget* page = nullptr;
        std::function<bool()> shown{};
    };
    T_BOX NewBox(QWidget* host);
    bool BoxGrows() const;
    void LetGrow();
    void CloseColumn();
    void AddWide(QWidget* widget);
    CFormField& Add(TextFn caption, std::unique_ptr<CFormField> field, const TextFn& unit = {});
    void ShowTitles();
    void MarkFindings();
    void Reveal(QWidget* widget);

    std::vector<T_BOX> m_boxes; // open ones
    std::vector<T_TITLE> m_titles;
    std::vector<std::unique_ptr<CFormField>> m_fields;
    std::vector<CGridView*> m_grids;
    std::function<std::vector<T_FINDING>()> m_findings;
    bool m_refreshing = false;
    bool m_touched = false;
};
