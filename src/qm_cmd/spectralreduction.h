// Spectral reduction of the ATC-40 capacity spectrum method.
#pragma once

struct T_SPEC_REDUCTION {
    double SRa = 1.0; // factor on the constant-acceleration range
    double SRv = 1.0; // factor on the constant-velocity range
};

/// SRA and SRV for an effective damping in per cent, without lower bounds.
/// ATC-40 (1996) 8.2.2.1.1, equations 8-9 and 8-10. 1 done; 0 betaPct is not above 0 or not finite.
[[nodiscard]] int CalcSpectralReduction(double betaPct, T_SPEC_REDUCTION& out);

/// Raises the factors to the lower bounds of ATC-40 (1996) Table 8-2 for structural behaviour
/// type 0 (A), 1 (B) or 2 (C); other types (user-defined damping) have none.
void ApplyReductionFloors(int behaviorType, T_SPEC_REDUCTION& factors);
