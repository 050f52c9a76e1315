#include "qm_db/casefile/caseget.h"
#include "qm_db/casefile/casereadertable.h"

void ReadHingeTables(CJsonReader& root, T_MODEL& model)
{
    const T_UNITS& units = model.styp.units;
    ReadTable(root, "increment_functions", units, nullptr, model.incrementFunctions,
              [](CJsonReader& in, const T_POFC_D& f) {
                  if (f.step.size() != f.factor.size())
                      in.FailAt("factor", std::to_string(f.factor.size()) + " values, expected " +
                                              std::to_string(f.step.size()));
              });
    ReadTable(root, "hinge_types", units, nullptr, model.hingeTypes,
              [&](CJsonReader& in, const T_PHGT_D& t) {
                  const auto isSection = [&](const char* key, int section) {
                      CheckReference(in, key, section == 0 || model.sections.contains(section),
                                     "section");
                  };
                  isSection("section", t.section);
                  isSection("fibre_section", t.fibreSection);
                  isSection("thickness_section", t.thicknessSection);
                  CheckReference(in, "section_material",
                                 t.sectionMaterial == 0 ||
                                     model.materials.contains(t.sectionMaterial),
                                 "material");
              });
    ReadTable(
        root, "hinges", units, nullptr, model.hinges, [&](CJsonReader& in, const T_PHGE_D& h) {
            CheckReference(in, "element", model.elements.contains(h.element), "element");
            CheckReference(in, "hinge_type", model.hingeTypes.contains(h.hingeType), "hinge type");
        });
    ReadTable(root, "inelastic_hinges", units, nullptr, model.inelasticHinges, kNoReferences);
}
