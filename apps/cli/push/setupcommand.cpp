// The command that shows and changes what load cases are pushed with.
#include "push/setupcommands.h"

#include "hingetools.h"
#include "push/setupsettings.h"
#include "push/setuptext.h"
#include "qm_base/say.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/pushoverglobalcontroldlg.h"

namespace {

EXIT_CODE Refuse(const T_PUSH_SETUP_OPTIONS& o, const std::string& why)
{
    return Complain(EXIT_CODE::Usage, o.file + ": " + why);
}

EXIT_CODE SetGlobal(CDBDoc& doc, const T_PUSH_SETUP_OPTIONS& o)
{
    CPushOverGlobalControlDlg dialog;
    dialog.SetDoc(&doc);
    T_SETUP_EDIT edit{doc.Data().Model(), dialog.m_control};
    const std::string why = TakeSettings(o.settings, edit);
    if (!why.empty()) return Refuse(o, why);
    return dialog.OnOK() ? EXIT_CODE::Done : Refuse(o, dialog.Messages().back().text);
}

EXIT_CODE SetCase(CDBDoc& doc, const T_PUSH_SETUP_OPTIONS& o)
{
    CPO_LoadCaseDlg dialog;
    dialog.SetDoc(&doc);
    int key = 0;
    const bool isThere = doc.Attr().FindPolc(o.caseName, key);
    if (!isThere && !o.fresh) return Refuse(o, Say("IDS_QM_CLI_NO_PUSH", o.caseName));
    if (isThere && o.fresh) return Refuse(o, Say("IDS_QM_UI_POLC_NAME_TAKEN"));
    if (!dialog.SetKey(key)) return Refuse(o, Say("IDS_QM_CLI_NO_PUSH", o.caseName));
    T_POLC_D record = dialog.m_case;
    if (o.fresh) record.name = o.caseName;
    T_POGC_D control = doc.Data().Model().pushControl;
    T_SETUP_EDIT edit{doc.Data().Model(), control, &record};
    const std::string why = TakeSettings(o.settings, edit);
    if (!why.empty()) return Refuse(o, why);
    dialog.TakeCase(std::move(record));
    return dialog.OnOK() ? EXIT_CODE::Done
                         : Refuse(o, "\"" + o.caseName + "\": " + dialog.Messages().back().text);
}

} // namespace

EXIT_CODE RunPushSetup(const T_PUSH_SETUP_OPTIONS& o)
{
    if (const EXIT_CODE code = CheckOutputs(
            o.file, {{o.out, OUTPUT_KIND::Document}, {o.json, OUTPUT_KIND::Json}}, o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    const bool edits = o.fresh || !o.settings.empty();
    if (edits != !o.out.empty()) return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SETUP_OUT"));
    if (o.fresh && o.caseName.empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_SETUP_CASE_ONLY", "--new"));
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    if (edits) {
        const EXIT_CODE code = o.caseName.empty() ? SetGlobal(doc, o) : SetCase(doc, o);
        if (code != EXIT_CODE::Done) return code;
    }
    std::vector<int> cases;
    const auto renamed = o.settings.find("--rename");
    const std::string name = renamed == o.settings.end() ? o.caseName : renamed->second.front();
    for (const auto& [key, record] : doc.Data().Model().pushovers)
        if (name.empty() || record.name == name) cases.push_back(key);
    if (!name.empty() && cases.empty()) return Refuse(o, Say("IDS_QM_CLI_NO_PUSH", name));
    if (edits)
        if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    if (!o.json.empty()) return WriteOutput(o.json, SetupJson(doc, cases));
    return WriteOutput("-", SetupTable(doc, cases));
}
