// From places in space to places on a page: parallel, or with perspective.
#pragma once

#include "qm_rps/desk/framescene.h"

#include <QPointF>
#include <QRectF>

#include <vector>

class QPainter;

/// Where the frame is looked at from, Z upwards.
struct T_CAMERA {
    double yawDeg = 45.0;             // about Z; 0 looks along Y
    double pitchDeg = 35.26438968275; // from the horizon; 90 looks straight down
    double zoom = 1.0;                // 1: the frame fits
    QPointF pan{};                    // px
    bool perspective = false;         // what is nearer is larger
    bool operator==(const T_CAMERA&) const = default;
};
inline constexpr T_CAMERA kIsometric{};
inline constexpr T_CAMERA kElevationXZ{0.0, 0.0, 1.0, {}};
inline constexpr T_CAMERA kElevationYZ{90.0, 0.0, 1.0, {}};
inline constexpr T_CAMERA kPlanXY{0.0, 90.0, 1.0, {}};

/// Looks straight on a frame in a plane with this normal axis (CFrameScene::FlatAxis); -1: from
/// above a corner.
const T_CAMERA& CameraFor(int flatAxis);

/// Lengths are px at 96 dpi. State: where things were placed last.
class CProjection {
public:
    using T_PLACE = std::array<double, 3>;

    /// So that the scene fits the area at zoom 1; room: for what stands out from it, over the
    /// scene's diagonal on the page. Places of its nodes go to `nodes`.
    void Place(const T_FRAME_SCENE& scene, const T_CAMERA& camera, const QRectF& area, double room,
               std::vector<QPointF>& nodes);
    [[nodiscard]] QPointF At(const T_PLACE& place) const
    {
        return m_centre + m_px * (Unit(place) - m_middle);
    }
    /// A place that lies at `from` on the page, moved.
    [[nodiscard]] QPointF Moved(QPointF from, const T_PLACE& place, const T_PLACE& by,
                                double factor) const;
    /// Towards the viewer.
    [[nodiscard]] double Depth(const T_PLACE& place) const;
    /// At the middle of the scene.
    double PxPerLength() const { return m_px; }
    double PxAtZoom1() const { return m_fit; }
    /// Diagonal of the box around the scene.
    double Size() const { return m_size; }
    const T_PLACE& Target() const { return m_target; } // middle of the scene
    bool IsPerspective() const { return m_perspective; }
    /// The three axes in the lower left corner.
    void DrawTriad(QPainter& painter, const QRectF& area) const;

private:
    [[nodiscard]] QPointF Unit(const T_PLACE& place) const;

    T_PLACE m_right{}, m_up{}, m_back{}; // axes of the page in space; back: to the viewer
    T_PLACE m_target{};                  // middle of the scene
    double m_size = 1.0, m_px = 1.0, m_fit = 1.0;
    bool m_perspective = false;
    QPointF m_centre, m_middle;
};
