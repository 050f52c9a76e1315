// Responses to static load cases, read from the document's analysis results.
#pragma once

#include "qm_rps/factors/ulfresponse.h"

class CDBDoc;

/// Each item's load case is made a combination of its own with factor 1, selected once, and
/// everything asked for is read from it. Leaves that combination as the document's current result.
class CUlfStaticResponse : public IUlfResponse {
public:
    explicit CUlfStaticResponse(CDBDoc& doc) : m_doc(doc) {}

    [[nodiscard]] int Read(std::span<const T_OPT_ITEM> items, std::span<const T_OPT_QUANTITY> what,
                           std::span<double> out) override;
    /// Names the load case and says what is missing: no results, results older than the model.
    std::string Error() const override { return m_error; }

private:
    [[nodiscard]] int ReadOne(const T_OPT_QUANTITY& what, double& out);

    CDBDoc& m_doc;
    std::string m_error;
};
