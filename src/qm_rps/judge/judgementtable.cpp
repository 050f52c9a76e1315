#include "qm_rps/judge/judgementtable.h"

#include "qm_base/say.h"
#include "qm_rps/generate/codehingerows.h"
#include "qm_rps/push/pushatpointtext.h"

#include <algorithm>
#include <map>
#include <set>

namespace {

/// How a column is measured, and what it is called.
struct T_COLUMN {
    JUDGED_COLUMN column;
    const char* key;
    const char* symbol; // instead of a text of the catalogue
    T_DIM dim;
    bool isAngle = false;
};
using C = JUDGED_COLUMN;
constexpr std::array<T_COLUMN, kJudgedColumns> kColumns{{
    {C::State, "IDS_QM_JUDGE_LIMIT_STATE", "", {}},
    {C::Element, "IDS_QM_CLI_ELEMENT", "", {}},
    {C::End, "IDS_QM_GEN_END", "", {}},
    {C::Axis, "IDS_QM_GEN_AXIS", "", {}},
    {C::Storey, "IDS_QM_JUDGE_STOREY", "", {}},
    {C::Code, "IDS_QM_JUDGE_BY", "", {}},
    {C::N, "", "N", kDimForce},
    {C::M, "", "M", kDimMoment},
    {C::V, "", "V", kDimForce},
    {C::Span, "", "LV", kDimLength},
    {C::ThetaY, "", "theta_y", {}, true},
    {C::Theta, "", "theta", {}, true},
    {C::ThetaCapacity, "IDS_QM_JUDGE_THETA_CAPACITY", "", {}, true},
    {C::ThetaRatio, "IDS_QM_JUDGE_THETA_RATIO", "", {}},
    {C::Shear, "IDS_QM_JUDGE_SHEAR_DEMAND", "", kDimForce},
    {C::ShearCapacity, "", "VR", kDimForce},
    {C::ShearRatio, "IDS_QM_JUDGE_SHEAR_RATIO", "", {}},
    {C::Other, "IDS_QM_JUDGE_OTHER", "", {}},
    {C::OtherCapacity, "IDS_QM_JUDGE_CAPACITY", "", {}},
    {C::OtherUnit, "IDS_QM_JUDGE_UNIT", "", {}},
    {C::OtherRatio, "IDS_QM_JUDGE_THETA_RATIO", "", {}},
    {C::Governing, "IDS_QM_JUDGE_GOVERNING", "", {}},
    {C::Clause, "IDS_QM_JUDGE_CLAUSE", "", {}},
    {C::Verdict, "IDS_QM_JUDGE_VERDICT", "", {}},
    {C::Figures, "IDS_QM_JUDGE_FIGURES", "", {}},
    {C::Reason, "IDS_QM_JUDGE_REASON", "", {}},
}};

/// The cells of a row, by their columns.
class CCells {
public:
    explicit CCells(const T_UNITS& units) : m_units(units) {}
    void Text(JUDGED_COLUMN column, std::string text)
    {
        cells[static_cast<std::size_t>(column)].text = std::move(text);
    }
    void Number(JUDGED_COLUMN column, std::optional<double> si)
    {
        const auto at = static_cast<std::size_t>(column);
        if (si) cells[at].number = FromSi(*si, m_units, kColumns[at].dim) + 0.0;
    }
    T_JUDGED_CELLS cells;

private:
    T_UNITS m_units;
};

/// The columns of a mode's demand, capacity and ratio.
struct T_CHECK_COLUMNS {
    C demand, capacity, ratio;
};
T_CHECK_COLUMNS ColumnsOf(JUDGE_MODE mode)
{
    if (mode == JUDGE_MODE::Rotation) return {C::Theta, C::ThetaCapacity, C::ThetaRatio};
    if (mode == JUDGE_MODE::Shear) return {C::Shear, C::ShearCapacity, C::ShearRatio};
    return {C::Other, C::OtherCapacity, C::OtherRatio};
}

void PutCheck(const T_MODE_CHECK& mode, std::size_t level, const T_UNITS& units, CCells& to)
{
    const std::optional<T_CHECK>& check = mode.at[level];
    if (!check) return;
    const T_CHECK_COLUMNS columns = ColumnsOf(mode.mode);
    // Columns of other modes have no unit of their own.
    const bool other = columns.demand == C::Other;
    const auto shown = [&](double si) { return other ? FromSi(si, units, mode.dim) : si; };
    to.Number(columns.demand, shown(check->demand));
    to.Number(columns.capacity, shown(check->capacity));
    to.Number(columns.ratio, check->Ratio());
    if (other) to.Text(C::OtherUnit, UnitText(mode.dim, units));
}

/// What a row calls a mode of its end.
std::string ModeOf(const T_JUDGED_END& end, JUDGE_MODE mode)
{
    return end.joint && end.joint->panel ? Say("IDS_QM_JUDGE_PANEL") : ModeText(mode);
}

/// Why a check is missing, by mode; those alike: once.
std::string ReasonOf(const T_END_CHECKS& checks)
{
    std::string text;
    std::vector<std::string> told;
    for (const T_MODE_CHECK& check : checks.modes) {
        if (check.why.empty() || std::ranges::find(told, check.why) != told.end()) continue;
        told.push_back(check.why);
        text += (text.empty() ? "" : "; ") + ModeText(check.mode) + ": " + check.why;
    }
    return text;
}

/// "3", "node 5"; "I"; "My", "X".
struct T_PLACE_TEXT {
    std::string what, end, axis;
};
T_PLACE_TEXT PlaceOf(const T_JUDGED_END& end)
{
    if (end.joint)
        return {Say("IDS_QM_JUDGE_NODE", std::to_string(end.joint->node)), "", end.joint->axis};
    return {std::to_string(end.place.element),
            end.kind != JUDGED_KIND::End ? "" : (end.place.atJ ? "J" : "I"),
            end.kind == JUDGED_KIND::Spring
                ? ""
                : kComponentNames[static_cast<std::size_t>(end.place.component)]};
}

std::optional<double> Known(double value)
{
    return value > 0.0 ? std::optional(value) : std::nullopt;
}

} // namespace

