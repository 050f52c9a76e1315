// Fully restrained beam-column connections of steel by ASCE 41: plastic rotations of the
// connection, and what shortens them. The codes' acceptance values are not known to us.
#pragma once

#include "qm_rps/codes/codetable.h"

enum class FR_CONNECTION {
    WeldedFlange,         // unreinforced, as built before 1994
    WeldedFlangeCollapse, // the same in the guides on progressive collapse: not to be mixed
    ImprovedBoltedWeb,
    ImprovedWeldedWeb,
    FreeFlange,
    ReducedBeamSection,
    SidePlate,
    TeeBoltShear, // double split tee, by what fails
    TeeBoltTension,
    TeeStemTension,
    TeeFlexure
};

/// By FR_CONNECTION; for commands and files.
inline constexpr std::array<const char*, 11> kFrConnectionNames{
    "WUF",        "WUF-collapse",   "WUF-B",
    "WUF-W",      "free-flange",    "RBS",
    "side-plate", "tee-bolt-shear", "tee-bolt-tension",
    "tee-stem",   "tee-flexure"};

/// Columns and beams that meet in a panel zone.
struct T_STEEL_JOINT {
    double columnFlange = 0.0;                 // thickness; 0: there is no column that is read
    double columnDepth = 0.0, columnWeb = 0.0; // m
    double columnFye = 0.0;                    // Pa
    double columnArea = 0.0;                   // m2
    double storey = 0.0;                       // mean length of the columns above and below, m
    double beams = 0.0;                        // sum of M L/(L - dc) of the beams, N m
    bool operator==(const T_STEEL_JOINT&) const = default;
};
/// Vye of a panel zone: 0.55 Fye dc tcw, the web of the column alone.
double AscePanelStrength(const T_STEEL_JOINT& joint, CCodeSheet& sheet);
/// Shear of a panel zone under the moments of its beams (depth `depth`) and the shear of the column
/// above it.
double AscePanelShear(double moment, double depth, double columnShear, CCodeSheet& sheet);
/// Vpz / Vye of ASCE 41-17 9.4.2.4.3: shear of the panel zone when the beams of depth `depth`
/// yield, over 0.55 Fye dc tcw.
std::optional<double> AscePanelRatio(const T_STEEL_JOINT& joint, double depth, CCodeSheet& sheet);

struct T_FR_CONNECTION {
    FR_CONNECTION kind = FR_CONNECTION::WeldedFlange;
    double depth = 0.0; // of the beam, m
    // ASCE 41-17 9.4.2.4.3.
    bool applyFactors = true;
    double span = 0.0;                               // clear span L of the beam, m
    double flangeWidth = 0.0, flangeThickness = 0.0; // of the beam: bf, tf, m
    double columnFlange = 0.0;                       // tcf, m
    double continuityPlate = 0.0;                    // thickness, m; 0: none
    double panelRatio = 0.0;                         // Vpz / Vye
    double slenderShare = 0.0;                       // of flange and web: 0 compact, 1 slender
};

/// a, b, c in rad; IO, LS, CP stay 0: say so to the backbone.
std::optional<T_CODE_PLASTIC> AsceConnection(const T_FR_CONNECTION& c, CCodeSheet& sheet);
