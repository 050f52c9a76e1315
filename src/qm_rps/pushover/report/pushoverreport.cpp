#include "qm_rps/pushover/report/pushoverreport.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"

#include <algorithm>
#include <array>

namespace {

using zql::lib::MMSGFunction;

constexpr const char* kVersion = QM_RPS_VERSION;
constexpr const char* kLine = "_____________________________________________\n\n";
constexpr const char* kDashes = "--------------------   -----------------------------------   "
                                "------------------------- \n";
constexpr const char* kDashesStatus =
    "--------------------   -----------------------------------   -------------------------   "
    "------------------------- \n";

constexpr std::array<const char*, 4> kPatternKeys{
    "IDS_PUSHOVER_Static_Load", "IDS_PUSHOVER_Accerelation", "IDS_PUSHOVER_Mode_Shape",
    "IDS_PUSHOVER_Mode_Shape_Story_Mass"};

// Axis labels by plot type, x and y.
constexpr const char* kDisp = "IDS_PUSHOVER_Monitored_Displ_";
constexpr const char* kSd = "IDS_PUSHOVER_Spectral_Displ_";
constexpr const char* kSa = "IDS_PUSHOVER_Spectral_Accel__g_";
constexpr std::array<std::array<const char*, 2>, 9> kAxisKeys{{
    {kDisp, "IDS_PUSHOVER_Resultant_Base_React_"},
    {kDisp, "IDS_PUSHOVER_Shear_Coeff_"},
    {"IDS_QM_DRIFT", "IDS_PUSHOVER_Shear_Coeff_"},
    {kDisp, "IDS_PUSHOVER_Load_Factor"},
    {kSd, kSa},
    {kSd, kSa},
    {kSd, kSa},
    {kSd, kSa},
    {kSd, kSa},
}};

constexpr const char* kNotMet = "N/A";

std::string DispText(const std::optional<double>& v)
{
    return v ? FormatText("%f", *v) : "-";
}
std::string StepText(const std::optional<int>& v)
{
    return v ? std::to_string(*v) : "-";
}

std::string Direction(const T_POLC_D& polc)
{
    return kDirectionNames[static_cast<std::size_t>(polc.direction - 1)];
}

std::string Head(const T_PUSH_EVALUATION& e, const char* title)
{
    const auto kind = static_cast<std::size_t>(e.loadCase.patternKind);
    return std::string(title) +
           FormatText("* Capacity Spectrum (SDOF) : %s \n", e.loadCase.name.c_str()) +
           FormatText("* Disp. Control Node : %d \n", e.loadCase.controlNode) +
           FormatText("* Direction : %s \n", Direction(e.loadCase).c_str()) +
           FormatText("* Load Pattern Type : %s \n",
                      MMSGFunction::GetValue(kPatternKeys[kind]).c_str());
}

std::string PointLines(const T_PUSH_EVALUATION& e)
{
    if (!e.point)
        return FormatText(
            "* %s \n", MMSGFunction::GetValue("IDS_RPS_FAILED_FINDING_PERFORMANCE_POINT").c_str());
    const T_PERF_POINT& p = *e.point;
    const std::string teff = p.damping ? FormatText("* Teff, Deff : %f, %f \n", p.Teff, *p.damping)
                                       : FormatText("* Teff, Deff : %f, - \n", p.Teff);
    if (e.result == 2)
        return FormatText("* V, D : %s \n", "Elastic") +
               FormatText("* Sa, Sd : %s (%f, %f)\n", "Elastic", p.Sa, p.Sd) + teff;
    return FormatText("* V, D : %f, %f \n", p.V, p.D) +
           FormatText("* Sa, Sd : %f, %f \n", p.Sa, p.Sd) + teff;
}

std::string PerfPointSection(const T_PUSH_EVALUATION& e)
{
    return Head(e, "[ Performance Point ]\n") + PointLines(e) + FormatText("* m* : %g\n", e.mStar) +
           FormatText("* Gamma : %g\n", e.factors.gamma) + kLine;
}

/// A row of the limit-state lines; NTC shows "NG" in the window and "N/A" in the file.
std::string StateLine(const T_LIMIT_ROW& r, bool elastic)
{
    const std::string remark = r.remark == "NG" ? kNotMet : r.RemarkText();
    return FormatText("* %s- Demand, Capacity, Step, Remark : %s, %s, %s, %s \n", r.name.c_str(),
                      DispText(r.demand).c_str(),
                      elastic ? kElasticText : DispText(r.capacity).c_str(),
                      StepText(r.demandStep).c_str(), remark.c_str());
}

std::string Derivation(const T_TARGET_DISP& t, double gamma)
{
    std::string s = FormatText("  m* = %g\n", t.mStar) + FormatText("  Gamma = %g\n", gamma) +
                    FormatText("  Fy* = %g\n", t.Fy) + FormatText("  T* = %g\n", t.Tstar) +
                    FormatText("  Se(T*) = %gg\n", t.Se) + FormatText("  det* = %g \n", t.det);
    if (t.qu)
        s += FormatText("  qu = %g \n", *t.qu) + FormatText("  Tc = %g \n", t.Tc) +
             FormatText("  dt* = %g (short period range) \n", t.dt);
    else
        s += FormatText("  dt* = %g (medium or long period range)\n", t.dt);
    return s + FormatText("  dt = %g \n", gamma * t.dt);
}

std::string FailedTarget()
{
    return FormatText("* %s \n",
                      MMSGFunction::GetValue("IDS_RPS_FAILED_FINDING_TARGET_DISPLACEMENT").c_str());
}

std::string Ec8Section(const T_PUSH_EVALUATION& e)
{
    std::string s = Head(e, "[ Target Displacement ]\n");
    for (std::size_t i = 0; i < e.limitStates.size() && i < 3; ++i)
        s += StateLine(e.limitStates[i], e.elastic);
    if (e.limitStates.size() > 3)
        s += FormatText("* q*- Displacement,     Step         : %s, %s \n",
                        DispText(e.limitStates[3].capacity).c_str(),
                        StepText(e.limitStates[3].capacityStep).c_str());
    s += kLine;
    if (e.targets.empty() || !e.targets[0].found) return s + FailedTarget() + kLine;
    const T_TARGET_DISP& t = e.targets[0];
    const double dt = e.factors.gamma * t.dt;
    return s + "- Target Displacement of SD\n" + Derivation(t, e.factors.gamma) +
           FormatText("- Target Displacement of DL = SD/2.5 = %g\n", dt / 2.5) +
           FormatText("- Target Displacement of NC = SD*1.5 = %g\n", dt * 1.5) + kLine;
}

std::string NtcSection(const T_PUSH_EVALUATION& e)
{
    std::string s = Head(e, "[ Target Displacement ]\n");
    for (const T_LIMIT_ROW& row : e.limitStates)
        s += StateLine(row, e.elastic);
    s += kLine;
    if (e.targets.empty()) return s + FailedTarget() + kLine;
    for (std::size_t i = 0; i < e.targets.size(); ++i) {
        const T_TARGET_DISP& t = e.targets[i];
        s += FormatText("- Target Displacement of %s\n", kLimitStateNames[i]);
        s += t.found ? Derivation(t, e.factors.gamma) : std::string("  -\n");
        if (t.found && t.qu) s += FormatText("  q* = %g \n", *t.qu);
    }
    return s + kLine;
}

/// Labels of the demands and capacities that fall on a step.
std::string StatusOf(const T_PUSH_EVALUATION& e, int step)
{
    std::string text;
    const bool ntc = e.eval.method != PUSH_METHOD::Ec8Opcm;
    for (const T_LIMIT_ROW& row : e.limitStates) {
        if (row.demandStep == step) text += row.name + "(Dem.)";
    }
    for (const T_LIMIT_ROW& row : e.limitStates) {
        // NTC marks the operational and damage states alone; SLV shares the step of SLD.
        const bool marked = !ntc || row.name == "SLO" || row.name == "SLD";
        if (marked && row.capacityStep == step)
            text += row.name == "q*=3" ? "q*=3(Displ.)" : row.name + "(Cap.)";
    }
    return text;
}

/// "1/n" beside a drift.
std::string Annotation(PLOT_TYPE type, double x)
{
    if (type != PLOT_TYPE::Drift) return {};
    return x > 0.0 ? ": 1/" + FormatText("%8g", 1.0 / x) : std::string(":   -");
}

std::string Extreme(const char* key, const T_PLOTTED_CURVE& c, std::size_t i)
{
    return MMSGFunction::Format(key, {FormatText("%20.5e", c.y[i]), FormatText("%20.5e", c.x[i])});
}

/// Behind the control node: how it came about, and the further nodes that are followed.
std::string NodeNote(const T_PUSH_EVALUATION& e)
{
    std::string note, nodes;
    if (e.loadCase.controlOption != kNamedControlNode)
        note = "( " + MMSGFunction::GetValue("IDS_QM_REPORT_NODE_FOUND") + " ) ";
    for (const T_MONITORED_NODE& node : e.curve.monitored)
        nodes += (nodes.empty() ? "" : ", ") + std::to_string(node.node);
    if (!nodes.empty())
        note += "( " + MMSGFunction::Format("IDS_QM_REPORT_FURTHER", {nodes}) + " )";
    return note;
}

/// What the numbers above rest on: the messages that no section has printed.
std::string RemarkSection(const T_PUSH_EVALUATION& e)
{
    std::string s;
    const auto isNotMet = [](const T_LIMIT_ROW& r) {
        return r.remark == kNotMet || r.remark == "NG";
    };
    if (std::ranges::any_of(e.limitStates, isNotMet))
        s += "* " + MMSGFunction::GetValue("IDS_QM_REPORT_NOT_MET") + "\n";
    const auto isPrinted = [](const auto& m) {
        return m.key == "IDS_RPS_FAILED_FINDING_PERFORMANCE_POINT" ||
               m.key == "IDS_RPS_FAILED_FINDING_TARGET_DISPLACEMENT";
    };
    for (const auto& m : e.messages)
        if (!isPrinted(m)) s += "* " + m.text + "\n";
    if (s.empty()) return s;
    return "[ " + MMSGFunction::GetValue("IDS_QM_REPORT_REMARKS") + " ]\n" + s + "\n\n";
}

std::string TableHead(const T_PUSH_EVALUATION& e, const std::string& x, const std::string& y)
{
    const T_POLC_D& polc = e.loadCase;
    std::string s = FormatText("[ %s vs. %s ]\n\n", y.c_str(), x.c_str());
    s += MMSGFunction::Format("IDS_RPS_PUSHOVER_Load_Case___s___Unit____s__s_n_n_n",
                              {polc.name, NameOf(e.units.force), NameOf(e.units.length)});
    if (polc.patternKind >= 2)
        s += MMSGFunction::Format("IDS_PUSHOVER_Mode__d", {std::to_string(e.factors.mode)}) + "\n";
    s += MMSGFunction::Format("IDS_RPS_PUSHOVER__Node____d___Direction____s____s_n",
                              {std::to_string(polc.controlNode), Direction(polc), NodeNote(e)});
    return s;
}

} // namespace

