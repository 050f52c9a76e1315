#include "qm_rps/pushover/explain/evaluationfacts.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/pushover/adrsformulas.h"
#include "qm_rps/pushover/answertrial.h"
#include "qm_rps/pushover/evaluation/pushtargetinput.h"

#include <cmath>

namespace {

constexpr const char* kAtcFactors = "ATC-40 8.2.2.1";
constexpr const char* kAtcDamping = "ATC-40 8.2.2.1.1";
constexpr const char* kAtcTables = "ATC-40 Tables 8-1, 8-2";
constexpr const char* kFemaDamping = "FEMA 440 6.2";
constexpr const char* kFemaMadrs = "FEMA 440 6.3";

std::string N(double value)
{
    return FormatText("%.6g", value);
}

/// Collects the facts of one group.
class CFactList {
public:
    explicit CFactList(const T_PUSH_EVALUATION& e)
        : m_length(NameOf(e.units.length)), m_force(NameOf(e.units.force)),
          m_mass(m_force + " s2/" + m_length)
    {
    }

    T_FACT& Add(const char* symbol, const char* definition, double value, const std::string& unit)
    {
        T_FACT& fact = m_facts.emplace_back();
        fact.symbol = symbol;
        fact.definition = Say(definition);
        fact.value = value;
        fact.unit = unit;
        return fact;
    }
    /// Worked out: the formula in symbols and with its numbers.
    void Formula(const char* symbol, const char* definition, double value, const std::string& unit,
                 const char* clause, const char* formula, std::string numbers)
    {
        T_FACT& fact = Add(symbol, definition, value, unit);
        fact.clause = clause;
        fact.formula = formula;
        fact.numbers = std::move(numbers);
    }
    /// Taken from somewhere, which the clause or the text names.
    void Taken(const char* symbol, const char* definition, double value, const std::string& unit,
               const char* clause, std::string from = {})
    {
        T_FACT& fact = Add(symbol, definition, value, unit);
        fact.clause = clause;
        fact.text = std::move(from);
    }

