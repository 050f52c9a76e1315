#include "section/sectioncheckcommand.h"

#include "analysecommands.h"
#include "analysis/analysisresults.h"
#include "console/tabletext.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/section/forcesets.h"
#include "qm_rps/section/sectionchecktable.h"
#include "qm_rps/section/sectionexport.h"
#include "json/tracejson.h"

#include <algorithm>
#include <cstdio>
#include <iterator>

namespace {

/// A set for each value of the longest list; lists of another length than that and 1 are refused.
EXIT_CODE ReadForces(const T_SECTION_CHECK_COMMAND& c, const T_UNITS& units,
                     std::vector<T_SECTION_FORCES>& out)
{
    const std::size_t count = std::ranges::max(c.forces, {}, &std::vector<double>::size).size();
    for (std::size_t k = 0; k < c.forces.size(); ++k) {
        const std::size_t size = c.forces[k].size();
        if (size > 1 && size != count)
            return Complain(EXIT_CODE::Usage,
                            Say("IDS_QM_SECK_SETS", std::string("--") + kSectionForceNames[k],
                                std::to_string(size), std::to_string(count)));
    }
    for (std::size_t i = 0; i < count; ++i) {
        T_SECTION_FORCES& forces = out.emplace_back();
        forces.name = std::to_string(i + 1);
        for (std::size_t k = 0; k < c.forces.size(); ++k)
            if (const std::vector<double>& list = c.forces[k]; !list.empty())
                forces.*kSectionForces[k].value =
                    ToSi(list[list.size() > 1 ? i : 0], units, kSectionForces[k].dim);
    }
    return EXIT_CODE::Done;
}

/// The sets of the file behind those of the options.
EXIT_CODE ReadFile(const T_SECTION_CHECK_COMMAND& c, const T_UNITS& units,
                   std::vector<T_SECTION_FORCES>& out)
{
    std::string text, reason;
    T_FILE_ERROR error;
    std::vector<T_SECTION_FORCES> sets;
    if (!CFileCtrl::ReadWholeFile(c.forcesFile, text, error)) return ReportFileError(error);
    if (!ReadForceSets(text, units, sets, reason))
        return Complain(EXIT_CODE::BadInput, c.forcesFile + ": " + reason);
    out.insert(out.end(), sets.begin(), sets.end());
    return EXIT_CODE::Done;
}

/// Analyses the load cases; their forces in the elements whose section is meant.
EXIT_CODE ReadResults(const T_SECTION_CHECK_COMMAND& c, CDBDoc& doc,
                      const std::vector<T_SECTION_PAIR>& meant, std::vector<T_SECTION_JOB>& jobs)
{
    const auto elements = ParseElementList(c.elements);
    if (!elements)
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_ELEMENT_LIST", c.elements));
    std::vector<T_SHOWN_CASE> shown;
    std::vector<int> keys;
    std::string error;
    if (!FindShownCases(doc, c.cases, shown, error))
        return Complain(EXIT_CODE::Usage, c.file + ": " + error);
    if (!LoadCasesOf(doc, shown, keys, error))
        return Complain(EXIT_CODE::BadInput, c.file + ": " + error);
    if (const EXIT_CODE code = Analyse(doc, keys, 0); code != EXIT_CODE::Done) return code;
    for (const std::string& name : c.cases) {
        std::vector<T_SECTION_JOB> found;
        if (!ForcesOfMembers(doc, name, *elements, found, error))
            return Complain(EXIT_CODE::BadInput, c.file + ": " + error);
        for (T_SECTION_JOB& job : found) {
            if (std::ranges::find(meant, job.pair) == meant.end()) continue;
            const auto same = std::ranges::find(jobs, job.pair, &T_SECTION_JOB::pair);
            T_SECTION_JOB& to =
                same == jobs.end() ? jobs.emplace_back(T_SECTION_JOB{job.pair, {}}) : *same;
            std::ranges::move(job.forces, std::back_inserter(to.forces));
        }
    }
    return jobs.empty() ? Complain(EXIT_CODE::BadInput, c.file + ": " + Say("IDS_QM_SECC_NONE"))
                        : EXIT_CODE::Done;
}

/// What each section is checked for; `pairs` become those that have forces.
EXIT_CODE ReadJobs(const T_SECTION_CHECK_COMMAND& c, CDBDoc& doc,
                   std::vector<T_SECTION_PAIR>& pairs, std::vector<T_SECTION_JOB>& jobs)
{
    const T_UNITS units = doc.Unit().Units();
    std::vector<T_SECTION_FORCES> given;
    if (const EXIT_CODE code = ReadForces(c, units, given); code != EXIT_CODE::Done) return code;
    const bool isGiven = !given.empty() || !c.forcesFile.empty();
    if ((isGiven && !c.cases.empty()) || (c.cases.empty() && !c.elements.empty()))
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_SECK_EITHER"));
    if (!c.cases.empty()) {
        if (const EXIT_CODE code = ReadResults(c, doc, pairs, jobs); code != EXIT_CODE::Done)
            return code;
        pairs.clear();
        for (const T_SECTION_JOB& job : jobs)
            pairs.push_back(job.pair);
        return EXIT_CODE::Done;
    }
    if (!c.forcesFile.empty())
        if (const EXIT_CODE code = ReadFile(c, units, given); code != EXIT_CODE::Done) return code;
    for (const T_SECTION_PAIR& pair : pairs)
        jobs.push_back({pair, given});
    return EXIT_CODE::Done;
}

void WriteWay(CJsonText& w, const T_SECTION_WAY& way, const T_UNITS& units)
{
    w.Object();
    w.Member("checked", kSectionCheckedNames[static_cast<std::size_t>(way.what)]);
    w.Member("by", way.by.empty() ? std::string("section calculator") : way.by);
    w.Member("ratio", way.ratio);
    w.Member("verdict", !way.ratio ? "not checked" : way.IsExceeded() ? "exceeded" : "kept");
    if (!way.ratio) w.Member("reason", way.reason);
    WriteTrace(w, "trace", way.trace, units);
    WriteWarnings(w, way.warnings);
    w.End();
}

void WriteSet(CJsonText& w, const T_SECTION_CHECKS& set, const T_UNITS& units)
{
    w.Object();
    w.Member("name", set.forces.name);
    w.Key("forces").Object(kJsonOneLine);
    for (const T_SECTION_FORCE& force : kSectionForces)
        w.Member(force.name, FromSi(set.forces.*force.value, units, force.dim));
    w.End();
    w.Key("ways").List();
    for (const T_SECTION_WAY& way : set.ways)
        WriteWay(w, way, units);
    w.End();
    w.End();
}

std::string CheckJson(const std::vector<T_SECTION_CHECK>& checks, const T_UNITS& units)
{
    CJsonText w(JSON_REALS::Shortest);
    w.Object();
    w.Key("units").Object(kJsonOneLine);
    w.Member("force", NameOf(units.force)).Member("length", NameOf(units.length));
    w.End();
    w.Member("task", "check");
    w.Key("sections").List();
    for (const T_SECTION_CHECK& check : checks) {
        w.Object();
        w.Member("section", check.section).Member("material", check.material);
        w.Member("values", kSectionValueNames[static_cast<std::size_t>(check.options.values)]);
        WriteTrace(w, "trace", check.trace, units);
        WriteWarnings(w, check.warnings);
        w.Key("sets").List();
        for (const T_SECTION_CHECKS& set : check.sets)
            WriteSet(w, set, units);
        w.End();
        w.End();
    }
    w.End();
    w.End();
    return w.Text();
}

std::string Text(const T_SECTION_CHECK& check, bool trace, const T_UNITS& units)
{
    std::string text;
    for (const std::string& line : SectionCheckHead(check, units))
        text += line + "\n";
    const T_TEXT_TABLE table = SectionCheckTable(check, units);
    T_TABLE_ROWS rows(1);
    for (const T_TEXT_COLUMN& column : table.columns)
        rows.front().push_back(column.head);
    rows.insert(rows.end(), table.rows.begin(), table.rows.end());
    text += TableText(rows);
    if (trace)
        for (const std::string& line : SectionCheckTrace(check, units))
            text += line + "\n";
    return text + "\n";
}

EXIT_CODE WriteAll(const T_SECTION_CHECK_COMMAND& c, const std::vector<T_SECTION_CHECK>& checks,
                   const T_UNITS& units)
{
    EXIT_CODE code = EXIT_CODE::Done;
    if (!c.json.empty()) code = WriteOutput(c.json, CheckJson(checks, units));
    if (code == EXIT_CODE::Done && !c.csv.empty())
        code = WriteOutput(c.csv, TableCsv(SectionCheckExport(checks, units)));
    if (code != EXIT_CODE::Done || c.sheet.empty()) return code;
    T_FILE_ERROR error;
    return WriteSheet(c.sheet, TableSheet(SectionCheckExport(checks, units)), error)
               ? EXIT_CODE::Done
               : ReportFileError(error);
}

T_SECTION_CHECK_REQUEST RequestOf(const T_SECTION_CHECK_COMMAND& c)
{
    T_SECTION_CHECK_REQUEST request;
    request.options = SectionOptionsOf(c);
    request.cotTheta = c.cotTheta;
    for (const std::string& code : c.codes)
        request.codes.push_back(static_cast<SECTION_CHECK_CODE>(
            std::ranges::find(kSectionCheckCodeNames, code) - kSectionCheckCodeNames.begin()));
    return request;
}

} // namespace

