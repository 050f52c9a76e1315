// The model: overview, picture, sections, materials, nodes, elements, storeys.
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/document/reportmaker.h"
#include "qm_rps/generate/codehingerows.h"

namespace {

T_DOC_TEXT Overview(const T_REPORT_WORK& work)
{
    const T_MODEL& m = work.Model();
    constexpr double kUsualGravity = 9.80665; // m/s2
    const double g = FromSi(m.styp.gravity.value_or(kUsualGravity), work.Units(), kDimAccel);
    std::string text = Say("IDS_QM_REPORT_COUNTS", std::to_string(m.nodes.size()),
                           std::to_string(m.elements.size()), std::to_string(m.sections.size()),
                           std::to_string(m.materials.size()), std::to_string(m.storeys.size()));
    text += " " + Say("IDS_QM_REPORT_GRAVITY", FormatText("%.6g", g),
                      std::string(NameOf(work.Units().length)));
    if (m.styp.plane)
        text +=
            " " + Say("IDS_QM_REPORT_PLANE", kPlaneNames[static_cast<std::size_t>(*m.styp.plane)]);
    for (const auto* code : {&m.styp.designCodes.concrete, &m.styp.designCodes.steel})
        if (*code) text += " " + Say("IDS_QM_REPORT_DESIGN_CODE", **code);
    return DocText(text);
}

/// Sum of the lumped masses of free directions; nothing where no node has any.
void AddTotalMass(const T_REPORT_WORK& work, T_DOC_CHAPTER& to)
{
    std::array<double, 3> sum{};
    for (const auto& [id, node] : work.Model().nodes)
        for (std::size_t d = 0; d < sum.size(); ++d)
            sum[d] += node.mass[d];
    if (sum == std::array<double, 3>{}) return;
    const auto shown = [&](double si) {
        return FormatText("%.6g", FromSi(si, work.Units(), kDimMass));
    };
    to.blocks.emplace_back(
        DocText(Say("IDS_QM_REPORT_TOTAL_MASS", shown(sum[0]), shown(sum[1]), shown(sum[2]),
                    std::string(NameOf(work.Units().force)) + " s2/" +
                        std::string(NameOf(work.Units().length)))));
}

/// Properties that the analysis takes, those of shapes worked out. Zero: not given, or not in play.
T_TEXT_TABLE SectionValues(const T_REPORT_WORK& work)
{
    struct T_COLUMN {
        const char* head;
        T_DIM dim;
        double T_SECT_D::*value;
    };
    using S = T_SECT_D;
    constexpr T_COLUMN columns[] = {{"A", {0, 2}, &S::area},   {"Asy", {0, 2}, &S::Asy},
                                    {"Asz", {0, 2}, &S::Asz},  {"J", {0, 4}, &S::J},
                                    {"Iy", {0, 4}, &S::Iyy},   {"Iz", {0, 4}, &S::Izz},
                                    {"Wpl,y", {0, 3}, &S::Zy}, {"Wpl,z", {0, 3}, &S::Zz}};
    T_TEXT_TABLE table{{{Say("IDS_QM_UI_HEAD_NAME")}}, {}};
    for (const T_COLUMN& c : columns)
        table.columns.push_back(
            {std::string(c.head) + " (" + UnitText(c.dim, work.Units()) + ")", true});
    for (const auto& [key, section] : work.Model().sections) {
        auto& row = table.rows.emplace_back(std::vector<std::string>{section.name});
        T_SECT_D full;
        SECT_FAULT fault{};
        const bool sound = CSectionProperties::Calc(section, full, fault) != 0;
        for (const T_COLUMN& c : columns)
            row.push_back(sound && full.*c.value != 0.0
                              ? ReportNumber(FromSi(full.*c.value, work.Units(), c.dim))
                              : "-");
    }
    return table;
}

void AddSections(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    if (work.Model().sections.empty()) return;
    T_DOC_CHAPTER& part = chapter.parts.emplace_back();
    part.title = Say("IDS_QM_REPORT_SECTIONS");
    AddRecords(work, EXPLORER_TABLE::Sections, part);
    part.blocks.emplace_back(
        DocTable(Say("IDS_QM_REPORT_SECTION_VALUES"), SectionValues(work), work.limit));
    constexpr std::size_t kMostPictures = 24;
    std::size_t count = 0;
    for (const auto& [key, section] : work.Model().sections) {
        if (section.shape == SECT_SHAPE::Value || ++count > kMostPictures) continue;
        T_SECT_D shown;
        if (work.doc.Attr().GetSect(key, shown))
            part.blocks.emplace_back(
                T_DOC_PICTURE{section.name, T_SECTION_VIEW{shown, work.Units()}, kHalfPage});
    }
    if (count > kMostPictures)
        part.blocks.emplace_back(DocText(Say(
            "IDS_QM_REPORT_MORE_PICTURES", std::to_string(kMostPictures), std::to_string(count))));
}

/// Mean strengths and knowledge of existing materials.
T_TEXT_TABLE AssessedValues(const T_REPORT_WORK& work)
{
    const std::string unit = " (" + UnitText(kDimStress, work.Units()) + ")";
    T_TEXT_TABLE table{{{Say("IDS_QM_UI_HEAD_NAME")},
                        {"fc,m" + unit, true},
                        {"fy,m" + unit, true},
                        {"fyw,m" + unit, true},
                        {Say("IDS_QM_REPORT_KNOWLEDGE")},
                        {"CF", true}},
                       {}};
    const auto stress = [&](double si) {
        return si > 0.0 ? FormatText("%.6g", FromSi(si, work.Units(), kDimStress)) : "-";
    };
    for (const auto& [key, m] : work.Model().materials) {
        if (!m.mean && !m.knowledge && !m.confidence) continue;
        const T_MATL_MEAN mean = m.mean.value_or(T_MATL_MEAN{});
        table.rows.push_back(
            {m.name, stress(mean.fc), stress(mean.fy), stress(mean.fyw),
             m.knowledge ? kKnowledgeNames[static_cast<std::size_t>(*m.knowledge)] : "-",
             m.confidence ? FormatText("%.4g", *m.confidence) : "-"});
    }
    return table;
}

void AddMaterials(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    if (work.Model().materials.empty()) return;
    T_DOC_CHAPTER& part = chapter.parts.emplace_back();
    part.title = Say("IDS_QM_REPORT_MATERIALS");
    AddRecords(work, EXPLORER_TABLE::Materials, part);
    T_TEXT_TABLE assessed = AssessedValues(work);
    if (!assessed.rows.empty())
        part.blocks.emplace_back(
            DocTable(Say("IDS_QM_REPORT_ASSESSED"), std::move(assessed), work.limit));
}

/// The frame, with its numbers where they can be read.
void AddFrame(const T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    constexpr std::size_t kMostNumbers = 150;
    const bool numbers = work.Model().nodes.size() + work.Model().elements.size() <= kMostNumbers;
    chapter.blocks.emplace_back(
        T_DOC_PICTURE{Say(numbers ? "IDS_QM_REPORT_FRAME_NUMBERS" : "IDS_QM_REPORT_FRAME_PICTURE"),
                      T_FRAME_VIEW{numbers}});
}

} // namespace

void FillModelChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    chapter.blocks.emplace_back(Overview(work));
    if (!work.Model().elements.empty()) AddFrame(work, chapter);
    AddSections(work, chapter);
    AddMaterials(work, chapter);
    T_DOC_CHAPTER nodes{Say("IDS_QM_REPORT_GEOMETRY")};
    for (const EXPLORER_TABLE kind :
         {EXPLORER_TABLE::Nodes, EXPLORER_TABLE::Elements, EXPLORER_TABLE::Storeys})
        AddRecords(work, kind, nodes);
    AddTotalMass(work, nodes);
    if (!nodes.blocks.empty()) chapter.parts.push_back(std::move(nodes));
}
