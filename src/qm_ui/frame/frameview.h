// The frame in a window: rotate, zoom, pan, read-out of the node under the mouse.
#pragma once

#include "qm_ui/frame/framepainter.h"

#include <QPixmap>
#include <QPoint>
#include <QWidget>

#include <functional>

/// Left drag turns, right or middle drag (or left with Shift) moves, the wheel zooms at the cursor,
/// a double click fits. Where lines can be chosen a click takes the nearest one, and left drag with
/// Ctrl those in a box. Arrow keys turn, + and - zoom, 0 fits; 1 to 4 isometric, XZ, YZ, XY.
class CFrameView : public QWidget {
public:
    explicit CFrameView(QWidget* parent = nullptr);

    /// The picture's scene must stay until another one is set.
    void SetPicture(T_FRAME_PICTURE picture);
    const T_FRAME_PICTURE& Picture() const { return m_picture; }
    void SetCamera(const T_CAMERA& camera);
    const T_CAMERA& Camera() const { return m_camera; }
    void SetOptions(const T_FRAME_OPTIONS& options);
    const T_FRAME_OPTIONS& Options() const { return m_options; }
    /// A hinge of the picture's marks was clicked.
    std::function<void(long hinge)> m_onHinge;
    /// A line of the scene was clicked; lines with both ends in a box that was drawn.
    std::function<void(std::size_t line)> m_onLine;
    std::function<void(const std::vector<std::size_t>& lines)> m_onLines;
    /// The hinge of the picture's marks at a place, as it was drawn last; -1: none.
    [[nodiscard]] long HingeAt(QPointF place) const;
    /// The line of the scene at a place, likewise.
    [[nodiscard]] long LineAt(QPointF place) const;
    /// Id and coordinates of the node under a place; empty: none.
    [[nodiscard]] QString ReadOut(QPointF place) const;

    QSize sizeHint() const override { return {720, 520}; }
    QSize minimumSizeHint() const override { return {240, 180}; }

protected:
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

private:
    void ZoomAt(QPointF place, double factor);
    void Turn(double yawDeg, double pitchDeg);
    QRectF Box() const;

    T_FRAME_PICTURE m_picture;
    T_CAMERA m_camera;
    T_FRAME_OPTIONS m_options;
    CFramePainter m_painter;
    /// What the background at hand was drawn for; another picture of the same frame keeps it.
    struct T_KEPT {
        const T_FRAME_SCENE* scene = nullptr;
        long revision = 0;
        bool moved = false;
        std::size_t lines = 0; // titles that are shown: they move the frame
        bool drifts = false, marks = false;
        std::ptrdiff_t chosen = 0;
        T_CAMERA camera;
        T_FRAME_OPTIONS options;
        QSize size;
        bool operator==(const T_KEPT&) const = default;
    };
    T_KEPT Key() const;
    T_KEPT m_kept;
    QPixmap m_background;
    QPointF m_grab, m_press;
    bool m_isBox = false; // a box is being drawn from m_press to m_grab
};
