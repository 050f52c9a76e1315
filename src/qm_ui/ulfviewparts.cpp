#include "qm_ui/ulfviewparts.h"

#include "qm_base/msgfunction.h"

QString UlfText(const char* key)
{
    return QString::fromStdString(zql::lib::MMSGFunction::GetValue(key));
}

CFormField& AddUlfGrid(CFormView& form, T_GRID_BINDING binding, QSize least)
{
    CFormField& field = form.Grid(std::move(binding));
    field.widget->setMinimumSize(least);
    return field;
}

void AddUlfButtons(CFormView& form, const std::vector<T_ULF_BUTTON>& buttons)
{
    form.Columns();
    for (std::size_t i = 0; i < buttons.size(); ++i) {
        if (i > 0) form.NextColumn();
        const T_ULF_BUTTON& button = buttons[i];
        CFormField& field =
            form.Button(KeyText(button.key), [&form, pressed = button.pressed, button] {
                if (!button.commits || form.Commit()) pressed();
            });
        field.enabled = button.enabled;
        field.widget->setObjectName(QLatin1String(button.key));
    }
    form.EndColumns();
}
