#include "qm_rps/view/resultview.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"

#include <algorithm>
#include <cmath>

namespace {

using S = T_SHAPE_SOURCE;
using W = VIEW_WHAT;

constexpr std::array<const char*, kViewWhats> kTexts{
    "IDS_QM_VIEW_DEFORMED", "IDS_QM_VIEW_N",      "IDS_QM_VIEW_VY",    "IDS_QM_VIEW_VZ",
    "IDS_QM_VIEW_T",        "IDS_QM_VIEW_MY",     "IDS_QM_VIEW_MZ",    "IDS_QM_VIEW_REACT",
    "IDS_QM_VIEW_LOADS",    "IDS_QM_VIEW_HINGES", "IDS_QM_VIEW_STRESS"};

bool IsForce(W what)
{
    return what >= W::N && what <= W::Mz;
}

const char* KindKey(S::KIND kind)
{
    switch (kind) {
    case S::KIND::Static:
        return "IDS_QM_UI_SHAPE_CASE";
    case S::KIND::Combination:
        return "IDS_QM_VIEW_COMBINATION";
    case S::KIND::Stage:
        return "IDS_QM_UI_SHAPE_STAGE";
    case S::KIND::Pushover:
        return "IDS_QM_UI_SHAPE_PUSHOVER";
    case S::KIND::Mode:
        return "IDS_QM_UI_SHAPE_MODE";
    case S::KIND::None:
        break;
    }
    return "IDS_QM_UI_SHAPE_NONE";
}

/// The same source in another list: results may have come or gone.
bool IsSame(const S& a, const S& b)
{
    return a.kind == b.kind && a.key == b.key && a.turn == b.turn;
}

} // namespace

std::string ViewWhatText(W what)
{
    return Say(kTexts[static_cast<std::size_t>(what)]);
}

std::string CResultView::NameOf(const S& source)
{
    const std::string name = Say(KindKey(source.kind), source.name);
    return source.analysed ? name : Say("IDS_QM_VIEW_NAME_NOT_ANALYSED", name);
}

CResultView::CResultView(CDBDoc& doc, CFrameScene& scene, const CSelection& selection)
    : m_doc(doc), m_source(scene), m_selection(selection), m_frame(doc), m_hinges(doc)
{
    Refresh();
}

void CResultView::Refresh()
{
    const S before = Source();
    const int step = m_step;
    m_sources = m_source.Sources();
    const auto it = std::ranges::find_if(m_sources, [&](const S& s) { return IsSame(s, before); });
    m_at = it == m_sources.end() ? 0 : static_cast<std::size_t>(it - m_sources.begin());
    m_step = std::clamp(step, 1, Steps());
    ShowSource();
}

void CResultView::OnHidden()
{
    Show();
}

void CResultView::OnSource(std::size_t index)
{
    if (index >= m_sources.size()) return;
    m_at = index;
    m_step = Steps();
    ShowSource();
}

void CResultView::OnStep(int step)
{
    m_step = std::clamp(step, 1, Steps());
    Show();
}

void CResultView::OnChoice(const T_VIEW_CHOICE& choice)
{
    const bool rescale = choice.scale != m_choice.scale;
    m_choice = choice;
    rescale ? ShowSource() : Show();
}

int CResultView::OnShow(const S& source, int step)
{
    const auto it = std::ranges::find(m_sources, source);
    if (it == m_sources.end()) return 0;
    m_at = static_cast<std::size_t>(it - m_sources.begin());
    m_step = Steps();
    ShowSource(); // the scale is that of the last step
    OnStep(step);
    return 1;
}

/// In a scale that suits the largest step, so that steps compare.
void CResultView::ShowSource()
{
    const int step = m_step;
    m_scale = m_choice.scale.value_or(1.0);
    std::vector<std::array<double, 3>> moves;
    if (!m_choice.scale && m_source.Read(Source(), Steps(), moves))
        m_scale = CFrameScene::RoundScale(m_source.Scene(), moves);
    ReadCurve();
    m_step = step;
    Show();
}

const std::vector<std::array<double, 3>>* CResultView::Moves() const
{
    const bool wanted = m_choice.what == W::Deformed || m_choice.what == W::Hinges ||
                        (m_choice.onDeformed && m_choice.what != W::Loads);
    return m_hasMoves && wanted ? &m_moves : nullptr;
}

