// Results of the analysis in construction stages, in SI.
#pragma once

#include "qm_db/results/staticresult.h"

#include <compare>
#include <set>

/// A result of stages: the state at the end of a step, by a load case or by a sum of them.
struct T_STAGE_CHOICE {
    int stage = 0; // key
    int step = kStageLastStep;
    int load = kStageLoadSum; // key of a load case, or of a sum
    auto operator<=>(const T_STAGE_CHOICE&) const = default;
};

/// A load case at the end of a step, with the group whose sums it belongs to.
struct T_STAGE_CASE {
    T_STAGE_CHOICE at; // of the load case; no sum
    int group = kLoadGroupRest;
    bool operator==(const T_STAGE_CASE&) const = default;
};

/// Whether a load case of that group belongs to what `load` selects: itself, or a sum.
bool BelongsTo(int load, int loadCase, int group);

class IStagedResult {
public:
    IStagedResult() = default;
    IStagedResult(const IStagedResult&) = delete;
    IStagedResult& operator=(const IStagedResult&) = delete;
    virtual ~IStagedResult() = default;

    /// Of what they were computed from, see FingerprintOfStages.
    virtual std::uint64_t Fingerprint() const = 0;
    /// Every load case at every step of every stage.
    virtual std::vector<T_STAGE_CASE> Cases() const = 0;
    /// The results that add up to one choice, perhaps none. A node or an element of the model that
    /// one of them does not have has zeros in it, as what does not stand then. The step is a
    /// number. 1 done; 0 there is no such result, output as it was.
    [[nodiscard]] virtual int Open(const T_STAGE_CHOICE& choice,
                                   std::vector<std::shared_ptr<IStaticResult>>& out) const = 0;
};

/// Keys of the load cases that come or go at a stage, ascending.
std::vector<int> StageLoadCases(const T_MODEL& model);
/// Ids of the elements that stand in a stage.
std::set<int> StandingElements(const T_MODEL& model, int stage);
