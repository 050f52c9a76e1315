#include "reportcommand.h"

#include "inputfile.h"
#include "output.h"
#include "qm_rps/irpsinterfaceimpl.h"
#include "qm_rps/rpsmanager.h"
#include "json/reportjson.h"

#include <cstdio>

EXIT_CODE RunReportData(const std::string& file, const std::string& out, bool overwrite)
{
    if (const EXIT_CODE code = CheckOutputs(file, {{out, OUTPUT_KIND::Json}}, overwrite);
        code != EXIT_CODE::Done)
        return code;
    CDBDoc doc;
    if (const EXIT_CODE code = OpenInput(doc, file); code != EXIT_CODE::Done) return code;
    IRPSInterfaceImpl report;
    if (!report.BuildReport()) return Complain(EXIT_CODE::BadInput, file + ": " + report.Error());
    const SSReportInfoRW& data = *CRPSManager::Current()->ReportInfo();
    const EXIT_CODE code = WriteOutput(out, ReportJson(data));
    if (code == EXIT_CODE::Done && out != "-") std::printf("%s\n", out.c_str());
    return code;
}
