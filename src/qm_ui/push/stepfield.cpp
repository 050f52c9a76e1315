#include "qm_ui/push/stepfield.h"

#include "qm_ui/frame/frameview.h"
#include "qm_ui/plot/plotwidget.h"
#include "qm_ui/push/stepdrawings.h"

#include <QSignalBlocker>
#include <QSlider>

#include <algorithm>

namespace {

class CStepField : public CFormField {
public:
    CStepField(CPushOverResultDlg& results, const ChangedFn& changed, QWidget* parent)
        : m_results(results), m_slider(new QSlider(Qt::Horizontal, parent))
    {
        widget = m_slider;
        m_slider->setMinimum(1);
        m_slider->setMinimumWidth(320);
        QObject::connect(m_slider, &QSlider::valueChanged, [this, changed](int step) {
            m_results.OnStep(step);
            changed();
        });
    }
    void Show() override
    {
        const QSignalBlocker quiet(m_slider);
        m_slider->setMaximum(std::max(m_results.Steps(), 1));
        m_slider->setValue(m_results.Step());
        m_slider->setEnabled(m_results.Steps() > 1);
    }

private:
    CPushOverResultDlg& m_results;
    QSlider* m_slider;
};

/// Shares its column with a table.
class CStateView : public CFrameView {
public:
    using CFrameView::CFrameView;
    QSize sizeHint() const override { return {560, 400}; }
};

class CStateFrame : public CFormField {
public:
    CStateFrame(CPushOverHingeStateDlg& results, const ChangedFn& changed, QWidget* parent)
        : m_results(results), m_view(new CStateView(parent))
    {
        widget = m_view;
        m_view->SetCamera(CameraFor(CFrameScene::FlatAxis(results.Scene())));
        m_view->m_onHinge = [this, changed](long hinge) {
            m_results.OnHinge(hinge);
            changed();
        };
    }
    void Show() override { m_view->SetPicture(StatePicture(m_results, m_results.Scale())); }

private:
    CPushOverHingeStateDlg& m_results;
    CFrameView* m_view;
};

} // namespace

CFormField& AddPlot(CFormView& form, std::function<T_PLOT()> plot, QSize wanted)
{
    CFormField& field = form.Picture(std::move(plot));
    if (auto* view = dynamic_cast<CPlotWidget*>(field.widget)) view->SetSizeHint(wanted);
    return field;
}

std::unique_ptr<CFormField> MakeStepField(CPushOverResultDlg& shown, ChangedFn changed,
                                          QWidget* parent)
{
    return std::make_unique<CStepField>(shown, changed, parent);
}

std::unique_ptr<CFormField> MakeStateFrame(CPushOverHingeStateDlg& shown, ChangedFn changed,
                                           QWidget* parent)
{
    return std::make_unique<CStateFrame>(shown, changed, parent);
}
