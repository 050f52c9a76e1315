#include "qm_ui/form/formheight.h"

#include <QGridLayout>
#include <QLabel>
#include <QTabWidget>

#include <algorithm>
#include <map>

namespace {

int ExtraOf(const QLayout& layout);

/// What the wrapped texts of an item need beyond its least height.
int ExtraOf(const QLayoutItem& item)
{
    const QWidget* const widget = item.widget();
    if (!widget) return 0;
    if (const auto* label = qobject_cast<const QLabel*>(widget))
        return label->wordWrap() ? std::max(label->heightForWidth(label->width()) -
                                                label->minimumSizeHint().height(),
                                            0)
                                 : 0;
    const auto* tabs = qobject_cast<const QTabWidget*>(widget);
    if (!tabs) return widget->layout() ? ExtraOf(*widget->layout()) : 0;
    int least = 0, whole = 0;
    for (int i = 0; i < tabs->count(); ++i) {
        const QLayout& page = *tabs->widget(i)->layout();
        least = std::max(least, page.minimumSize().height());
        whole = std::max(whole, page.minimumSize().height() + ExtraOf(page));
    }
    return whole - least;
}

/// Of a grid, row by row; of others, whose items stand side by side, as one row.
int ExtraOf(const QLayout& layout)
{
    struct T_ROW {
        int least = 0, whole = 0;
    };
    std::map<int, T_ROW> rows;
    const auto* grid = qobject_cast<const QGridLayout*>(&layout);
    for (int i = 0; i < layout.count(); ++i) {
        const QLayoutItem& item = *layout.itemAt(i);
        if (item.isEmpty()) continue; // hidden
        int at = 0, column = 0, height = 0, width = 0;
        if (grid) grid->getItemPosition(i, &at, &column, &height, &width);
        T_ROW& row = rows[at];
        const int least = item.minimumSize().height();
        row.least = std::max(row.least, least);
        row.whole = std::max(row.whole, least + ExtraOf(item));
    }
    int extra = 0;
    for (const auto& [at, row] : rows)
        extra += row.whole - row.least;
    return extra;
}

} // namespace

int LeastFormHeight(const QWidget& form, int width)
{
    return std::min(form.layout()->totalHeightForWidth(width),
                    form.minimumSizeHint().height() + ExtraOf(*form.layout()));
}
