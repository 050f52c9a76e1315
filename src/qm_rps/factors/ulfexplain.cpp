#include "qm_rps/factors/ulfexplain.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/factors/ulftexts.h"
#include "qm_solver/ulfdiagnosis.h"

#include <algorithm>
#include <cmath>

using zql::lib::MMSGFunction;

namespace {

using LIMIT = T_ULF_HOLD::LIMIT;

std::string Number(double value)
{
    return FormatText("%.6g", value);
}

/// The limit of a row of the system, in the user's terms.
struct T_PLACE_OF_ROW {
    const T_ULFC_D* constraint;
    LIMIT limit;
    double value;
};

class CExplainer {
public:
    CExplainer(const T_ULF_RUN& run, const T_UNITS& units, T_ULF_EXPLAINED& out)
        : m_run(run), m_units(units), m_out(out), m_system(run.answer.system)
    {
    }

    int Run(const std::function<bool(int, int)>& progress)
    {
        if (!Examine()) return 0;
        if (m_run.answer.message.empty() && ExplainSolution()) {
            TellSolution();
        } else {
            ExplainFailure(progress);
            TellFailure();
        }
        TellMatrix();
        if (m_run.linearForecast) Tell("IDS_QM_ULF_LINEAR_FORECAST", {});
        return 1;
    }

private:
    T_ULF_PROBLEM Problem(int sign) const
    {
        return {m_system.nvar, m_system.neq,     m_system.matrix,
                m_system.rhs,  m_system.weights, m_run.formed.problem.iobj,
                sign};
    }
    const std::string& CaseName(int unknown) const
    {
        return m_run.cases[m_run.formed.unknowns[static_cast<std::size_t>(unknown)]].name;
    }
    T_PLACE_OF_ROW PlaceOf(int row) const
    {
        const auto at = static_cast<std::size_t>(row);
        const auto record = static_cast<std::size_t>(m_system.order[at]);
        const T_ULFC_D& c = m_run.constraints[m_run.formed.owner[record]];
        switch (m_system.relations[at]) {
        case -1:
            return {&c, LIMIT::Upper, c.upper.value_or(0.0)};
        case 1:
            return {&c, LIMIT::Lower, c.lower.value_or(0.0)};
        default:
            return {&c, LIMIT::Target, c.compareWithValue ? c.value : 0.0};
        }
    }
    std::string UnitOf(const T_ULFC_D& c) const
    {
        return UlfUnitText(c.type, c.component, m_units);
    }

    /// 1 % of a limit, or of the largest term of its row where the limit is 0.
    double PartOf(int row, double limit, const std::vector<double>& factors) const;
    int Examine();
    int ExplainSolution();
    void ExplainFailure(const std::function<bool(int, int)>& progress);
    void TellSolution();
    void TellFailure();
    void TellMatrix();
    void Tell(const char* key, std::initializer_list<std::string_view> args)
    {
        m_out.lines.push_back(MMSGFunction::Format(key, args));
    }

