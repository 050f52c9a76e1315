// Limit states of the target-displacement methods: demands, nearest steps, capacities, remarks.
// Eurocode 8 (EN 1998-1 Annex B; DL, SD, NC; with masonry a capacity side) and NTC 2008/2018
// (SLO, SLD, SLV, SLC). Reads finished arrays, knows no model and no window.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"

/// Elastic spectrum as a limit state needs it.
struct T_TARGET_SPECTRUM {
    std::function<double(double)> SaAt; // g at a period in s; empty: the state is not enabled
    double Tc = 0.0;                    // s
};

struct T_TARGET_INPUT {
    T_ADRS_CURVE capacity; // index = step
    double gravity = 9.80665;
    double gamma = 1.0;
    double mStar = 0.0;
    T_BILINEAR_OPTIONS options;
    std::array<T_TARGET_SPECTRUM, 4> spectra; // Eurocode 8 uses the first alone
    T_DRIFT_OF_STEP drift;                    // of the chosen kind
};

class CPushOverTargetEvaluation {
public:
    explicit CPushOverTargetEvaluation(T_TARGET_INPUT input);

    /// Rows of a method without any value.
    static std::vector<T_LIMIT_ROW> EmptyRows(PUSH_METHOD method);

    /// Eurocode 8 limit states without and with the masonry capacity side. 1 a target was found;
    /// 0 none, the rows stay empty.
    [[nodiscard]] int UpdateTargetDispDataEC8();
    [[nodiscard]] int UpdateTargetDispDataMasonry();
    /// NTC limit states with the capacities of the 2008 or the 2018 code. 1 a state has a target.
    [[nodiscard]] int UpdateTargetDispDataNTC(PUSH_METHOD code);

    const std::optional<T_BILINEAR>& Bilinear() const { return m_bilinear; }
    const std::vector<T_TARGET_DISP>& Targets() const { return m_targets; }
    const std::vector<T_LIMIT_ROW>& Rows() const { return m_rows; }
    /// Demand steps in the order of the rows; kStepNone where not found.
    const std::vector<int>& DemandSteps() const { return m_demandSteps; }
    const std::vector<T_GUIDE_LINE>& GuideLines() const { return m_guides; }
    const T_OUTCOME& Outcome() const { return m_outcome; }
    /// True where the masonry strength never falls to 80 %: the last step stands for it.
    bool StrengthDropMissing() const { return m_noDrop; }

private:
    int CalcBilinear();
    int IterateBilinear();
    int FitEc8(const T_CURVE_PLACE& dm);
    T_TARGET_DISP CalcTarget(const T_TARGET_SPECTRUM& spectrum, bool capAt3) const;
    void FindDlSdNcSteps(std::span<const double> demands) { FindSteps(demands); }
    void FindNTC2008Steps(std::span<const double> demands) { FindSteps(demands); }
    void FindSteps(std::span<const double> demands);
    void SetDemand(std::size_t row, double dt);
    int UpdateTargetDispDataCapacity();
    void UpdateTargetDispDataCapacity_NTC2008(int driftStep);
    void UpdateTargetDispDataCapacity_NTC2018(std::optional<int> driftStep);
    void SetCapacity(std::size_t row, double mdof, const char* failing);
    void AddGuide(T_GUIDE_LINE::KIND kind, double Sd, const std::string& label);
    void FinishOutcome();

    T_TARGET_INPUT m_in;
    T_ADRS_CURVE m_fromOrigin; // the capacity preceded by the origin
    std::optional<T_BILINEAR> m_bilinear;
    int m_fits = 0; // bilinear curves fitted
    std::vector<T_TARGET_DISP> m_targets;
    std::vector<T_LIMIT_ROW> m_rows;
    std::vector<int> m_demandSteps;
    std::vector<T_GUIDE_LINE> m_guides;
    T_OUTCOME m_outcome;
    bool m_noDrop = false;
};
