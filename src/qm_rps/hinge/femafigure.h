// The explanatory figures of FEMA hinges: how strength and unloading stiffness degrade.
// Deformations in D / Dy, strengths in F / Fy, about the origin.
#pragma once

#include "qm_base/mdialog.h"

#include <string>
#include <vector>

struct T_FIGURE_POINT {
    double x = 0.0, y = 0.0;
    std::string label{};
    bool operator==(const T_FIGURE_POINT&) const = default;
};

struct T_FIGURE_CURVE {
    std::string name; // in the chosen language
    std::vector<T_FIGURE_POINT> points;
};

/// Base of the figures: it shows, and nothing can be changed in it.
class CFemaFigureDlg : public zql::frx::MDialog {
public:
    virtual const char* TitleKey() const = 0;
    /// The sentences that explain the figure.
    virtual const char* TextKey() const = 0;
    virtual std::vector<T_FIGURE_CURVE> Curves() const = 0;
    /// Marked points: those of the backbone, or of a loop.
    virtual std::vector<T_FIGURE_POINT> Points() const = 0;
};

/// The backbone of the figures on the positive side: A, B, C, D, E, and the drop to 0 after E.
const std::vector<T_FIGURE_POINT>& FigureBackbone();
/// Its strength at a deformation, odd: the negative side mirrors the positive one.
double FigureStrength(double deform);

/// Response to cycles of growing amplitude, each twice. Unloading has the initial stiffness,
/// reloading aims at the largest deformation reached on that side (peak-oriented). Energy-based:
/// strength falls with the energy dissipated so far (cyclic degradation); else it is lost along the
/// backbone alone, within the cycle that passes C (FEMA 440 2.2, ASCE 41-13 7.4.3).
std::vector<T_FIGURE_POINT> CyclicResponse(bool energyBased);
/// Amplitudes of the cycles, D / Dy.
const std::vector<double>& FigureAmplitudes();

/// What both figures of strength loss draw: the backbone of both sides, and the response.
std::vector<T_FIGURE_CURVE> StrengthLossCurves(bool energyBased);
/// Its points A to E.
std::vector<T_FIGURE_POINT> BackbonePoints();

/// Closed loop of an elastic-plastic component between -ductility and +ductility whose area is
/// `energy` times that of the full parallelogram. factor, -1 to 1, says how: -1 keeps the unloading
/// stiffness and shortens the elastic range, +1 keeps the elastic range and lowers the stiffness,
/// between them the elastic range is interpolated. energy in (0, 1].
std::vector<T_FIGURE_POINT> DegradedLoop(double ductility, double energy, double factor);
/// Unloading stiffness of that loop over the initial one.
double UnloadingStiffness(double ductility, double energy, double factor);
