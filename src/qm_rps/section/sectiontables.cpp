#include "qm_rps/section/sectiontables.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/generate/codehingerows.h"
#include "qm_rps/section/sectiontexts.h"

#include <numbers>

namespace {

using namespace solver;
constexpr T_DIM kDimCurvature{0, -1};

std::string Degrees(double direction)
{
    return FormatText("%.6g", direction * 180.0 / std::numbers::pi);
}

/// A table of numbers with units, row by row.
class CTable {
public:
    explicit CTable(const T_UNITS& units) : m_units(units) {}
    CTable& Head(const std::string& head, T_DIM dim)
    {
        m_table.columns.push_back({HeadWithUnit(head, dim, m_units), true});
        return *this;
    }
    CTable& Head(const std::string& head, bool number = false)
    {
        m_table.columns.push_back({head, number});
        return *this;
    }
    CTable& Row()
    {
        m_table.rows.emplace_back();
        return *this;
    }
    CTable& Cell(std::string text)
    {
        m_table.rows.back().push_back(std::move(text));
        return *this;
    }
    CTable& Cell(double si, T_DIM dim)
    {
        return Cell(FormatText("%.6g", FromSi(si, m_units, dim) + 0.0));
    }
    T_TEXT_TABLE Take() { return std::move(m_table); }

private:
    T_UNITS m_units;
    T_TEXT_TABLE m_table;
};

CTable WithDirection(const T_UNITS& units, bool axial = true)
{
    CTable t(units);
    t.Head(Say("IDS_QM_SECC_HEAD_DIRECTION"), true);
    if (axial) t.Head("N", kDimForce);
    return t;
}

T_TEXT_TABLE Capacities(const T_SECTION_ANSWER& answer, const T_UNITS& units)
{
    CTable t = WithDirection(units);
    t.Head("My", kDimMoment).Head("Mz", kDimMoment).Head("x", kDimLength);
    t.Head(Say("IDS_QM_SECC_HEAD_TOP"), true).Head(Say("IDS_QM_SECC_HEAD_BOTTOM"), true);
    t.Head(Say("IDS_QM_SECC_HEAD_GOVERNS"));
    for (const T_SECTION_CAPACITY_AT& row : answer.capacities) {
        const T_SECTION_STATE& s = row.at;
        t.Row().Cell(Degrees(row.direction)).Cell(s.axial, kDimForce).Cell(s.My, kDimMoment);
        t.Cell(s.Mz, kDimMoment);
        s.depth > 0.0 ? t.Cell(s.depth, kDimLength) : t.Cell("-");
        if (s.residual)
            t.Cell(s.top, kDimNone).Cell(s.bottom, kDimNone);
        else
            t.Cell("-").Cell("-");
        t.Cell(FibreText(s.governs));
    }
    return t.Take();
}

void CurvatureState(const char* name, double curvature, double moment, const T_SECTION_STATE& s,
                    const std::string& why, CTable& t)
{
    t.Cell(Say(name)).Cell(curvature, kDimCurvature).Cell(moment, kDimMoment);
    s.depth > 0.0 ? t.Cell(s.depth, kDimLength) : t.Cell("-");
    t.Cell(s.top, kDimNone).Cell(s.bottom, kDimNone).Cell(why);
}

T_TEXT_TABLE Curvatures(const T_SECTION_ANSWER& answer, const T_UNITS& units)
{
    CTable t = WithDirection(units);
    t.Head(Say("IDS_QM_SECC_HEAD_STATE")).Head(Say("IDS_QM_SECC_HEAD_CURVATURE"), kDimCurvature);
    t.Head("M", kDimMoment).Head("x", kDimLength);
    t.Head(Say("IDS_QM_SECC_HEAD_TOP"), true).Head(Say("IDS_QM_SECC_HEAD_BOTTOM"), true);
    t.Head(Say("IDS_QM_SECC_HEAD_BY"));
    const auto row = [&](const T_SECTION_CURVATURE& c) {
        t.Row().Cell(Degrees(c.direction)).Cell(c.axial, kDimForce);
    };
    for (const T_SECTION_CURVATURE& c : answer.curvatures) {
        const T_CURVATURE_POINT &yield = c.curve.points[c.curve.yield],
                                &last = c.curve.points.back();
        if (c.curve.yields.kind != FIBRE_KIND::None) {
            row(c);
            CurvatureState("IDS_QM_SECC_YIELD", yield.curvature, yield.moment, c.yield,
                           FibreText(c.curve.yields), t);
        }
        row(c);
        CurvatureState("IDS_QM_SECC_ULTIMATE", last.curvature, last.moment, c.ultimate,
                       CurvatureEndText(c), t);
        if (!c.curve.idealised) continue;
        row(c);
        t.Cell(Say("IDS_QM_SECC_IDEAL")).Cell(c.curve.idealCurvature, kDimCurvature);
        t.Cell(c.curve.idealMoment, kDimMoment).Cell("-").Cell("-").Cell("-");
        t.Cell(Say("IDS_QM_SECC_DUCTILITY",
                   FormatText("%.4g", last.curvature / c.curve.idealCurvature)));
    }
    return t.Take();
}

T_TEXT_TABLE CurvaturePoints(const T_SECTION_ANSWER& answer, const T_UNITS& units)
{
    CTable t = WithDirection(units);
    t.Head(Say("IDS_QM_SECC_HEAD_CURVATURE"), kDimCurvature).Head("M", kDimMoment);
    t.Head("My", kDimMoment).Head("Mz", kDimMoment);
    for (const T_SECTION_CURVATURE& c : answer.curvatures)
        for (const T_CURVATURE_POINT& p : c.curve.points) {
            t.Row().Cell(Degrees(c.direction)).Cell(c.axial, kDimForce);
            t.Cell(p.curvature, kDimCurvature).Cell(p.moment, kDimMoment);
            t.Cell(p.My, kDimMoment).Cell(p.Mz, kDimMoment);
        }
    return t.Take();
}

T_TEXT_TABLE InteractionPoints(const T_SECTION_ANSWER& answer, const T_UNITS& units)
{
    CTable t = WithDirection(units);
    t.Head("My", kDimMoment).Head("Mz", kDimMoment).Head(Say("IDS_QM_SECC_HEAD_POINT"));
    for (const T_SECTION_INTERACTION& c : answer.interactions)
        for (std::size_t i = 0; i < c.curve.points.size(); ++i) {
            const T_CAPACITY& p = c.curve.points[i];
            const auto at = static_cast<long>(i);
            t.Row().Cell(Degrees(c.direction)).Cell(p.axial, kDimForce);
            t.Cell(p.My, kDimMoment).Cell(p.Mz, kDimMoment);
            t.Cell(at == c.curve.largest    ? Say("IDS_QM_SECC_LARGEST")
                   : at == c.curve.balanced ? Say("IDS_QM_SECC_BALANCED")
                   : at == c.curve.bending  ? Say("IDS_QM_SECC_BENDING")
                                            : std::string("-"));
        }
    return t.Take();
}

T_TEXT_TABLE SurfacePoints(const T_SECTION_ANSWER& answer, const T_UNITS& units)
{
    CTable t(units);
    t.Head("N", kDimForce).Head(Say("IDS_QM_SECC_HEAD_DIRECTION"), true);
    t.Head("My", kDimMoment).Head("Mz", kDimMoment);
    for (const T_SECTION_CONTOUR& contour : answer.contours)
        for (std::size_t i = 0; i < contour.points.size(); ++i) {
            const T_CAPACITY& p = contour.points[i];
            t.Row().Cell(p.axial, kDimForce);
            t.Cell(Degrees(2.0 * std::numbers::pi * double(i) / double(contour.points.size())));
            t.Cell(p.My, kDimMoment).Cell(p.Mz, kDimMoment);
        }
    return t.Take();
}

} // namespace

