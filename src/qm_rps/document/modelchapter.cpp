// What stands before any analysis: the model, its loads, its modes.
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

/// Sum of the lumped masses of free directions.
T_DOC_TEXT TotalMass(const T_REPORT_WORK& work)
{
    std::array<double, 3> sum{};
    for (const auto& [id, node] : work.Model().nodes)
        for (std::size_t d = 0; d < sum.size(); ++d)
            sum[d] += node.mass[d];
    const auto shown = [&](double si) {
        return FormatText("%.6g", FromSi(si, work.Units(), kDimMass));
    };
    return DocText(Say("IDS_QM_REPORT_TOTAL_MASS", shown(sum[0]), shown(sum[1]), shown(sum[2]),
                       std::string(NameOf(work.Units().force)) + " s2/" +
                           std::string(NameOf(work.Units().length))));
}

void AddTable(T_REPORT_WORK& work, EXPLORER_TABLE kind, T_DOC_CHAPTER& to)
{
    if (RecordCount(work.doc, kind) > 0)
        to.blocks.emplace_back(RecordsTable(work.doc, kind, work.limit));
}

/// Properties that the analysis takes, those of shapes worked out.
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
            row.push_back(sound ? FormatText("%.6g", FromSi(full.*c.value, work.Units(), c.dim))
                                : "-");
    }
    return table;
}

void AddSections(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    if (work.Model().sections.empty()) return;
    T_DOC_CHAPTER& part = chapter.parts.emplace_back();
    part.title = Say("IDS_QM_REPORT_SECTIONS");
    AddTable(work, EXPLORER_TABLE::Sections, part);
    part.blocks.emplace_back(
        DocTable(Say("IDS_QM_REPORT_SECTION_VALUES"), SectionValues(work), work.limit));
    constexpr double kWidth = 0.5;
    constexpr std::size_t kMostPictures = 24;
    std::size_t count = 0;
    for (const auto& [key, section] : work.Model().sections) {
        if (section.shape == SECT_SHAPE::Value || ++count > kMostPictures) continue;
        T_SECT_D shown;
        if (work.doc.Attr().GetSect(key, shown))
            part.blocks.emplace_back(
                T_DOC_PICTURE{section.name, T_SECTION_VIEW{shown, work.Units()}, kWidth});
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
    AddTable(work, EXPLORER_TABLE::Materials, part);
    T_TEXT_TABLE assessed = AssessedValues(work);
    if (!assessed.rows.empty())
        part.blocks.emplace_back(
            DocTable(Say("IDS_QM_REPORT_ASSESSED"), std::move(assessed), work.limit));
}

} // namespace

void FillModelChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    chapter.blocks.emplace_back(Overview(work));
    if (!work.Model().elements.empty())
        chapter.blocks.emplace_back(
            T_DOC_PICTURE{Say("IDS_QM_REPORT_FRAME_PICTURE"), T_FRAME_VIEW{}});
    AddSections(work, chapter);
    AddMaterials(work, chapter);
    T_DOC_CHAPTER nodes{Say("IDS_QM_REPORT_GEOMETRY")};
    for (const EXPLORER_TABLE kind :
         {EXPLORER_TABLE::Nodes, EXPLORER_TABLE::Elements, EXPLORER_TABLE::Storeys})
        AddTable(work, kind, nodes);
    if (!work.Model().nodes.empty()) nodes.blocks.emplace_back(TotalMass(work));
    if (!nodes.blocks.empty()) chapter.parts.push_back(std::move(nodes));
}

