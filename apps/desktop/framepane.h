// The frame view under its bar of results; what is clicked in it is chosen in every pane.
#pragma once

#include "qm_rps/desk/selection.h"
#include "qm_ui/frame/frameview.h"
#include "qm_ui/report/picturefile.h"
#include "qm_ui/view/resultsbar.h"

#include <QWidget>

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
    /// Another quantity, numbers or scale.
    void SetChoice(const T_VIEW_CHOICE& choice);
    /// Looks at the frame as suits it: a plane one straight on, any other isometrically.
    void ResetCamera();
    /// Another source, step or model is shown and stands.
    std::function<void()> m_onResults;
    CFrameView& View() { return *m_view; }
    CResultsBar& Bar() { return *m_bar; }
    QSlider& Slider() { return m_bar->Slider(); }
    const CResultView& Shown() const { return m_shown; }
    const std::vector<T_SHAPE_SOURCE>& Sources() const { return m_shown.Sources(); }
    CDBDoc& Doc() { return m_doc; }
    CSelection& Selection() { return m_selection; }
    /// What is shown, for a file or a printer; valid until the document changes.
    T_DRAWING Drawing() const;

private:
    void ShowPicture();
    void ShowResults();
    void Choose(const T_PICK& pick);
    void OnSelection();

    CDBDoc& m_doc;
    CFrameScene& m_scene;
    CSelection& m_selection;
    CResultView m_shown;
    CSelection::T_KEYS m_hidden; // as they are shown
    CFrameView* m_view;
    CResultsBar* m_bar;
};
