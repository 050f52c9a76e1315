// Draws a frame with any QPainter: wireframe, supports, numbers, hinges, its displaced shape.
#pragma once

#include "qm_rps/desk/hingemarks.h"
#include "qm_rps/judge/ratiobands.h"

#include <QLineF>
#include <QPointF>
#include <QRectF>

#include <string>
#include <vector>

class QPainter;

/// Where the frame is looked at from: parallel projection, Z upwards.
struct T_CAMERA {
    double yawDeg = 45.0;             // about Z; 0 looks along Y
    double pitchDeg = 35.26438968275; // from the horizon; 90 looks straight down
    double zoom = 1.0;                // 1: the frame fits
    QPointF pan{};                    // px
    bool operator==(const T_CAMERA&) const = default;
};
inline constexpr T_CAMERA kIsometric{};
inline constexpr T_CAMERA kElevationXZ{0.0, 0.0, 1.0, {}};
inline constexpr T_CAMERA kElevationYZ{90.0, 0.0, 1.0, {}};
inline constexpr T_CAMERA kPlanXY{0.0, 90.0, 1.0, {}};

/// Looks straight on a frame in a plane with this normal axis (CFrameScene::FlatAxis); -1: from
/// above a corner.
const T_CAMERA& CameraFor(int flatAxis);

/// What is drawn besides the lines.
struct T_FRAME_OPTIONS {
    bool nodeNumbers = false, elementNumbers = false;
    bool supports = true, hinges = true, drifts = true;
    bool undeformed = true; // also where a displaced shape is drawn
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
};

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
    void DrawForeground(QPainter& painter, const QRectF& rect, const T_FRAME_PICTURE& picture,
                        const T_CAMERA& camera, const T_FRAME_OPTIONS& options);

    /// The node of the latest picture nearest to a place, within 10 px; -1: none.
    [[nodiscard]] long NodeAt(QPointF place) const;
    /// The hinge of its marks, likewise; of several at one place the one whose state is worst.
    [[nodiscard]] long HingeAt(QPointF place) const;
    /// The nearest line, likewise.
    [[nodiscard]] long LineAt(const T_FRAME_SCENE& scene, QPointF place) const;
    /// Lines with both ends in a box.
    [[nodiscard]] std::vector<std::size_t> LinesIn(const T_FRAME_SCENE& scene,
                                                   const QRectF& box) const;

private:
    void PlaceDesign(const T_FRAME_PICTURE& picture, const T_CAMERA& camera, const QRectF& area);
    void PlaceMoved(const T_FRAME_PICTURE& picture, const T_CAMERA& camera);
    void DrawLines(QPainter& painter, const T_FRAME_SCENE& scene, const std::vector<QPointF>& at,
                   bool faint);
    void DrawBands(QPainter& painter, const T_FRAME_PICTURE& picture) const;
    void DrawNodes(QPainter& painter) const;
    void DrawSupports(QPainter& painter, const T_FRAME_SCENE& scene) const;
    void DrawChosen(QPainter& painter, const T_FRAME_PICTURE& picture);
    void DrawHinges(QPainter& painter, const T_FRAME_SCENE& scene) const;
    void DrawMarks(QPainter& painter, const T_FRAME_PICTURE& picture);
    void DrawNumbers(QPainter& painter, const QRectF& area, const T_FRAME_PICTURE& picture,
                     const T_FRAME_OPTIONS& options) const;

    std::vector<QPointF> m_design, m_moved; // nodes on the page
    std::vector<QPointF> m_hinges;          // marks on the page
    std::vector<std::size_t> m_order;       // of marks, the worst state last
    double m_pxPerLength = 1.0;
    std::vector<QLineF> m_lines;
};
