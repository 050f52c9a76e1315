#include "qm_db/casefile/casereadertable.h"
#include "qm_db/records/lcomflatten.h"

namespace {

void ReadModelOptions(CJsonReader& root, T_STYP_D& styp)
{
    CCaseGet codes(root, styp.units);
    codes.Part("design_codes", styp.designCodes);
    codes.Part("stage_control", styp.stageControl);
    if (!root.Has("hinge_options")) return;
    CJsonReader member = root.Member("hinge_options");
    CCaseGet options(member, styp.units);
    HingeOptionFields(options, styp);
    options.Finish();
}

/// Names and keys of a table that is read already.
template <class T>
void AddNames(const T_TABLE<T>& table, CASE_REF kind, CCaseNames& names)
{
    for (const auto& [key, record] : table)
        names.Add(kind, record.name, key);
}

/// Names and keys of a table that is still to be read: combinations may refer to later ones.
void AddNamesAhead(CJsonReader& root, const char* member, CASE_REF kind, CCaseNames& names)
{
    int last = 0;
    ForEachRecord(root, member, [&](CJsonReader& item, std::size_t) {
        std::string name;
        item.Get("name", name);
        last = NextKey(item, last);
        names.Add(kind, name, last);
    });
}

void ReadElements(CJsonReader& root, const CCaseNames& names, T_MODEL& model)
{
    ForEachRecord(root, "elements", [&](CJsonReader& item, std::size_t) {
        T_ELEM_D e;
        CCaseGet::Record(item, model.styp.units, names, {}, e);
        item.Check("id", e.id > 0, "an element id must be above 0");
        if (!model.elements.emplace(e.id, e).second)
            item.FailAt("id", "element " + std::to_string(e.id) + " appears twice");
    });
}

void CheckCycles(CJsonReader& root, const T_MODEL& model)
{
    auto combination = model.combinations.begin();
    ForEachRecord(root, "combinations", [&](CJsonReader& item, std::size_t) {
        T_LCOM_D flat;
        std::string reason;
        if (!FlattenLcom(model, (combination++)->second, flat, reason)) item.Fail(reason);
    });
}

} // namespace

void ReadStructTables(CJsonReader& root, T_MODEL& model)
{
    const T_UNITS& units = model.styp.units;
    CCaseNames names(model);
    ReadModelOptions(root, model.styp);
    ReadTable(root, "materials", units, &names, model.materials, kNoReferences);
    ReadTable(root, "sections", units, &names, model.sections, kNoReferences);
    AddNames(model.materials, CASE_REF::Material, names);
    AddNames(model.sections, CASE_REF::Section, names);
    ReadElements(root, names, model);
    ReadTable(root, "diaphragms", units, &names, model.diaphragms, kNoReferences);
    ReadTable(root, "equal_displacements", units, &names, model.equalDisplacements, kNoReferences);
    ReadTable(root, "load_cases", units, &names, model.loadCases, kNoReferences);
    AddNames(model.loadCases, CASE_REF::LoadCase, names);
    AddNamesAhead(root, "combinations", CASE_REF::Combination, names);
    ReadTable(root, "combinations", units, &names, model.combinations, kNoReferences);
    CheckCycles(root, model);
    ReadTable(root, "stages", units, &names, model.stages, kNoReferences);
    AddNames(model.stages, CASE_REF::Stage, names);
    ReadTable(root, "ulf_constraints", units, &names, model.ulfConstraints, kNoReferences);
    ReadTable(root, "ulf_items", units, &names, model.ulfItems, kNoReferences);
    ReadTable(root, "ulf_stage_items", units, &names, model.ulfStageItems, kNoReferences);
}
