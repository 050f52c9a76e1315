// The command on increment functions.
#include "push/setupcommands.h"

#include "hingetools.h"
#include "push/setupsettings.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushoverincrementfunctiondlg.h"
#include "json/jsontext.h"

#ifdef QM_UI
#include "qm_ui/push/incrementfunctionplot.h"
#endif

namespace {

using DLG = CPushOverIncrementFunctionDlg;

EXIT_CODE Refuse(const T_PUSH_FUNCTION_OPTIONS& o, const std::string& why)
{
    return Complain(EXIT_CODE::Usage, o.file + ": " + why);
}

/// "STEP=FACTOR" words as rows. Empty: taken; else the word that is none.
std::string TakeRows(const std::vector<std::string>& words, T_POFC_D& function)
{
    T_POFC_D rows{function.name, {}, {}};
    for (const std::string& word : words) {
        double factor = 0.0;
        const std::string step = SplitFactor(word, factor);
        const std::optional<double> value = ParseFinite(step);
        if (!value || step == word) return Say("IDS_QM_CLI_FUNCTION_ROW", word);
        rows.step.push_back(*value);
        rows.factor.push_back(factor);
    }
    function = std::move(rows);
    return {};
}

EXIT_CODE Edit(DLG& dialog, const T_PUSH_FUNCTION_OPTIONS& o)
{
    const std::string& name = o.add.empty() ? o.change.empty() ? o.remove : o.change : o.add;
    if (!o.add.empty()) {
        dialog.OnAdd();
        dialog.Selected()->name = o.add;
    } else if (!dialog.Select(name)) {
        return Refuse(o, Say("IDS_QM_CLI_FUNCTION_NONE", name));
    }
    if (!o.remove.empty()) {
        if (!dialog.OnDelete()) return Refuse(o, dialog.Messages().back().text);
    } else {
        T_POFC_D& function = *dialog.Selected();
        const std::string why =
            o.rows.empty() && o.add.empty() ? std::string() : TakeRows(o.rows, function);
        if (!why.empty()) return Refuse(o, why);
        if (!o.rename.empty()) function.name = o.rename;
    }
    return dialog.OnOK() ? EXIT_CODE::Done : Refuse(o, dialog.Messages().back().text);
}

std::string ListText(const DLG& dialog)
{
    std::string text;
    for (const auto& [key, function] : dialog.m_functions) {
        text += std::to_string(key) + "  " + function.name + "\n";
        for (std::size_t i = 0; i < function.step.size() && i < function.factor.size(); ++i)
            text += "    " + ShortestText(function.step[i]) + " = " +
                    ShortestText(function.factor[i]) + "\n";
    }
    return text.empty() ? Say("IDS_QM_CLI_FUNCTION_EMPTY") + "\n" : text;
}

std::string ListJson(const DLG& dialog)
{
    CJsonText w(JSON_REALS::Shortest);
    w.List();
    for (const auto& [key, function] : dialog.m_functions) {
        w.Object();
        w.Member("key", key).Member("name", function.name);
        w.Items("step", function.step, kJsonOneLine);
        w.Items("factor", function.factor, kJsonOneLine);
        w.End();
    }
    w.End();
    return w.Text();
}

EXIT_CODE Draw([[maybe_unused]] DLG& dialog, [[maybe_unused]] const std::string& name,
               [[maybe_unused]] const T_PUSH_FUNCTION_OPTIONS& o)
{
#ifdef QM_UI
    if (!name.empty() && !dialog.Select(name))
        return Refuse(o, Say("IDS_QM_CLI_FUNCTION_NONE", name));
    if (!dialog.Selected()) return Refuse(o, Say("IDS_QM_CLI_FUNCTION_EMPTY"));
    return WritePicture(IncrementFunctionPlot(*dialog.Selected()), o.plot);
#else
    return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_NO_PICTURES"));
#endif
}

} // namespace

EXIT_CODE RunPushFunction(const T_PUSH_FUNCTION_OPTIONS& o)
{
    const bool edits = !o.add.empty() || !o.change.empty() || !o.remove.empty();
    if (const EXIT_CODE code = CheckOutputs(o.file,
                                            {{o.out, OUTPUT_KIND::Document},
                                             {o.plot, OUTPUT_KIND::Picture},
                                             {o.json, OUTPUT_KIND::Json}},
                                            o.overwrite);
        code != EXIT_CODE::Done)
        return code;
    if (edits != !o.out.empty() || (!edits && (!o.rows.empty() || !o.rename.empty())))
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_FUNCTION_OUT"));
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, o.file); code != EXIT_CODE::Done) return code;
    DLG dialog;
    dialog.SetDoc(&doc);
    if (edits) {
        if (const EXIT_CODE code = Edit(dialog, o); code != EXIT_CODE::Done) return code;
        if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    }
    const std::string shown = !o.rename.empty() ? o.rename : o.add.empty() ? o.change : o.add;
    if (!o.plot.empty())
        if (const EXIT_CODE code = Draw(dialog, shown, o); code != EXIT_CODE::Done) return code;
    if (!o.json.empty()) return WriteOutput(o.json, ListJson(dialog));
    return WriteOutput("-", ListText(dialog));
}
