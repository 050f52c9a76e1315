// Stage results of a document, for the stage family of the optimizer's sources.
#pragma once

#include "qm_rps/factors/ulfstageresponse.h"

class CDBDoc;

class CUlfStageResults : public IUlfStageResults {
public:
    explicit CUlfStageResults(CDBDoc& doc) : m_doc(doc) {}

    [[nodiscard]] int SelectSum(const std::string& stageLoad, int stage, int step) override;
    [[nodiscard]] int SelectCase(int loadCase, int stage, int step) override;
    [[nodiscard]] int ReadOne(const T_OPT_QUANTITY& what, double& out) override;
    std::string Error() const override;

private:
    CDBDoc& m_doc;
};
