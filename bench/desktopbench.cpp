// The pushover curve window: a change of the settings, evaluated and drawn, against drawing the
// same plot again. Every benchmark checks that what it drew has changed.
#include "benchapp.h"
#include "pushovertools.h"
#include "qm_rps/pushovercurveedit.h"
#include "qm_ui/form/dialogwindow.h"
#include "qm_ui/plot/plotwidget.h"
#include "qm_ui/pushover/pushovercurveplot.h"
#include "ratios.h"

#include <QApplication>
#include <benchmark/benchmark.h>

#include <memory>
#include <string>

namespace {

/// The window on an evaluation of the three-storey frame, in its wanted size.
class CCurveWindow {
public:
    explicit CCurveWindow(const char* evaluation)
    {
        NeedBenchApp();
        T_FILE_ERROR error;
        if (!m_doc.ImportCase(QM_EXAMPLES "/rc-frame-3-storey/case.json", error)) return;
        RegisterPushoverViews(m_factory);
        m_edit = std::make_unique<CPushOverCurveEdit>(m_doc);
        if (!m_edit->OnOpen(evaluation)) return;
        m_window =
            std::make_unique<CDialogWindow>(m_factory, *m_factory.Find(*m_edit), *m_edit, nullptr);
        m_window->show();
        m_window->resize(1280, 860);
        QApplication::processEvents();
        m_plot = dynamic_cast<CPlotWidget*>(m_window->Form().Find("plot")->widget);
    }
    bool IsReady() const { return m_plot && m_edit->Shown().Refusal().empty(); }

    /// Draws what is on show anew.
    void Repaint()
    {
        m_plot->SetView({});
        m_plot->repaint();
    }
    /// The same with everything else in the window.
    void RepaintWindow()
    {
        m_plot->SetView({});
        for (QWidget* widget : m_window->findChildren<QWidget*>())
            widget->update();
        m_window->repaint();
    }
    /// Evaluates other settings and draws the plot.
    void Redraw()
    {
        m_edit->m_settings.name = m_edit->m_settings.name == "A" ? "B" : "A";
        m_edit->Update();
        T_PLOT plot =
            PushoverCurvePlot(m_edit->Shown().Pictured(), m_edit->m_show, m_edit->Shown().Trial());
        plot.notes.clear(); // as in the window
        m_plot->UpdatePlot(std::move(plot));
        m_plot->repaint();
    }
    /// The same through the window: its fields, cells and findings follow.
    void RefreshWindow()
    {
        m_edit->m_settings.name = m_edit->m_settings.name == "A" ? "B" : "A";
        m_edit->Update();
        m_window->Form().Refresh();
        m_window->repaint();
    }
    const std::string& Title() const { return m_plot->Plot().title; }
    void Evaluate() { m_edit->Update(); }

private:
    CDBDoc m_doc;
    CViewFactory m_factory;
    std::unique_ptr<CPushOverCurveEdit> m_edit;
    std::unique_ptr<CDialogWindow> m_window;
    CPlotWidget* m_plot = nullptr;
};

/// Runs one of the window's operations over and over.
void Run(benchmark::State& state, const char* evaluation, void (CCurveWindow::*operation)(),
         bool changes)
{
    CCurveWindow window(evaluation);
    if (!window.IsReady()) return state.SkipWithError("no picture");
    std::string before;
    for (auto _ : state) {
        before = window.Title();
        (window.*operation)();
    }
    if ((before != window.Title()) != changes) state.SkipWithError("not the plot that was meant");
}

constexpr const char *kAtc = "PX_MODE1 ATC-40 A", *kFema = "PX_MODE1 FEMA440 B",
                     *kEc8 = "PX_MODE1 EC8", *kNtc = "PX_MODE1 NTC2018";
constexpr auto kUnit = benchmark::kMillisecond;

BENCHMARK_CAPTURE(Run, RepaintAtc40, kAtc, &CCurveWindow::Repaint, false)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, EvaluateAtc40, kAtc, &CCurveWindow::Evaluate, false)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, RedrawAtc40, kAtc, &CCurveWindow::Redraw, true)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, RepaintWindow, kAtc, &CCurveWindow::RepaintWindow, false)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, RedrawWindow, kAtc, &CCurveWindow::RefreshWindow, true)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, RepaintFema440, kFema, &CCurveWindow::Repaint, false)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, RedrawFema440, kFema, &CCurveWindow::Redraw, true)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, RepaintEc8, kEc8, &CCurveWindow::Repaint, false)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, RedrawEc8, kEc8, &CCurveWindow::Redraw, true)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, RepaintNtc, kNtc, &CCurveWindow::Repaint, false)->Unit(kUnit);
BENCHMARK_CAPTURE(Run, RedrawNtc, kNtc, &CCurveWindow::Redraw, true)->Unit(kUnit);

/// A change that is evaluated and drawn takes at most two repaints of the plot.
int RedrawRatio(const std::string& method)
{
    return AddRatio({"pushover window, " + method + ": evaluation and repaint / repaint",
                     "Run/Redraw" + method, "Run/Repaint" + method, 1.0, 2.0});
}

[[maybe_unused]] const int kRatios[] = {
    RedrawRatio("Atc40"), RedrawRatio("Fema440"), RedrawRatio("Ec8"), RedrawRatio("Ntc"),
    AddRatio({"pushover window, whole: evaluation and repaint / repaint", "Run/RedrawWindow",
              "Run/RepaintWindow", 1.0, 2.0})};

} // namespace
