// What the result and report tools of a document share.
#pragma once

#include "qm_base/dynmodule.h"
#include "qm_rps/ssreportinforw.h"

/// State: the latest report data set. Lives in the document's module registry.
class CRPSManager : public CDynModule {
public:
    /// In the module registry.
    static constexpr const char* kName = "CRPSManager";
    /// That of the current document, made when it is first asked for; null without a document.
    static CRPSManager* Current();

    /// Takes a data set in place of the one it holds. The very set that it holds already raises
    /// the release assertion first. A null one empties it.
    void SetReportInfo(std::shared_ptr<const SSReportInfoRW> info);
    /// Null: none was built yet.
    const std::shared_ptr<const SSReportInfoRW>& ReportInfo() const { return m_info; }

private:
    std::shared_ptr<const SSReportInfoRW> m_info;
};
