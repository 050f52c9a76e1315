// Results of the analysis in construction stages, in SI.
#pragma once

#include "qm_db/staticresult.h"

#include <compare>

/// A result of stages: the state at the end of a step, by a load case or by a sum of them.
struct T_STAGE_CHOICE {
    int stage = 0; // key
    int step = kStageLastStep;
    int load = kStageLoadSum; // key of a load case, or of a sum
    auto operator<=>(const T_STAGE_CHOICE&) const = default;
};

class IStagedResult {
public:
    IStagedResult() = default;
    IStagedResult(const IStagedResult&) = delete;
    IStagedResult& operator=(const IStagedResult&) = delete;
    virtual ~IStagedResult() = default;

    /// Of what they were computed from, see FingerprintOfStages.
    virtual std::uint64_t Fingerprint() const = 0;
    /// Whether the load case acts in a stage.
    virtual bool HasLoadCase(int key) const = 0;
    /// Everything of one choice, in one pass through the model; what does not stand then has zeros.
    /// 1 done; 0 there is no such result, output as it was.
    [[nodiscard]] virtual int Read(const T_STAGE_CHOICE& choice, T_STATIC_DATA& out) const = 0;
};

/// Keys of the load cases that come or go at a stage, ascending.
std::vector<int> StageLoadCases(const T_MODEL& model);
