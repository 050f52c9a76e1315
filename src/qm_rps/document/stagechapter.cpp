// Construction stages with what the structure does at each, and the page of remarks.
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/document/reportmaker.h"
#include "qm_rps/factors/ulfstanding.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <set>

namespace {

// By STAGE_BIRTH.
constexpr std::array kBirthTexts{"IDS_QM_REPORT_BIRTH_DEFORMED", "IDS_QM_REPORT_BIRTH_DESIGN"};

void SelectEnd(CDBDoc& doc, int stage)
{
    doc.Post().SelectStage(stage, kStageLastStep, kStageLoadSum);
}

/// The largest displacement in a direction and its node.
struct T_EXTREME {
    double value = 0.0;
    int node = 0;

    void Take(double other, int id)
    {
        if (node == 0 || std::fabs(other) > std::fabs(value)) *this = {other, id};
    }
    /// "-0.0123 (12)"; "0": nothing beside the largest of all.
    std::string Text(double largest) const
    {
        constexpr double kNothing = 1e-9; // of it: what rounding has left
        if (node == 0 || std::fabs(value) <= kNothing * largest) return "0";
        return FormatText("%.6g (%d)", value, node);
    }
};
using T_EXTREMES = std::array<T_EXTREME, 3>;

/// Of all that stands at the end of a stage; fault: why they are not known.
T_EXTREMES ExtremesOf(T_REPORT_WORK& work, int stage, std::string& fault)
{
    T_EXTREMES extremes;
    SelectEnd(work.doc, stage);
    for (const int node : StandingAt(work.Model(), stage).nodes) {
        T_DOF6 value{};
        if (!work.doc.Post().GetDspcNew(node, value)) fault = work.doc.Post().Error();
        for (std::size_t d = 0; d < extremes.size(); ++d)
            extremes[d].Take(value[d], node);
    }
    return extremes;
}

/// A row for each stage, a column for each direction in which something moves.
T_TEXT_TABLE DisplacementCells(T_REPORT_WORK& work, std::string& fault)
{
    std::vector<T_EXTREMES> stages;
    std::array<double, 3> most{};
    for (const auto& [key, stage] : work.Model().stages) {
        stages.push_back(ExtremesOf(work, key, fault));
        for (std::size_t d = 0; d < most.size(); ++d)
            most[d] = std::max(most[d], std::fabs(stages.back()[d].value));
    }
    const double largest = std::ranges::max(most);
    const std::string unit = " (" + std::string(NameOf(work.Units().length)) + ")";
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_STAGE")}}, {}};
    for (const auto& [key, stage] : work.Model().stages)
        table.rows.push_back({stage.name});
    for (std::size_t d = 0; d < most.size(); ++d) {
        if (T_EXTREME{most[d], 1}.Text(largest) == "0") continue;
        table.columns.push_back({kDirectionNames[d] + unit, true});
        for (std::size_t i = 0; i < stages.size(); ++i)
            table.rows[i].push_back(stages[i][d].Text(largest));
    }
    return table;
}

/// Trusses and beams that a load case of the stages tensions.
std::vector<int> TensionedElements(const T_MODEL& model)
{
    std::set<int> elements;
    for (const auto& [key, stage] : model.stages)
        for (const T_STAG_LOAD& load : stage.activate.loads) {
            const auto c = model.loadCases.find(load.loadCase);
            if (c == model.loadCases.end()) continue;
            for (const T_PTNS_D& tension : c->second.pretension)
                elements.insert(tension.element);
        }
    return {elements.begin(), elements.end()};
}

std::optional<double> AxialForce(CDBDoc& doc, const T_ELEM_D& element)
{
    double axial = 0.0;
    if (element.kind == ELEM_KIND::Truss)
        return doc.Post().GetStrtcNew(element.id, axial) ? std::optional(axial) : std::nullopt;
    T_DOF6 forces{};
    return doc.Post().GetStrbcNew(element.id, 0, forces) ? std::optional(forces[0]) : std::nullopt;
}

/// Axial forces of tensioned elements at the end of each stage; "-" where one does not stand.
T_TEXT_TABLE ForceCells(T_REPORT_WORK& work, const std::vector<int>& elements)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_STAGE")}}, {}};
    for (const int element : elements)
        table.columns.push_back({std::to_string(element), true});
    for (const auto& [key, stage] : work.Model().stages) {
        const T_STANDING standing = StandingAt(work.Model(), key);
        SelectEnd(work.doc, key);
        auto& row = table.rows.emplace_back(std::vector{stage.name});
        for (const int id : elements) {
            const auto element = work.Model().elements.find(id);
            const bool stands =
                element != work.Model().elements.end() && standing.elements.contains(id);
            const auto force = stands ? AxialForce(work.doc, element->second) : std::nullopt;
            row.push_back(force ? FormatText("%.6g", *force + 0.0) : "-");
        }
    }
    return table;
}

void AddResults(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    std::string fault = work.data.stageFault;
    T_TEXT_TABLE displacements;
    if (fault.empty()) displacements = DisplacementCells(work, fault);
    if (!fault.empty()) {
        chapter.blocks.emplace_back(DocText(fault, DOC_TONE::Warning));
        work.Remark(chapter.title, fault);
        return;
    }
    chapter.blocks.emplace_back(
        DocTable(Say("IDS_QM_REPORT_STAGE_DISPLACEMENTS"), std::move(displacements), work.limit));
    const std::vector<int> elements = TensionedElements(work.Model());
    if (elements.empty()) return;
    chapter.blocks.emplace_back(
        DocTable(Say("IDS_QM_REPORT_STAGE_FORCES", std::string(NameOf(work.Units().force))),
                 ForceCells(work, elements), work.limit));
}

} // namespace

void FillStagesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    if (work.Model().stages.empty()) return;
    AddRecords(work, EXPLORER_TABLE::Stages, chapter);
    const T_STCT_D& control = work.Model().styp.stageControl;
    chapter.blocks.emplace_back(DocText(Say(
        "IDS_QM_REPORT_STAGE_CONTROL", Say(kBirthTexts[static_cast<std::size_t>(control.birth)]),
        Say(control.geometricStiffness ? "IDS_QM_FACT_YES" : "IDS_QM_FACT_NO"),
        Say(control.cableSag ? "IDS_QM_FACT_YES" : "IDS_QM_FACT_NO"))));
    AddResults(work, chapter);
}

void FillRemarksChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    for (const auto& [where, text] : work.data.findings)
        work.Remark(where, text);
    chapter.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_ASSUMPTIONS")));
    if (work.remarks.empty()) {
        chapter.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_NO_REMARKS")));
        return;
    }
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_WARNING")}, {Say("IDS_QM_REPORT_WARNING_AT")}}, {}};
    for (const T_REPORT_REMARK& remark : work.remarks) {
        std::string places;
        for (const std::string& where : remark.where)
            places += (places.empty() ? "" : "; ") + where;
        table.rows.push_back({remark.text, places.empty() ? "-" : places});
    }
    T_DOC_TABLE all = DocTable(Say("IDS_QM_REPORT_ALL_REMARKS"), std::move(table), {0});
    all.tones.assign(work.remarks.size(), DOC_TONE::Warning);
    chapter.blocks.emplace_back(std::move(all));
}
