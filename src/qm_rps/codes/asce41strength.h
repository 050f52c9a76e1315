// Strength, stiffness and knowledge of concrete members by ASCE 41.
#pragma once

#include "qm_rps/codes/asce41concrete.h"

/// Column shear, ASCE 41-17 Eq. (10-3).
struct T_ASCE_COLUMN_SHEAR {
    double tieArea = 0.0, spacing = 0.0; // Av, m2; s, m
    double fyt = 0.0, fc = 0.0;          // Pa
    double d = 0.0, Ag = 0.0;            // m, m2
    double axial = 0.0;                  // N_UG of gravity, compression positive
    double momentShear = 0.0;            // M_UD / V_UD, m
    double lambda = 1.0;                 // 0.75: lightweight concrete
    double ductility = 0.0;              // displacement ductility demand
};
struct T_ASCE_COLUMN_STRENGTH {
    double initial = 0.0; // V_ColO
    double factor = 1.0;  // k_nl
    double strength = 0.0;
};
std::optional<T_ASCE_COLUMN_STRENGTH> AsceColumnShear(const T_ASCE_COLUMN_SHEAR& column,
                                                      CCodeSheet& sheet);

/// ASCE 41-17 10.3.4: share of the ties that counts, 1 up to s = d/2, 2 (1 - s/d), 0 from s = d.
std::optional<double> AsceTieShare(double spacing, double d, CCodeSheet& sheet);

enum class ASCE_MEMBER { Beam, PrestressedBeam, Column, Wall };
/// Effective flexural stiffness over Ec Ig and shear stiffness over Ec Aw, Table 10-5.
struct T_ASCE_STIFFNESS {
    double flexure = 0.0, shear = 0.0;
};
/// `axialRatio` is P / (Ag f'cE), compression positive; of columns alone. No row for FEMA 356.
std::optional<T_ASCE_STIFFNESS> AsceStiffness(ASCE_MEMBER member, double axialRatio,
                                              ASCE_EDITION edition, CCodeSheet& sheet);

/// Expected over lower-bound strength, Table 10-1 and (steel) Table 9-3.
enum class ASCE_MATERIAL { Concrete, Rebar, ConnectorSteel, Steel };
double AsceExpectedFactor(ASCE_MATERIAL material, CCodeSheet& sheet);

/// Knowledge factor, 6.2.4.
enum class ASCE_KNOWLEDGE { Minimum, Usual, Comprehensive };
double AsceKappa(ASCE_KNOWLEDGE knowledge, CCodeSheet& sheet);
