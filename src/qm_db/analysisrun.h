// Linear static analysis of load cases, eigen analysis and construction stages of a model.
#pragma once

#include "qm_db/analysis/analysisoptions.h"
#include "qm_db/editdata.h"

class CDBDoc;

/// What an analysis has found.
struct T_ANALYSIS_RESULTS {
    T_STATIC_MAP cases;                         // of the load cases that were asked for
    std::optional<std::vector<T_EIGV_D>> modes; // where they were asked for
    std::shared_ptr<IStagedResult> staged;      // likewise, where the model has stages
    std::vector<T_LOST_DIGITS> lost;
};

/// Feeds a model to the analysis engine, and keeps the results in a document: of each load case
/// with the fingerprint of what it was computed from; modes, when they are asked for, in place of
/// the model's modes, as an edit that can be undone.
class CAnalysisRun {
public:
    explicit CAnalysisRun(CDBDoc& doc) : m_doc(doc) {}

    /// Reads the model and changes nothing. One factorisation serves all load cases and the modes;
    /// construction stages have their own, whose symbolic part is that of `before` (results of an
    /// earlier run, may be null) where only loads have changed. 1 done; 0 error filled, output as
    /// it was.
    [[nodiscard]] static int Compute(const T_MODEL& model, const T_ANALYSIS_OPTIONS& options,
                                     const std::shared_ptr<IStagedResult>& before,
                                     T_ANALYSIS_RESULTS& out, T_ANALYSIS_ERROR& error);
    /// 1 done; 0 the modes were not changed.
    [[nodiscard]] int Keep(T_ANALYSIS_RESULTS results);

private:
    [[nodiscard]] int KeepModes(std::vector<T_EIGV_D> modes);

    CDBDoc& m_doc;
};
