#include "qm_ui/factors/ulfviewparts.h"

#include "qm_base/msgfunction.h"

#include <QScrollArea>

#include <algorithm>

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

CFormField& AddUlfPicture(CFormView& form, std::function<T_PLOT()> plot)
{
    constexpr double kLeast = 360.0, kMost = 4000.0; // px
    const double height = std::clamp(plot().pageHeight, kLeast, kMost);
    auto* scroll = new QScrollArea(form.Host());
    std::unique_ptr<CFormField> field = MakePicture(std::move(plot), scroll);
    field->widget->setMinimumHeight(static_cast<int>(height));
    scroll->setWidget(field->widget);
    scroll->setWidgetResizable(true);
    scroll->setMinimumHeight(static_cast<int>(kLeast));
    field->widget = scroll;
    return form.Custom({}, std::move(field));
}

namespace {

class CFiller : public CFormField {
public:
    explicit CFiller(QWidget* parent)
    {
        widget = new QWidget(parent);
        widget->setSizePolicy(QSizePolicy::Preferred, QSizePolicy::Expanding);
    }
    void Show() override {}
};

} // namespace

void AddUlfFiller(CFormView& form)
{
    form.Custom({}, std::make_unique<CFiller>(form.Host()));
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
