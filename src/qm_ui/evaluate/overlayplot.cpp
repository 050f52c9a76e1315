#include "qm_ui/evaluate/overlayplot.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_ui/pushover/adrscurve.h"
#include "qm_ui/pushover/evaluationplot.h"

#include <algorithm>

namespace {

/// Dark enough on white, told apart by people who see few colours too (Okabe and Ito, 2008).
constexpr std::array<T_PLOT_COLOR, 7> kColors{{{0, 114, 178},
                                               {213, 94, 0},
                                               {0, 130, 95},
                                               {170, 70, 130},
                                               {150, 110, 0},
                                               {40, 40, 40},
                                               {60, 150, 200}}};
constexpr double kRoom = 1.12; // beyond the largest value

/// By EVALUATION_VERDICT.
constexpr std::array<T_PLOT_COLOR, 7> kVerdictColors{{{27, 120, 55},
                                                      {0, 110, 130},
                                                      {190, 30, 30},
                                                      {190, 90, 0},
                                                      {95, 100, 110},
                                                      {140, 70, 140},
                                                      {140, 70, 140}}};
static_assert(kVerdictColors.size() == static_cast<std::size_t>(EVALUATION_VERDICT::Refused) + 1);

/// Draws a curve unless an evaluation before had the same one, whose line then stands for both.
class CSharedCurves {
public:
    explicit CSharedCurves(T_PLOT& plot) : m_plot(plot) {}

    void Add(const std::string& name, const T_ADRS_CURVE& curve, PLOT_LINE line, double width,
             T_PLOT_COLOR color)
    {
        if (std::ranges::find(m_drawn, curve) != m_drawn.end()) return;
        m_drawn.push_back(curve);
        AddAdrsCurve(m_plot, name.c_str(), curve, line, width, color);
    }

private:
    T_PLOT& m_plot;
    std::vector<T_ADRS_CURVE> m_drawn;
};

void AddAnswer(T_PLOT& plot, const T_PUSH_EVALUATION& e, T_PLOT_COLOR color)
{
    const std::optional<T_EVALUATION_ANSWER> answer = AnswerOf(e);
    if (!answer) { // the legend says that it has none
        T_PLOT_SERIES none;
        none.name = e.eval.name + ": " + VerdictText(EVALUATION_VERDICT::NoPoint);
        none.color = color;
        none.line = PLOT_LINE::Solid;
        plot.series.push_back(std::move(none));
        return;
    }
    const std::string name =
        e.eval.name + (answer->state.empty() ? "" : " (" + answer->state + ")");
    if (!answer->Sa) {
        plot.guides.push_back({PLOT_GUIDE::Vertical, answer->Sd, name, PLOT_LINE::Dash, color});
        return;
    }
    T_PLOT_SERIES point;
    point.name = name;
    point.x = {answer->Sd};
    point.y = {*answer->Sa};
    point.line = PLOT_LINE::None;
    point.marker = e.IsTarget() ? PLOT_MARKER::Square : PLOT_MARKER::Circle;
    point.markerSize = 10.0;
    point.color = color;
    plot.series.push_back(std::move(point));
    plot.labels.push_back({answer->Sd, *answer->Sa,
                           FormatText("D = %.4g ", answer->D) + std::string(NameOf(e.units.length)),
                           PLOT_MARKER::None, true});
}

/// The legend has one entry for each evaluation and each capacity; what the other lines are says
/// the subtitle.
void AddCurves(CSharedCurves& curves, const T_PUSH_EVALUATION& e, T_PLOT_COLOR color)
{
    const auto line = [&](const T_ADRS_CURVE& curve, PLOT_LINE dash) {
        curves.Add({}, curve, dash, 1.5, color);
    };
    curves.Add(Say("IDS_QM_UI_PLOT_CAPACITY") + ", " + ShownPushName(e), e.capacity,
               PLOT_LINE::Solid, 2.6, color);
    if (e.stateDemands.empty()) line(e.demand, PLOT_LINE::Solid);
    // Of several limit states that of the answer: all of them would hide what is compared.
    const std::optional<T_EVALUATION_ANSWER> answer = AnswerOf(e);
    for (std::size_t i = 0; i < e.stateDemands.size(); ++i)
        if (answer && answer->state == kLimitStateNames[i])
            line(e.stateDemands[i], PLOT_LINE::Solid);
    line(e.reduced, PLOT_LINE::Dash);
    if (e.bilinear) {
        const T_BILINEAR& b = *e.bilinear;
        line({{0.0, b.dy, b.du}, {0.0, b.ay, b.au}}, PLOT_LINE::DashDot);
    }
}

void ShowAll(T_PLOT& plot)
{
    double x = 0.0, y = 0.0;
    for (const T_PLOT_SERIES& s : plot.series)
        for (std::size_t i = 0; i < s.x.size(); ++i) {
            x = std::max(x, s.x[i]);
            y = std::max(y, s.y[i]);
        }
    if (!(x > 0.0) || !(y > 0.0)) return;
    plot.x.range = T_PLOT_RANGE{0.0, kRoom * x};
    plot.y.range = T_PLOT_RANGE{0.0, kRoom * y};
}

std::string HeadOf(const T_CARD& card)
{
    return card.unit.empty() ? card.symbol : card.symbol + " (" + card.unit + ")";
}

} // namespace

