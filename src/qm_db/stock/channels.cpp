#include "qm_db/stock/rolledtables.h"

namespace {

// mm: height, width, web, flange, root radius. UPN (DIN 1026-1): the flange at half the width,
// above 300 mm at the middle of what stands out; its slope 8 %, above 300 mm 5 %; the tip rounded
// with half the root radius. UPE: parallel flanges. UPN sighted in two public tables (one has the
// flange, radii and all properties), UPE in three. Properties calculated from the outline: A, Iy,
// Iz of all to 0.6 % of the printed ones, Wpl,y to 0.4 % (UPN 80 1.2 %, UPN 350 2.0 %), Wpl,z of
// UPN to 1.5 %, of UPE to 300 to 2.5 %; the printed Wpl,z of UPE 330 to 400 are none that these
// dimensions have (UPE 400: 191, by hand 221 cm3).
struct T_EU_ROW {
    const char* name;
    double height, width, web, flange, fillet;
};
// clang-format off
constexpr T_EU_ROW kTapered[] = {
    {"UPN 80", 80, 45, 6, 8, 8},
    {"UPN 100", 100, 50, 6, 8.5, 8.5},
    {"UPN 120", 120, 55, 7, 9, 9},
    {"UPN 140", 140, 60, 7, 10, 10},
    {"UPN 160", 160, 65, 7.5, 10.5, 10.5},
    {"UPN 180", 180, 70, 8, 11, 11},
    {"UPN 200", 200, 75, 8.5, 11.5, 11.5},
    {"UPN 220", 220, 80, 9, 12.5, 12.5},
    {"UPN 240", 240, 85, 9.5, 13, 13},
    {"UPN 260", 260, 90, 10, 14, 14},
    {"UPN 280", 280, 95, 10, 15, 15},
    {"UPN 300", 300, 100, 10, 16, 16},
    {"UPN 320", 320, 100, 14, 17.5, 17.5},
    {"UPN 350", 350, 100, 14, 16, 16},
    {"UPN 380", 380, 102, 13.5, 16, 16},
    {"UPN 400", 400, 110, 14, 18, 18},
};
constexpr T_EU_ROW kParallel[] = {
    {"UPE 80", 80, 50, 4, 7, 10},
    {"UPE 100", 100, 55, 4.5, 7.5, 10},
    {"UPE 120", 120, 60, 5, 8, 12},
    {"UPE 140", 140, 65, 5, 9, 12},
    {"UPE 160", 160, 70, 5.5, 9.5, 12},
    {"UPE 180", 180, 75, 5.5, 10.5, 12},
    {"UPE 200", 200, 80, 6, 11, 13},
    {"UPE 220", 220, 85, 6.5, 12, 13},
    {"UPE 240", 240, 90, 7, 12.5, 15},
    {"UPE 270", 270, 95, 7.5, 13.5, 15},
    {"UPE 300", 300, 100, 9.5, 15, 15},
    {"UPE 330", 330, 105, 11, 16, 18},
    {"UPE 360", 360, 110, 12, 17, 18},
    {"UPE 400", 400, 115, 13.5, 18, 18},
};

// AISC Shapes Database, inches: d, bf, tw, tf (at the middle of what stands out), sighted as the W
// shapes. The fillet and the slope are not in it. C: slope 1 in 6, fillet 0.1 + the thinnest web of
// the depth (both recalled from ASTM A6); with them A, Ix, Zx, Zy and the places of both axes are
// the printed ones to 0.8 %, Iy to 0.9 %. MC: the slope and the fillet for which a series has its
// printed A, Ix, Zx, Iy, Zy and place of the centroid, all to 0.8 %.
struct T_US_ROW {
    const char* name;
    double d, bf, tw, tf, fillet, slope;
};
constexpr T_US_ROW kAisc[] = {
    {"C6X8.2", 6, 1.92, 0.200, 0.343, 0.30, 1.0 / 6.0},
    {"C6X10.5", 6, 2.03, 0.314, 0.343, 0.30, 1.0 / 6.0},
    {"C6X13", 6, 2.16, 0.437, 0.343, 0.30, 1.0 / 6.0},
    {"C7X9.8", 7, 2.09, 0.210, 0.366, 0.31, 1.0 / 6.0},
    {"C7X12.25", 7, 2.19, 0.314, 0.366, 0.31, 1.0 / 6.0},
    {"C7X14.75", 7, 2.30, 0.419, 0.366, 0.31, 1.0 / 6.0},
    {"C8X11.5", 8, 2.26, 0.220, 0.390, 0.32, 1.0 / 6.0},
    {"C8X13.75", 8, 2.34, 0.303, 0.390, 0.32, 1.0 / 6.0},
    {"C8X18.75", 8, 2.53, 0.487, 0.390, 0.32, 1.0 / 6.0},
    {"C9X13.4", 9, 2.43, 0.233, 0.413, 0.33, 1.0 / 6.0},
    {"C9X15", 9, 2.49, 0.285, 0.413, 0.33, 1.0 / 6.0},
    {"C9X20", 9, 2.65, 0.448, 0.413, 0.33, 1.0 / 6.0},
    {"C10X15.3", 10, 2.60, 0.240, 0.436, 0.34, 1.0 / 6.0},
    {"C10X20", 10, 2.74, 0.379, 0.436, 0.34, 1.0 / 6.0},
    {"C10X25", 10, 2.89, 0.526, 0.436, 0.34, 1.0 / 6.0},
    {"C10X30", 10, 3.03, 0.673, 0.436, 0.34, 1.0 / 6.0},
    {"C12X20.7", 12, 2.94, 0.282, 0.501, 0.38, 1.0 / 6.0},
    {"C12X25", 12, 3.05, 0.387, 0.501, 0.38, 1.0 / 6.0},
    {"C12X30", 12, 3.17, 0.510, 0.501, 0.38, 1.0 / 6.0},
    {"C15X33.9", 15, 3.40, 0.400, 0.65, 0.50, 1.0 / 6.0},
    {"C15X40", 15, 3.52, 0.520, 0.65, 0.50, 1.0 / 6.0},
    {"C15X50", 15, 3.72, 0.716, 0.65, 0.50, 1.0 / 6.0},
    {"MC8X18.7", 8, 2.98, 0.353, 0.500, 0.40, 0.07},
    {"MC8X20", 8, 3.03, 0.400, 0.500, 0.40, 0.07},
    {"MC8X21.4", 8, 3.45, 0.375, 0.525, 0.40, 0.065},
    {"MC8X22.8", 8, 3.50, 0.427, 0.525, 0.40, 0.065},
    {"MC10X25", 10, 3.41, 0.380, 0.575, 0.42, 0.075},
    {"MC10X28.5", 10, 3.95, 0.425, 0.575, 0.40, 0.06},
    {"MC10X33.6", 10, 4.10, 0.575, 0.575, 0.40, 0.06},
    {"MC10X41.1", 10, 4.32, 0.796, 0.575, 0.40, 0.06},
    {"MC12X31", 12, 3.67, 0.370, 0.700, 0.48, 0.04},
    {"MC12X35", 12, 3.77, 0.465, 0.700, 0.48, 0.04},
    {"MC12X40", 12, 3.89, 0.590, 0.700, 0.48, 0.04},
    {"MC12X45", 12, 4.01, 0.710, 0.700, 0.48, 0.04},
    {"MC12X50", 12, 4.14, 0.835, 0.700, 0.48, 0.04},
    {"MC13X31.8", 13, 4.00, 0.375, 0.610, 0.48, 0.15},
    {"MC13X35", 13, 4.07, 0.447, 0.610, 0.48, 0.15},
    {"MC13X40", 13, 4.19, 0.560, 0.610, 0.48, 0.15},
    {"MC13X50", 13, 4.41, 0.787, 0.610, 0.48, 0.15},
    {"MC18X42.7", 18, 3.95, 0.450, 0.625, 0.56, 0.06},
    {"MC18X45.8", 18, 4.00, 0.500, 0.625, 0.56, 0.06},
    {"MC18X51.9", 18, 4.10, 0.600, 0.625, 0.56, 0.06},
    {"MC18X58", 18, 4.20, 0.700, 0.625, 0.56, 0.06},
};
// clang-format on
constexpr double kMm = 1e-3, kInch = 25.4e-3;

T_ROLLED_SHAPE European(const T_EU_ROW& r, bool tapered)
{
    constexpr double kDeep = 300.0;
    const bool deep = r.height > kDeep;
    const double slope = !tapered ? 0.0 : deep ? 0.05 : 0.08;
    // The middle of what stands out is half the web nearer to the tip than half the width.
    const double flange = r.flange - (deep ? 0.0 : 0.5 * slope * r.web);
    return {r.name,
            {STOCK_SHAPE::Channel,
             {r.height * kMm, r.width * kMm, r.web * kMm, flange * kMm},
             r.fillet * kMm,
             slope}};
}

} // namespace

std::vector<T_ROLLED_SHAPE> EuropeanChannels()
{
    std::vector<T_ROLLED_SHAPE> out;
    for (const T_EU_ROW& r : kTapered)
        out.push_back(European(r, true));
    for (const T_EU_ROW& r : kParallel)
        out.push_back(European(r, false));
    return out;
}

std::vector<T_ROLLED_SHAPE> AiscChannels()
{
    std::vector<T_ROLLED_SHAPE> out;
    for (const T_US_ROW& r : kAisc)
        out.push_back({r.name,
                       {STOCK_SHAPE::Channel,
                        {r.d * kInch, r.bf * kInch, r.tw * kInch, r.tf * kInch},
                        r.fillet * kInch,
                        r.slope}});
    return out;
}
