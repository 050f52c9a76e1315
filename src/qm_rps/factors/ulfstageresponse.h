// Responses to construction-stage loads: the stage family of the optimizer's sources.
#pragma once

#include "qm_rps/factors/ulfresponse.h"

#include <vector>

/// Where stage results come from.
class IUlfStageResults {
public:
    IUlfStageResults() = default;
    IUlfStageResults(const IUlfStageResults&) = delete;
    IUlfStageResults& operator=(const IUlfStageResults&) = delete;
    virtual ~IUlfStageResults() = default;

    /// Selects the results of a stage load at the end of a stage's step (kStageLastStep: its last
    /// one). 1 done; 0 Error() says why not.
    [[nodiscard]] virtual int SelectSum(const std::string& stageLoad, int stage, int step) = 0;
    [[nodiscard]] virtual int SelectCase(int loadCase, int stage, int step) = 0;
    /// A quantity of the selected results in the document's current units; its `at` is not read.
    [[nodiscard]] virtual int ReadOne(const T_OPT_QUANTITY& what, double& out) = 0;
    virtual std::string Error() const = 0;
};

/// An item reads, by its load group: 0 and 1 both the dead-load sum (the sum of all stage loads
/// when those are summed), whatever its own load, 2 its own load; any other group gives 0. A
/// quantity that names a stage and step is read there, any other one at those of the item.
class CUlfStageResponse : public IUlfResponse {
public:
    /// `results` is not owned and must outlive this object.
    explicit CUlfStageResponse(IUlfStageResults& results) : m_results(results) {}

    bool m_sumStageLoads = false;
    /// Keys of the load cases of the items, in the order of the items given to Read.
    std::vector<int> m_loads;

    [[nodiscard]] int Read(std::span<const T_OPT_ITEM> items, std::span<const T_OPT_QUANTITY> what,
                           std::span<double> out) override;
    /// Names the stage and step and says what is missing.
    std::string Error() const override { return m_error; }

private:
    [[nodiscard]] int Select(const T_OPT_ITEM& item, int loadCase, int at);

    IUlfStageResults& m_results;
    std::string m_error;
};
