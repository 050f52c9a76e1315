#include "push/pushfirst.h"

#include "console/console.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/push/pushquantity.h"
#include "qm_rps/push/pushwarnings.h"

#include <cstdio>
#include <unistd.h>

namespace {

/// Shows the step, where somebody looks at it; false: Ctrl-C.
bool ShowStep(const T_PUSH_PROGRESS& p, const T_PUSH_QUANTITY& displacement)
{
    if (isatty(STDERR_FILENO))
        ShowOnTerminal(Say("IDS_QM_CLI_PUSHING", p.name, std::to_string(p.done),
                           std::to_string(p.total),
                           FormatText("%.4g", displacement.Shown(p.displacement))),
                       p.done >= p.total);
    return !CInterrupt::IsAsked();
}

EXIT_CODE PushOne(CDBDoc& doc, const std::string& file, CPushRun& push, int key,
                  std::vector<T_PUSH_RUN>& out)
{
    const int direction = doc.Data().Model().pushovers.at(key).direction;
    const PUSH_PROGRESS_FN progress = ProgressOnTerminal(doc, direction);
    std::vector<T_PUSH_RUN> runs;
    std::string error;
    if (!push.Run(key, progress, runs, error))
        return Complain(EXIT_CODE::BadInput, file + ": " + error);
    push.Keep(runs);
    const std::vector<double> points = StepsOfEvaluations(doc, runs);
    if (!points.empty()) {
        std::vector<T_PUSH_RUN> exact;
        if (!push.Run(key, progress, exact, error, points))
            return Complain(EXIT_CODE::BadInput, file + ": " + error);
        push.Keep(exact);
        runs = std::move(exact);
    }
    for (T_PUSH_RUN& run : runs)
        out.push_back(std::move(run));
    return EXIT_CODE::Done;
}

} // namespace

PUSH_PROGRESS_FN ProgressOnTerminal(CDBDoc& doc, int direction)
{
    const T_PUSH_QUANTITY displacement =
        DisplacementIn(static_cast<std::size_t>(direction - 1), doc.Unit().Units());
    return [displacement](const T_PUSH_PROGRESS& p) { return ShowStep(p, displacement); };
}

EXIT_CODE PushCases(CDBDoc& doc, const std::string& file, const std::vector<int>& keys,
                    std::vector<T_PUSH_RUN>& out)
{
    const CInterrupt interrupt;
    for (const std::string& warning : keys.empty() ? std::vector<std::string>() : PushWarnings(doc))
        std::fprintf(stderr, "%s\n", warning.c_str());
    CPushRun push(doc);
    for (const int key : keys) {
        if (const EXIT_CODE code = PushOne(doc, file, push, key, out); code != EXIT_CODE::Done)
            return code;
        if (out.back().cancelled) break;
    }
    return EXIT_CODE::Done;
}

EXIT_CODE PushWhereMissing(CDBDoc& doc, const std::string& file, const std::set<int>& keys)
{
    std::vector<int> missing;
    for (const int key : keys) {
        const auto record = doc.Data().Model().pushovers.find(key);
        if (record == doc.Data().Model().pushovers.end() || !record->second.control) continue;
        std::string why;
        const int turn =
            doc.Post().SelectPushover(key) || TurnedNames(record->second).empty() ? 0 : 1;
        if (!doc.Post().SelectPushover(key, turn))
            why = Say("IDS_QM_CLI_PUSHING_FIRST", record->second.name);
        else if (doc.Post().IsStale(key, why, turn))
            why += " " + Say("IDS_QM_CLI_PUSHING_AGAIN");
        else
            continue;
        std::fprintf(stderr, "%s\n", why.c_str());
        missing.push_back(key);
    }
    std::vector<T_PUSH_RUN> runs;
    return PushCases(doc, file, missing, runs);
}

std::vector<T_HINGES_AT> HingesAtPoints(CDBDoc& doc, const std::vector<T_PUSH_EVALUATION>& results)
{
    const CInterrupt interrupt;
    return HingesOfEvaluations(doc, results, ProgressOnTerminal(doc));
}
