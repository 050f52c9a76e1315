// The command that makes load cases in both ways along X and Y.
#include "push/setupcommands.h"

#include "hingetools.h"
#include "qm_base/say.h"
#include "qm_rps/pushovercasegeneratordlg.h"

#include <algorithm>

namespace {

bool Has(const std::vector<std::string>& words, const char* word)
{
    return words.empty() || std::ranges::find(words, word) != words.end();
}

} // namespace

EXIT_CODE RunCaseGenerate(const T_CASE_GENERATE_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckOutputs(o.file, {{o.out, OUTPUT_KIND::Document}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    CPushOverCaseGeneratorDlg dialog;
    dialog.SetDoc(&doc);
    T_CASE_CHOICE& choice = dialog.m_choice;
    if (!o.directions.empty()) choice.directions = {Has(o.directions, "X"), Has(o.directions, "Y")};
    choice.uniform = Has(o.patterns, "uniform");
    choice.mode = Has(o.patterns, "mode");
    choice.eccentricity = o.eccentricity;
    choice.plus = o.signs != "-";
    choice.minus = o.signs != "+";
    choice.controlNode = o.node;
    choice.target = o.target;
    if (!dialog.OnOK())
        return Complain(EXIT_CODE::Usage, o.file + ": " + dialog.Messages().back().text);
    if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    for (const std::string& name : CaseNames(choice))
        PrintLine(name);
    PrintLine(dialog.BasisText());
    return EXIT_CODE::Done;
}