std::vector<T_SCENE_DRIFT> CResultView::Drifts() const
{
    return m_choice.what == W::Deformed || m_choice.what == W::Hinges
               ? m_source.Drifts(Source(), m_step)
               : std::vector<T_SCENE_DRIFT>{};
}

void CResultView::Show()
{
    const S& source = Source();
    m_scene = &m_source.Shown(source, m_selection.Hidden());
    m_diagram = {};
    m_marks = {};
    m_stress = {};
    m_bent = {};
    m_missing.clear();
    m_hingeMarks = m_hinges.Marks(source, m_step, *m_scene);
    const W what = m_choice.what;
    const bool bends = what == W::Deformed || what == W::Hinges || m_choice.onDeformed;
    const bool small = m_scene->lines.size() <= kBentLines;
    T_VIEW_RESULTS results;
    if (source.kind != S::KIND::None && source.analysed)
        results = ReadViewResults(
            m_doc, *m_scene, source, m_step,
            {IsForce(what) || what == W::Stress || (bends && small), what == W::Reactions});
    else
        results.noForces = results.noReactions = Say(
            source.kind == S::KIND::None ? "IDS_QM_VIEW_NO_SOURCE" : "IDS_QM_VIEW_NOT_ANALYSED");
    solver::T_LOAD_CASE loads;
    std::string why;
    const bool hasFrame = m_frame.Refresh(why) && m_frame.LoadsOf(source, m_step, loads, why);
    ReadMoves(results, loads, hasFrame);
    if (what == W::Deformed || what == W::Hinges || what == W::Reactions)
        ReadQuantity(results, loads);
    else if (hasFrame)
        ReadQuantity(results, loads);
    else
        m_missing = why;
}

/// Nodes are moved by whatever the source knows of them, members bend where all of it is known.
void CResultView::ReadMoves(const T_VIEW_RESULTS& results, const solver::T_LOAD_CASE& loads,
                            bool hasFrame)
{
    const S& source = Source();
    m_hasMoves =
        source.kind != S::KIND::None && source.analysed && m_source.Read(source, m_step, m_moves);
    if (source.kind != S::KIND::None && source.analysed && !m_hasMoves)
        m_missing = m_source.Error();
    if (!m_hasMoves || !hasFrame || !Moves()) return;
    m_bent = BentLinesOf(m_frame, *m_scene, results, loads, m_doc.Unit().Units(),
                         source.kind == S::KIND::Mode ? kDimNone : kDimLength,
                         m_hingeMarks ? HingeTurnsOf(m_hinges.Run(), m_step) : T_HINGE_TURNS{});
}

void CResultView::ReadQuantity(const T_VIEW_RESULTS& results, const solver::T_LOAD_CASE& loads)
{
    const T_UNITS units = m_doc.Unit().Units();
    const W what = m_choice.what;
    if (IsForce(what)) {
        m_missing = results.noForces;
        m_diagram = DiagramOf(
            m_frame, *m_scene, results, loads,
            static_cast<MEMBER_FORCE>(static_cast<int>(what) - static_cast<int>(W::N)), units);
    } else if (what == W::Stress) {
        m_missing = results.noForces;
        m_stress = StressesOf(m_frame, m_doc.Data().Model(), *m_scene, results, loads, units);
    } else if (what == W::Reactions) {
        m_missing = results.noReactions;
        m_marks = ReactionMarksOf(*m_scene, results, units);
    } else if (what == W::Loads) {
        const bool has = Source().kind == S::KIND::Static || Source().kind == S::KIND::Stage ||
                         Source().kind == S::KIND::Combination;
        m_marks = LoadMarksOf(m_frame, *m_scene, loads, units);
        if (!has) m_missing = Say("IDS_QM_VIEW_NO_LOADS_OF");
        if (has && m_marks.IsEmpty()) m_missing = Say("IDS_QM_VIEW_NO_LOADS");
    } else if (what == W::Hinges && !m_hingeMarks) {
        m_missing = Say("IDS_QM_VIEW_NO_HINGES");
    } else if (!m_hasMoves && m_missing.empty() && Source().kind != S::KIND::None) {
        m_missing = Say("IDS_QM_VIEW_NOT_ANALYSED");
    }
}

