#include "section/sectioncommands.h"

#include "console/tabletext.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/section/sectionexport.h"

#ifdef QM_UI
#include "qm_ui/section/sectionplot.h"
#endif

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <numbers>

namespace {

constexpr T_DIM kDimCurvature{0, -1};

template <class E, std::size_t N>
E NamedIn(const std::array<const char*, N>& names, const std::string& name)
{
    return static_cast<E>(std::ranges::find(names, name) - names.begin());
}

T_SECTION_REQUEST RequestOf(const T_SECTION_COMMAND& c, const T_UNITS& units)
{
    T_SECTION_REQUEST r;
    r.task = c.task;
    r.options = SectionOptionsOf(c);
    if (!c.directions.empty()) r.directions.clear();
    for (const double degrees : c.directions)
        r.directions.push_back(degrees * std::numbers::pi / 180.0);
    for (const double axial : c.axial)
        r.axial.push_back(ToSi(axial, units, kDimForce));
    r.ofMoment = c.ofMoment;
    r.points = static_cast<std::size_t>(std::max(0, c.points));
    r.maxCurvature = ToSi(c.maxCurvature, units, kDimCurvature);
    return r;
}

/// Pairs of one section: with the material that was named, or with those it has in the model.
EXIT_CODE PairsOf(const T_MODEL& model, const T_SECTION_COMMAND& c, const std::string& name,
                  int material, std::vector<T_SECTION_PAIR>& out)
{
    const int section = SectionKey(model, name);
    if (!section)
        return Complain(EXIT_CODE::Usage, c.file + ": " + Say("IDS_QM_SECC_NO_SECTION", name));
    if (material) {
        out.push_back({section, material});
        return EXIT_CODE::Done;
    }
    const std::size_t before = out.size();
    for (const T_SECTION_PAIR& pair : SectionPairs(model))
        if (pair.section == section) out.push_back(pair);
    return out.size() > before
               ? EXIT_CODE::Done
               : Complain(EXIT_CODE::Usage, c.file + ": " + Say("IDS_QM_SECC_UNUSED", name));
}

void AppendTable(const T_TEXT_TABLE& table, std::string& text)
{
    if (table.columns.empty()) return;
    T_TABLE_ROWS rows(1);
    for (const T_TEXT_COLUMN& column : table.columns)
        rows.front().push_back(column.head);
    rows.insert(rows.end(), table.rows.begin(), table.rows.end());
    text += TableText(rows);
}

std::optional<double> LargestResidual(const T_SECTION_ANSWER& answer)
{
    std::optional<double> largest;
    const auto take = [&](const T_SECTION_STATE& s) {
        if (s.residual) largest = std::max(largest.value_or(0.0), *s.residual);
    };
    for (const T_SECTION_CAPACITY_AT& c : answer.capacities)
        take(c.at);
    for (const T_SECTION_CURVATURE& c : answer.curvatures) {
        take(c.yield);
        take(c.ultimate);
    }
    return largest;
}

std::string Text(const T_SECTION_ANSWER& answer, bool table, const T_UNITS& units)
{
    std::string text;
    for (const std::string& line : SectionHead(answer, units))
        text += line + "\n";
    AppendTable(SectionStates(answer, units), text);
    if (table || SectionStates(answer, units).columns.empty())
        AppendTable(SectionPoints(answer, units), text);
    if (const std::optional<double> residual = LargestResidual(answer))
        text += Say("IDS_QM_SECC_RESIDUAL", FormatText("%.2g", *residual)) + "\n";
    return text + "\n";
}

EXIT_CODE WriteAll(const T_SECTION_COMMAND& c, const std::vector<T_SECTION_ANSWER>& answers,
                   const T_UNITS& units)
{
    EXIT_CODE code = EXIT_CODE::Done;
    if (!c.json.empty()) code = WriteOutput(c.json, SectionJson(answers, units));
    if (code == EXIT_CODE::Done && !c.csv.empty())
        code = WriteOutput(c.csv, TableCsv(SectionExport(answers, units)));
    if (code == EXIT_CODE::Done && !c.sheet.empty()) {
        T_FILE_ERROR error;
        if (!WriteSheet(c.sheet, TableSheet(SectionExport(answers, units)), error))
            code = ReportFileError(error);
    }
#ifdef QM_UI
    if (code == EXIT_CODE::Done && !c.plot.empty())
        code = WritePicture(SectionPlot(answers.front(), units), c.plot);
#endif
    return code;
}

/// The sections that are meant, with their materials. Usage and BadInput are told.
EXIT_CODE FindSectionPairs(const T_MODEL& model, const T_SECTION_COMMAND& c,
                           std::vector<T_SECTION_PAIR>& out)
{
    int material = 0;
    if (!c.material.empty() && !(material = MaterialKey(model, c.material)))
        return Complain(EXIT_CODE::Usage,
                        c.file + ": " + Say("IDS_QM_SECC_NO_MATERIAL", c.material));
    for (const std::string& name : c.sections)
        if (const EXIT_CODE code = PairsOf(model, c, name, material, out); code != EXIT_CODE::Done)
            return code;
    if (c.sections.empty()) {
        out = SectionPairs(model);
        if (material)
            std::erase_if(out, [&](const T_SECTION_PAIR& p) { return p.material != material; });
    }
    return out.empty() ? Complain(EXIT_CODE::BadInput, c.file + ": " + Say("IDS_QM_SECC_NONE"))
                       : EXIT_CODE::Done;
}

} // namespace