    const std::string& L() const { return m_length; }
    const std::string& F() const { return m_force; }
    const std::string& M() const { return m_mass; }
    std::vector<T_FACT> Take() { return std::move(m_facts); }

private:
    std::string m_length, m_force, m_mass;
    std::vector<T_FACT> m_facts;
};

const char* FactorClause(const T_PUSH_EVALUATION& e)
{
    if (e.eval.method == PUSH_METHOD::Ec8Opcm) return "EN 1998-1 Annex B.2";
    return e.IsTarget() ? "NTC C7.3.4.2" : kAtcFactors;
}

T_FACT_GROUP EquivalentSystem(const T_PUSH_EVALUATION& e)
{
    CFactList list(e);
    const T_PUSH_FACTORS& f = e.factors;
    const char* const clause = FactorClause(e);
    list.Taken("M", "IDS_QM_FACT_MASS", f.mass, list.M(), "");
    list.Taken("W", "IDS_QM_FACT_WEIGHT", f.weight, list.F(), "");
    list.Taken("g", "IDS_QM_FACT_GRAVITY", f.gravity, list.L() + "/s2", "");
    list.Taken("Gamma", "IDS_QM_FACT_GAMMA", f.gamma, "", clause, e.gammaNote);
    list.Taken("alpha", "IDS_QM_FACT_ALPHA", f.alpha, "", clause);
    list.Formula("m*", "IDS_QM_FACT_MSTAR", e.mStar, list.M(), clause, "M alpha / Gamma",
                 N(f.mass) + " x " + N(f.alpha) + " / " + N(f.gamma));
    return {Say("IDS_QM_FACTS_SYSTEM"), list.Take()};
}

std::string RuleName(const T_PUSH_EVALUATION& e)
{
    const T_BILINEAR_OPTIONS options = BilinearOptionsOf(e.eval);
    const char* const key = options.rule == BILINEAR_RULE::Ec8   ? "IDS_QM_FACT_RULE_EC8"
                            : options.rule == BILINEAR_RULE::Ntc ? "IDS_QM_FACT_RULE_NTC"
                                                                 : "IDS_QM_FACT_RULE_MASONRY";
    return Say(key, N(options.secant), N(options.drop));
}

T_FACT_GROUP BilinearCurve(const T_PUSH_EVALUATION& e)
{
    CFactList list(e);
    const char* const clause =
        e.eval.method == PUSH_METHOD::Ec8Opcm ? "EN 1998-1 Annex B.3" : "NTC C7.3.4.2";
    const T_BILINEAR& b = *e.bilinear;
    list.Taken("dy*", "IDS_QM_FACT_DY", b.dy, list.L(), clause, RuleName(e));
    list.Taken("ay*", "IDS_QM_FACT_AY", b.ay, "g", clause);
    list.Taken("du*", "IDS_QM_FACT_DU", b.du, list.L(), clause);
    list.Formula("Fy*", "IDS_QM_FACT_FY", e.mStar * b.ay * e.factors.gravity, list.F(), clause,
                 "m* ay* g", N(e.mStar) + " x " + N(b.ay) + " x " + N(e.factors.gravity));
    return {Say("IDS_QM_FACTS_BILINEAR"), list.Take()};
}

/// The inelastic displacement of the equivalent system.
void AddInelastic(CFactList& list, const T_TARGET_DISP& t, const char* clause)
{
    if (!t.qu)
        return list.Formula("dt*", "IDS_QM_FACT_DT_STAR", t.dt, list.L(), clause,
                            "det*  (T* >= TC)", N(t.Tstar) + " >= " + N(t.Tc));
    list.Formula("qu", "IDS_QM_FACT_QU", *t.qu, "", clause, "Se(T*) / ay*",
                 N(t.Se) + " / " + N(t.ay));
    if (*t.qu <= 1.0)
        return list.Formula("dt*", "IDS_QM_FACT_DT_STAR", t.dt, list.L(), clause, "det*  (qu <= 1)",
                            N(*t.qu) + " <= 1");
    if (t.capped)
        return list.Formula("dt*", "IDS_QM_FACT_DT_STAR", t.dt, list.L(), clause, "3 det*",
                            "3 x " + N(t.det));
    list.Formula("dt*", "IDS_QM_FACT_DT_STAR", t.dt, list.L(), clause,
                 "det* / qu (1 + (qu - 1) TC / T*)",
                 N(t.det) + " / " + N(*t.qu) + " x (1 + (" + N(*t.qu) + " - 1) x " + N(t.Tc) +
                     " / " + N(t.Tstar) + ")");
}

T_FACT_GROUP Target(const T_PUSH_EVALUATION& e, std::size_t i)
{
    CFactList list(e);
    const bool ec8 = e.eval.method == PUSH_METHOD::Ec8Opcm;
    const T_TARGET_DISP& t = e.targets[i];
    const char* const clause = ec8 ? "EN 1998-1 Annex B.5" : "NTC C7.3.4.2";
    const std::string g = N(e.factors.gravity);
    list.Formula("T*", "IDS_QM_FACT_TSTAR", t.Tstar, "s", ec8 ? "EN 1998-1 Annex B.4" : clause,
                 "2 pi sqrt(dy* / (ay* g))",
                 "2 pi sqrt(" + N(t.dy) + " / (" + N(t.ay) + " x " + g + "))");
    list.Taken("TC", "IDS_QM_FACT_TC", t.Tc, "s", "", e.eval.spectrum);
    list.Taken("Se(T*)", "IDS_QM_FACT_SE", t.Se, "g", "", e.eval.spectrum);
    list.Formula("det*", "IDS_QM_FACT_DET", t.det, list.L(), clause, "Se(T*) g (T* / 2 pi)^2",
                 N(t.Se) + " x " + g + " x (" + N(t.Tstar) + " / 2 pi)^2");
    AddInelastic(list, t, clause);
    list.Formula("dt", "IDS_QM_FACT_DT", e.factors.gamma * t.dt, list.L(), clause, "Gamma dt*",
                 N(e.factors.gamma) + " x " + N(t.dt));
    const std::string state = ec8 ? "SD" : kLimitStateNames[i];
    return {Say("IDS_QM_FACTS_TARGET", state), list.Take()};
}

/// Demands of DL and NC as shares of that of SD, which our tables take for EN 1998-3.
T_FACT_GROUP SharesOfSd(const T_PUSH_EVALUATION& e)
{
    CFactList list(e);
    const double dt = e.factors.gamma * e.targets[0].dt;
    list.Formula("dt,DL", "IDS_QM_FACT_DT", dt / 2.5, list.L(), "", "dt,SD / 2.5",
                 N(dt) + " / 2.5");
    list.Formula("dt,NC", "IDS_QM_FACT_DT", 1.5 * dt, list.L(), "", "1.5 dt,SD", "1.5 x " + N(dt));
    return {Say("IDS_QM_FACTS_SHARES"), list.Take()};
}

/// A spectral reduction factor: (k0 - k1 ln beta) / k2 down to a lower bound. ATC-40 8.2.2.1.1.
struct T_REDUCTION {
    const char *symbol, *definition, *formula;
    double k0, k1, k2;
};
constexpr std::array<T_REDUCTION, 2> kReductions{
    {{"SRA", "IDS_QM_FACT_SRA", "(3.21 - 0.68 ln beta_eff) / 2.12", 3.21, 0.68, 2.12},
     {"SRV", "IDS_QM_FACT_SRV", "(2.31 - 0.41 ln beta_eff) / 1.65", 2.31, 0.41, 1.65}}};

void AddReduction(CFactList& list, const T_REDUCTION& r, std::optional<double> value,
                  std::optional<double> beta, bool fema)
{
    if (!value) return;
    constexpr double kSame = 1e-9;
    const double free = beta && *beta > 0.0 ? (r.k0 - r.k1 * std::log(*beta)) / r.k2 : 0.0;
    if (fema)
        list.Taken(r.symbol, r.definition, *value, "", kFemaDamping);
    else if (std::fabs(free - *value) < kSame)
        list.Formula(r.symbol, r.definition, *value, "", kAtcDamping, r.formula,
                     "(" + N(r.k0) + " - " + N(r.k1) + " ln " + N(*beta) + ") / " + N(r.k2));
    else
        list.Taken(r.symbol, r.definition, *value, "", kAtcTables, Say("IDS_QM_FACT_BOUNDED"));
}

/// The last trial, as far as the procedure has these numbers.
void AddTrial(CFactList& list, const T_PERFPT_TRIAL& t, const T_PUSH_EVALUATION& e)
{
    const bool fema = e.eval.method == PUSH_METHOD::Fema440;
    const char* const damping = fema ? kFemaDamping : kAtcDamping;
    list.Taken("dpi", "IDS_QM_FACT_DPI", t.dpi, list.L(), "");
    list.Taken("api", "IDS_QM_FACT_API", t.api, "g", "");
    const auto taken = [&](const char* symbol, const char* definition, std::optional<double> value,
                           const std::string& unit, const char* clause) {
        if (value) list.Taken(symbol, definition, *value, unit, clause);
    };
    taken("dy", "IDS_QM_FACT_TRIAL_DY", t.dy, list.L(), damping);
    taken("ay", "IDS_QM_FACT_TRIAL_AY", t.ay, "g", damping);
    taken("alpha", "IDS_QM_FACT_POST_YIELD", t.alpha, "", damping);
    if (t.mu && t.dy && fema)
        list.Formula("mu", "IDS_QM_FACT_MU", *t.mu, "", damping, "dpi / dy",
                     N(t.dpi) + " / " + N(*t.dy));
    if (!fema && t.dy && t.ay && t.kappa) {
        const double loop = kFullLoopPct * (*t.ay * t.dpi - *t.dy * t.api) / (t.api * t.dpi);
        list.Formula("beta0", "IDS_QM_FACT_BETA0", loop, "%", kAtcDamping,
                     "63.7 (ay dpi - dy api) / (api dpi)",
                     "63.7 x (" + N(*t.ay) + " x " + N(t.dpi) + " - " + N(*t.dy) + " x " +
                         N(t.api) + ") / (" + N(t.api) + " x " + N(t.dpi) + ")");
        list.Taken("kappa", "IDS_QM_FACT_KAPPA", *t.kappa, "", kAtcTables);
    }
    taken("beta_eff", "IDS_QM_FACT_BETA_EFF", t.betaEff, "%", damping);
    AddReduction(list, kReductions[0], t.SRa, t.betaEff, fema);
    AddReduction(list, kReductions[1], t.SRv, t.betaEff, fema);
    taken("Teff", "IDS_QM_FACT_TRIAL_TEFF", t.Teff, "s", damping);
    taken("M", "IDS_QM_FACT_MADRS", t.M, "", kFemaMadrs);
    taken("Di", "IDS_QM_FACT_DI", t.Di, list.L(), "");
    taken("Ai", "IDS_QM_FACT_AI", t.Ai, "g", "");
}

T_FACT_GROUP Trial(const T_PUSH_EVALUATION& e, const T_PERFPT_TRIAL& trial)
{
    CFactList list(e);
    AddTrial(list, trial, e);
    return {Say(TriesFamily(e) ? "IDS_QM_FACTS_NEAREST_TRIAL" : "IDS_QM_FACTS_TRIAL",
                std::to_string(trial.trial)),
            list.Take()};
}

T_FACT_GROUP Point(const T_PUSH_EVALUATION& e)
{
    CFactList list(e);
    const T_PERF_POINT& p = *e.point;
    const T_PUSH_FACTORS& f = e.factors;
    const std::string g = N(f.gravity);
    list.Taken("Sd", "IDS_QM_FACT_SD", p.Sd, list.L(), "");
    list.Taken("Sa", "IDS_QM_FACT_SA", p.Sa, "g", "");
    list.Formula("D", "IDS_QM_FACT_D", p.D, list.L(), kAtcFactors, "Gamma Sd",
                 N(f.gamma) + " x " + N(p.Sd));
    list.Formula("V", "IDS_QM_FACT_V", p.V, list.F(), kAtcFactors, "alpha Sa M g",
                 N(f.alpha) + " x " + N(p.Sa) + " x " + N(f.mass) + " x " + g);
    list.Formula("Teff", "IDS_QM_FACT_TEFF", p.Teff, "s", kAtcFactors, "2 pi sqrt(Sd / (Sa g))",
                 "2 pi sqrt(" + N(p.Sd) + " / (" + N(p.Sa) + " x " + g + "))");
    if (p.damping)
        list.Taken("Deff", "IDS_QM_FACT_BETA_EFF", *p.damping, "%",
                   e.eval.method == PUSH_METHOD::Fema440 ? kFemaDamping : kAtcDamping);
    return {Say("IDS_QM_FACTS_POINT"), list.Take()};
}

void AddTargets(const T_PUSH_EVALUATION& e, std::vector<T_FACT_GROUP>& groups)
{
    for (std::size_t i = 0; i < e.targets.size(); ++i)
        if (e.targets[i].found) groups.push_back(Target(e, i));
    const bool ec8 = e.eval.method == PUSH_METHOD::Ec8Opcm;
    if (ec8 && !e.targets.empty() && e.targets[0].found) groups.push_back(SharesOfSd(e));
}

} // namespace

std::vector<T_FACT_GROUP> FactsOf(const T_PUSH_EVALUATION& e)
{
    if (e.capacity.Sd.empty()) return {};
    std::vector<T_FACT_GROUP> groups{EquivalentSystem(e)};
    if (e.IsTarget()) {
        if (e.bilinear) groups.push_back(BilinearCurve(e));
        AddTargets(e, groups);
        return groups;
    }
    if (const T_PERFPT_TRIAL* const trial = AnswerTrial(e)) groups.push_back(Trial(e, *trial));
    if (e.point) groups.push_back(Point(e));
    return groups;
}
