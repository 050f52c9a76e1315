#include "push/pushpictures.h"

#include "output.h"
#include "push/pushfirst.h"
#include "qm_base/say.h"
#include "qm_ui/push/stepdrawings.h"

#include <algorithm>

namespace {

/// Where one of several results is needed, the user names it.
EXIT_CODE FindResult(const T_PUSH_OPTIONS& o, const std::vector<T_PUSH_RUN>& runs, std::string& out)
{
    if (o.of.empty() && runs.size() == 1) {
        out = runs.front().name;
        return EXIT_CODE::Done;
    }
    std::string names;
    for (const T_PUSH_RUN& run : runs)
        names += (names.empty() ? "" : ", ") + run.name;
    if (o.of.empty()) return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_PUSH_WHICH", names));
    if (std::ranges::none_of(runs, [&](const T_PUSH_RUN& run) { return run.name == o.of; }))
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_NOT_SHOWN", o.of));
    out = o.of;
    return EXIT_CODE::Done;
}

/// The step that the options name.
EXIT_CODE OpenStep(CPushOverResultDlg& dialog, const T_PUSH_OPTIONS& o, const std::string& result)
{
    if (!dialog.OnOpen(result))
        return Complain(EXIT_CODE::NotFound, o.file + ": " + dialog.StatusText());
    if (o.step > dialog.Steps())
        return Complain(EXIT_CODE::Usage,
                        Say("IDS_QM_CLI_PUSH_NO_SUCH_STEP", result, std::to_string(o.step),
                            std::to_string(dialog.Steps())));
    if (o.step > 0) dialog.OnStep(o.step);
    return EXIT_CODE::Done;
}

/// The point of an evaluation.
EXIT_CODE OpenPoint(CDBDoc& doc, CPushOverResultDlg& dialog, const T_PUSH_OPTIONS& o,
                    const T_PUSH_EVALUATION& evaluation)
{
    std::string why;
    if (!dialog.OnShowPoints(evaluation, ProgressOnTerminal(doc), why))
        return Complain(EXIT_CODE::NotFound, o.file + ": " + o.at + ": " + why);
    if (!o.state.empty() && !dialog.OnShowState(o.state))
        return Complain(EXIT_CODE::NotFound,
                        o.file + ": " + Say("IDS_QM_CLI_PUSH_NO_STATE", o.at, o.state));
    return EXIT_CODE::Done;
}

EXIT_CODE Write(const T_DRAWING& drawing, const std::string& path)
{
    std::string error;
    if (WritePictureFile(drawing, path, error)) return EXIT_CODE::Done;
    return Complain(EXIT_CODE::NoAccess, error);
}

} // namespace

EXIT_CODE CheckSteps(CDBDoc& doc, const T_PUSH_OPTIONS& o, const std::vector<int>& keys)
{
    if (o.plotHinges.empty() && o.plotStoreys.empty()) return EXIT_CODE::Done;
    const T_MODEL& model = doc.Data().Model();
    std::string names;
    for (const int key : keys)
        names += (names.empty() ? "" : ", ") + model.pushovers.at(key).name;
    if (o.at.empty())
        return o.of.empty() && keys.size() > 1
                   ? Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_PUSH_WHICH", names))
                   : EXIT_CODE::Done;
    const auto record = std::ranges::find_if(model.evaluations,
                                             [&](const auto& e) { return e.second.name == o.at; });
    if (record == model.evaluations.end())
        return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_NO_EVALUATION", o.at));
    const std::string& push = record->second.push;
    const bool pushed = std::ranges::any_of(
        keys, [&](const int key) { return model.pushovers.at(key).name == push; });
    return pushed ? EXIT_CODE::Done : Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_NOT_SHOWN", push));
}

EXIT_CODE DrawSteps(CDBDoc& doc, const T_PUSH_OPTIONS& o, const std::vector<T_PUSH_RUN>& runs)
{
    if (o.plotHinges.empty() && o.plotStoreys.empty()) return EXIT_CODE::Done;
    std::string result, error;
    T_PUSH_EVALUATION evaluation;
    if (!o.at.empty() && !EvaluateStored(doc, o.at, evaluation, error))
        return Complain(EXIT_CODE::Usage, o.file + ": " + error);
    if (o.at.empty())
        if (const EXIT_CODE code = FindResult(o, runs, result); code != EXIT_CODE::Done)
            return code;
    const auto open = [&](CPushOverResultDlg& dialog) {
        return o.at.empty() ? OpenStep(dialog, o, result) : OpenPoint(doc, dialog, o, evaluation);
    };
    if (!o.plotHinges.empty()) {
        CPushOverHingeStateDlg states(doc);
        EXIT_CODE code = open(states);
        if (code == EXIT_CODE::Done) code = Write(StateDrawing(states), o.plotHinges);
        if (code != EXIT_CODE::Done) return code;
    }
    if (o.plotStoreys.empty()) return EXIT_CODE::Done;
    CPushOverStoreyDlg storeys(doc);
    if (const EXIT_CODE code = open(storeys); code != EXIT_CODE::Done) return code;
    if (!storeys.HasStoreys())
        return Complain(EXIT_CODE::NotFound, o.file + ": " + Say("IDS_QM_UI_STOREY_NONE"));
    return Write(StoreyDrawing(storeys), o.plotStoreys);
}