T_TEXT_TABLE SectionStates(const T_SECTION_ANSWER& answer, const T_UNITS& units)
{
    if (answer.task == SECTION_TASK::Capacity) return Capacities(answer, units);
    return answer.task == SECTION_TASK::Curvature ? Curvatures(answer, units) : T_TEXT_TABLE();
}

T_TEXT_TABLE SectionPoints(const T_SECTION_ANSWER& answer, const T_UNITS& units)
{
    switch (answer.task) {
    case SECTION_TASK::Capacity:
        break;
    case SECTION_TASK::Curvature:
        return CurvaturePoints(answer, units);
    case SECTION_TASK::Interaction:
        return InteractionPoints(answer, units);
    case SECTION_TASK::Surface:
        return SurfacePoints(answer, units);
    }
    return {};
}

std::vector<std::string> SectionHead(const T_SECTION_ANSWER& answer, const T_UNITS& units)
{
    std::vector<std::string> lines{
        Say("IDS_QM_SECC_OF", answer.section, answer.material, SectionOptionsText(answer))};
    std::string strengths;
    for (const T_CODE_TRACE& line : answer.trace) {
        const std::string unit = UnitText(line.dim, units);
        strengths += (strengths.empty() ? "" : "; ") + line.symbol + " = " +
                     FormatText("%.6g", FromSi(line.value, units, line.dim)) +
                     (unit.empty() ? "" : " " + unit);
        if (!line.clause.empty()) strengths += " (" + line.clause + ")";
    }
    lines.push_back(strengths);
    for (const T_CODE_WARNING& warning : answer.warnings)
        lines.push_back("! " + WarningText(warning));
    return lines;
}
