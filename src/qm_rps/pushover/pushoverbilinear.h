// Bilinear (elastic-perfectly plastic) capacity spectrum of the target-displacement methods.
#pragma once

#include "qm_rps/pushover/pushoverperfptrecord.h"

#include <span>

enum class BILINEAR_RULE { Ec8, Ntc, Masonry };

struct T_BILINEAR_OPTIONS {
    BILINEAR_RULE rule = BILINEAR_RULE::Ec8;
    double secant = 0.6;  // fraction of the strength that fixes the stiffness (ntc, masonry)
    double drop = 0.85;   // fraction of the strength that ends the curve (ntc, masonry)
    bool iterate = false; // EN 1998-1 B.3: repeat with the target displacement (ec8)
    bool peak = false;    // the yield force is the largest force, not that of the rule
};

/// Points of the bilinear curve: origin, yield (dy, ay), ultimate (du, au). Lengths, g.
struct T_BILINEAR {
    double dy = 0.0, ay = 0.0;
    double du = 0.0, au = 0.0;
    bool operator==(const T_BILINEAR&) const = default;
};
inline auto Numbers(const T_BILINEAR& b)
{
    return std::tie(b.dy, b.ay, b.du, b.au);
}

/// Defaults of a rule: ntc 0.6 and 0.85 (NTC C7.3.4.2), masonry 0.7 and 0.8 (C7.8.1.6).
T_BILINEAR_OPTIONS BilinearDefaults(BILINEAR_RULE rule);

/// Index of the first maximum of the forces of a curve, that of a plateau being its first point:
/// nothing later is higher by more than rounding (kSameOnCurve).
std::size_t FirstMaximum(std::span<const double> V);

/// Sa on a curve at d: of the first segment that holds d, the last ordinate beyond the curve.
double CurveAccelAt(const T_ADRS_VIEW& curve, double d);

/// A point of a curve that may step back: behind its point `before`, at or before the next one.
struct T_CURVE_PLACE {
    std::size_t before = 0;
    double Sd = 0.0, Sa = 0.0; // length, g
};
T_CURVE_PLACE PlaceAt(const T_ADRS_VIEW& curve, std::size_t point);
/// The first place with the displacement d; the last point where there is none.
T_CURVE_PLACE FirstPlaceAt(const T_ADRS_VIEW& curve, double d);

/// Area along a curve from its first point to a place, where it steps back negative; what comes
/// behind the place does not count.
double AreaTo(const T_ADRS_VIEW& curve, const T_CURVE_PLACE& place);

/// EN 1998-1 Annex B.3: equal energy up to the place of dm, yield force = force there; `peak`: the
/// largest force up to there. `curve` starts at the origin. 1 done; 0 no yield point (no force, or
/// too little energy), output as it was.
[[nodiscard]] int CalcBilinearEc8(const T_ADRS_VIEW& curve, const T_CURVE_PLACE& dm, bool peak,
                                  T_BILINEAR& out);

/// NTC C7.3.4.2: secant through a fraction of the peak, equal area to the displacement where the
/// force has dropped; options.peak: the peak itself, on the secant. As above.
[[nodiscard]] int CalcBilinearNtc(const T_ADRS_VIEW& curve, const T_BILINEAR_OPTIONS& options,
                                  T_BILINEAR& out);
