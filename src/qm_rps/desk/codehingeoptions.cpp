#include "qm_rps/desk/codehingeoptions.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushstoreys.h"

#include <algorithm>
#include <cmath>

namespace {

/// A document with the content of another one, which stays the current one.
class CTrial {
public:
    explicit CTrial(const CDBDoc& of)
    {
        CDBDoc* const current = CDBDoc::GetDocPoint();
        m_doc = std::make_unique<CDBDoc>();
        CDBDoc::SetDocPoint(current);
        m_doc->Data().Assign(of.Data().Content());
    }
    CDBDoc& Doc() { return *m_doc; }

private:
    std::unique_ptr<CDBDoc> m_doc;
};

std::optional<HINGE_CODE> CodeOf(const T_GENERATED& made)
{
    const auto code = std::ranges::find(kHingeCodeNames, made.code);
    if (code == kHingeCodeNames.end()) return {};
    return static_cast<HINGE_CODE>(code - kHingeCodeNames.begin());
}

/// A beam element of steel that rises by 45 degrees at most: to the generator it is no column.
bool IsSteelBeam(const T_MODEL& model, int id)
{
    const auto element = model.elements.find(id);
    if (element == model.elements.end() || element->second.kind != ELEM_KIND::Beam) return false;
    const auto material = model.materials.find(element->second.material);
    if (material == model.materials.end() || material->second.type != MATL_CLASS::Steel)
        return false;
    const std::array<double, 3>& i = model.nodes.at(element->second.nodeI).xyz;
    const std::array<double, 3>& j = model.nodes.at(element->second.nodeJ).xyz;
    const std::size_t up = VerticalAxis(model);
    const double length = std::hypot(j[0] - i[0], j[1] - i[1], j[2] - i[2]);
    return std::fabs(j[up] - i[up]) <= std::sqrt(0.5) * length;
}

} // namespace

CCodeHingeOptions::CCodeHingeOptions(CDBDoc& doc) : m_doc(doc)
{
    const auto& concrete = doc.Data().Model().styp.designCodes.concrete;
    if (concrete && concrete->starts_with("Eurocode")) m_code = HINGE_CODE::En1998;
}

std::vector<std::string> CCodeHingeOptions::ShearTexts() const
{
    std::vector<std::string> texts{Say("IDS_QM_UI_GEN_SHEAR_STRENGTHS")};
    for (const auto& entry : m_doc.Data().Model().pushovers)
        texts.push_back(Say("IDS_QM_UI_GEN_SHEAR_PUSH", entry.second.name));
    if (!m_pushed.empty()) texts.push_back(Say("IDS_QM_UI_GEN_SHEAR_STALE"));
    return texts;
}

int CCodeHingeOptions::PushedCase() const
{
    const auto& all = m_doc.Data().Model().pushovers;
    return m_shear < 1 || m_shear > std::ssize(all) ? 0
                                                    : std::next(all.begin(), m_shear - 1)->first;
}

bool CCodeHingeOptions::HasMasonry() const
{
    return std::ranges::any_of(m_doc.Data().Model().materials, [](const auto& entry) {
        return entry.second.type == MATL_CLASS::Masonry;
    });
}

bool CCodeHingeOptions::AsksConnection(const std::vector<int>& elements) const
{
    const T_MODEL& model = m_doc.Data().Model();
    return m_code == HINGE_CODE::Asce17 &&
           std::ranges::any_of(elements, [&](int id) { return IsSteelBeam(model, id); });
}

std::vector<std::string> CCodeHingeOptions::ConnectionTexts()
{
    std::vector<std::string> texts{Say("IDS_QM_UI_GEN_NO_CONNECTION")};
    texts.insert(texts.end(), kFrConnectionNames.begin(), kFrConnectionNames.end());
    return texts;
}

void CCodeHingeOptions::TakeConnection(const std::optional<T_STEEL_CONNECTION>& connection)
{
    m_connection = 0;
    m_measures = {};
    if (!connection) return;
    const auto kind = std::ranges::find(kFrConnectionNames, connection->kind);
    if (kind == kFrConnectionNames.end()) return;
    m_connection = 1 + static_cast<int>(kind - kFrConnectionNames.begin());
    for (std::size_t i = 0; i < m_measures.size(); ++i) {
        const T_CONNECTION_MEASURE& measure = kConnectionMeasures[i];
        const double value = (*connection).*measure.value;
        if (value > 0.0) m_measures[i] = FromSi(value, Units(), measure.dim);
    }
}

int CCodeHingeOptions::ReadConnection(T_CODE_REQUEST& request, std::string& reason) const
{
    if (m_connection < 1 || !AsksConnection(request.elements)) return 1;
    T_STEEL_CONNECTION& connection = request.options.connection.emplace();
    connection.kind = kFrConnectionNames.at(static_cast<std::size_t>(m_connection - 1));
    for (std::size_t i = 0; i < m_measures.size(); ++i) {
        const T_CONNECTION_MEASURE& measure = kConnectionMeasures[i];
        if (!m_measures[i]) continue;
        if (!(*m_measures[i] > 0.0)) {
            reason = Say("IDS_QM_UI_GEN_MEASURE", Say(measure.key), ShortestText(*m_measures[i]));
            return 0;
        }
        connection.*measure.value = ToSi(*m_measures[i], Units(), measure.dim);
    }
    return 1;
}

