// Assembly of the capacity curve of one pushover load case from the model's result steps.
//
// Index 0 is one tenth of the first step, index i is step Steps()[i]: steps that a push of our own
// has at what evaluations found are left out, so that these find the same again. Values are in
// current units; the spectral plot types give Sd in the model's length unit and Sa in g.
#pragma once

#include "qm_db/dbdoc.h"

#include <array>
#include <string>
#include <vector>

/// Plot types; the spectral ones (4 to 8) are also the method codes.
enum class PLOT_TYPE {
    BaseReaction = 0, // displacement against base reaction
    ShearCoeff = 1,   // displacement against base reaction / weight
    Drift = 2,        // displacement / height against base reaction / weight
    LoadFactor = 3,   // displacement against load factor
    Fema440 = 4,
    Atc40 = 5,
    Ec8Opcm = 6,
    Ntc2008 = 7,
    Ntc2018 = 8
};
inline bool IsSpectral(PLOT_TYPE type)
{
    return type >= PLOT_TYPE::Fema440;
}
inline bool IsTargetType(PLOT_TYPE type)
{
    return type >= PLOT_TYPE::Ec8Opcm;
}

struct T_PUSH_CURVE_SETTINGS {
    int pushover = 0; // key of the load case
    int turn = 0;     // of its static angle: so many times
    PLOT_TYPE plotType = PLOT_TYPE::Atc40;
    bool eigenFactors = true; // factors of the eigen mode, else from nodal masses and the shape
    double gravity = 9.80665; // current units
    double userWeight = 0.0;  // used where the model has no vertical mass, force unit
    std::array<double, 4> extraNodes{}; // further monitored nodes; numbers kept as reals
    bool operator==(const T_PUSH_CURVE_SETTINGS&) const = default;
};

/// Control option of a load case that names its control node.
inline constexpr int kNamedControlNode = 1;

/// Factors between the multi- and the single-degree-of-freedom system.
struct T_PUSH_FACTORS {
    double gamma = 0.0;   // Gamma-phi: control displacement / Sd
    double alpha = 0.0;   // modal mass ratio
    double mass = 0.0;    // direction mass total of the control direction
    double weight = 0.0;  // vertical mass times gravity, else the user's weight
    double gravity = 0.0; // length / s2
    bool eigenBased = true;
    int mode = 0;         // eigen mode used; 0 none
    bool oblique = false; // the direction lies between the axes
    bool operator==(const T_PUSH_FACTORS&) const = default;
};
inline auto Numbers(const T_PUSH_FACTORS& f)
{
    return std::tie(f.gamma, f.alpha, f.mass, f.weight, f.gravity);
}

class CPushOverCurveData {
public:
    explicit CPushOverCurveData(CDBDoc& doc) : m_doc(doc) {}

    /// Prepares the factors and assembles the curve. 1 done; 0 no such load case, no results, or
    /// results that can't be read (Error says which). The flags below tell what is not usable.
    [[nodiscard]] int Calc(const T_PUSH_CURVE_SETTINGS& settings);

    const std::vector<double>& Displacement() const { return m_x; }
    const std::vector<double>& Force() const { return m_y; }
    /// Numbers of the steps by index; 0 stands for no step.
    const std::vector<int>& Steps() const { return m_steps; }
    double MaxDisplacement() const { return m_maxX; }
    double MaxForce() const { return m_maxY; }
    const std::vector<double>& ExtraDisplacement(std::size_t i) const { return m_extra[i]; }
    const T_PUSH_FACTORS& Factors() const { return m_factors; }
    const T_POLC_D& LoadCase() const { return m_polc; }
    /// The plot type used: a vertical push allows the load factor alone.
    PLOT_TYPE PlotType() const { return m_plotType; }

    /// Whether the control node is the one that has moved most at the last step.
    bool IsControlNodeFound() const { return m_polc.controlOption != kNamedControlNode; }

    bool NoEigen() const { return m_noEigen; }                 // the model has no eigen modes
    bool EigenError() const { return m_eigenError; }           // the mode does not move that way
    bool ConversionError() const { return m_conversionError; } // Gamma or the force scale is 0
    bool MassError() const { return m_massError; }             // no mass-based factors
    bool StoreyWithoutMass() const { return m_storeyWithoutMass; }
    /// First step whose control displacement is smaller than the step before; 0 none.
    int FirstDecreasingStep() const { return m_decreasingStep; }
    const std::string& Error() const { return m_error; }

    /// Transforms a displacement and a force of the model by the plot type.
    void TransformByPlotType(PLOT_TYPE type, double& displacement, double& force) const;

    /// SDOF to MDOF for the spectral plot types: displacement times Gamma-phi, force times mass,
    /// gravity and alpha, both made absolute. Null arguments are left out.
    void TransferToDispAndReac(double* displacement, double* reaction) const;

private:
    int BeforePreparePOCurveData(const T_PUSH_CURVE_SETTINGS& settings);
    int FindControlNode();
    void CalcEigenMode();
    void CalcMassFactors(double control);
    void CheckStoreyMasses();
    void CalcConversion();
    int PreparePOCurveData();
    int AppendStep(int step);
    double ControlShape() const;
    int Direction() const { return m_polc.direction - 1; } // 0 to 5; the nearest axis
    bool IsRotation() const { return Direction() > 2; }
    void FindDirection();
    double Along(const std::array<double, 3>& v) const;
    double MassAlong(const std::array<double, 3>& mass) const;
    double ModalFactor(const T_MPAF_D& factor) const;
    double ModalPercent(const T_MPAF_D& factor, const T_MPAM_D& percent) const;

    CDBDoc& m_doc;
    T_PUSH_CURVE_SETTINGS m_settings;
    T_POLC_D m_polc;
    PLOT_TYPE m_plotType = PLOT_TYPE::Atc40;
    T_PUSH_FACTORS m_factors;
    std::array<double, 3> m_along{}; // unit vector of a translation
    std::array<double, 3> m_mass{};  // second per-direction totals
    double m_massGamma = 0.0, m_massAlpha = 0.0;
    bool m_noEigen = false, m_eigenError = false, m_conversionError = false, m_massError = false;
    bool m_storeyWithoutMass = false;
    int m_decreasingStep = 0;
    double m_controlHeight = 0.0;
    std::vector<double> m_x, m_y;
    std::vector<int> m_steps;
    std::array<std::vector<double>, 4> m_extra;
    double m_maxX = 0.0, m_maxY = 0.0;
    std::string m_error;
};