T_PLOT_COLOR VerdictColor(EVALUATION_VERDICT verdict)
{
    return kVerdictColors[static_cast<std::size_t>(verdict)];
}

T_PLOT OverlayPlot(std::span<const T_PUSH_EVALUATION* const> evaluations,
                   const std::optional<T_PLOT_REGION>& region)
{
    T_PLOT plot;
    if (evaluations.empty()) return plot;
    plot.title = Say("IDS_QM_EVAL_OVERLAY", std::to_string(evaluations.size()));
    plot.subtitle = Say("IDS_QM_EVAL_OVERLAY_LINES");
    plot.x.title = Say("IDS_PUSHOVER_Spectral_Displ_") + " (" +
                   std::string(NameOf(evaluations.front()->units.length)) + ")";
    plot.y.title = Say("IDS_PUSHOVER_Spectral_Accel__g_");
    CSharedCurves curves(plot);
    for (std::size_t i = 0; i < evaluations.size(); ++i)
        AddCurves(curves, *evaluations[i], kColors[i % kColors.size()]);
    ShowAll(plot);
    // Answers stand before the curves.
    for (std::size_t i = 0; i < evaluations.size(); ++i)
        AddAnswer(plot, *evaluations[i], kColors[i % kColors.size()]);
    if (region) {
        plot.x.range = T_PLOT_RANGE{0.0, region->Sd};
        plot.y.range = T_PLOT_RANGE{0.0, region->Sa};
    }
    return plot;
}

T_PLOT BarsPlot(std::span<const T_EVALUATION_ENTRY> entries, CARD which)
{
    constexpr double kThick = 16.0; // px of a bar
    constexpr double kMin = 0.0;
    T_PLOT plot;
    plot.legend = false;
    if (entries.empty()) return plot;
    const auto index = static_cast<std::size_t>(which);
    const T_CARD head = CardsOf(entries.front())[index];
    plot.title = HeadOf(head);
    plot.subtitle = Say("IDS_QM_EVAL_COMPARED", std::to_string(entries.size()));
    plot.x.title = HeadOf(head);
    double largest = kMin;
    const auto count = static_cast<double>(entries.size());
    for (std::size_t i = 0; i < entries.size(); ++i) {
        const T_CARD card = CardsOf(entries[i])[index];
        const double at = count - static_cast<double>(i); // the first one on top
        const EVALUATION_VERDICT verdict = VerdictOf(entries[i]);
        const std::string value =
            card.value ? card.NumberText() + " " + card.unit : Say("IDS_QM_EVAL_NO_VALUE");
        plot.y.labels.push_back({at, entries[i].eval.name, value + ", " + VerdictText(verdict)});
        T_PLOT_SERIES bar;
        bar.x = {kMin, card.value.value_or(kMin)};
        bar.y = {at, at};
        bar.line = PLOT_LINE::Solid;
        bar.marker = PLOT_MARKER::None;
        bar.width = kThick;
        bar.color = VerdictColor(verdict);
        plot.series.push_back(std::move(bar));
        largest = std::max(largest, card.value.value_or(kMin));
    }
    plot.x.range = T_PLOT_RANGE{kMin, largest > kMin ? 1.25 * largest : 1.0};
    plot.y.range = T_PLOT_RANGE{0.4, count + 0.6};
    constexpr double kHead = 140.0, kRow = 42.0; // px of the page
    plot.pageHeight = kHead + kRow * count;
    return plot;
}
