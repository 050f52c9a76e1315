// The bar over the view of the frame: source, quantity, step, play, numbers, scales.
#pragma once

#include "qm_rps/view/resultview.h"

#include <QTimer>
#include <QWidget>

class CStepCurve;
class QComboBox;
class QDoubleSpinBox;
class QLabel;
class QLineEdit;
class QSlider;
class QToolButton;

class CResultsBar : public QWidget {
public:
    /// The view must outlive the bar.
    explicit CResultsBar(CResultView& view, QWidget* parent = nullptr);

    /// What the view shows has changed: the fields follow.
    void Refresh();
    void Retranslate();
    /// To be drawn anew: another choice, step or phase.
    std::function<void()> m_onShown;
    /// Of a mode that swings; else 1.
    double Phase() const;
    void Play(bool play);
    bool IsPlaying() const { return m_timer.isActive(); }
    QSlider& Slider() { return *m_slider; }
    CStepCurve& Curve() { return *m_curve; }
    QToolButton& PlayButton() { return *m_play; }

protected:
    void hideEvent(QHideEvent* event) override;

private:
    void MakeRows();
    void Connect();
    void Choose(const std::function<void(T_VIEW_CHOICE&)>& change);
    void TakeScale();
    void Tick();
    void Shown();
    void FillSources();

    CResultView& m_view;
    QComboBox *m_source, *m_what, *m_labels;
    QToolButton *m_onDeformed, *m_filled, *m_play;
    QSlider* m_slider;
    CStepCurve* m_curve;
    QLabel *m_step, *m_scaleLabel, *m_sizeLabel;
    QLineEdit* m_scale;
    QDoubleSpinBox* m_size;
    QTimer m_timer;
    double m_angle = 0.0; // of a mode that swings
};
