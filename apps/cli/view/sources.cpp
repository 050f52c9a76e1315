#include "view/viewcommands.h"

#include "analysecommands.h"
#include "output.h"
#include "push/pushfirst.h"
#include "qm_base/say.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/view/resulttable.h"

#include <algorithm>

namespace {

using KIND = T_SHAPE_SOURCE::KIND;

bool AsksForNothing(const T_SOURCE_OPTIONS& o)
{
    return o.cases.empty() && o.stages.empty() && o.pushes.empty() && o.modes.empty();
}

/// Load cases, combinations and stages that are named are analysed, modes too.
EXIT_CODE AnalyseFor(CDBDoc& doc, const T_SOURCE_OPTIONS& o)
{
    const bool all = AsksForNothing(o);
    if (!all && o.cases.empty() && o.stages.empty() && o.modes.empty()) return EXIT_CODE::Done;
    std::set<int> keys;
    for (const std::string& name : o.cases) {
        int key = 0;
        T_LCOM_D record, flat;
        std::string why;
        if (doc.Attr().FindStld(name, key)) {
            keys.insert(key);
        } else if (doc.Attr().GetLcom_(name, record)) {
            if (!doc.Attr().NormalizeLcom(record, flat, why))
                return Complain(EXIT_CODE::BadInput, o.file + ": " + why);
            for (const T_LCOM_ITEM& item : flat.items)
                keys.insert(item.key);
        } else {
            return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_CLI_NO_CASE", name));
        }
    }
    if (all && doc.Data().Model().loadCases.empty())
        return Complain(EXIT_CODE::BadInput, o.file + ": " + Say("IDS_QM_CLI_NO_CASES"));
    const int modes = o.modes.empty() ? 0 : *std::ranges::max_element(o.modes);
    const bool hasModes = modes <= doc.Post().GetNumEigvPost();
    return Analyse(doc, {keys.begin(), keys.end()}, hasModes ? 0 : modes, !all);
}

EXIT_CODE PushFor(CDBDoc& doc, const T_SOURCE_OPTIONS& o)
{
    std::set<int> keys;
    for (const std::string& name : o.pushes) {
        int key = 0;
        const std::string record = name.substr(0, name.find('@')); // of a turned result
        if (!doc.Attr().FindPolc(name, key) && !doc.Attr().FindPolc(record, key))
            return Complain(EXIT_CODE::Usage, o.file + ": " + Say("IDS_QM_VIEW_NO_PUSH", name));
        keys.insert(key);
    }
    return keys.empty() ? EXIT_CODE::Done : PushWhereMissing(doc, o.file, keys);
}

} // namespace

EXIT_CODE FindSources(CDBDoc& doc, const T_SOURCE_OPTIONS& o, CFrameScene& scene,
                      std::vector<T_SHAPE_SOURCE>& out)
{
    if (const EXIT_CODE code = AnalyseFor(doc, o); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = PushFor(doc, o); code != EXIT_CODE::Done) return code;
    const std::vector<T_SHAPE_SOURCE> all = scene.Sources();
    const auto add = [&](auto fits, const char* missing, const std::string& name) {
        const auto it = std::ranges::find_if(all, fits);
        if (it == all.end()) return Complain(EXIT_CODE::Usage, o.file + ": " + Say(missing, name));
        out.push_back(*it);
        return EXIT_CODE::Done;
    };
    const auto named = [](const std::string& name, std::initializer_list<KIND> kinds) {
        return [name, kinds = std::vector(kinds)](const T_SHAPE_SOURCE& s) {
            return s.name == name && std::ranges::find(kinds, s.kind) != kinds.end();
        };
    };
    EXIT_CODE code = EXIT_CODE::Done;
    for (const std::string& name : o.cases)
        if (code == EXIT_CODE::Done)
            code = add(named(name, {KIND::Static, KIND::Combination}), "IDS_QM_CLI_NO_CASE", name);
    for (const std::string& name : o.stages)
        if (code == EXIT_CODE::Done)
            code = add(named(name, {KIND::Stage}), "IDS_QM_CLI_NO_STAGE", name);
    for (const std::string& name : o.pushes)
        if (code == EXIT_CODE::Done)
            code = add(named(name, {KIND::Pushover}), "IDS_QM_VIEW_NO_PUSH", name);
    for (const int mode : o.modes)
        if (code == EXIT_CODE::Done)
            code = add([mode](const auto& s) { return s.kind == KIND::Mode && s.key == mode; },
                       "IDS_QM_CLI_NO_MODE", std::to_string(mode));
    if (AsksForNothing(o) && o.envelope)
        out = EnvelopeSources(all);
    else if (AsksForNothing(o))
        std::ranges::copy_if(all, std::back_inserter(out),
                             [](const auto& s) { return s.kind == KIND::Static; });
    return code;
}

EXIT_CODE ReadElementIds(CDBDoc& doc, const T_SOURCE_OPTIONS& o, std::set<int>& out)
{
    if (o.elements.empty()) return EXIT_CODE::Done;
    const std::optional<std::vector<int>> ids = ParseElementList(o.elements);
    if (!ids || ids->empty())
        return Complain(EXIT_CODE::Usage, Say("IDS_QM_CLI_HINGE_ELEMENT_LIST", o.elements));
    for (const int id : *ids) {
        if (!doc.Data().Model().elements.contains(id))
            return Complain(EXIT_CODE::Usage,
                            o.file + ": " + Say("IDS_QM_ANALYSIS_NO_ELEMENT", std::to_string(id)));
        out.insert(id);
    }
    return EXIT_CODE::Done;
}
