// What the views of load factors have in common.
#pragma once

#include "qm_rps/factors/ulfanalysis.h"
#include "qm_ui/form/viewfactory.h"

#include <QString>

#include <array>

/// What their windows ask of the application.
struct T_ULF_HOOKS {
    using WORK = std::function<int(ULF_PROGRESS)>;
    /// Runs work under a window that shows its progress and can cancel it; returns what it does.
    std::function<int(QWidget* parent, const QString& title, const WORK& work)> run;
    /// The name of a spreadsheet to write; empty: cancelled.
    std::function<QString(QWidget* parent)> askSheetName;
};

/// A catalogue text now.
QString UlfText(const char* key);

/// Fixed columns with these heads, of these kinds.
template <std::size_t N>
std::vector<T_GRID_COLUMN> UlfColumns(const std::array<const char*, N>& heads,
                                      const std::array<CELL_KIND, N>& kinds)
{
    std::vector<T_GRID_COLUMN> columns;
    for (std::size_t i = 0; i < N; ++i)
        columns.push_back({KeyText(heads[i]), kinds[i]});
    return columns;
}

/// Adds a table of at least this size in px.
CFormField& AddUlfGrid(CFormView& form, T_GRID_BINDING binding, QSize least);

/// Adds a picture that scrolls where it is less high than it needs to be.
CFormField& AddUlfPicture(CFormView& form, std::function<T_PLOT()> plot);

/// Takes the room that is left below the fields of a column.
void AddUlfFiller(CFormView& form);

/// Adds a row of buttons; each gives what was typed to the model before it does its work.
struct T_ULF_BUTTON {
    const char* key;
    std::function<void()> pressed;
    std::function<bool()> enabled{};
    bool commits = true;
};
void AddUlfButtons(CFormView& form, const std::vector<T_ULF_BUTTON>& buttons);
