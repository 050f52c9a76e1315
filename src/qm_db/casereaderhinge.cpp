#include "qm_db/caseget.h"
#include "qm_db/casereader.h"

namespace {

template <class R>
constexpr bool kHasName = requires(R& r)
{
    r.name;
};

/// Reads a table. Keys run 1, 2, 3, ... unless a record states a higher one. check(item, record)
/// judges the references.
template <class R, class F>
void ReadTable(CJsonReader& root, std::string_view member, const T_UNITS& units, T_TABLE<R>& out,
               F check)
{
    std::set<std::string> taken;
    ForEachRecord(root, member, [&](CJsonReader& item, std::size_t) {
        const int last = out.empty() ? 0 : out.rbegin()->first;
        int key = last + 1;
        R record;
        if constexpr (kHasName<R>) {
            CCaseGet::Record(item, units, {"key", "name"}, record);
            item.GetName("name", record.name, taken);
        } else {
            CCaseGet::Record(item, units, {"key"}, record);
        }
        item.GetIf("key", key);
        item.Check("key", key > last, "keys must rise, from 1");
        check(item, record);
        out.insert_or_assign(out.end(), key, std::move(record));
    });
}

constexpr auto kNoReferences = [](CJsonReader&, const auto&) {};

void CheckReference(CJsonReader& in, const char* key, bool exists, const char* what)
{
    if (!exists) in.FailAt(key, std::string("there is no such ") + what);
}

void ReadElement(CJsonReader& in, T_MODEL& model)
{
    T_ELEM_D e;
    CCaseGet::Record(in, model.styp.units, {}, e);
    in.Check("id", e.id > 0, "an element id must be above 0");
    const std::array<int, 2> nodes{e.nodeI, e.nodeJ};
    in.CheckEach(
        "nodes", nodes, [&](int n) { return model.nodes.contains(n); }, "there is no such node");
    in.Check("nodes", e.nodeI != e.nodeJ, "an element has two nodes");
    CheckReference(in, "section", e.section == 0 || model.sections.contains(e.section), "section");
    CheckReference(in, "material", e.material == 0 || model.materials.contains(e.material),
                   "material");
    if (!model.elements.emplace(e.id, e).second)
        in.FailAt("id", "element " + std::to_string(e.id) + " appears twice");
}

void ReadModelOptions(CJsonReader& root, T_STYP_D& styp)
{
    CCaseGet codes(root, styp.units);
    codes.Part("design_codes", styp.designCodes);
    if (!root.Has("hinge_options")) return;
    CJsonReader member = root.Member("hinge_options");
    CCaseGet options(member, styp.units);
    HingeOptionFields(options, styp);
    options.Finish();
}

} // namespace

void ReadHingeTables(CJsonReader& root, T_MODEL& model)
{
    const T_UNITS& units = model.styp.units;
    ReadModelOptions(root, model.styp);
    ReadTable(root, "materials", units, model.materials, kNoReferences);
    ReadTable(root, "sections", units, model.sections, kNoReferences);
    ForEachRecord(root, "elements",
                  [&](CJsonReader& item, std::size_t) { ReadElement(item, model); });
    ReadTable(root, "increment_functions", units, model.incrementFunctions,
              [](CJsonReader& in, const T_POFC_D& f) {
                  if (f.step.size() != f.factor.size())
                      in.FailAt("factor", std::to_string(f.factor.size()) + " values, expected " +
                                              std::to_string(f.step.size()));
              });
    ReadTable(
        root, "hinge_types", units, model.hingeTypes, [&](CJsonReader& in, const T_PHGT_D& t) {
            const auto isSection = [&](const char* key, int section) {
                CheckReference(in, key, section == 0 || model.sections.contains(section),
                               "section");
            };
            isSection("section", t.section);
            isSection("fibre_section", t.fibreSection);
            isSection("thickness_section", t.thicknessSection);
            CheckReference(in, "section_material",
                           t.sectionMaterial == 0 || model.materials.contains(t.sectionMaterial),
                           "material");
        });
    ReadTable(root, "hinges", units, model.hinges, [&](CJsonReader& in, const T_PHGE_D& h) {
        CheckReference(in, "element", model.elements.contains(h.element), "element");
        CheckReference(in, "hinge_type", model.hingeTypes.contains(h.hingeType), "hinge type");
    });
    ReadTable(root, "inelastic_hinges", units, model.inelasticHinges, kNoReferences);
}
