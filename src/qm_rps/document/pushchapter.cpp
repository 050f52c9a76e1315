// Pushes: how they are set up, how they ended, their curves and events.
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/document/reportmaker.h"
#include "qm_rps/generate/codehingerows.h"

#include <algorithm>

namespace {

// By the number of the pattern and by kPDeltaNames.
constexpr std::array kPatternTexts{"IDS_PUSHOVER_Static_Load", "IDS_PUSHOVER_Accerelation",
                                   "IDS_PUSHOVER_Mode_Shape", "IDS_PUSHOVER_Mode_Shape_Story_Mass"};
constexpr std::array kPDeltaTexts{"IDS_QM_REPORT_NO_LOADS", "IDS_QM_REPORT_PDELTA_INITIAL",
                                  "IDS_QM_REPORT_PDELTA_UPDATED"};

std::string InitialLoadsText(const T_MODEL& model, const std::vector<T_PUSH_INITIAL_LOAD>& loads)
{
    std::string text;
    for (const T_PUSH_INITIAL_LOAD& load : loads) {
        const auto c = model.loadCases.find(load.loadCase);
        text += (text.empty() ? "" : " + ") + FormatText("%.6g ", load.factor) +
                (c == model.loadCases.end() ? "?" : c->second.name);
    }
    return text.empty() ? Say("IDS_QM_REPORT_NO_LOADS") : text;
}

T_TEXT_TABLE SetupTable(const T_REPORT_WORK& work)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_FACT_LOAD_CASE")},
                        {Say("IDS_QM_FACT_CONTROL")},
                        {Say("IDS_QM_REPORT_PATTERN")},
                        {Say("IDS_QM_REPORT_TARGET")},
                        {Say("IDS_QM_REPORT_STEPS"), true},
                        {Say("IDS_QM_REPORT_INITIAL")},
                        {"P-Delta"}},
                       {}};
    const T_POGC_D& global = work.Model().pushControl;
    for (const int key : work.doc.Attr().GetKeys<T_POLC_D>()) {
        T_POLC_D c;
        if (!work.doc.Attr().GetPolc(key, c)) continue;
        const auto direction = static_cast<std::size_t>(c.direction - 1);
        const auto pattern = static_cast<std::size_t>(c.patternKind);
        const std::string target =
            c.control ? FormatText("%.6g ", c.control->masterMaxDispl) +
                            (direction < 3 ? std::string(NameOf(work.Units().length)) : "rad")
                      : Say("IDS_QM_REPORT_OTHER_PROGRAM");
        table.rows.push_back(
            {c.name, std::to_string(c.controlNode) + ", " + kDirectionNames[direction],
             Say(kPatternTexts[pattern]), target, std::to_string(c.steps.value_or(global.steps)),
             InitialLoadsText(work.Model(), c.initialLoads.value_or(global.initialLoads)),
             Say(kPDeltaTexts[static_cast<std::size_t>(c.pDelta.value_or(global.pDelta))])});
    }
    return table;
}

/// "C: 17 J My; unload: 1 I My, 1 J My".
std::string EventText(const T_PUSH_RUN& run, const T_PUSH_EVENT_ROW& event)
{
    std::vector<std::pair<std::string, std::string>> byPoint;
    for (const auto& hinge : event.hinges) {
        const T_PUSH_LAW_PLACE& place = run.hinges.at(hinge.hinge).place;
        const std::string name = std::to_string(place.element) + " " + place.end + " " +
                                 kComponentNames[static_cast<std::size_t>(place.component)];
        const auto at = std::ranges::find(byPoint, hinge.to, [](const auto& p) { return p.first; });
        if (at == byPoint.end())
            byPoint.emplace_back(hinge.to, name);
        else
            at->second += ", " + name;
    }
    std::string text = event.initial ? Say("IDS_QM_REPORT_INITIAL") + ": " : std::string();
    for (std::size_t i = 0; i < byPoint.size(); ++i)
        text += (i ? "; " : "") + byPoint[i].first + ": " + byPoint[i].second;
    return text;
}

