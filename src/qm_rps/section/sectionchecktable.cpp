#include "qm_rps/section/sectionchecktable.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/generate/codehingerows.h"
#include "qm_rps/section/sectionexport.h"

#include <algorithm>

namespace {

constexpr std::array<const char*, 5> kChecked{"IDS_QM_SECK_AXIAL", "IDS_QM_SECK_BENDING",
                                              "IDS_QM_SECK_SHEAR_Y", "IDS_QM_SECK_SHEAR_Z",
                                              "IDS_QM_SECK_TORSION"};

std::string WhatText(const T_SECTION_WAY& way)
{
    return Say(kChecked[static_cast<std::size_t>(way.what)]);
}

std::string ByText(const T_SECTION_WAY& way)
{
    return way.by.empty() ? Say("IDS_QM_SECK_EXACT") : way.by;
}

std::string VerdictText(const T_SECTION_WAY& way)
{
    if (!way.ratio) return Say("IDS_QM_SECK_NOT_CHECKED", way.reason);
    return Say(way.IsExceeded() ? "IDS_QM_SECK_EXCEEDED" : "IDS_QM_SECK_KEPT");
}

} // namespace

T_TEXT_TABLE SectionWaysTable(const std::vector<T_SECTION_WAY>& ways)
{
    T_TEXT_TABLE t;
    t.columns = {{Say("IDS_QM_SECK_HEAD_WHAT")},
                 {Say("IDS_QM_SECK_HEAD_BY")},
                 {Say("IDS_QM_SECK_HEAD_RATIO"), true},
                 {Say("IDS_QM_SECK_HEAD_VERDICT")}};
    for (const T_SECTION_WAY& way : ways)
        t.rows.push_back({WhatText(way), ByText(way),
                          way.ratio ? FormatText("%.4g", *way.ratio) : std::string("-"),
                          VerdictText(way)});
    return t;
}

T_TEXT_TABLE SectionSetsTable(const T_SECTION_CHECK& check)
{
    T_TEXT_TABLE t = SectionWaysTable({});
    t.columns.insert(t.columns.begin(), {Say("IDS_QM_SECK_HEAD_SET")});
    for (const T_SECTION_CHECKS& set : check.sets)
        for (std::vector<std::string>& way : SectionWaysTable(set.ways).rows) {
            way.insert(way.begin(), set.forces.name);
            t.rows.push_back(std::move(way));
        }
    return t;
}

T_TEXT_TABLE SectionCheckTable(const T_SECTION_CHECK& check, const T_UNITS& units)
{
    T_TEXT_TABLE t;
    t.columns.push_back({Say("IDS_QM_SECK_HEAD_SET")});
    for (const T_SECTION_FORCE& force : kSectionForces)
        t.columns.push_back({HeadWithUnit(force.name, force.dim, units), true});
    const std::vector<T_TEXT_COLUMN> heads = SectionWaysTable({}).columns;
    t.columns.insert(t.columns.end(), heads.begin(), heads.end());
    for (const T_SECTION_CHECKS& set : check.sets)
        for (const std::vector<std::string>& way : SectionWaysTable(set.ways).rows) {
            std::vector<std::string>& row = t.rows.emplace_back(1, set.forces.name);
            for (const T_SECTION_FORCE& force : kSectionForces)
                row.push_back(
                    FormatText("%.6g", FromSi(set.forces.*force.value, units, force.dim) + 0.0));
            row.insert(row.end(), way.begin(), way.end());
        }
    return t;
}

std::vector<std::string> SectionCheckHead(const T_SECTION_CHECK& check, const T_UNITS& units)
{
    T_SECTION_ANSWER like; // its head is that of every answer on this section
    like.section = check.section, like.material = check.material;
    like.options = check.options, like.ofConcrete = check.ofConcrete;
    like.trace = check.trace, like.warnings = check.warnings;
    std::vector<std::string> lines = SectionHead(like, units);
    for (const T_SECTION_CHECKS& set : check.sets)
        for (const T_SECTION_WAY& way : set.ways)
            for (const T_CODE_WARNING& warning : way.warnings) {
                const std::string text = "! " + WarningText(warning);
                if (std::ranges::find(lines, text) == lines.end()) lines.push_back(text);
            }
    return lines;
}

std::vector<std::string> SectionCheckTrace(const T_SECTION_CHECK& check, const T_UNITS& units)
{
    std::vector<std::string> lines;
    for (const T_SECTION_CHECKS& set : check.sets) {
        for (const T_SECTION_WAY& way : set.ways) {
            lines.push_back(Say("IDS_QM_SECK_TRACE", set.forces.name, WhatText(way), ByText(way)));
            if (!way.ratio) lines.push_back("  " + VerdictText(way));
            for (const T_CODE_TRACE& line : way.trace)
                lines.push_back("  " + TraceLine(line, units));
        }
    }
    return lines;
}

T_TEXT_TABLE SectionCheckExport(const std::vector<T_SECTION_CHECK>& checks, const T_UNITS& units)
{
    T_TEXT_TABLE all;
    for (const T_SECTION_CHECK& check : checks)
        AppendOfSection(check.section, check.material, SectionCheckTable(check, units), all);
    return all;
}
