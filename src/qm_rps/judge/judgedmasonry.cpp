// Piers and spandrels of masonry: Circolare 2019 with NTC 2018, EN 1998-3 Annex C.
#include "qm_base/say.h"
#include "qm_rps/judge/judgedchecks.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto K = CODE_MARK::Computed;

/// The limits of the mode that comes first at M / V of the state, as rotations of the chord.
std::array<double, kLevels> LimitsOf(const T_CODE_SIDE& side, const T_MEMBER_END& member,
                                     CCodeSheet& sheet)
{
    const double bending =
        sheet.Put("V flexure", side.strength / member.shearSpan, kDimForce, "", "Mu/h0", K);
    const bool shearFirst = side.shearBone && side.shearStrength < bending;
    sheet.Put("V shear", side.shearStrength, kDimForce, "",
              shearFirst ? "comes first" : "flexure comes first", K);
    std::array<double, kLevels> limits =
        shearFirst ? *side.shearBone->acceptance : *side.bone.acceptance;
    for (std::size_t i = 0; i < kLevels; ++i)
        limits[i] = sheet.Put(std::string("drift ") + kLevelNames[1][i],
                              shearFirst ? limits[i] / member.clear : limits[i], "",
                              i == 0       ? "yield of the model"
                              : shearFirst ? "shear"
                                           : "flexure",
                              K);
    return limits;
}

} // namespace

void CheckMasonry(const T_CHECKING& c)
{
    T_MODE_CHECK& check = c.Of(JUDGE_MODE::Rotation);
    T_MODE_CHECK* const shear = c.out.Of(JUDGE_MODE::Shear);
    CCodeSheet sheet;
    const T_MEMBER_END member = RotationEnd(c.end, c.state, sheet);
    c.out.LV = member.shearSpan;
    const auto side = GeneratedSide(member, true, check.why);
    if (!side) {
        if (shear) shear->why = check.why;
        return;
    }
    check.trace = side->trace;
    c.out.warnings = side->warnings;
    const double drift = ChordDemand(c, member, sheet);
    const std::array<double, kLevels> limits = LimitsOf(*side, member, sheet);
    Keep(sheet, check, c.out);
    for (std::size_t i = 0; i < kLevels; ++i) {
        check.at[i] = T_CHECK{drift, limits[i]};
        check.clause[i] =
            c.end.By() == HINGE_CODE::En1998 ? "EN 1998-3 Annex C" : "Circolare 2019 C8.7.1.3.1.1";
    }
    if (!shear) return;
    // Its lines stand with the rotation.
    for (const T_CODE_TRACE& line : side->trace)
        shear->leastSure = std::max(shear->leastSure, line.mark);
    shear->at.fill(T_CHECK{std::fabs(c.with.brittle.V), side->shearStrength});
    shear->clause.fill(c.end.By() == HINGE_CODE::En1998 ? "EN 1998-3 Annex C"
                                                        : "Circolare 2019 C8.7.1.3.1.1");
}
