// Unknown load factors, construction stages, and the page of remarks.
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/document/reportmaker.h"

namespace {

std::string Number(const std::optional<double>& value)
{
    return value ? FormatText("%.7g", *value + 0.0) : "-";
}

T_TEXT_TABLE FactorTable(const T_ULF_RESULT& r)
{
    T_TEXT_TABLE table{{{Say(r.stage ? "IDS_QM_CLI_STAGE_CASE" : "IDS_QM_CLI_LOAD_CASE")},
                        {Say("IDS_QM_REPORT_KNOWN")},
                        {Say("IDS_QM_CLI_FACTOR"), true}},
                       {}};
    for (std::size_t i = 0; i < r.cases.size(); ++i)
        table.rows.push_back({r.cases[i].name,
                              Say(r.cases[i].unknown ? "IDS_QM_CLI_UNKNOWN" : "IDS_QM_CLI_KNOWN"),
                              Number(UlfShownFactor(r, i))});
    return table;
}

T_DOC_TABLE ConstraintTable(const T_REPORT_WORK& work, const T_ULF_RESULT& r)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_CLI_CONSTRAINT")},
                        {Say(r.linearForecast ? "IDS_QM_CLI_FORECAST" : "IDS_QM_CLI_VALUE"), true},
                        {Say("IDS_QM_CLI_LOWER"), true},
                        {Say("IDS_QM_CLI_UPPER"), true},
                        {Say("IDS_QM_CLI_MISSED_BY"), true},
                        {Say("IDS_QM_CLI_UNIT")},
                        {Say("IDS_QM_CLI_STATE")}},
                       {}};
    std::vector<DOC_TONE> tones;
    const auto rows = UlfResultRows(r);
    for (std::size_t i = 0; i < rows.size(); ++i) {
        const T_ULF_RESULT_ROW& row = rows[i];
        const double scale = UlfScale(r, i);
        table.rows.push_back({UlfNameAt(row.name, row.place), Number(UlfShown(row.value, scale)),
                              Number(row.lower), Number(row.upper),
                              Number(UlfShown(row.residual, scale)), row.unit,
                              !row.met     ? Say("IDS_QM_CLI_NOT_MET")
                              : row.active ? Say("IDS_QM_CLI_ACTIVE")
                                           : "-"});
        tones.push_back(row.met ? DOC_TONE::Plain : DOC_TONE::Bad);
    }
    T_DOC_TABLE out = DocTable(Say("IDS_QM_REPORT_CONSTRAINTS"), std::move(table), work.limit);
    out.tones = std::move(tones);
    out.tones.resize(out.table.rows.size());
    return out;
}

T_TEXT_TABLE StayTable(const T_REPORT_WORK& work, const std::vector<T_ULF_STAY>& stays)
{
    const std::string unit = " (" + std::string(NameOf(work.Units().force)) + ")";
    T_TEXT_TABLE table{{{Say("IDS_QM_CLI_ELEMENT"), true},
                        {Say("IDS_QM_CLI_LOAD_CASE")},
                        {Say("IDS_QM_CLI_STAY_START") + unit, true},
                        {Say("IDS_QM_CLI_FACTOR"), true},
                        {Say("IDS_QM_CLI_STAY_NOW") + unit, true},
                        {Say("IDS_QM_CLI_STAY_FORCE") + unit, true}},
                       {}};
    for (const T_ULF_STAY& s : stays)
        table.rows.push_back({std::to_string(s.element), s.load, Number(s.start),
                              Number(s.Factor()), Number(s.now), Number(s.force)});
    return table;
}

} // namespace

void FillFactorsChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    for (const T_SOLVED_ITEM& item : work.data.items) {
        T_DOC_CHAPTER part{item.name};
        if (!item.result) {
            part.blocks.emplace_back(DocText(item.fault, DOC_TONE::Bad));
            work.Remark(item.name, item.fault);
            chapter.parts.push_back(std::move(part));
            continue;
        }
        const T_ULF_RESULT& r = *item.result;
        part.blocks.emplace_back(
            DocTable(Say("IDS_QM_REPORT_FACTORS_TABLE"), FactorTable(r), work.limit));
        part.blocks.emplace_back(ConstraintTable(work, r));
        part.blocks.emplace_back(
            DocText(Say("IDS_QM_CLI_OBJECTIVE", FormatText("%.9g", UlfObjective(r)))));
        if (r.linearForecast) {
            part.blocks.emplace_back(DocText(Say("IDS_QM_ULF_LINEAR_FORECAST"), DOC_TONE::Warning));
            work.Remark(item.name, Say("IDS_QM_ULF_LINEAR_FORECAST"));
        }
        if (const std::string misses = UlfMisses(r); !misses.empty())
            work.Remark(item.name, Say("IDS_QM_CLI_NOT_MET") + ": " + misses);
        if (!item.stays.empty())
            part.blocks.emplace_back(
                DocTable(Say("IDS_QM_REPORT_STAYS"), StayTable(work, item.stays), work.limit));
        chapter.parts.push_back(std::move(part));
    }
}

void FillStagesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    if (work.Model().stages.empty()) return;
    chapter.blocks.emplace_back(RecordsTable(work.doc, EXPLORER_TABLE::Stages, work.limit));
    const T_STCT_D& control = work.Model().styp.stageControl;
    chapter.blocks.emplace_back(DocText(Say(
        "IDS_QM_REPORT_STAGE_CONTROL", kStageBirthNames[static_cast<std::size_t>(control.birth)],
        Say(control.geometricStiffness ? "IDS_QM_FACT_YES" : "IDS_QM_FACT_NO"),
        Say(control.cableSag ? "IDS_QM_FACT_YES" : "IDS_QM_FACT_NO"))));
}

void FillRemarksChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    chapter.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_ASSUMPTIONS")));
    if (work.remarks.empty()) {
        chapter.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_NO_REMARKS")));
        return;
    }
    chapter.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_ALL_REMARKS")));
    for (const std::string& remark : work.remarks)
        chapter.blocks.emplace_back(DocText(remark, DOC_TONE::Warning));
}
