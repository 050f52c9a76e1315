#include "qm_ui/form/formheight.h"

#include <QLabel>
#include <QLayout>

#include <algorithm>

int LeastFormHeight(const QWidget& form, int width)
{
    int wrapped = 0; // height of texts beyond their first lines
    for (const QLabel* label : form.findChildren<const QLabel*>())
        if (label->wordWrap() && label->isVisibleTo(&form))
            wrapped += std::max(
                label->heightForWidth(label->width()) - label->minimumSizeHint().height(), 0);
    return std::min(form.layout()->totalHeightForWidth(width),
                    form.minimumSizeHint().height() + wrapped);
}