std::string VerdictText(VERDICT verdict)
{
    constexpr std::array<const char*, 3> kKeys{
        "IDS_QM_JUDGE_FULFILLED", "IDS_QM_JUDGE_NOT_FULFILLED", "IDS_QM_JUDGE_NOT_CHECKED"};
    return Say(kKeys[static_cast<std::size_t>(verdict)]);
}

std::string VerdictCountText(const T_VERDICT_COUNT& count)
{
    std::string text;
    for (std::size_t v = 0; v < count.count.size(); ++v)
        text += (v == 0 ? "" : ", ") + VerdictText(static_cast<VERDICT>(v)) + " " +
                std::to_string(count.count[v]);
    const auto& [holds, fails, unknown] = count.joints;
    if (holds + fails + unknown > 0)
        text += "; " + Say("IDS_QM_JUDGE_OF_JOINTS", std::to_string(holds), std::to_string(fails),
                           std::to_string(unknown));
    return text;
}

std::string WholeVerdictText(const T_JUDGEMENT& judgement)
{
    const std::string text = Say("IDS_QM_JUDGE_WHOLE", VerdictText(judgement.Verdict()));
    return judgement.stale.empty() ? text : text + " (" + Say("IDS_QM_JUDGE_WHOLE_STALE") + ")";
}

std::string ModeText(JUDGE_MODE mode)
{
    constexpr std::array<const char*, kModes> kKeys{"IDS_QM_JUDGE_ROTATION", "IDS_QM_JUDGE_SHEAR",
                                                    "IDS_QM_JUDGE_AXIAL", "IDS_QM_JUDGE_ELONGATION",
                                                    "IDS_QM_JUDGE_JOINT"};
    return Say(kKeys[static_cast<std::size_t>(mode)]);
}

std::string EndText(const T_JUDGED_END& end)
{
    const T_PLACE_TEXT place = PlaceOf(end);
    std::string text = place.what;
    for (const std::string& part : {place.end, place.axis})
        if (!part.empty()) text += " " + part;
    return text;
}

std::vector<std::string> UncheckedTexts(const T_JUDGED_STATE& state)
{
    std::map<std::string, std::size_t> count;
    for (const T_JUDGED_ROW& row : state.rows)
        if (const std::string reason = ReasonOf(row.checks); !reason.empty()) ++count[reason];
    std::vector<std::string> texts;
    for (const auto& [reason, rows] : count)
        texts.push_back(std::to_string(rows) + ": " + reason);
    return texts;
}

