#include "qm_db/casefile/casewritertable.h"

namespace {

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

void WriteStructTables(CJsonWriter& out, const T_MODEL& model)
{
    const CCaseNames names(model);
    const T_STYP_D& styp = model.styp;
    WriteObject(out, "design_codes", styp.designCodes != T_DESIGN_CODES{},
                [&](CCasePut& put) { CaseFields(put, styp.designCodes); });
    WriteObject(out, "stage_control", styp.stageControl != T_STCT_D{},
                [&](CCasePut& put) { CaseFields(put, styp.stageControl); });
    WriteObject(out, "hinge_options",
                styp.alternativeHysteresis || styp.wallStrengthDegradation || styp.gsd,
                [&](CCasePut& put) { HingeOptionFields(put, styp); });
    WriteTable(out, &names, "materials", model.materials);
    WriteTable(out, &names, "sections", model.sections);
    WriteTable(out, &names, "elements", model.elements);
    WriteTable(out, &names, "diaphragms", model.diaphragms);
    WriteTable(out, &names, "equal_displacements", model.equalDisplacements);
    WriteTable(out, &names, "load_cases", model.loadCases);
    WriteTable(out, &names, "combinations", model.combinations);
    WriteTable(out, &names, "stages", model.stages);
    WriteTable(out, &names, "ulf_constraints", model.ulfConstraints);
    WriteTable(out, &names, "ulf_items", model.ulfItems);
    WriteTable(out, &names, "ulf_stage_items", model.ulfStageItems);
}
