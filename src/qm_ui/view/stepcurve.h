// A small picture of a push beside its slider: base reaction over displacement, and the step.
#pragma once

#include "qm_rps/view/resultview.h"

#include <QPolygonF>
#include <QWidget>

/// A click chooses the step whose displacement is nearest.
class CStepCurve : public QWidget {
public:
    explicit CStepCurve(QWidget* parent = nullptr);

    /// The curve must stay until another one is set.
    void SetCurve(const T_VIEW_CURVE& curve, int step);
    std::function<void(int step)> m_onStep;
    /// The place of a step.
    QPointF PlaceOf(int step) const;

    QSize sizeHint() const override { return {170, 46}; }

protected:
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;

private:
    void Go(QPointF place);

    const T_VIEW_CURVE* m_curve = nullptr;
    int m_step = 1;
};
