#include "qm_rps/hinge/hingecontext.h"

T_HINGE_CONTEXT HingeContextOf(CDBDoc& doc)
{
    const T_MODEL& model = doc.Data().Model();
    T_HINGE_CONTEXT context;
    context.altHysteresis = model.styp.alternativeHysteresis;
    context.strengthDegradation = model.styp.wallStrengthDegradation;
    context.gsd = context.gsdAllowed = model.styp.gsd;
    context.units = model.styp.units;
    const auto& [pos1, neg1] = model.styp.defaultAlpha1;
    const auto& [pos2, neg2] = model.styp.defaultAlpha2;
    context.alpha1 = {pos1, neg1};
    context.alpha2 = {pos2, neg2};
    context.concreteCode = doc.Lib().GetConCodeName();
    context.steelCode = doc.Lib().GetStlCodeName();
    T_TABLE<T_SECT_D> sections = model.sections; // in SI
    for (auto& [key, section] : sections)
        RecordFromSi(section, model.styp.units);
    T_TABLE<T_MATL_D> materials = model.materials;
    for (auto& [key, material] : materials)
        RecordFromSi(material, model.styp.units);
    context.sources = std::make_shared<CHingeSources>(std::move(sections), std::move(materials),
                                                      model.styp.units);
    return context;
}