void CResultView::ReadCurve()
{
    m_curve = {};
    const S& source = Source();
    CPostCtrl& post = m_doc.Post();
    const auto push = m_doc.Data().Model().pushovers.find(source.key);
    if (source.kind != S::KIND::Pushover || push == m_doc.Data().Model().pushovers.end() ||
        !post.SelectPushover(source.key, source.turn))
        return;
    int node = push->second.controlNode;
    if (!post.ExistNodePost(node) && !post.FindControlNode(node)) return;
    m_curve.forceUnit = ::NameOf(m_doc.Unit().Units().force);
    m_curve.lengthUnit = ::NameOf(m_doc.Unit().Units().length);
    for (int step = 1; step <= post.GetStepCount(); ++step) {
        double d = 0.0, v = 0.0;
        if (!post.SelectStep(step) || !post.GetDispNew(node, d) || !post.GetReacNew(v)) break;
        m_curve.displacement.push_back(d);
        m_curve.reaction.push_back(v);
    }
}

std::string CResultView::Subtitle() const
{
    std::string text = NameOf(Source());
    if (Source().steps > 0)
        text += ", " + Say("IDS_QM_UI_SHAPE_STEP_OF", std::to_string(m_step),
                           std::to_string(Source().steps));
    if (Source().kind != S::KIND::None || m_choice.what != W::Deformed)
        text += ": " + ViewWhatText(m_choice.what);
    return text;
}

/// "largest 12.5 kN*m (element 3), smallest -25 (element 4)".
std::string CResultView::DiagramFacts() const
{
    const auto number = [](double v) { return FormatText("%.5g", v); };
    const auto element = [&](std::size_t member) {
        return std::to_string(m_scene->lines[m_diagram.members[member].line].id);
    };
    const double largest = m_diagram.Value(m_diagram.members[m_diagram.largest].largest);
    const double smallest = m_diagram.Value(m_diagram.members[m_diagram.smallest].smallest);
    return Say("IDS_QM_VIEW_EXTREMES", number(largest), element(m_diagram.largest),
               number(smallest), element(m_diagram.smallest), m_diagram.unit);
}

std::vector<std::string> CResultView::Facts() const
{
    std::vector<std::string> facts;
    if (Diagram()) {
        facts.push_back(DiagramFacts());
        if (m_choice.what == W::My || m_choice.what == W::Mz)
            facts.push_back(Say("IDS_QM_VIEW_TENSION_SIDE"));
        if (m_choice.what == W::N) {
            facts.push_back(Say("IDS_QM_VIEW_TENSION_POSITIVE"));
            const std::size_t rigid = CountInDiaphragms(m_doc.Data().Model(), *m_scene);
            if (rigid > 0) facts.push_back(RigidFloorNote(rigid));
        }
        if (m_diagram.notExact > 0)
            facts.push_back(Say("IDS_QM_VIEW_NOT_EXACT", std::to_string(m_diagram.notExact)));
    }
    if (Stress() && m_stress.unchecked > 0)
        facts.push_back(Say("IDS_QM_VIEW_UNCHECKED", std::to_string(m_stress.unchecked)));
    if (Stress()) facts.push_back(Say("IDS_QM_VIEW_STRESS_OF"));
    for (const std::string& note : m_marks.notes)
        facts.push_back(note);
    if (Moves() && Source().kind == S::KIND::Mode)
        facts.push_back(Say("IDS_QM_VIEW_MODE_SCALE"));
    else if (Moves())
        facts.push_back(Say("IDS_QM_UI_SHAPE_NOTE", ShortestText(m_scale), m_scene->lengthUnit));
    if (Moves() && m_scene->lines.size() > kBentLines)
        facts.push_back(Say("IDS_QM_VIEW_STRAIGHT", std::to_string(kBentLines)));
    const auto hidden = m_selection.Hidden().size();
    if (hidden > 0) facts.push_back(Say("IDS_QM_VIEW_HIDDEN", std::to_string(hidden)));
    return facts;
}

std::string CResultView::Note() const
{
    std::string text = m_missing;
    for (const std::string& fact : Facts())
        text += (text.empty() ? "" : "; ") + fact;
    return text;
}
