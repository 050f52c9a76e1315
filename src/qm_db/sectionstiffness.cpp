#include "qm_db/sectionstiffness.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"

#include <array>
#include <cmath>
#include <set>

namespace {

/// A property and its factor.
struct T_FACTORED {
    const char* name;
    double T_SECT_FACTORS::*factor;
    double T_SECT_D::*property;
};
constexpr std::array<T_FACTORED, 6> kFactored{
    {{"area", &T_SECT_FACTORS::area, &T_SECT_D::area},
     {"Asy", &T_SECT_FACTORS::Asy, &T_SECT_D::Asy},
     {"Asz", &T_SECT_FACTORS::Asz, &T_SECT_D::Asz},
     {"J", &T_SECT_FACTORS::J, &T_SECT_D::J},
     {"Iyy", &T_SECT_FACTORS::Iyy, &T_SECT_D::Iyy},
     {"Izz", &T_SECT_FACTORS::Izz, &T_SECT_D::Izz}}};

bool IsFactor(double v)
{
    return v > 0.0 && std::isfinite(v);
}

/// Empty: all factors are 1.
std::string FactorsOf(const T_SECT_D& section)
{
    const T_SECT_FACTORS mean = MeanFactors(section);
    std::string text;
    for (const T_FACTORED& f : kFactored) {
        const double I = section.factorsI.*f.factor, J = section.factorsJ.*f.factor;
        if (I == 1.0 && J == 1.0) continue;
        text += std::string(text.empty() ? "" : ", ") + f.name + " " + ShortestText(mean.*f.factor);
        if (I != J) text += Say("IDS_QM_FACTORS_OF_ENDS", ShortestText(I), ShortestText(J));
    }
    return text;
}

} // namespace

double ShearModulus(const T_MATL_D& m)
{
    return m.G.value_or(m.E / (2.0 * (1.0 + m.nu)));
}

T_SECT_FACTORS MeanFactors(const T_SECT_D& section)
{
    T_SECT_FACTORS mean;
    for (const T_FACTORED& f : kFactored)
        mean.*f.factor = 0.5 * (section.factorsI.*f.factor + section.factorsJ.*f.factor);
    return mean;
}

int CalcStiffness(const T_SECT_D& in, T_SECT_D& out, SECT_FAULT& fault)
{
    T_SECT_D s;
    if (!CSectionProperties::Calc(in, s, fault)) return 0;
    const T_SECT_FACTORS mean = MeanFactors(in);
    for (const T_FACTORED& f : kFactored) {
        if (!IsFactor(in.factorsI.*f.factor) || !IsFactor(in.factorsJ.*f.factor)) {
            fault = SECT_FAULT::Factors;
            return 0;
        }
        s.*f.property *= mean.*f.factor;
    }
    out = std::move(s);
    return 1;
}

std::string StiffnessFactorText(const T_MODEL& model)
{
    std::set<int> used;
    for (const auto& [id, element] : model.elements)
        if (element.kind == ELEM_KIND::Beam || element.kind == ELEM_KIND::Truss)
            used.insert(element.section);
    std::string list;
    for (const int key : used) {
        const auto section = model.sections.find(key);
        if (section == model.sections.end()) continue;
        const std::string factors = FactorsOf(section->second);
        if (factors.empty()) continue;
        list += (list.empty() ? "" : "; ") + section->second.name + ": " + factors;
    }
    return list.empty() ? list : Say("IDS_QM_FACTORS_COUNT", list);
}