void CCodeHingeOptions::TakeStale(const std::vector<int>& elements)
{
    m_pushed.clear();
    const T_GENERATED* first = nullptr;
    std::optional<T_STEEL_CONNECTION> connection;
    const T_MODEL& model = m_doc.Data().Model();
    for (const auto& entry : model.hinges) {
        const int element = entry.second.element;
        const auto type = model.hingeTypes.find(entry.second.hingeType);
        if (std::ranges::find(elements, element) == elements.end() ||
            type == model.hingeTypes.end() || !type->second.generated)
            continue;
        const T_GENERATED& made = *type->second.generated;
        if (!made.pushed.empty()) m_pushed[element] = made.pushed;
        if (!first && CodeOf(made)) first = &made;
        if (!connection) connection = made.connection;
    }
    m_shear = m_pushed.empty() ? 0 : static_cast<int>(std::ssize(ShearTexts())) - 1;
    TakeConnection(connection);
    if (!first) return;
    m_code = *CodeOf(*first);
    m_secondary = first->secondary;
    m_tie = FromSi(first->tie, Units(), kDimForce);
    for (std::size_t i = 0; i < m_axial.size(); ++i) {
        m_axial[i].reset();
        if (!first->axialRange.empty())
            m_axial[i] = FromSi(first->axialRange.at(i), Units(), kDimForce);
    }
}

int CCodeHingeOptions::Read(std::vector<int> elements, T_CODE_REQUEST& out,
                            std::string& reason) const
{
    T_CODE_REQUEST request;
    request.elements = std::move(elements);
    request.keepGoing = m_keepGoing;
    const bool asStale = !m_pushed.empty() && m_shear == std::ssize(ShearTexts()) - 1;
    if (asStale) request.pushed = m_pushed;
    request.options = {m_code, m_secondary};
    if (m_tie < 0.0) {
        reason = Say("IDS_QM_UI_GEN_NO_TIE", ShortestText(m_tie));
        return 0;
    }
    if (HasMasonry()) request.options.tie = ToSi(m_tie, Units(), kDimForce);
    const auto& [from, to] = m_axial;
    if (HasAxialCurves() && (from || to)) {
        if (!from || !to || !(*from < *to)) {
            const auto text = [](const std::optional<double>& force) {
                return force ? FormatText("%.10g", *force) : std::string("?");
            };
            reason = Say("IDS_QM_GEN_RANGE", text(from) + ".." + text(to));
            return 0;
        }
        request.options.axialRange = {ToSi(*from, Units(), kDimForce),
                                      ToSi(*to, Units(), kDimForce)};
    }
    if (!ReadConnection(request, reason)) return 0;
    out = std::move(request);
    return 1;
}

int CCodeHingeOptions::Make(CDBDoc& doc, const T_CODE_REQUEST& request,
                            const PUSH_PROGRESS_FN& progress, T_CODE_HINGES& out,
                            T_HINGE_REFUSAL& refusal) const
{
    CCodeHinges generator(doc);
    const int pushed = PushedCase();
    return pushed == 0 ? generator.Generate(request, out, refusal)
                       : generator.GenerateFromPush(request, pushed, progress, out, refusal);
}

int CCodeHingeOptions::Generate(const T_CODE_REQUEST& request, const PUSH_PROGRESS_FN& progress,
                                T_CODE_HINGES& out, T_HINGE_REFUSAL& refusal) const
{
    return Make(m_doc, request, progress, out, refusal);
}

int CCodeHingeOptions::Preview(const T_CODE_REQUEST& request, const PUSH_PROGRESS_FN& progress,
                               T_CODE_HINGES& out, T_HINGE_REFUSAL& refusal) const
{
    if (PushedCase() == 0) return CCodeHinges(m_doc).Preview(request, out, refusal);
    CTrial trial(m_doc); // what is pushed are hinges that are there
    return Make(trial.Doc(), request, progress, out, refusal);
}

std::string CodeIterationsText(const T_CODE_HINGES& hinges, const T_UNITS& units)
{
    const auto force = [&units](double value) {
        return FormatText("%.5g", FromSi(value, units, kDimForce));
    };
    std::string text;
    int number = 0;
    for (const T_CODE_ITERATION& it : hinges.iterations)
        text += Say("IDS_QM_GEN_ITERATION", std::to_string(++number),
                    std::to_string(it.change.element), FormatText("%.3g", 100.0 * it.change.change),
                    force(it.change.before) + " -> " + force(it.change.now)) +
                ", " + it.outcome + "\n";
    return text;
}
