#include "hinge/generatehinges.h"

#include "qm_rps/generate/codehingerows.h"
#include "json/tracejson.h"

#include <algorithm>

namespace {

/// Total deformations, rotations in rad; strengths over the yield strength.
void WriteBackbone(CJsonText& w, const T_CODE_BACKBONE& bone, HINGE_COMPONENT component,
                   const T_UNITS& units)
{
    const T_DIM dim = DeformDim(component, HINGE_DEFINITION::MomentRotation);
    const auto shown = [&](double deform) { return FromSi(deform, units, dim); };
    w.Key("backbone").Object(kJsonOneLine);
    w.Member(IsBending(component) ? "yield_rotation" : "yield_displacement",
             shown(bone.yieldDeform));
    const std::pair<const char*, const T_CODE_POINT*> points[] = {
        {"B", &bone.B}, {"C", &bone.C}, {"D", &bone.D}, {"E", &bone.E}};
    for (const auto& [name, point] : points)
        w.Items(name, std::array{shown(point->deform), point->strength}, kJsonOneLine);
    const bool chord = bone.levels == CODE_LEVELS::DlSdNc;
    const auto names = chord ? std::array{"DL", "SD", "NC"} : std::array{"IO", "LS", "CP"};
    for (std::size_t i = 0; bone.acceptance && i < names.size(); ++i)
        w.Member(names[i], shown((*bone.acceptance)[i]));
    w.End();
}

void WriteHinge(CJsonText& w, const T_CODE_ROW_OF_HINGE& row, const T_UNITS& units)
{
    w.Object();
    w.Member("component", kComponentNames[static_cast<std::size_t>(row.component)]);
    w.Beside().Member("end", row.end);
    w.Beside().Member("side", row.side);
    w.Member("axial", FromSi(row.axial, units, kDimForce));
    w.Member(IsBending(row.component) ? "moment" : "force",
             FromSi(row.of->strength, units, StrengthDim(row.component)));
    if (row.of->shearStrength > 0.0) {
        w.Member("shear", FromSi(row.of->shear, units, kDimForce));
        w.Member("shear_strength", FromSi(row.of->shearStrength, units, kDimForce));
    }
    WriteBackbone(w, row.of->bone, row.component, units);
    WriteTrace(w, "trace", row.of->trace, units);
    WriteWarnings(w, row.of->warnings);
    w.End();
}

} // namespace

std::string CodeHingesJson(const T_CODE_HINGES& hinges, const std::string& code,
                           const T_UNITS& units)
{
    CJsonText w(JSON_REALS::Shortest);
    w.Object();
    w.Member("code", code);
    w.Key("units").Object(kJsonOneLine);
    w.Member("force", NameOf(units.force)).Member("length", NameOf(units.length));
    w.End();
    WriteWarnings(w, hinges.warnings);
    w.Key("pushes").List();
    for (const T_CODE_ITERATION& it : hinges.iterations) {
        w.Object(kJsonOneLine);
        w.Member("element", it.change.element).Member("change", it.change.change);
        w.Member("shear_before", FromSi(it.change.before, units, kDimForce));
        w.Member("shear", FromSi(it.change.now, units, kDimForce)).Member("outcome", it.outcome);
        w.End();
    }
    w.End();
    w.Key("types").List();
    std::vector<const T_CODE_HINGE*> done;
    for (const T_CODE_ELEMENT& first : hinges.elements) {
        const T_CODE_HINGE* const hinge = first.hinge.get();
        if (std::ranges::find(done, hinge) != done.end()) continue;
        done.push_back(hinge);
        std::vector<int> ids;
        for (const T_CODE_ELEMENT& element : hinges.elements)
            if (element.hinge.get() == hinge) ids.push_back(element.member.element);
        w.Object();
        w.Member("name", hinge->type.name);
        w.Member("member", kMemberKindNames[static_cast<std::size_t>(first.member.kind)]);
        w.Member("clear_length", FromSi(first.member.clear, units, kDimLength));
        w.Items("elements", ids, kJsonOneLine);
        WriteWarnings(w, hinge->warnings);
        w.Key("hinges").List();
        for (const T_CODE_ROW_OF_HINGE& row : HingeRows(first))
            WriteHinge(w, row, units);
        w.End();
        w.End();
    }
    w.End();
    w.Key("skipped").List();
    for (const T_HINGE_REFUSAL& refusal : hinges.skipped) {
        w.Object(kJsonOneLine);
        w.Member("element", refusal.element).Member("reason", refusal.why);
        w.End();
    }
    w.End();
    w.End();
    return w.Text();
}
