// Properties of rectangle, circle, pipe, box, I and channel from their dimensions and fillets;
// torsion and stiffness in shear as with sharp corners.
#pragma once

#include "qm_db/records/structrecords.h"
#include "qm_db/shape/channelshape.h"

#include <string>
#include <vector>

struct T_MODEL;

enum class SECT_FAULT {
    None,
    Dimensions,    // a dimension is not above 0 or not finite, or the walls leave no hollow
    Values,        // an entered property is negative or not finite
    Factors,       // a stiffness factor is not above 0 or not finite
    Material,      // a strength or modulus is not above 0 or not finite
    Class,         // no method for this material class
    Shape,         // no method for this shape in this material
    NoBars,        // concrete without bars
    ConcreteClass, // fck above the law's range
    Bars,          // a bar outside the concrete, without area, or more steel than section
    NotConverged,  // the neutral axis was not found within the iteration limit
};
/// Message key of a fault; empty for None.
const char* MessageKeyOf(SECT_FAULT fault);

/// A part of a section that is symmetric about both axes, centred on the centroid.
struct T_SECT_PIECE {
    double sign = 1.0;               // -1: cut out
    bool round = false;              // a circle of diameter `depth`, else a rectangle
    double width = 0.0, depth = 0.0; // along and across the bending axis
};

/// Shear areas for a force along y and along z.
struct T_SHEAR_AREAS {
    double y = 0.0, z = 0.0;
};

class CSectionProperties {
public:
    /// Fills area, shear areas, torsion constant, second moments and plastic moduli of a copy of
    /// the section; a section given by values keeps them. 1 done; 0 with the fault (Dimensions,
    /// Values), `out` unchanged. `in` and `out` may be the same record.
    [[nodiscard]] static int Calc(const T_SECT_D& in, T_SECT_D& out, SECT_FAULT& fault);

    /// Shear areas Av of steel for strength; those of stiffness are the section's Asy and Asz.
    /// EN 1993-1-1 6.2.6(3): I and box as welded (d, e; eta = 1) or, with a fillet, as
    /// rolled (a, eta = 1; f), channel likewise (d, e; c), pipe (g). Solid
    /// sections have none there: first yield of 6.2.6(4), (5), 2/3 A of a rectangle and 3/4 A of a
    /// circle. A section given by values: as entered. `section` carries its properties.
    static T_SHEAR_AREAS StrengthShearAreas(const T_SECT_D& section);

    /// The section as a sum of pieces for bending about y (depth along z) or about z. Empty for a
    /// section given by values and of a channel, without fillets. The dimensions must be sound.
    static std::vector<T_SECT_PIECE> Pieces(const T_SECT_D& section, bool aboutY);
};

// ---- stiffness, as analyses take it
// ---------------------------------------------------------------

/// G of a material as given, else of E and Poisson's ratio.
double ShearModulus(const T_MATL_D& material);

/// Factors of a prismatic element: the mean of those of both ends.
T_SECT_FACTORS MeanFactors(const T_SECT_D& section);

/// The properties of the section (CSectionProperties::Calc) times their mean factors; those of
/// strength as they are. 1 done; 0 with the fault (Factors: one of an end is not above 0), `out`
/// unchanged. `in` and `out` may be the same record.
[[nodiscard]] int CalcStiffness(const T_SECT_D& in, T_SECT_D& out, SECT_FAULT& fault);

/// "beam 30x50: Iyy 0.35, Izz 0.4 (0.3 at I, 0.5 at J)" for each section with factors that beams
/// and trusses have, in a sentence; empty: none has any.
std::string StiffnessFactorText(const T_MODEL& model);
