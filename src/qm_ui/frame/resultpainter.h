// Draws what results add to the picture of a frame: diagrams along members, loads and reactions,
// stresses. It decides where things stand on the page, not what they are.
#pragma once

#include "qm_rps/view/resultview.h"
#include "qm_ui/frame/projection.h"

#include <QFontMetricsF>
#include <QPainterPath>

#include <functional>

/// What is drawn of results; nothing is owned, null: none.
struct T_FRAME_RESULTS {
    const T_BENT_LINES* bent = nullptr;
    const T_DIAGRAM* diagram = nullptr;
    const T_LOAD_MARKS* marks = nullptr;
    const T_STRESS_PICTURE* stress = nullptr;
    VIEW_LABELS labels = VIEW_LABELS::Member;
    bool filled = true;
    double size = 1.0; // of diagrams and arrows, times the one that suits
    bool HasValues() const { return diagram || marks || stress; }
    bool operator==(const T_FRAME_RESULTS&) const = default;
};

/// An entry of the legend.
struct T_LEGEND_ENTRY {
    QString text;
    std::function<void(QPainter&, QPointF middle)> swatch;
};

/// Four digits, those before the point all of them; as the locale writes it.
[[nodiscard]] QString ValueText(double value);

/// The lines of the frame on the page, as they are drawn.
struct T_PLACED_FRAME {
    const T_FRAME_SCENE& scene;
    const CProjection& projection;
    const std::vector<std::array<double, 3>>* moves = nullptr; // by node; null: none
    const T_BENT_LINES* bent = nullptr;                        // null: lines are straight
    double scale = 1.0;                                        // of the displacements

    /// A place along a line in space, displaced as it is drawn.
    [[nodiscard]] std::array<double, 3> On(std::size_t line, double s) const;
};

class CResultPainter {
public:
    /// quick: while the view moves: outlines alone, no numbers.
    void Draw(QPainter& painter, const QRectF& area, const T_PLACED_FRAME& frame,
              const T_FRAME_RESULTS& results, bool quick);
    [[nodiscard]] static std::vector<T_LEGEND_ENTRY> Legend(const T_FRAME_RESULTS& results);

private:
    struct T_LABEL {
        QPointF at, from; // beside `at`, away from `from`
        double value = 0.0;
        QString text;
    };
    void DrawDiagram(QPainter& painter, const QRectF& area, const T_PLACED_FRAME& frame,
                     const T_FRAME_RESULTS& results, bool quick);
    void PlaceMember(const T_PLACED_FRAME& frame, const T_DIAGRAM& diagram,
                     const T_MEMBER_DIAGRAM& member, double perValue);
    void FillMember(const T_DIAGRAM& diagram, const T_MEMBER_DIAGRAM& member);
    void LabelMember(const T_DIAGRAM& diagram, const T_MEMBER_DIAGRAM& member, std::size_t index,
                     VIEW_LABELS labels);
    void DrawMarks(QPainter& painter, const T_PLACED_FRAME& frame, const T_FRAME_RESULTS& results,
                   bool quick);
    void DrawStress(QPainter& painter, const T_PLACED_FRAME& frame, const T_STRESS_PICTURE& stress);
    void DrawLabels(QPainter& painter, const QRectF& area);

    // Of the member at hand: its line and the ends of its values; kept so that nothing is
    // allocated from frame to frame.
    std::vector<QPointF> m_base, m_tip;
    std::vector<QLineF> m_outline;
    QPainterPath m_positive, m_negative;
    std::vector<T_LABEL> m_labels;
    std::vector<QRectF> m_taken;
};
