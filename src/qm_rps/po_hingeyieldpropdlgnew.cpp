#include "qm_rps/po_hingeyieldpropdlgnew.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/po_hingeyieldpropgrid.h"

#include <algorithm>
#include <cmath>
#include <span>

namespace {

constexpr const char* kMessage = "IDS_CMD_IEHP_YIELD";
constexpr int kMy = static_cast<int>(HINGE_COMPONENT::My);
constexpr int kMz = static_cast<int>(HINGE_COMPONENT::Mz);

using T_LEVEL = T_YIELD_LEVEL;

/// A strength or moment of a level. component: the axis it belongs to, -1 for both.
struct T_PARAMETER {
    const char* field;
    int component;
    HINGE_SIDE side;
    double (*value)(const T_LEVEL&);
};

enum PARAMETER {
    kTension,
    kPmax,
    kYPos,
    kZPos,
    kYNeg,
    kZNeg,
    kYMaxPos,
    kZMaxPos,
    kYMaxNeg,
    kZMaxNeg
};

// clang-format off
constexpr T_PARAMETER kParameters[] = { // by PARAMETER
    {"tension",         -1,  HINGE_SIDE::None,     [](const T_LEVEL& l) { return l.tension; }},
    {"compression",     -1,  HINGE_SIDE::None,     [](const T_LEVEL& l) { return l.compression; }},
    {"y.moment.pos",    kMy, HINGE_SIDE::Positive, [](const T_LEVEL& l) { return l.y.moment.pos; }},
    {"z.moment.pos",    kMz, HINGE_SIDE::Positive, [](const T_LEVEL& l) { return l.z.moment.pos; }},
    {"y.moment.neg",    kMy, HINGE_SIDE::Negative, [](const T_LEVEL& l) { return l.y.moment.neg; }},
    {"z.moment.neg",    kMz, HINGE_SIDE::Negative, [](const T_LEVEL& l) { return l.z.moment.neg; }},
    {"y.momentMax.pos", kMy, HINGE_SIDE::Positive, [](const T_LEVEL& l) { return l.y.momentMax.pos; }},
    {"z.momentMax.pos", kMz, HINGE_SIDE::Positive, [](const T_LEVEL& l) { return l.z.momentMax.pos; }},
    {"y.momentMax.neg", kMy, HINGE_SIDE::Negative, [](const T_LEVEL& l) { return l.y.momentMax.neg; }},
    {"z.momentMax.neg", kMz, HINGE_SIDE::Negative, [](const T_LEVEL& l) { return l.z.momentMax.neg; }},
};

struct T_LABEL {
    const char* label;
    PARAMETER parameter;
};
constexpr T_LABEL kCrackLabels[] = {
    {"PC(t)", kTension}, {"Pmax(c)", kPmax},
    {"MCy(+)", kYPos}, {"MCz(+)", kZPos}, {"MCy(-)", kYNeg}, {"MCz(-)", kZNeg},
    {"MYy,max(+)", kYMaxPos}, {"MYz,max(+)", kZMaxPos},
    {"MYy,max(-)", kYMaxNeg}, {"MYz,max(-)", kZMaxNeg},
};
constexpr T_LABEL kYieldLabels[] = {
    {"PY(t)", kTension}, {"Pmax(c)", kPmax},
    {"MYy(+)", kYPos}, {"MYz(+)", kZPos}, {"MYy(-)", kYNeg}, {"MYz(-)", kZNeg},
    {"MUy,max(+)", kYMaxPos}, {"MUz,max(+)", kZMaxPos},
    {"MUy,max(-)", kYMaxNeg}, {"MUz,max(-)", kZMaxNeg},
};
constexpr T_LABEL kEc8Labels[] = {
    {"PC0(t)", kTension}, {"Pmax(c)", kPmax},
    {"MC0y(+)", kYPos}, {"MUy,max(+)", kYMaxPos}, {"MC0z(+)", kZPos}, {"MUz,max(+)", kZMaxPos},
    {"MC0y(-)", kYNeg}, {"MUy,max(-)", kYMaxNeg}, {"MC0z(-)", kZNeg}, {"MUz,max(-)", kZMaxNeg},
};
// clang-format on

/// A level with its name in the record and its labels.
struct T_LEVEL_VIEW {
    std::string name;
    const T_LEVEL* level;
    std::span<const T_LABEL> labels;
};

bool Used(const T_LEVEL& level, int component)
{
    return component == kMy ? level.y.used : component == kMz ? level.z.used : true;
}

T_FINDING Finding(std::string field, std::string rule, int component, HINGE_SIDE side,
                  const char* point)
{
    T_FINDING f;
    f.field = std::move(field);
    f.text = zql::lib::MMSGFunction::Format(kMessage, {rule});
    f.ruleText = std::move(rule);
    f.messageKey = kMessage;
    f.component = component;
    f.side = side;
    f.point = point;
    return f;
}

void CheckParameters(const T_LEVEL_VIEW& view, std::vector<T_FINDING>& out)
{
    for (const T_LABEL& row : view.labels) {
        const T_PARAMETER& p = kParameters[row.parameter];
        const double value = p.value(*view.level);
        if (!Used(*view.level, p.component) || (value > 0.0 && std::isfinite(value))) continue;
        out.push_back(Finding(view.name + "." + p.field, std::string(row.label) + " > 0",
                              p.component, p.side, ""));
    }
}

/// A curve of a used axis.
struct T_CURVE_VIEW {
    std::string field;
    const T_PM_CURVE* curve;
    int component;
    HINGE_SIDE side;
};

std::vector<T_CURVE_VIEW> CurvesOf(const T_LEVEL_VIEW& view)
{
    std::vector<T_CURVE_VIEW> out;
    for (const int c : {kMy, kMz}) {
        if (!Used(*view.level, c)) continue;
        const T_YIELD_AXIS& axis = c == kMy ? view.level->y : view.level->z;
        const std::string field = view.name + (c == kMy ? ".y" : ".z") + ".curves.";
        out.push_back({field + "pos", &axis.curves.pos, c, HINGE_SIDE::Positive});
        out.push_back({field + "neg", &axis.curves.neg, c, HINGE_SIDE::Negative});
    }
    return out;
}

std::string PointField(const T_CURVE_VIEW& v, std::size_t i, char what)
{
    return v.field + FormatText("[%zu].%c", i, what);
}

/// The ratios of one axis, point by point, (+) before (-).
void CheckRatios(const T_CURVE_VIEW& pos, const T_CURVE_VIEW& neg, std::vector<T_FINDING>& out)
{
    for (std::size_t i = 0; i < kPmPointNames.size(); ++i)
        for (const T_CURVE_VIEW* v : {&pos, &neg}) {
            const double m = (*v->curve)[i].m;
            if (m > -1.0 && m < 1.0) continue;
            const bool plus = v->side == HINGE_SIDE::Positive;
            out.push_back(Finding(PointField(*v, i, 'm'),
                                  plus ? "-1 < M/MY,max(+) < 1" : "-1 < M/MY,max(-) < 1",
                                  v->component, v->side, kPmPointNames[i]));
        }
}

/// P/Pmax falls strictly along the points first ... first + 4, and is finite.
void CheckFall(const T_CURVE_VIEW& v, std::size_t first, const char* rule,
               std::vector<T_FINDING>& out)
{
    for (std::size_t i = first; i < first + 5; ++i) {
        const double p = (*v.curve)[i].p;
        if (std::isfinite(p) && (i == first || p < (*v.curve)[i - 1].p)) continue;
        out.push_back(Finding(PointField(v, i, 'p'), rule, v.component, v.side, kPmPointNames[i]));
    }
}

/// The levels of a curve type; `missing` stands in for a crack level that is not there.
std::vector<T_LEVEL_VIEW> LevelsOf(const T_YIELD_SURFACE& s, SKEL_TYPE type, T_LEVEL& missing)
{
    missing.y.used = s.yield.y.used;
    missing.z.used = s.yield.z.used;
    if (type == SKEL_TYPE::Ec8) return {{"yield", &s.yield, kEc8Labels}};
    std::vector<T_LEVEL_VIEW> out;
    if (type == SKEL_TYPE::Trilinear || type == SKEL_TYPE::SlipTrilinear)
        out.push_back({"crack", s.crack ? &*s.crack : &missing, kCrackLabels});
    out.push_back({"yield", &s.yield, kYieldLabels});
    return out;
}

} // namespace

