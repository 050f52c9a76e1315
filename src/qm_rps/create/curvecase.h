// A model around a capacity curve of another program: a stick with the masses of the storeys, one
// mode, the curve as the steps of a push, a spectrum and evaluations.
#pragma once

#include "qm_db/modelstore.h"
#include "qm_rps/create/curvetext.h"

#include <optional>
#include <string>
#include <vector>

/// What the numbers of the masses are.
enum class MASS_GIVEN {
    Model,     // mass of the model's units: force s2 / length
    Tonnes,    // 1000 kg
    Kilograms, // kg
    Weight     // force of the model's units, over gravity
};
/// Where the shape comes from that Gamma and the mass of the substitute oscillator are made of.
enum class SHAPE_GIVEN {
    Heights, // proportional to the height above the ground
    Curve,   // displacements of the storeys at the first step of the curve
    Typed
};

struct T_CURVE_METHOD {
    PUSH_METHOD method = PUSH_METHOD::Atc40;
    std::optional<char> procedure{}; // absent: A, where the method has procedures
};
/// "ATC-40:A", "FEMA440:C", "EC8/OPCM" and back.
std::string CurveMethodText(const T_CURVE_METHOD& method);
/// 0: no such method, `out` as it was.
[[nodiscard]] int ParseCurveMethod(const std::string& text, T_CURVE_METHOD& out);

struct T_CURVE_CASE {
    std::string title{};
    T_UNITS units{}; // of curve, masses and heights, and of the model
    T_CURVE_TEXT curve{};
    std::vector<double> masses{}; // by storey, bottom to top; with isTotal one, spread evenly
    MASS_GIVEN massGiven = MASS_GIVEN::Model;
    bool isTotal = false;
    std::vector<double> heights{}; // of the storeys, bottom to top
    SHAPE_GIVEN shape = SHAPE_GIVEN::Heights;
    std::vector<double> typedShape{}; // by storey, any scale
    T_SPFC_D spectrum{};
    std::vector<T_CURVE_METHOD> methods{}; // empty: the one that goes with the spectrum
};

/// What the case was made with, in the case's units.
struct T_CURVE_FACTS {
    T_CURVE_READ read;
    std::vector<double> mass, shape; // by storey; the shape is 1 at the top
    double totalMass = 0.0, weight = 0.0;
    double gamma = 0.0;          // sum(m phi) / sum(m phi2)
    double substituteMass = 0.0; // m* = sum(m phi), EN 1998-1 (B.2)
    double massRatio = 0.0;      // sum(m phi)2 / (sum(m phi2) sum(m)), alpha1 of ATC-40 (8-2)
    double period = 0.0;         // 2 pi sqrt(m* d / V) of the first step, s
    double peakForce = 0.0;      // largest base shear
};

/// 1 made; 0 `fault` names the field (text, columns, masses, heights, shape, spectrum) and why,
/// outputs as they were.
[[nodiscard]] int MakeCurveCase(const T_CURVE_CASE& in, T_MODEL_CONTENT& out, T_CURVE_FACTS& facts,
                                T_FINDING& fault);

/// How the text was read, masses, weight, Gamma, period, and what looks odd: a line each.
std::vector<std::string> CurveCaseNotes(const T_CURVE_CASE& in, const T_CURVE_FACTS& facts);