std::string StateText(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state)
{
    for (const T_JUDGED_END& end : judgement.ends) {
        if (end.basis == JUDGE_BASIS::Nothing) continue;
        const std::string own = end.Levels()[state.level];
        return own == state.name ? state.name : state.name + " (" + own + ")";
    }
    return state.name;
}

std::string StateAtText(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state)
{
    const std::string name = StateText(judgement, state);
    T_PUSH_POINT point = state.point;
    if (point.kind == PUSH_POINT::Performance) return name + ", " + PointName(point);
    point.state = name;
    return PointName(point);
}

T_JUDGED_CELLS CellsOf(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state,
                       const T_JUDGED_ROW& row)
{
    const T_JUDGED_END& end = judgement.ends[row.end];
    CCells to(judgement.units);
    to.Text(C::State, StateText(judgement, state));
    const T_PLACE_TEXT place = PlaceOf(end);
    if (end.joint)
        to.Text(C::Element, place.what);
    else
        to.cells[static_cast<std::size_t>(C::Element)].number = end.place.element;
    to.Text(C::End, place.end);
    to.Text(C::Axis, place.axis);
    to.Text(C::Storey, end.storey);
    to.Text(C::Code, end.Code());
    if (end.HasForces()) {
        to.Number(C::N, row.state.N);
        to.Number(C::M, row.state.M);
        to.Number(C::V, row.state.V);
    }
    to.Number(C::Span, Known(row.checks.LV));
    to.Number(C::ThetaY, Known(row.checks.thetaY));
    bool any = false;
    for (const T_MODE_CHECK& check : row.checks.modes) {
        PutCheck(check, state.level, judgement.units, to);
        any = any || check.at[state.level];
    }
    if (any) {
        to.Text(C::Governing, ModeOf(end, row.governing));
        to.Text(C::Clause, row.checks.Of(row.governing)->clause[state.level]);
    }
    to.Text(C::Verdict, VerdictText(row.verdict));
    if (end.basis == JUDGE_BASIS::Code && any)
        to.Text(C::Figures, MarkText(LeastSureOf(row.checks)));
    to.Text(C::Reason, ReasonOf(row.checks));
    return to.cells;
}

std::array<std::string, kJudgedColumns> JudgedHeads(const T_UNITS& units)
{
    std::array<std::string, kJudgedColumns> heads;
    for (const T_COLUMN& column : kColumns) {
        std::string& head = heads[static_cast<std::size_t>(column.column)];
        head = column.key[0] ? Say(column.key) : column.symbol;
        const std::string unit = column.isAngle ? "rad" : UnitText(column.dim, units);
        if (!unit.empty()) head += " (" + unit + ")";
    }
    return heads;
}

std::vector<std::string> JudgementNotes(const T_JUDGEMENT& judgement)
{
    std::vector<std::string> notes;
    std::set<std::string> told;
    const auto add = [&](const std::string& note) {
        if (std::ranges::find(notes, note) == notes.end()) notes.push_back(note);
    };
    if (!judgement.stale.empty()) add(judgement.stale);
    if (judgement.LeastSure() != CODE_MARK::Computed) add(Say("IDS_QM_JUDGE_UNSURE"));
    if (std::ranges::any_of(judgement.ends, [](const T_JUDGED_END& end) {
            return end.basis == JUDGE_BASIS::Code && !IsChordCode(end.By()) &&
                   !end.member.material.knowledge;
        }))
        add(Say("IDS_QM_JUDGE_NO_KNOWLEDGE"));
    for (const T_JUDGED_STATE& state : judgement.states)
        for (const T_JUDGED_ROW& row : state.rows)
            for (const T_CODE_WARNING& warning : row.checks.warnings) {
                // One that differs by its numbers alone stands once.
                std::string subject = warning.key;
                for (std::size_t i = 0; i < std::min<std::size_t>(2, warning.places.size()); ++i)
                    subject += '|' + warning.places[i];
                if (told.insert(subject).second) add(WarningText(warning));
            }
    return notes;
}