std::vector<T_FINDING> CPO_HingeYieldPropDlgNew::Findings() const
{
    std::vector<T_FINDING> out;
    std::vector<T_CURVE_VIEW> curves;
    T_YIELD_LEVEL missing;
    for (const T_LEVEL_VIEW& view : LevelsOf(m_surface, m_type, missing)) {
        CheckParameters(view, out);
        for (T_CURVE_VIEW& c : CurvesOf(view))
            curves.push_back(std::move(c));
    }
    for (std::size_t i = 0; i < curves.size(); i += 2)
        CheckRatios(curves[i], curves[i + 1], out);
    for (const T_CURVE_VIEW& c : curves) {
        CheckFall(c, 5, "P/Pmax(t)", out);
        CheckFall(c, 0, "P/Pmax(c)", out);
    }
    return out;
}

int CPO_HingeYieldPropDlgNew::CheckData()
{
    const std::vector<T_FINDING> findings = Findings();
    if (findings.empty()) return 1;
    ShowMessage(findings.front().messageKey, findings.front().text);
    return 0;
}

int CPO_HingeYieldPropDlgNew::OnOK()
{
    if (!CheckData()) return 0;
    m_record = m_surface;
    return 1;
}

std::string CPO_HingeYieldPropDlgNew::AxisNoteKey(bool aboutY) const
{
    if (aboutY) return m_surface.yield.y.used ? "" : "IDS_RPS_PO_Y_AXIS_NOT_USED";
    return m_surface.yield.z.used ? "" : "IDS_RPS_PO_Z_AXIS_NOT_USED";
}

double CPO_HingeYieldPropDlgNew::MomentNormaliser(const T_YIELD_LEVEL& level)
{
    return std::max({std::fabs(level.y.momentMax.pos), std::fabs(level.y.momentMax.neg),
                     std::fabs(level.z.momentMax.pos), std::fabs(level.z.momentMax.neg)});
}