T_SECTION_OPTIONS SectionOptionsOf(const T_SECTION_COMMAND& c)
{
    T_SECTION_OPTIONS o = c.options;
    o.values = NamedIn<SECTION_VALUES>(kSectionValueNames, c.values);
    o.law = NamedIn<SECTION_LAW>(kSectionLawNames, c.law);
    o.core = NamedIn<SECTION_CORE>(kSectionCoreNames, c.confined);
    return o;
}

EXIT_CODE OverSections(const T_SECTION_COMMAND& c, const std::vector<T_OUTPUT>& outputs,
                       CDBDoc& doc, const SECTION_PREPARE_FN& prepare, const SECTION_DO_FN& each)
{
    if (const EXIT_CODE code = CheckOutputs(c.file, outputs, c.overwrite); code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = OpenInput(doc, c.file); code != EXIT_CODE::Done) return code;
    const T_MODEL& model = doc.Data().Model();
    std::vector<T_SECTION_PAIR> pairs;
    if (const EXIT_CODE code = FindSectionPairs(model, c, pairs); code != EXIT_CODE::Done)
        return code;
    if (const EXIT_CODE code = prepare(pairs); code != EXIT_CODE::Done) return code;
    for (std::size_t i = 0; i < pairs.size(); ++i) {
        const T_SECT_D& section = model.sections.at(pairs[i].section);
        const T_MATL_D& material = model.materials.at(pairs[i].material);
        std::string why;
        if (!each(i, section, material, why))
            return Complain(EXIT_CODE::BadInput,
                            c.file + ": " +
                                Say("IDS_QM_SECC_IN", section.name, material.name, why));
    }
    return EXIT_CODE::Done;
}

EXIT_CODE RunSection(const T_SECTION_COMMAND& c)
{
    if (const EXIT_CODE code = CheckPlotName(c.plot); code != EXIT_CODE::Done) return code;
    CDBDoc doc;
    T_SECTION_REQUEST request;
    std::vector<T_SECTION_ANSWER> answers;
    const EXIT_CODE code = OverSections(
        c,
        {{c.json, OUTPUT_KIND::Json},
         {c.csv, OUTPUT_KIND::Text},
         {c.sheet, OUTPUT_KIND::Sheet},
         {c.plot, OUTPUT_KIND::Picture}},
        doc,
        [&](std::vector<T_SECTION_PAIR>& pairs) {
            if (!c.plot.empty() && pairs.size() > 1)
                return Complain(EXIT_CODE::Usage, Say("IDS_QM_SECC_ONE_PICTURE"));
            request = RequestOf(c, doc.Unit().Units());
            return EXIT_CODE::Done;
        },
        [&](std::size_t, const T_SECT_D& section, const T_MATL_D& material, std::string& why) {
            return CalcSection(section, material, request, doc.Unit().Units(),
                               answers.emplace_back(), why);
        });
    if (code != EXIT_CODE::Done) return code;
    const T_UNITS units = doc.Unit().Units();
    if (c.json != "-" && c.csv != "-") {
        std::string text;
        for (const T_SECTION_ANSWER& answer : answers)
            text += Text(answer, c.table, units);
        text += Say("IDS_QM_SECC_SIGNS") + "\n";
        std::fwrite(text.data(), 1, text.size(), stdout);
    }
    return WriteAll(c, answers, units);
}