EXIT_CODE RunSectionCheck(const T_SECTION_CHECK_COMMAND& c)
{
    CDBDoc doc;
    T_SECTION_CHECK_REQUEST request = RequestOf(c);
    std::vector<T_SECTION_JOB> jobs;
    std::vector<T_SECTION_CHECK> checks;
    const EXIT_CODE code = OverSections(
        c, {{c.json, OUTPUT_KIND::Json}, {c.csv, OUTPUT_KIND::Text}, {c.sheet, OUTPUT_KIND::Sheet}},
        doc, [&](std::vector<T_SECTION_PAIR>& pairs) { return ReadJobs(c, doc, pairs, jobs); },
        [&](std::size_t i, const T_SECT_D& section, const T_MATL_D& material, std::string& why) {
            request.forces = std::move(jobs[i].forces);
            T_SECTION_CHECK& check = checks.emplace_back();
            const int done =
                CheckSection(section, material, request, doc.Unit().Units(), check, why);
            if (done && c.byRatio) SortByRatio(check);
            return done;
        });
    if (code != EXIT_CODE::Done) return code;
    const T_UNITS units = doc.Unit().Units();
    if (c.json != "-" && c.csv != "-") {
        std::string text;
        for (const T_SECTION_CHECK& check : checks)
            text += Text(check, c.trace, units);
        text += Say("IDS_QM_SECK_SIGNS") + "\n";
        std::fwrite(text.data(), 1, text.size(), stdout);
    }
    return WriteAll(c, checks, units);
}
