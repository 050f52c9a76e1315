#include "qm_rps/factors/ulfchecked.h"

#include "qm_base/say.h"
#include "qm_rps/factors/ulfstageproblem.h"
#include "qm_rps/factors/ulfstageresults.h"
#include "qm_rps/factors/ulfstaticresponse.h"

#include <cmath>
#include <set>

namespace {

constexpr double kRounding = 1e-6; // of a row's scale, as of a constraint that is met

/// A document of another model; the one that was current before is so again behind it.
class COwnDoc {
public:
    explicit COwnDoc(T_MODEL model) : m_before(CDBDoc::GetDocPoint()), m_doc(std::in_place)
    {
        T_MODEL_CONTENT content;
        content.model = std::move(model);
        m_doc->Data().Assign(std::move(content));
    }
    COwnDoc(const COwnDoc&) = delete;
    COwnDoc& operator=(const COwnDoc&) = delete;
    ~COwnDoc()
    {
        m_doc.reset();
        CDBDoc::SetDocPoint(m_before);
    }
    CDBDoc& Doc() { return *m_doc; }

private:
    CDBDoc* m_before;
    std::optional<CDBDoc> m_doc;
};

template <class LOADS, class SCALE>
void Append(const LOADS& from, LOADS& to, SCALE scale)
{
    for (auto load : from) {
        scale(load);
        to.push_back(std::move(load));
    }
}

/// Adds the loads of a case times a factor.
void AddTimes(const T_STLD_D& from, double factor, T_STLD_D& to)
{
    const auto all = [factor](auto& values) {
        for (double& value : values)
            value *= factor;
    };
    for (std::size_t d = 0; d < to.selfWeight.size(); ++d)
        to.selfWeight[d] += factor * from.selfWeight[d];
    Append(from.nodal, to.nodal, [&](T_NODAL_LOAD& l) { all(l.load); });
    Append(from.beam, to.beam, [&](T_BEAM_LOAD& l) { all(l.w); });
    Append(from.settlement, to.settlement, [&](T_SETTLEMENT& l) { all(l.displacement); });
    Append(from.temperature, to.temperature, [&](T_TEMPERATURE_LOAD& l) { l.change *= factor; });
    Append(from.pretension, to.pretension, [&](T_PTNS_D& l) { l.force *= factor; });
}

/// Whether the stages analysed as they are, with scaled pretension, are what the factors mean.
bool IsPretensionAlone(const T_ULSI_D& item, const T_ULF_RESULT& result)
{
    constexpr double kOne = 1e-9; // a factor that changes nothing
    for (std::size_t j = 0; j < item.rows.size(); ++j) {
        const bool isScaled = item.rows[j].unknown && item.rows[j].pretension;
        if (!isScaled && std::fabs(result.factors[j] - 1.0) > kOne) return false;
    }
    return true;
}

/// Multiplies the pretension that the unknowns scale.
void Scale(const T_ULSI_D& item, const T_ULF_RESULT& result, T_MODEL& model)
{
    for (std::size_t j = 0; j < item.rows.size(); ++j) {
        if (!item.rows[j].unknown) continue;
        for (const int load : LoadsScaledBy(model, item.rows[j]))
            for (T_PTNS_D& tension : model.loadCases.at(load).pretension)
                tension.force *= result.factors[j];
    }
}

T_ULF_CHECKED NotChecked(std::string why)
{
    T_ULF_CHECKED out;
    out.why = std::move(why);
    return out;
}

} // namespace

T_ULF_CHECKED CheckUlf(CDBDoc& doc, const T_ULF_RUN& run, const T_ULF_RESULT& result)
{
    T_MODEL model = doc.Data().Model();
    T_STLD_D together;
    together.name = Say("IDS_QM_ULF_CHECKED_CASE");
    for (std::size_t j = 0; j < result.cases.size(); ++j)
        AddTimes(model.loadCases.at(result.cases[j].key), result.factors[j], together);
    const int key = model.loadCases.rbegin()->first + 1;
    model.loadCases[key] = together;
    COwnDoc own(std::move(model));
    T_ANALYSIS_OPTIONS options;
    options.allCases = options.stages = false;
    options.cases = {key};
    T_ANALYSIS_ERROR error;
    if (!own.Doc().RunAnalysis(options, error)) return NotChecked(error.text);
    CUlfStaticResponse source(own.Doc());
    const T_ULF_CASE whole{key, together.name, 1.0};
    std::vector<std::vector<double>> values;
    if (!ReadUlfInfluence({&whole, 1}, run.constraints, source, values))
        return NotChecked(source.Error());
    T_ULF_CHECKED out;
    for (std::size_t i = 0; i < values.size(); ++i) {
        T_ULF_ANALYSED& row = out.rows.emplace_back();
        row.name = result.constraints[i].name;
        row.unit = result.constraints[i].unit;
        row.forecast = UlfValue(result, i);
        row.analysed = values[i].front();
        row.scale = UlfScale(result, i);
        row.allowed = kRounding * row.scale;
    }
    return out;
}

T_ULF_CHECKED CheckUlfStages(CDBDoc& doc, const T_ULSI_D& item, const T_ULF_RUN& run,
                             const T_ULF_RESULT& result)
{
    if (!IsPretensionAlone(item, result)) return NotChecked(Say("IDS_QM_ULF_CHECKED_OTHER"));
    T_MODEL model = doc.Data().Model();
    Scale(item, result, model);
    COwnDoc own(std::move(model));
    T_ANALYSIS_OPTIONS options;
    options.allCases = false;
    T_ANALYSIS_ERROR error;
    if (!own.Doc().RunAnalysis(options, error)) return NotChecked(error.text);
    CUlfStageResults results(own.Doc());
    T_ULF_CHECKED out;
    if (!CompareWithAnalysis(run, result, item, own.Doc().Data(), results, 0.0, out.rows))
        return NotChecked(results.Error());
    out.stays = StaysOf(PretensionOf(item, doc.Data()), own.Doc().Data(), results);
    return out;
}