    const T_ULF_RUN& m_run;
    const T_UNITS& m_units;
    T_ULF_EXPLAINED& m_out;
    const T_OPT_SYSTEM& m_system;
};

int CExplainer::Examine()
{
    T_ULF_MATRIX matrix;
    if (m_system.nvar == 0 || !CUlfDiagnosis().Examine(Problem(0), matrix)) return 0;
    m_out.unknowns = m_system.nvar;
    m_out.rows = m_system.ncon;
    m_out.rank = matrix.rank;
    m_out.condition = matrix.condition;
    for (const int unknown : matrix.unfelt)
        m_out.unfelt.push_back(CaseName(unknown));
    return 1;
}

double CExplainer::PartOf(int row, double limit, const std::vector<double>& factors) const
{
    constexpr double kPart = 0.01;
    double size = std::fabs(limit);
    const bool isZero = !(size > 0.0);
    for (std::size_t j = 0; isZero && j < factors.size(); ++j) {
        const double entry = m_system.matrix[static_cast<std::size_t>(row) * factors.size() + j];
        size = std::max(size, std::fabs(entry * factors[j]));
    }
    return kPart * size;
}

int CExplainer::ExplainSolution()
{
    // Equations are solved without the sign restriction, which only judges their factors.
    const int sign = m_run.answer.exact ? 0 : m_run.formed.problem.isign;
    T_ULF_EXPLANATION e;
    if (!CUlfDiagnosis().Explain(Problem(sign), e)) return 0;
    m_out.solved = true;
    m_out.objective = e.objective;
    for (const T_ULF_HELD& row : e.rows) {
        const T_PLACE_OF_ROW place = PlaceOf(row.index);
        // A lower bound was handed over turned round.
        const double turn = place.limit == LIMIT::Lower ? -1.0 : 1.0;
        T_ULF_HOLD hold{place.constraint->name, place.limit, place.value, UnitOf(*place.constraint),
                        turn * row.multiplier};
        const bool isTurned = place.limit == LIMIT::Lower;
        hold.raised = isTurned ? row.lowered : row.raised;
        hold.lowered = isTurned ? row.raised : row.lowered;
        hold.part = PartOf(row.index, place.value, e.factors);
        m_out.held.push_back(std::move(hold));
    }
    for (const T_ULF_HELD& held : e.signs)
        m_out.held.push_back({CaseName(held.index), LIMIT::Sign, 0.0, {}, -held.multiplier});
    return 1;
}

void CExplainer::ExplainFailure(const std::function<bool(int, int)>& progress)
{
    const T_ULF_PROBLEM problem = Problem(m_run.formed.problem.isign);
    const T_ULF_CONFLICT conflict = CUlfDiagnosis().Conflict(problem, progress);
    m_out.contradicts = conflict.state == ULF_CONFLICT::Found;
    m_out.cancelled = conflict.state == ULF_CONFLICT::Cancelled;
    m_out.notProved = conflict.state == ULF_CONFLICT::NotProved;
    if (m_out.contradicts) {
        for (const int row : conflict.rows) {
            const T_PLACE_OF_ROW place = PlaceOf(row);
            m_out.conflict.push_back(
                {place.constraint->name, place.limit, place.value, UnitOf(*place.constraint)});
        }
        m_out.conflictWithSign = conflict.sign;
    }
    T_ULF_COMPROMISE compromise;
    if (conflict.state != ULF_CONFLICT::Solvable && CUlfDiagnosis().Compromise(problem, compromise))
        m_out.compromise = UlfResultOf(m_run, compromise.factors);
}

/// "D5 (upper bound 0.01 m)"
std::string LimitText(const std::string& name, LIMIT limit, double value, const std::string& unit)
{
    constexpr std::array<const char*, 3> keys{"IDS_QM_ULF_TARGET_OF", "IDS_QM_ULF_UPPER_OF",
                                              "IDS_QM_ULF_LOWER_OF"};
    return MMSGFunction::Format(keys.at(static_cast<std::size_t>(limit)),
                                {name, Number(value), unit});
}

void CExplainer::TellSolution()
{
    Tell("IDS_QM_ULF_OBJECTIVE_IS", {Number(m_out.objective)});
    if (m_out.held.empty()) Tell("IDS_QM_ULF_HELD_BY_NOTHING", {});
    for (const T_ULF_HOLD& h : m_out.held) {
        if (h.limit == LIMIT::Sign) {
            Tell("IDS_QM_ULF_HELD_BY_SIGN", {h.name, Number(h.multiplier)});
            continue;
        }
        const std::string limit = LimitText(h.name, h.limit, h.value, h.unit);
        const auto change = [&](const std::optional<double>& price) {
            return price ? FormatText("%+.4g", *price * h.part + 0.0)
                         : MMSGFunction::GetValue("IDS_QM_ULF_NO_SOLUTION_LEFT");
        };
        const bool isZero = !(std::fabs(h.value) > 0.0);
        Tell(isZero ? "IDS_QM_ULF_HELD_AT_ZERO" : "IDS_QM_ULF_HELD",
             {limit, Number(h.part), h.unit, change(h.raised), change(h.lowered)});
    }
}

void CExplainer::TellFailure()
{
    if (!m_run.answer.message.empty()) m_out.lines.push_back(m_run.answer.message);
    if (m_out.contradicts) {
        std::string members;
        for (const T_ULF_CLASH& c : m_out.conflict)
            members += (members.empty() ? "" : ", ") + LimitText(c.name, c.limit, c.value, c.unit);
        if (m_out.conflictWithSign)
            members += (members.empty() ? "" : ", ") +
                       MMSGFunction::GetValue("IDS_QM_ULF_SIGN_RESTRICTION");
        Tell("IDS_QM_ULF_CONFLICT", {members});
    } else if (!m_out.cancelled) {
        Tell(m_out.notProved ? "IDS_QM_ULF_NOT_PROVED" : "IDS_QM_ULF_NO_CONFLICT", {});
    }
    if (!m_out.compromise) return;
    std::string factors;
    for (const std::size_t at : m_run.formed.unknowns)
        factors += (factors.empty() ? "" : ", ") + m_run.cases[at].name + " = " +
                   Number(m_out.compromise->factors[at]);
    std::string misses;
    const std::vector<T_ULF_RESULT_ROW> rows = UlfResultRows(*m_out.compromise);
    for (std::size_t i = 0; i < rows.size(); ++i)
        if (!rows[i].met)
            misses += (misses.empty() ? "" : ", ") + rows[i].name + " " +
                      FormatText("%+.6g", rows[i].residual) + " " + UnitOf(m_run.constraints[i]);
    Tell("IDS_QM_ULF_COMPROMISE", {factors, misses});
}

void CExplainer::TellMatrix()
{
    Tell("IDS_QM_ULF_RANK", {std::to_string(m_out.rows), std::to_string(m_out.unknowns),
                             std::to_string(m_out.rank), Number(m_out.condition)});
    constexpr double kPoor = 1e8; // half of the digits of a double are gone
    if (m_out.condition > kPoor) Tell("IDS_QM_ULF_POOR_CONDITION", {});
    for (const std::string& name : m_out.unfelt)
        Tell("IDS_QM_ULF_UNFELT", {name});
}

} // namespace

int ExplainUlf(const T_ULF_RUN& run, const T_UNITS& units, T_ULF_EXPLAINED& out,
               const std::function<bool(int, int)>& progress)
{
    T_ULF_EXPLAINED made;
    if (!CExplainer(run, units, made).Run(progress)) return 0;
    out = std::move(made);
    return 1;
}
