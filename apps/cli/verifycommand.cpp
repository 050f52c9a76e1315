#include "verifycommand.h"

#include "inputfile.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/filectrl.h"
#include "qm_rps/pushovercurvedlg.h"
#include "json/resultjson.h"

#include <nlohmann/json.hpp>

#include <cmath>
#include <cstdio>
#include <map>

namespace {

using json = nlohmann::json;

/// Results of the case files of one folder by evaluation name; each case is evaluated once.
class CCases {
public:
    explicit CCases(std::string folder) : m_folder(std::move(folder)) {}

    /// The result object of an evaluation; null where the case or the evaluation is missing.
    const json& Result(const std::string& file, const std::string& evaluation)
    {
        static const json kNone;
        if (!m_results.contains(file)) Evaluate(file);
        for (const json& r : m_results[file]) {
            if (r.at("name") == evaluation) return r;
        }
        return kNone;
    }

private:
    void Evaluate(const std::string& file)
    {
        m_results[file] = json::array();
        CDBDoc doc;
        if (OpenInput(doc, m_folder + "/" + file) != EXIT_CODE::Done) return;
        std::vector<T_PUSH_EVALUATION> results;
        CPushOverCurveDlg driver(doc);
        for (const auto& entry : doc.Data().Model().evaluations) {
            if (!driver.SetEvaluation(entry.second)) continue;
            driver.Evaluate();
            results.push_back(driver.Result());
        }
        m_results[file] = json::parse(ResultJson(results));
    }

    std::string m_folder;
    std::map<std::string, json> m_results;
};

/// Our value of a check, scaled to the unit of its reference; NaN where there is none.
double OurValue(const json& check, CCases& cases)
{
    const json& result = cases.Result(check.at("case"), check.at("evaluation"));
    const auto at = [&](const char* key) {
        const json::json_pointer pointer(check.at(key).get<std::string>());
        return result.contains(pointer) && result.at(pointer).is_number()
                   ? result.at(pointer).get<double>()
                   : std::nan("");
    };
    if (result.is_null()) return std::nan("");
    const double value = at("path") * check.value("scale", 1.0);
    return check.contains("divide_by") ? value / at("divide_by") : value;
}

/// One row of the table; false for a difference that nothing explains.
bool PrintRow(const json& check, CCases& cases)
{
    const double reference = check.at("reference"), precision = check.at("precision");
    const double ours = OurValue(check, cases);
    const double difference = ours - reference;
    const bool within = std::fabs(difference) <= precision * (1.0 + 1e-9);
    const std::string why = check.value("explanation", std::string());
    const bool good = std::isfinite(ours) && (within || !why.empty());
    const std::string note = within ? ""
                             : good ? why
                                    : "**" + Say("IDS_QM_CLI_NOT_EXPLAINED") + "**";
    std::printf("%s", FormatText("| %s | %s | %s | %.2g | %.9g | %.2g | %s |\n",
                                 check.at("source").get<std::string>().c_str(),
                                 check.at("quantity").get<std::string>().c_str(),
                                 ShortestText(reference).c_str(), precision, ours, difference,
                                 note.c_str())
                          .c_str());
    return good;
}

} // namespace

EXIT_CODE RunVerify(const std::string& folder)
{
    T_FILE_ERROR error;
    std::string text;
    if (!CFileCtrl::ReadWholeFile(folder + "/checks.json", text, error))
        return ReportFileError(error);
    const json document = json::parse(text, nullptr, false);
    if (document.is_discarded() || !document.contains("checks"))
        return ReportFileError(
            {FILE_FAULT::BadInput, folder + "/checks.json: " + Say("IDS_QM_CLI_NO_CHECKS")});
    CCases cases(folder);
    std::printf("%s\n|---|---|---|---|---|---|---|\n", Say("IDS_QM_CLI_VERIFY_HEAD").c_str());
    int bad = 0;
    for (const json& check : document.at("checks"))
        bad += PrintRow(check, cases) ? 0 : 1;
    std::printf("\n%s\n", Say("IDS_QM_CLI_VERIFY_COUNTS",
                              std::to_string(document.at("checks").size()), std::to_string(bad))
                              .c_str());
    return bad == 0 ? EXIT_CODE::Done : EXIT_CODE::NotFound;
}
