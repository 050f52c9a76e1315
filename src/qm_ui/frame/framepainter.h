// Draws a frame with any QPainter: wireframe, supports, numbers, hinges, its displaced shape.
#pragma once

#include "qm_rps/desk/hingemarks.h"
#include "qm_rps/judge/ratiobands.h"
#include "qm_ui/frame/resultpainter.h"

#include <QLineF>
#include <QPointF>
#include <QRectF>

#include <string>
#include <vector>

class QPainter;

/// What is drawn besides the lines.
struct T_FRAME_OPTIONS {
    bool nodeNumbers = false, elementNumbers = false;
    bool supports = true, hinges = true, drifts = true;
    bool undeformed = true; // also where a displaced shape is drawn
    bool quick = false;     // while the view moves: nothing is smoothed, no numbers
    bool operator==(const T_FRAME_OPTIONS&) const = default;
};

/// A frame in a picture. The scene is not owned.
struct T_FRAME_PICTURE {
    const T_FRAME_SCENE* scene = nullptr;
    const std::vector<std::array<double, 3>>* displacement = nullptr; // by node; null: none
    double scale = 1.0;                                               // of the displacements
    std::string subtitle;                                             // what is shown
    std::string note;                                                 // more about it
    std::vector<T_SCENE_DRIFT> drifts;
    const T_HINGE_MARKS* marks = nullptr; // hinges by their states; null: in one colour
    const T_RATIO_BANDS* bands = nullptr; // ends of members by their ratios; null: none
    std::vector<bool> chosen{};           // by line: those that are marked; empty: none
    std::vector<std::size_t> chosenNodes{};
    T_FRAME_RESULTS results{};
};

/// What stands out from the frame: displacements of the size that a round scale gives them,
/// diagrams, arrows. Over the frame's diagonal on the page.
[[nodiscard]] double RoomOf(const T_FRAME_PICTURE& picture);

/// Lengths are px at 96 dpi. State: buffers that are used again for the next picture.
class CFramePainter {
public:
    /// The whole picture: background, then foreground.
    void Draw(QPainter& painter, const QRectF& rect, const T_FRAME_PICTURE& picture,
              const T_CAMERA& camera, const T_FRAME_OPTIONS& options);
    /// What does not change with the displacements, so that a window can keep it: ground, frame as
    /// it was, supports.
    void DrawBackground(QPainter& painter, const QRectF& rect, const T_FRAME_PICTURE& picture,
                        const T_CAMERA& camera, const T_FRAME_OPTIONS& options);
    /// The rest, seen as the background was.
    void DrawForeground(QPainter& painter, const QRectF& rect, const T_FRAME_PICTURE& picture,
                        const T_FRAME_OPTIONS& options);

    /// The node that is shown in the latest picture nearest to a place, within 10 px; -1: none.
    [[nodiscard]] long NodeAt(const T_FRAME_SCENE& scene, QPointF place) const;
    /// The hinge of its marks, likewise; of several at one place the one whose state is worst.
    [[nodiscard]] long HingeAt(QPointF place) const;
    /// The nearest line, likewise.
    [[nodiscard]] long LineAt(const T_FRAME_SCENE& scene, QPointF place) const;
    /// Lines with both ends in a box; nodes in it that are shown.
    [[nodiscard]] std::vector<std::size_t> LinesIn(const T_FRAME_SCENE& scene,
                                                   const QRectF& box) const;
    [[nodiscard]] std::vector<std::size_t> NodesIn(const T_FRAME_SCENE& scene,
                                                   const QRectF& box) const;
    /// Where things were placed last.
    const CProjection& Projection() const { return m_projection; }
    const std::vector<QPointF>& Nodes() const { return m_moved; }
    const QRectF& Area() const { return m_area; }
    /// Places the frame for another camera, in the same area, without drawing.
    void Put(const T_FRAME_SCENE& scene, const T_CAMERA& camera, double room)
    {
        m_projection.Place(scene, camera, m_area, room, m_design);
    }

private:
    void PlaceMoved(const T_FRAME_PICTURE& picture);
    void PlaceBent(const T_FRAME_PICTURE& picture);
    void AddLine(const T_FRAME_SCENE& scene, std::size_t line, const std::vector<QPointF>& at,
                 bool bent, std::vector<QLineF>& out) const;
    void DrawLines(QPainter& painter, const T_FRAME_SCENE& scene, const std::vector<QPointF>& at,
                   bool faint);
    void DrawBands(QPainter& painter, const T_FRAME_PICTURE& picture) const;
    void DrawNodes(QPainter& painter) const;
    void DrawSupports(QPainter& painter, const T_FRAME_SCENE& scene, bool quick);
    void DrawChosen(QPainter& painter, const T_FRAME_PICTURE& picture);
    void DrawHinges(QPainter& painter, const T_FRAME_SCENE& scene) const;
    void PlaceMarks(const T_FRAME_PICTURE& picture);
    void DrawMarks(QPainter& painter, const T_FRAME_PICTURE& picture, bool quick);
    void DrawNumbers(QPainter& painter, const QRectF& area, const T_FRAME_PICTURE& picture,
                     const T_FRAME_OPTIONS& options) const;

    QRectF m_area; // of the frame, between titles and legend
    CProjection m_projection;
    CResultPainter m_results;
    std::vector<QPointF> m_design, m_moved; // nodes on the page
    std::vector<QPointF> m_bent;            // points along lines that are bent; empty: straight
    std::vector<std::size_t> m_bentAt;      // where those of a line begin, and the end
    std::vector<QPointF> m_hinges;          // marks on the page
    std::vector<std::size_t> m_order;       // of marks, the worst state last
    std::vector<QLineF> m_lines;
    std::array<std::vector<QLineF>, 3> m_kinds; // lines by the kind of element
    std::vector<QRectF> m_boxes;
};
