#include "qm_rps/ulfcalculation.h"

#include "qm_base/finite.h"
#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulfstageproblem.h"
#include "qm_rps/factors/ulftexts.h"
#include "qm_rps/optdsgn.h"

using zql::lib::MMSGFunction;

namespace {

void SaveHistory(const std::string& text)
{
    GSaveHistoryFormatNF("%s", text.c_str());
}

T_FINDING Saying(const char* key, std::string text)
{
    T_FINDING said;
    said.ruleText = said.messageKey = key;
    said.text = std::move(text);
    return said;
}

/// The constraints of run.item, all of which are there: the rules of the item ask for them.
void ReadConstraints(CDBDoc& doc, T_ULF_RUN& run)
{
    for (const std::string& name : run.item.constraints) {
        T_ULFC_D constraint;
        if (!doc.Attr().GetUlfc_(name, constraint)) continue;
        run.units.push_back(UlfUnitText(constraint.type, constraint.component, doc.Unit().Units()));
        run.constraints.push_back(std::move(constraint));
    }
}

/// The optimizer's message with the name of the constraint or load case that it numbers.
std::string FailureText(const T_ULF_RUN& run, const std::string& sourceError)
{
    const T_OPT_ANSWER& a = run.answer;
    if (a.message.empty()) return sourceError;
    std::string name;
    if (a.constraint > 0)
        name = run.constraints[run.formed.owner[static_cast<std::size_t>(a.constraint - 1)]].name;
    else if (a.factor > 0)
        name = run.cases[run.formed.unknowns[static_cast<std::size_t>(a.factor - 1)]].name;
    return name.empty() ? a.message : a.message + " (" + name + ")";
}

/// The constraints that equations could not meet, if any.
std::optional<T_FINDING> MissesOf(const T_ULF_RESULT& result)
{
    const std::string names = UlfMisses(result);
    if (names.empty()) return std::nullopt;
    constexpr const char* key = "IDS_QM_ULF_NOT_MET";
    return Saying(key, MMSGFunction::Format(key, {names}));
}

/// Keeps the run, with its result or why there is none.
T_ULF_CALCULATION Finished(T_ULF_RUN run, bool solved, const std::string& sourceError)
{
    T_ULF_CALCULATION out;
    if (solved) out.result = UlfResultOf(run, run.answer.factors);
    if (out.result && !(IsFinite(*out.result) && IsFinite(UlfResultRows(*out.result)) &&
                        IsFinite(UlfObjective(*out.result)))) {
        constexpr const char* key = "IDS_QM_ULF_NOT_FINITE";
        out.result.reset();
        out.said = Saying(key, MMSGFunction::Format(key, {run.item.name}));
        SaveHistory(out.said->text);
    } else if (solved) {
        out.said = MissesOf(*out.result);
        SaveHistory(MMSGFunction::GetValue("IDS_RPS_Unknown_CAN_FIND_OPTIMIZED_SOLUTION"));
        if (out.said) SaveHistory(out.said->text);
    } else {
        constexpr const char* key = "IDS_RPS_Unknown_Load_Factor_Item_has_an_error";
        out.said =
            Saying(key, MMSGFunction::Format(key, {run.item.name, FailureText(run, sourceError)}));
        SaveHistory(MMSGFunction::GetValue("IDS_RPS_Unknown_CANNOT_FIND_OPTIMIZED_SOLUTION"));
    }
    out.run = std::move(run);
    return out;
}

} // namespace

T_ULF_CALCULATION CalculateUlf(CDBDoc& doc, const T_ULFI_D& item,
                               const std::vector<T_ULF_CASE>& cases, IUlfResponse& source,
                               const T_OPT_DUMP& dump)
{
    T_ULF_RUN run;
    run.item = item;
    run.cases = cases;
    ReadConstraints(doc, run);
    run.formed = FormUlfProblem(run.item, run.cases, run.constraints);
    COptDsgn optimizer(source);
    optimizer.m_dump = dump;
    const bool found = optimizer.Run(run.formed.problem, run.answer) != 0;
    const bool read = ReadUlfInfluence(run.cases, run.constraints, source, run.influence) != 0;
    return Finished(std::move(run), read && found, source.Error());
}

T_ULF_CALCULATION CalculateUlfStages(CDBDoc& doc, const T_ULSI_D& item, CUlfStageResponse& source,
                                     const T_OPT_DUMP& dump)
{
    T_ULF_RUN run;
    run.item = {item.name,       0, item.objective, item.sign, item.solveByEquations, {},
                item.constraints};
    for (const T_ULSI_ROW& row : item.rows)
        run.cases.push_back(
            {row.loadCase, UlfStageRowText(doc.Data(), row), row.factor, row.unknown, row.weight});
    ReadConstraints(doc, run);
    for (const T_ULFC_D& c : run.constraints)
        run.places.push_back(UlfPlaceText(doc.Data(), c.stage, c.step));
    const T_STCT_D& control = doc.Data().Model().styp.stageControl;
    run.linearForecast = control.geometricStiffness || control.cableSag;
    T_ULF_STAGE_FORMED formed = FormUlfStageProblem(item, run.constraints);
    source.m_loads = formed.loads;
    source.m_sumStageLoads = item.sumStageLoads;
    run.formed = std::move(formed);
    COptDsgn optimizer(source, &source);
    optimizer.m_dump = dump;
    const bool found = optimizer.Run(run.formed.problem, run.answer) != 0;
    const bool read = ReadUlfStageInfluence(item, run.formed, source, run.influence) != 0;
    return Finished(std::move(run), read && found, source.Error());
}
