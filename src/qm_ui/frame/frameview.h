// The frame in a window: rotate, zoom, pan, read-out of the node under the mouse.
#pragma once

#include "qm_ui/frame/framepainter.h"

#include <QPixmap>
#include <QPoint>
#include <QTimer>
#include <QWidget>

#include <functional>
#include <optional>

/// How what is clicked joins what is chosen.
enum class PICK { Only, Add, Toggle };
struct T_PICK {
    PICK how = PICK::Only;
    std::vector<std::size_t> lines, nodes; // of the scene; both empty: a click beside everything
};

/// Left drag turns about the middle of what is seen, right or middle drag (or left with Shift)
/// moves, the wheel zooms at the cursor, a double click fits. Where something can be chosen a click
/// takes the nearest node or line, with Ctrl it toggles, with Shift it adds; left drag with Ctrl
/// takes what is in a box, with Ctrl and Shift it adds. Arrow keys turn, + and - zoom, 0 fits, F
/// fits what is chosen, P is perspective; 1 to 4 isometric, XZ, YZ, XY.
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
    /// Takes clicks and boxes in place of these two; Escape; a right click without a drag.
    std::function<void(const T_PICK& pick)> m_onPick;
    std::function<void()> m_onEscape;
    std::function<void(QPoint global)> m_onMenu;
    /// All of what is shown, or of what is chosen, in the middle and as large as fits.
    void FitAll();
    void FitChosen();
    /// The hinge of the picture's marks at a place, as it was drawn last; -1: none.
    [[nodiscard]] long HingeAt(QPointF place) const;
    /// The line of the scene at a place, likewise.
    [[nodiscard]] long LineAt(QPointF place) const;
    /// Id and coordinates of the node under a place, or id and extremes of the member; empty: none.
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
    /// The view moves: large frames are drawn without numbers until it stands.
    void Moving();
    void Pick(QPointF place, Qt::KeyboardModifiers with);
    void PickBox(Qt::KeyboardModifiers with);
    CProjection::T_PLACE Pivot() const;
    QString LineText(std::size_t line) const;
    QRectF Box() const;

    T_FRAME_PICTURE m_picture;
    T_CAMERA m_camera;
    T_FRAME_OPTIONS m_options;
    CFramePainter m_painter;
    /// What the background at hand was drawn for; another picture of the same frame keeps it.
    struct T_KEPT {
        const T_FRAME_SCENE* scene = nullptr;
        long revision = 0, variant = 0;
        bool moved = false;
        std::string note; // titles that are shown move the frame
        bool subtitle = false;
        std::size_t entries = 0; // of results in the legend, likewise
        double room = 0.0;
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
    QTimer m_still;
    std::optional<CProjection::T_PLACE> m_pivot{}; // what a drag turns about
    std::vector<QPointF> m_places;                 // of nodes, while it turns
    QPointF m_grab, m_press;
    bool m_isBox = false; // a box is being drawn from m_press to m_grab
};
