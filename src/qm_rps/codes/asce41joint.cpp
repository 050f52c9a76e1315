#include "qm_rps/codes/asce41concrete.h"

#include <algorithm>

namespace {

constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr auto K = CODE_MARK::Computed;
constexpr double kN = kAnyValue;

enum GROUP { InteriorC, InteriorNC, OtherC, OtherNC };
constexpr std::array<const char*, 4> kNames{"interior, C", "interior, NC", "other, C", "other, NC"};

// ASCE 41-17 Table 10-11: P/(Ag f'cE), V/Vn. b of rows 4 and 5 reads 0.2 in the source seen, a slip
// for 0.02.
// clang-format off
constexpr T_CODE_ROW kRows[] = {
    //                            a      b       c    IO   LS      CP
    {InteriorC,  {0.1, 1.2, kN}, {0.015, 0.03,   0.2, 0.0, 0.02,   0.03},   S1},
    {InteriorC,  {0.1, 1.5, kN}, {0.015, 0.03,   0.2, 0.0, 0.015,  0.02},   S1},
    {InteriorC,  {0.4, 1.2, kN}, {0.015, 0.025,  0.2, 0.0, 0.015,  0.025},  S1},
    {InteriorC,  {0.4, 1.5, kN}, {0.015, 0.02,   0.2, 0.0, 0.015,  0.02},   S1},
    {InteriorNC, {0.1, 1.2, kN}, {0.005, 0.02,   0.2, 0.0, 0.015,  0.02},   S1},
    {InteriorNC, {0.1, 1.5, kN}, {0.005, 0.015,  0.2, 0.0, 0.01,   0.015},  S1},
    {InteriorNC, {0.4, kN,  kN}, {0.005, 0.015,  0.2, 0.0, 0.01,   0.015},  S1},
    {OtherC,     {kN,  1.2, kN}, {0.01,  0.02,   0.2, 0.0, 0.015,  0.02},   S1},
    {OtherC,     {kN,  1.5, kN}, {0.01,  0.015,  0.2, 0.0, 0.01,   0.015},  S1},
    {OtherNC,    {0.1, kN,  kN}, {0.005, 0.01,   0.2, 0.0, 0.0075, 0.01},   S1},
    {OtherNC,    {0.4, kN,  kN}, {0.0,   0.0075, 0.0, 0.0, 0.005,  0.0075}, S1},
};

struct T_GAMMA {
    JOINT_KIND kind;
    double conforming, other; // psi
};
// ASCE 41-17 Table 10-12; which joint is which letter is recalled.
constexpr std::array<T_GAMMA, 5> kGammas{{
    {JOINT_KIND::InteriorWithBeams, 20.0, 12.0},
    {JOINT_KIND::Interior,          15.0, 10.0},
    {JOINT_KIND::ExteriorWithBeams, 15.0,  8.0},
    {JOINT_KIND::Exterior,          12.0,  6.0},
    {JOINT_KIND::Knee,               8.0,  4.0},
}};
// clang-format on
const T_CODE_TABLE kTable{"ASCE 41-17 Table 10-11", {"P/(Ag f'cE)", "V/Vn", ""}, kRows};
constexpr const char* kStrength = "ASCE 41-17 Table 10-12";

bool Conforms(const T_ASCE_JOINT& j)
{
    return j.spacing > 0.0 && j.spacing <= j.hc / 2.0;
}

} // namespace

std::optional<double> AsceJointStrength(const T_ASCE_JOINT& joint, CCodeSheet& sheet)
{
    sheet.Positive({{"hc", joint.hc}, {"fc", joint.fc}, {"area", joint.area}});
    sheet.NotNegative({{"spacing", joint.spacing}});
    if (!sheet.Within("lambda", joint.lambda, 0.5, 1.0)) return {};
    const auto row = std::find_if(kGammas.begin(), kGammas.end(),
                                  [&](const T_GAMMA& g) { return g.kind == joint.kind; });
    if (row == kGammas.end()) {
        sheet.Refuse(CODE_REASON::NoRow, "kind", kStrength);
        return {};
    }
    const double gamma = Conforms(joint) ? row->conforming : row->other;
    sheet.Put("s/hc", joint.spacing / joint.hc, kStrength, "C: 0 < s <= hc/2", K);
    sheet.Put("gamma", gamma, kStrength, "20 15 15 12 8; NC: 12 10 8 6 4 (psi)", R);
    return sheet.Put("Vj", joint.lambda * gamma * RootPsi(joint.fc) * joint.area, kDimForce,
                     kStrength, "lambda gamma sqrt(f'cE) Aj (psi)", S1);
}

std::optional<T_CODE_PLASTIC> AsceJoint(const T_ASCE_JOINT& joint, CCodeSheet& sheet)
{
    sheet.Positive({{"Ag", joint.Ag}});
    sheet.NotNegative({{"shear", joint.shear}});
    if (!sheet.Finite({{"axial", joint.axial}})) return {};
    const std::optional<double> strength = AsceJointStrength(joint, sheet);
    if (!strength) return {};
    const bool interior =
        joint.kind == JOINT_KIND::Interior || joint.kind == JOINT_KIND::InteriorWithBeams;
    const GROUP group =
        Conforms(joint) ? (interior ? InteriorC : OtherC) : (interior ? InteriorNC : OtherNC);
    const double axial = std::max(0.0, joint.axial) / (joint.Ag * joint.fc);
    return Interpolate(kTable, group, kNames[group], {axial, joint.shear / *strength, 0.0}, sheet);
}