namespace {

/// A load of a case in one line.
T_TEXT_TABLE LoadRows(const T_REPORT_WORK& work, const T_STLD_D& c)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_LOAD")},
                        {Say("IDS_QM_REPORT_LOAD_AT")},
                        {Say("IDS_QM_REPORT_LOAD_VALUES")}},
                       {}};
    const std::string L(NameOf(work.Units().length)), F(NameOf(work.Units().force));
    const auto add = [&](const char* what, const char* where, int id, std::string values) {
        table.rows.push_back({Say(what), Say(where) + " " + std::to_string(id), std::move(values)});
    };
    const auto list = [](std::span<const double> values, std::span<const char* const> names,
                         const auto& unitOf) {
        std::string text;
        for (std::size_t i = 0; i < values.size(); ++i)
            if (values[i] != 0.0)
                text += (text.empty() ? "" : ", ") + std::string(names[i]) + " " +
                        FormatText("%.6g", values[i]) + " " + unitOf(i);
        return text.empty() ? std::string("0") : text;
    };
    const auto forceUnit = [&](std::size_t i) { return i < 3 ? F : F + " " + L; };
    const auto moveUnit = [&](std::size_t i) { return i < 3 ? L : std::string("rad"); };
    for (const T_NODAL_LOAD& l : c.nodal)
        add("IDS_QM_REPORT_NODAL_LOAD", "IDS_QM_NOUN_NODE", l.node,
            list(l.load, kReactionNames, forceUnit));
    for (const T_BEAM_LOAD& l : c.beam) {
        const std::string axes = kLoadAxesNames[static_cast<std::size_t>(l.axes)],
                          direction = kLoadDirectionNames[static_cast<std::size_t>(l.direction)];
        const bool spread = l.type == BEAM_LOAD_TYPE::Distributed;
        const std::string unit = spread                             ? F + "/" + L
                                 : l.type == BEAM_LOAD_TYPE::Moment ? F + " " + L
                                                                    : F;
        std::string values = kBeamLoadNames[static_cast<std::size_t>(l.type)] +
                             (" " + axes + " " + direction + ": ") + FormatText("%.6g", l.w[0]);
        if (spread && l.w[1] != l.w[0]) values += " ... " + FormatText("%.6g", l.w[1]);
        values += " " + unit;
        if (!spread)
            values += FormatText(" (x/L = %.4g)", l.at[0]);
        else if (l.at[0] != 0.0 || l.at[1] != 1.0)
            values += FormatText(" (x/L = %.4g ... %.4g)", l.at[0], l.at[1]);
        add("IDS_QM_REPORT_BEAM_LOAD", "IDS_QM_NOUN_ELEMENT", l.element, values);
    }
    for (const T_SETTLEMENT& l : c.settlement)
        add("IDS_QM_REPORT_SETTLEMENT", "IDS_QM_NOUN_NODE", l.node,
            list(l.displacement, kDirectionNames, moveUnit));
    for (const T_TEMPERATURE_LOAD& l : c.temperature)
        add("IDS_QM_REPORT_TEMPERATURE", "IDS_QM_NOUN_ELEMENT", l.element,
            FormatText("%.6g K", l.change));
    for (const T_PTNS_D& l : c.pretension)
        add("IDS_QM_REPORT_PRETENSION", "IDS_QM_NOUN_ELEMENT", l.element,
            FormatText("%.6g ", l.force) + F);
    return table;
}

} // namespace

void FillLoadsChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    AddTable(work, EXPLORER_TABLE::LoadCases, chapter);
    for (const int key : work.doc.Attr().GetStldKeys()) {
        T_STLD_D c;
        if (!work.doc.Attr().GetStld(key, c)) continue;
        T_TEXT_TABLE rows = LoadRows(work, c);
        if (!rows.rows.empty())
            chapter.blocks.emplace_back(DocTable(c.name, std::move(rows), work.limit));
    }
    AddTable(work, EXPLORER_TABLE::Combinations, chapter);
}

void FillModesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    if (work.Model().modes.empty()) return;
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_MODE"), true}, {"T (s)", true}, {"f (Hz)", true}}, {}};
    for (const char* const direction : kDirectionNames)
        table.columns.push_back({std::string("m ") + direction + " (%)", true});
    bool any = false;
    for (const auto& [number, mode] : work.Model().modes) {
        auto& row = table.rows.emplace_back(std::vector<std::string>{
            std::to_string(number), FormatText("%.5g", mode.period),
            mode.period > 0.0 ? FormatText("%.5g", 1.0 / mode.period) : "-"});
        any = any || mode.massPercent;
        for (std::size_t d = 0; d < 6; ++d)
            row.push_back(mode.massPercent ? FormatText("%.4g", (*mode.massPercent)[d]) : "-");
    }
    chapter.blocks.emplace_back(
        DocTable(Say("IDS_QM_REPORT_MODES_TABLE"), std::move(table), work.limit));
    if (!any) chapter.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_NO_MODAL_MASS")));
}
