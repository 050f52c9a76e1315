// Unknown load factors: what was found, what holds it, and whether the structure agrees.
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/document/reportmaker.h"

#include <algorithm>

namespace {

// By the item's objective.
constexpr std::array kObjectiveTexts{"IDS_QM_REPORT_OBJECTIVE_LINEAR",
                                     "IDS_QM_REPORT_OBJECTIVE_SQUARE",
                                     "IDS_QM_REPORT_OBJECTIVE_MIN_MAX"};
constexpr double kMetTol = 1e-6; // of a row's scale, as of a constraint that is met

std::string Number(const std::optional<double>& value)
{
    return value ? FormatText("%.7g", *value + 0.0) : "-";
}

/// A word of the terminal at the head of a column.
std::string Head(const char* key)
{
    return Capital(Say(key));
}

T_TEXT_TABLE FactorTable(const T_ULF_RESULT& r)
{
    T_TEXT_TABLE table{{{Head(r.stage ? "IDS_QM_CLI_STAGE_CASE" : "IDS_QM_CLI_LOAD_CASE")},
                        {Say("IDS_QM_REPORT_KNOWN")},
                        {Head("IDS_QM_CLI_FACTOR") + " (-)", true}},
                       {}};
    for (std::size_t i = 0; i < r.cases.size(); ++i)
        table.rows.push_back({r.cases[i].name,
                              Say(r.cases[i].unknown ? "IDS_QM_CLI_UNKNOWN" : "IDS_QM_CLI_KNOWN"),
                              Number(UlfShownFactor(r, i))});
    return table;
}

T_DOC_TABLE ConstraintTable(const T_REPORT_WORK& work, const T_ULF_RESULT& r)
{
    T_TEXT_TABLE table{{{Head("IDS_QM_CLI_CONSTRAINT")},
                        {Head(r.linearForecast ? "IDS_QM_CLI_FORECAST" : "IDS_QM_CLI_VALUE"), true},
                        {Head("IDS_QM_CLI_LOWER"), true},
                        {Head("IDS_QM_CLI_UPPER"), true},
                        {Head("IDS_QM_CLI_MISSED_BY"), true},
                        {Head("IDS_QM_CLI_UNIT")},
                        {Head("IDS_QM_CLI_STATE")}},
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

/// The constraints on the structure analysed with the factors, beside what they were solved for.
T_DOC_TABLE CheckedTable(const T_REPORT_WORK& work, const T_SOLVED_ITEM& item)
{
    T_TEXT_TABLE table{{{Head("IDS_QM_CLI_CONSTRAINT")},
                        {Say("IDS_QM_REPORT_SOLVED"), true},
                        {Say("IDS_QM_REPORT_ANALYSED"), true},
                        {Say("IDS_QM_REPORT_DIFFERENCE"), true},
                        {Head("IDS_QM_CLI_LOWER"), true},
                        {Head("IDS_QM_CLI_UPPER"), true},
                        {Head("IDS_QM_CLI_UNIT")},
                        {Head("IDS_QM_CLI_STATE")}},
                       {}};
    std::vector<DOC_TONE> tones;
    const auto rows = UlfResultRows(*item.result);
    for (std::size_t i = 0; i < item.checked.rows.size(); ++i) {
        const T_ULF_ANALYSED& a = item.checked.rows[i];
        const double off = kMetTol * a.scale;
        const bool isMet = !(rows[i].lower && a.analysed < *rows[i].lower - off) &&
                           !(rows[i].upper && a.analysed > *rows[i].upper + off);
        table.rows.push_back({UlfNameAt(a.name, a.place), Number(a.Shown(a.forecast)),
                              Number(a.Shown(a.analysed)), Number(a.Shown(a.analysed - a.forecast)),
                              Number(rows[i].lower), Number(rows[i].upper), a.unit,
                              Say(isMet ? "IDS_QM_REPORT_MET" : "IDS_QM_CLI_NOT_MET")});
        tones.push_back(isMet ? DOC_TONE::Good : DOC_TONE::Bad);
    }
    T_DOC_TABLE out = DocTable(Say("IDS_QM_REPORT_CHECKED"), std::move(table), work.limit);
    out.tones = std::move(tones);
    out.tones.resize(out.table.rows.size());
    return out;
}

/// What the analysed structure says of the factors.
void AddChecked(T_REPORT_WORK& work, const T_SOLVED_ITEM& item, T_DOC_CHAPTER& part)
{
    if (!item.checked.why.empty()) {
        const std::string text = Say("IDS_QM_REPORT_NOT_CHECKED", item.checked.why);
        part.blocks.emplace_back(DocText(text, DOC_TONE::Warning));
        work.Remark(part.title, text);
        return;
    }
    T_DOC_TABLE table = CheckedTable(work, item);
    if (std::ranges::count(table.tones, DOC_TONE::Bad) > 0)
        work.Remark(part.title, Say("IDS_QM_REPORT_CHECK_MISSED"));
    part.blocks.emplace_back(std::move(table));
    part.blocks.emplace_back(DocText(
        Say(item.result->stage ? "IDS_QM_REPORT_CHECKED_STAGES" : "IDS_QM_REPORT_CHECKED_HOW")));
}

T_TEXT_TABLE StayTable(const T_REPORT_WORK& work, const std::vector<T_ULF_STAY>& stays)
{
    const std::string unit = " (" + std::string(NameOf(work.Units().force)) + ")";
    T_TEXT_TABLE table{{{Head("IDS_QM_CLI_ELEMENT"), true},
                        {Head("IDS_QM_CLI_LOAD_CASE")},
                        {Head("IDS_QM_CLI_STAY_START") + unit, true},
                        {Head("IDS_QM_CLI_FACTOR"), true},
                        {Head("IDS_QM_CLI_STAY_NOW") + unit, true},
                        {Head("IDS_QM_CLI_STAY_FORCE") + unit, true}},
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
            DocText(Say(kObjectiveTexts.at(static_cast<std::size_t>(r.item.objective)),
                        FormatText("%.6g", UlfObjective(r)))));
        if (!r.constraints.empty())
            part.blocks.emplace_back(
                T_DOC_PICTURE{Say("IDS_QM_REPORT_FACTORS_PICTURE", item.name),
                              T_FACTORS_VIEW{std::make_shared<const T_ULF_RESULT>(r)}});
        if (r.linearForecast) {
            part.blocks.emplace_back(DocText(Say("IDS_QM_ULF_LINEAR_FORECAST"), DOC_TONE::Warning));
            work.Remark(item.name, Say("IDS_QM_ULF_LINEAR_FORECAST"));
        }
        if (const std::string misses = UlfMisses(r); !misses.empty())
            work.Remark(item.name, Say("IDS_QM_CLI_NOT_MET") + ": " + misses);
        AddChecked(work, item, part);
        if (!item.stays.empty())
            part.blocks.emplace_back(
                DocTable(Say("IDS_QM_REPORT_STAYS"), StayTable(work, item.stays), work.limit));
        chapter.parts.push_back(std::move(part));
    }
}
