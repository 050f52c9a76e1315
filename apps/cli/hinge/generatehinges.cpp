#include "hinge/generatehinges.h"

#include "console/tabletext.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/desk/codehingeoptions.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/generate/codehingerows.h"

#include <algorithm>
#include <cstdio>
#include <set>

namespace {

/// Plastic rotations and chord rotations have tables of their own.
std::string Table(const T_CODE_HINGES& hinges, bool chord, const T_UNITS& units)
{
    T_TABLE_ROWS table{HingeRowHeads(hinges, chord, units)};
    table.front().insert(table.front().begin(), Say("IDS_QM_CLI_ELEMENT"));
    table.front().push_back(Say("IDS_QM_CLI_HINGE_TYPE"));
    for (const T_CODE_ELEMENT& element : hinges.elements)
        for (const T_CODE_ROW_OF_HINGE& row : HingeRows(element)) {
            if (chord != (row.of->bone.levels == CODE_LEVELS::DlSdNc)) continue;
            std::vector<std::string>& cells = table.emplace_back();
            cells = HingeRowCells(row, chord, units);
            cells.insert(cells.begin(), std::to_string(row.element));
            cells.push_back(element.hinge->type.name);
        }
    return table.size() > 1 ? TableText(table) : std::string();
}

/// "ASCE41-17", of stale ones maybe several.
std::string CodesOf(const T_CODE_HINGES& hinges)
{
    std::set<std::string> codes;
    for (const T_CODE_ELEMENT& element : hinges.elements)
        codes.insert(element.hinge->type.generated->code);
    std::string text;
    for (const std::string& code : codes)
        text += (text.empty() ? "" : ", ") + code;
    return text;
}

std::string TraceText(const T_CODE_HINGES& hinges, const T_UNITS& units)
{
    std::string text;
    for (const T_CODE_ELEMENT* element : FirstsOfTypes(hinges))
        for (const T_CODE_ROW_OF_HINGE& row : HingeRows(*element)) {
            text += "\n" +
                    Say("IDS_QM_GEN_TRACE", element->hinge->type.name, row.end,
                        kComponentNames[static_cast<std::size_t>(row.component)], row.side) +
                    "\n";
            for (const T_CODE_TRACE& line : row.of->trace)
                text += "  " + TraceLine(line, units) + "\n";
        }
    return text;
}

/// Warnings, each once, with the types that have it.
std::string WarningsText(const T_CODE_HINGES& hinges)
{
    std::string text;
    for (const auto& [warning, elements] : HingeWarnings(hinges)) {
        text += "! " + warning;
        for (std::size_t i = 0; i < elements.size(); ++i)
            text += (i == 0 ? " [" : ", ") + elements[i]->hinge->type.name;
        text += elements.empty() ? "\n" : "]\n";
    }
    return text;
}

/// "-100..800" in the file's units; nothing: it is no such text.
std::optional<std::vector<double>> RangeOf(const std::string& text, const T_UNITS& units)
{
    const std::size_t dots = text.find("..");
    if (dots == std::string::npos) return {};
    const std::optional<double> from = ParseFinite(text.substr(0, dots));
    const std::optional<double> to = ParseFinite(text.substr(dots + 2));
    if (!from || !to || !(*from < *to)) return {};
    return std::vector<double>{ToSi(*from, units, kDimForce), ToSi(*to, units, kDimForce)};
}

/// What the document's units and load cases decide.
EXIT_CODE ReadRequest(const T_HINGE_GENERATE_OPTIONS& o, CDBDoc& doc, T_CODE_REQUEST& request,
                      int& loadCase)
{
    const T_UNITS units = doc.Unit().Units();
    request.options.tie = ToSi(o.tie, units, kDimForce);
    if (!o.connection.kind.empty()) {
        T_STEEL_CONNECTION& connection = request.options.connection.emplace(o.connection);
        connection.columnFlange = ToSi(connection.columnFlange, units, kDimLength);
        connection.continuityPlate = ToSi(connection.continuityPlate, units, kDimLength);
    }
    if (!o.axialRange.empty()) {
        const auto range = RangeOf(o.axialRange, units);
        if (!range || IsChordCode(request.options.code))
            return Complain(
                EXIT_CODE::Usage,
                Say(range ? "IDS_QM_GEN_RANGE_FEMA" : "IDS_QM_GEN_RANGE", o.axialRange));
        request.options.axialRange = *range;
    }
    if (o.push.empty()) return EXIT_CODE::Done;
    const T_MODEL& model = doc.Data().Model();
    const auto found = std::ranges::find_if(
        model.pushovers, [&](const auto& entry) { return entry.second.name == o.push; });
    if (found == model.pushovers.end())
        return Complain(EXIT_CODE::BadInput, Say("IDS_QM_GEN_NO_PUSH", o.push));
    loadCase = found->first;
    return EXIT_CODE::Done;
}

EXIT_CODE CheckConnection(const T_HINGE_GENERATE_OPTIONS& o, HINGE_CODE code)
{
    T_STEEL_CONNECTION bare;
    bare.kind = o.connection.kind;
    if (bare.kind.empty())
        return o.connection == bare ? EXIT_CODE::Done
                                    : Complain(EXIT_CODE::Usage, Say("IDS_QM_GEN_NO_CONNECTION"));
    return code == HINGE_CODE::Asce17
               ? EXIT_CODE::Done
               : Complain(EXIT_CODE::Usage, Say("IDS_QM_GEN_CONNECTION_CODE", o.code));
}

EXIT_CODE CheckOptions(const T_HINGE_GENERATE_OPTIONS& o, T_CODE_REQUEST& request)
{
    if (o.stale) {
        if (!o.code.empty() || o.all || !o.elements.empty() || o.connection != T_STEEL_CONNECTION{})
            return Complain(EXIT_CODE::Usage, Say("IDS_QM_GEN_STALE_ALONE"));
        return CheckOutputs(o.file, {{o.out, OUTPUT_KIND::Document}, {o.json, OUTPUT_KIND::Json}},
                            o.overwrite);
    }
    if (o.code.empty()) return Complain(EXIT_CODE::Usage, Say("IDS_QM_GEN_CODE_NEEDED"));
    if (o.all == !o.elements.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_GEN_ONE_OF", "--all", "--elements"));
    const auto at = std::ranges::find(kHingeCodeNames, o.code);
    request.options.code = static_cast<HINGE_CODE>(at - kHingeCodeNames.begin());
    request.options.secondary = o.level == "secondary";
    request.keepGoing = o.keepGoing;
    if (const EXIT_CODE code = CheckConnection(o, request.options.code); code != EXIT_CODE::Done)
        return code;
    const std::optional<std::vector<int>> elements = ParseElementList(o.elements);
    if (!elements)
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_ELEMENT_LIST", o.elements));
    request.elements = *elements;
    return CheckOutputs(o.file, {{o.out, OUTPUT_KIND::Document}, {o.json, OUTPUT_KIND::Json}},
                        o.overwrite);
}

} // namespace

EXIT_CODE RunHingeGenerate(const T_HINGE_GENERATE_OPTIONS& o)
{
    T_CODE_REQUEST request;
    if (const EXIT_CODE code = CheckOptions(o, request); code != EXIT_CODE::Done) return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    T_CODE_HINGES hinges;
    T_HINGE_REFUSAL refusal;
    int loadCase = 0;
    if (!o.stale)
        if (const EXIT_CODE code = ReadRequest(o, doc, request, loadCase); code != EXIT_CODE::Done)
            return code;
    CCodeHinges generator(doc);
    if (!(o.stale         ? generator.Regenerate(hinges, refusal)
          : loadCase == 0 ? generator.Generate(request, hinges, refusal)
                          : generator.GenerateFromPush(request, loadCase, {}, hinges, refusal)))
        return Complain(EXIT_CODE::BadInput, o.file + ": " + refusal.text);
    const T_UNITS units = doc.Unit().Units();
    if (o.json != "-") {
        const std::string text = CodeIterationsText(hinges, units) + Table(hinges, false, units) +
                                 Table(hinges, true, units) +
                                 (o.trace ? TraceText(hinges, units) : "") + WarningsText(hinges);
        std::fputs(text.c_str(), stdout);
    }
    for (const T_HINGE_REFUSAL& skipped : hinges.skipped)
        (void)Complain(EXIT_CODE::NotFound, Say("IDS_QM_GEN_SKIPPED", skipped.text));
    if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    if (!o.json.empty())
        if (const EXIT_CODE code =
                WriteOutput(o.json, CodeHingesJson(hinges, CodesOf(hinges), units));
            code != EXIT_CODE::Done)
            return code;
    if (o.json != "-")
        std::printf("%s\n", Say("IDS_QM_GEN_DONE", std::to_string(hinges.elements.size()),
                                std::to_string(hinges.types))
                                .c_str());
    return hinges.skipped.empty() ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}
