// The frame view with its controls: what it is shown under, the step, the scale, what is drawn.
#pragma once

#include "qm_rps/desk/selection.h"
#include "qm_ui/frame/frameview.h"
#include "qm_ui/report/picturefile.h"

#include <QWidget>

class QComboBox;
class QLabel;
class QLineEdit;
class QSlider;

class CFramePane : public QWidget {
public:
    /// Document, scene and selection must outlive the pane.
    CFramePane(CDBDoc& doc, CFrameScene& scene, CSelection& selection, QWidget* parent = nullptr);
    ~CFramePane() override;

    /// The document has changed: frame, sources and shape again; the choice stays where it can.
    void Refresh();
    void Retranslate();
    /// 1 shown; 0 there is no such source.
    int Show(const T_SHAPE_SOURCE& source, int step);
    void SetStep(int step);
    /// Looks at the frame as suits it: a plane one straight on, any other isometrically.
    void ResetCamera();
    CFrameView& View() { return *m_view; }
    QSlider& Slider() { return *m_slider; }
    const std::vector<T_SHAPE_SOURCE>& Sources() const { return m_sources; }
    /// What is shown, for a file or a printer; valid until the document changes.
    T_DRAWING Drawing() const;

private:
    QString NameOf(const T_SHAPE_SOURCE& source) const;
    void ShowSource();
    void ShowStep();
    void TakeScale();
    void Choose(const std::vector<std::size_t>& lines);
    void MarkChosen();

    CFrameScene& m_scene;
    CSelection& m_selection;
    CShownHinges m_hinges;
    std::vector<T_SHAPE_SOURCE> m_sources;
    std::vector<std::array<double, 3>> m_moves;
    bool m_ownScale = false; // typed by the person
    double m_scale = 1.0;
    CFrameView* m_view;
    QComboBox* m_source;
    QSlider* m_slider;
    QLabel *m_step, *m_scaleLabel, *m_sourceLabel;
    QLineEdit* m_scaleEdit;
};