T_TEXT_TABLE EventTable(const T_REPORT_WORK& work, const T_PUSH_RUN& run)
{
    const T_UNITS& units = work.Units();
    const T_DIM move = DisplacementDim(static_cast<int>(run.direction) + 1),
                react = ReactionDim(static_cast<int>(run.direction) + 1);
    const std::string moved = move == kDimNone ? "rad" : UnitText(move, units);
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_FACTOR"), true},
                        {"D (" + moved + ")", true},
                        {"V (" + UnitText(react, units) + ")", true},
                        {Say("IDS_QM_REPORT_EVENT")}},
                       {}};
    for (const T_PUSH_EVENT_ROW& event : run.events)
        table.rows.push_back({FormatText("%.6g", event.loadFactor),
                              FormatText("%.6g", FromSi(event.displacement, units, move)),
                              FormatText("%.6g", FromSi(event.baseReaction, units, react)),
                              EventText(run, event)});
    return table;
}

T_TEXT_TABLE StoreyTable(const T_REPORT_WORK& work, const T_PUSH_RUN& run)
{
    const T_UNITS& units = work.Units();
    T_TEXT_TABLE table{
        {{Say("IDS_QM_REPORT_STOREY")},
         {Say("IDS_QM_REPORT_DISPLACEMENT") + " (" + std::string(NameOf(units.length)) + ")", true},
         {Say("IDS_QM_REPORT_DRIFT"), true},
         {Say("IDS_QM_REPORT_SHEAR") + " (" + std::string(NameOf(units.force)) + ")", true}},
        {}};
    const std::size_t last = run.displacement.size() - 1;
    for (const T_PUSH_STOREY_SERIES& s : run.storeys)
        table.rows.push_back(
            {s.name, FormatText("%.6g", FromSi(s.displacement.at(last), units, kDimLength)),
             FormatText("%.6g", s.drift.at(last)),
             s.shear.empty() ? "-"
                             : FormatText("%.6g", FromSi(s.shear.at(last), units, kDimForce))});
    return table;
}

void AddRun(T_REPORT_WORK& work, const T_PUSH_RUN& run, T_DOC_CHAPTER& chapter)
{
    T_DOC_CHAPTER& part = chapter.parts.emplace_back();
    part.title = run.name;
    const DOC_TONE tone = run.status == PUSH_STATUS::Failed ? DOC_TONE::Warning : DOC_TONE::Plain;
    part.blocks.emplace_back(DocText(run.advice, tone));
    if (run.status == PUSH_STATUS::Failed) work.Remark(run.name, run.advice);
    for (const std::string& warning : run.warnings) {
        part.blocks.emplace_back(DocText(warning, DOC_TONE::Warning));
        work.Remark(run.name, warning);
    }
    const auto one = std::make_shared<const std::vector<T_PUSH_RUN>>(1, run);
    part.blocks.emplace_back(T_DOC_PICTURE{Say("IDS_QM_REPORT_CURVE", run.name),
                                           T_PUSH_VIEW{one, work.Units(), run.name}});
    if (!run.events.empty())
        part.blocks.emplace_back(
            DocTable(Say("IDS_QM_REPORT_EVENTS"), EventTable(work, run), work.limit));
    if (!run.storeys.empty() && !run.displacement.empty())
        part.blocks.emplace_back(
            DocTable(Say("IDS_QM_REPORT_STOREYS_AT_END"), StoreyTable(work, run), work.limit));
}

} // namespace

void FillPushesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    if (work.Model().pushovers.empty()) return;
    chapter.blocks.emplace_back(DocTable(Say("IDS_QM_REPORT_SETUP"), SetupTable(work), work.limit));
    for (const std::string& fault : work.data.runFaults) {
        chapter.blocks.emplace_back(DocText(fault, DOC_TONE::Warning));
        work.Remark({}, fault);
    }
    for (const T_PUSH_RUN& run : *work.data.runs)
        AddRun(work, run, chapter);
}
