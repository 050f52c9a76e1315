#include "qm_db/caseput.h"
#include "qm_db/casewriter.h"

#include <set>

namespace {

template <class R>
constexpr bool kHasName = requires(R& r)
{
    r.name;
};

/// Records that stand on one line.
template <class R>
constexpr bool kIsSmall = std::is_same_v<R, T_ELEM_D> || std::is_same_v<R, T_MATL_D>;

template <class R>
void WriteTable(CJsonWriter& out, const char* member, const T_TABLE<R>& table)
{
    if (table.empty()) return;
    out.Key(member);
    out.BeginArray();
    int next = 1;
    std::set<std::string> taken;
    for (const auto& [key, record] : table) {
        out.BeginObject(kIsSmall<R>);
        if (key != next && !std::is_same_v<R, T_ELEM_D>) out.Member("key", key);
        next = key + 1;
        if constexpr (kHasName<R>) {
            out.Member("name", record.name);
            if (record.name.empty()) out.Fail("a name can't be empty");
            if (!taken.insert(record.name).second) out.Fail("the name appears twice");
        }
        CCasePut put(out);
        CaseFields(put, record);
        out.EndObject();
    }
    out.EndArray();
}

/// One member of the document with the fields that `write` names, unless all have their defaults.
template <class F>
void WriteObject(CJsonWriter& out, const char* member, bool isThere, F write)
{
    if (!isThere) return;
    out.Key(member);
    out.BeginObject(true);
    CCasePut put(out);
    write(put);
    out.EndObject();
}

} // namespace

void WriteHingeTables(CJsonWriter& out, const T_MODEL& model)
{
    const T_STYP_D& styp = model.styp;
    WriteObject(out, "design_codes", styp.designCodes != T_DESIGN_CODES{},
                [&](CCasePut& put) { CaseFields(put, styp.designCodes); });
    WriteObject(out, "hinge_options",
                styp.alternativeHysteresis || styp.wallStrengthDegradation || styp.gsd,
                [&](CCasePut& put) { HingeOptionFields(put, styp); });
    WriteTable(out, "materials", model.materials);
    WriteTable(out, "sections", model.sections);
    WriteTable(out, "elements", model.elements);
    WriteTable(out, "increment_functions", model.incrementFunctions);
    WriteTable(out, "hinge_types", model.hingeTypes);
    WriteTable(out, "hinges", model.hinges);
    WriteTable(out, "inelastic_hinges", model.inelasticHinges);
}
