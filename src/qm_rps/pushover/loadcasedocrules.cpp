#include "qm_rps/pushover/loadcasedocrules.h"

#include "qm_base/ruletable.h"

namespace {

struct T_IN_DOC {
    CDBDoc& doc;
    int key;
    const T_POLC_D& record;
    bool results;
};

constexpr T_RULE<T_IN_DOC> kRules[] = {
    {{.message = "IDS_QM_UI_POLC_NAME_TAKEN", .field = "name"},
     [](const T_IN_DOC& d) {
         int other = 0;
         return !d.doc.Attr().FindPolc(d.record.name, other) || other == d.key;
     }},
    {{.message = "IDS_QM_UI_POLC_NO_NODE", .field = "controlNode"},
     [](const T_IN_DOC& d) { return d.doc.Data().Model().nodes.contains(d.record.controlNode); }},
    {{.message = "IDS_QM_UI_POLC_NO_RESULT", .field = "controlNode"},
     [](const T_IN_DOC& d) { return d.doc.Post().ExistNodePost(d.record.controlNode); },
     [](const T_IN_DOC& d) { return d.results; }},
    {{.message = "IDS_QM_UI_POLC_NO_CONTROL", .field = "hasControl"},
     [](const T_IN_DOC& d) { return d.record.control.has_value(); },
     [](const T_IN_DOC& d) { return !d.results; }},
};

} // namespace

bool HasPushResults(CDBDoc& doc, int key)
{
    return key != 0 && doc.Post().SelectPushover(key);
}

std::vector<T_FINDING> LoadCaseDocFindings(CDBDoc& doc, int key, const T_POLC_D& record)
{
    std::vector<T_FINDING> out;
    WalkRules(kRules, {doc, key, record, HasPushResults(doc, key)}, {}, out);
    return out;
}