std::string ProductText()
{
    return MMSGFunction::GetValue("IDS_QM_PRODUCT") + " " + kVersion;
}

std::string PlotXLabel(PLOT_TYPE type)
{
    return MMSGFunction::GetValue(kAxisKeys[static_cast<std::size_t>(type)][0]);
}

std::string PlotYLabel(PLOT_TYPE type)
{
    return MMSGFunction::GetValue(kAxisKeys[static_cast<std::size_t>(type)][1]);
}

std::string PushoverCurveText(const T_PUSH_EVALUATION& e)
{
    const T_PLOTTED_CURVE& c = e.curve;
    const std::string x = PlotXLabel(c.type), y = PlotYLabel(c.type);
    const bool status = e.IsTarget();
    const char* const dashes = status ? kDashesStatus : kDashes;
    std::string s = TableHead(e, x, y);
    const std::string hx = FormatText("%20s", x.c_str()), hy = FormatText("%20s", y.c_str());
    if (status)
        s += MMSGFunction::Format("IDS_RPS_PUSHOVER__step____20s____20s____20s_n",
                                  {hx, hy, FormatText("%20s", "Status of Step")});
    else
        s += MMSGFunction::Format("IDS_RPS_PUSHOVER__step____20s____20s_n", {hx, hy});
    s += dashes;
    for (std::size_t i = 0; i < c.x.size(); ++i) {
        const int step = e.StepAt(i);
        const std::string note = Annotation(c.type, c.x[i]);
        if (status)
            s += FormatText("%20d    %20.5e %-14s   %25.5e  %25s\n", step, c.x[i], note.c_str(),
                            c.y[i], StatusOf(e, step).c_str());
        else
            s += FormatText("%20s    %20.5e %-14s   %25.5e\n", std::to_string(step).c_str(), c.x[i],
                            note.c_str(), c.y[i]);
    }
    s += dashes;
    if (!c.y.empty()) {
        const auto lowest = std::min_element(c.y.begin(), c.y.end());
        s += Extreme("IDS_RPS_PUSHOVER_Min___20_5e_at___20_5e__n", c,
                     static_cast<std::size_t>(lowest - c.y.begin()));
        s += Extreme("IDS_RPS_PUSHOVER_Max___20_5e_at___20_5e__n", c, FirstMaximum(c.y));
    }
    return s + "\n\n";
}

std::string PushoverReportText(const T_PUSH_EVALUATION& e)
{
    std::string s =
        ProductText() +
        FormatText("\n ** %s ** \n",
                   MMSGFunction::GetValue("IDS_RPS_PUSHOVER_Pushover_Curve_Data").c_str()) +
        kLine;
    if (!e.IsTarget())
        s += PerfPointSection(e);
    else if (e.eval.method == PUSH_METHOD::Ec8Opcm)
        s += Ec8Section(e);
    else
        s += NtcSection(e);
    return s + PushoverCurveText(e) + RemarkSection(e);
}

int WritePushoverText(const std::string& text, const std::string& path, std::string& error)
{
    T_FILE_ERROR fault;
    if (CFileCtrl::CheckOutput({path, OUTPUT_KIND::Text}, fault) &&
        CFileCtrl::WriteWholeFile(path, text, fault))
        return 1;
    error =
        MMSGFunction::Format("IDS_RPS_PUSHOVER_Can_t_create_the_file__", {path}) + " " + fault.text;
    return 0;
}
