#include "qm_rps/create/spectrumtext.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/pastedtable.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/create/createfault.h"

#include <algorithm>
#include <array>
#include <functional>
#include <map>

namespace {

constexpr const char* kField = "spectrum";
constexpr const char* kAsce = "asce41"; // an atc40 spectrum by the parameters of ASCE 41

std::vector<std::string> Split(const std::string& text, char mark)
{
    std::vector<std::string> parts;
    for (std::size_t at = 0; at <= text.size();) {
        const std::size_t end = std::min(text.find(mark, at), text.size());
        parts.push_back(text.substr(at, end - at));
        at = end + 1;
    }
    return parts;
}

/// The values of one text by their keys; each is taken once, what is left is unknown.
class CValues {
public:
    CValues(std::map<std::string, std::string> values, T_FINDING& fault)
        : m_values(std::move(values)), m_fault(fault)
    {
    }

    bool Ok() const { return m_ok; }
    bool Has(const std::string& key) const { return m_values.contains(key); }
    std::string Text(const char* key, const std::string& missing)
    {
        const auto at = m_values.find(key);
        if (at == m_values.end()) return missing;
        const std::string value = at->second;
        m_values.erase(at);
        return value;
    }
    void Need(const char* key, double& out)
    {
        if (!Has(key)) return Fail("IDS_QM_NEW_SPECTRUM_MISSING", key);
        const std::vector<double> all = List(key);
        if (all.size() == 1) out = all.front();
    }
    void Maybe(const char* key, std::optional<double>& out)
    {
        if (Has(key)) Need(key, out.emplace());
    }
    /// Numbers parted by slashes.
    std::vector<double> List(const char* key)
    {
        std::vector<double> out;
        for (const std::string& part : Split(Text(key, ""), '/')) {
            const std::optional<double> value = ParseFinite(part);
            if (!value) {
                Fail("IDS_QM_NEW_SPECTRUM_NUMBER", key, part);
                return {};
            }
            out.push_back(*value);
        }
        return out;
    }
    void Letter(const char* key, char& out)
    {
        const std::string text = Text(key, "");
        if (text.size() != 1) return Fail("IDS_QM_NEW_SPECTRUM_MISSING", key);
        out = text.front();
    }
    template <class... ARGS>
    void Fail(const char* key, const ARGS&... args)
    {
        if (m_ok) (void)CreateFault(m_fault, kField, key, args...);
        m_ok = false;
    }
    void Finish()
    {
        if (!m_values.empty()) Fail("IDS_QM_NEW_SPECTRUM_KEY", m_values.begin()->first);
    }

private:
    std::map<std::string, std::string> m_values;
    T_FINDING& m_fault;
    bool m_ok = true;
};

/// No structure has a damping below 0.5 per cent: less is a ratio.
void ReadDamping(CValues& in, std::optional<double>& damping)
{
    constexpr double kLeast = 0.5;
    in.Maybe("damping", damping);
    if (damping && *damping > 0.0 && *damping < kLeast) *damping *= 100.0;
}

void Read(CValues& in, T_SPFC_ATC40& r)
{
    in.Need("Ca", r.Ca);
    in.Need("Cv", r.Cv);
    const std::string floors = in.Text("floors", "");
    if (floors == "true" || floors == "false")
        r.floors = floors == "true";
    else if (!floors.empty())
        in.Fail("IDS_QM_NEW_SPECTRUM_NUMBER", "floors", floors);
}

// ASCE 41-17 2.4.1.7 and ATC-40 4.4.3: the plateau is SXS = 2.5 Ca, the branch of 1/T SX1 = Cv.
void ReadAsce(CValues& in, T_SPFC_ATC40& r)
{
    constexpr double kOfPlateau = 0.4;
    in.Need("SXS", r.Ca);
    in.Need("SX1", r.Cv);
    r.Ca *= kOfPlateau;
}

void Read(CValues& in, T_SPFC_EURO2003& r)
{
    if (in.Has("type")) {
        double type = 0.0;
        in.Need("type", type);
        r.type = type == 1.0 ? 1 : type == 2.0 ? 2 : 0; // 0 is refused by the rule of the record
    }
    in.Letter("soil", r.soil);
    in.Need("ag", r.ag);
    ReadDamping(in, r.damping);
    in.Maybe("S", r.S);
    in.Maybe("TB", r.TB);
    in.Maybe("TC", r.TC);
    in.Maybe("TD", r.TD);
}

void Read(CValues& in, T_SPFC_EURO1996& r)
{
    in.Letter("soil", r.soil);
    in.Need("ag", r.ag);
    ReadDamping(in, r.damping);
}

void Read(CValues& in, T_SPFC_NTC& r)
{
    in.Letter("soil", r.soil);
    const std::string topography = in.Text("topography", kTopographies[0]);
    const auto* const at = std::ranges::find(kTopographies, topography);
    if (at == kTopographies.end()) return in.Fail("IDS_QM_NEW_SPECTRUM_TOPOGRAPHY", topography);
    r.topography = static_cast<int>(at - kTopographies.begin()) + 1;
    ReadDamping(in, r.damping);
    bool any = false;
    for (std::size_t i = 0; i < r.states.size(); ++i) {
        if (!in.Has(kLimitStateNames[i])) continue;
        any = true;
        const std::vector<double> v = in.List(kLimitStateNames[i]);
        if (v.size() == 3)
            r.states[i] = {v[0], v[1], v[2]};
        else
            in.Fail("IDS_QM_NEW_SPECTRUM_STATE", kLimitStateNames[i]);
    }
    if (!any) in.Fail("IDS_QM_NEW_SPECTRUM_STATE", "SLV");
}

void Read(CValues& in, T_SPFC_USER& r)
{
    for (const char* const key : {"T", "Sa"})
        if (!in.Has(key)) in.Fail("IDS_QM_NEW_SPECTRUM_MISSING", key);
    if (!in.Ok()) return;
    r.T = in.List("T");
    r.Sa = in.List("Sa");
    in.Maybe("gravity", r.gravity);
}

// ---- back to text -------------------------------------------------------------------------------

std::string Pair(const char* key, double value)
{
    return std::string(",") + key + "=" + ShortestText(value);
}
std::string Pair(const char* key, const std::optional<double>& value)
{
    return value ? Pair(key, *value) : "";
}
std::string Soil(char soil)
{
    return std::string(",soil=") + soil;
}
std::string Slashes(const std::vector<double>& values)
{
    std::string text;
    for (const double value : values)
        text += (text.empty() ? "" : "/") + ShortestText(value);
    return text;
}

std::string Words(const T_SPFC_ATC40& r)
{
    return Pair("Ca", r.Ca) + Pair("Cv", r.Cv) +
           (r.floors ? std::string(",floors=") + (*r.floors ? "true" : "false") : "");
}
std::string Words(const T_SPFC_EURO2003& r)
{
    return Soil(r.soil) + Pair("ag", r.ag) + ",type=" + std::to_string(r.type) +
           Pair("damping", r.damping) + Pair("S", r.S) + Pair("TB", r.TB) + Pair("TC", r.TC) +
           Pair("TD", r.TD);
}
std::string Words(const T_SPFC_EURO1996& r)
{
    return Soil(r.soil) + Pair("ag", r.ag) + Pair("damping", r.damping);
}
std::string Words(const T_SPFC_NTC& r)
{
    std::string text =
        Soil(r.soil) + ",topography=T" + std::to_string(r.topography) + Pair("damping", r.damping);
    for (std::size_t i = 0; i < r.states.size(); ++i)
        if (const auto& s = r.states[i])
            text +=
                std::string(",") + kLimitStateNames[i] + "=" + Slashes({s->ag, s->F0, s->TCstar});
    return text;
}
std::string Words(const T_SPFC_USER& r)
{
    return ",T=" + Slashes(r.T) + ",Sa=" + Slashes(r.Sa) + Pair("gravity", r.gravity);
}

template <std::size_t I = 0>
void ReadKind(std::size_t kind, CValues& in, T_SPFC_D& out)
{
    if constexpr (I < std::variant_size_v<decltype(out.data)>) {
        if (kind == I) return Read(in, out.data.template emplace<I>());
        ReadKind<I + 1>(kind, in, out);
    }
}

std::string KindList()
{
    std::string all;
    for (const char* const kind : kSpectrumKinds)
        all += std::string(kind) + ", ";
    return all + kAsce;
}

} // namespace

std::string SpectrumNameOf(std::size_t kind)
{
    constexpr std::array<const char*, 5> kNames{"ATC", "EC8", "ENV", "NTC", "USER"};
    return kNames.at(kind);
}

int ParseSpectrum(const std::string& text, T_SPFC_D& out, T_FINDING& fault)
{
    const std::size_t mark = std::min(text.find(':'), text.size());
    const std::string word = text.substr(0, mark);
    const auto* const at = std::ranges::find(kSpectrumKinds, word);
    const bool isAsce = word == kAsce;
    if (at == kSpectrumKinds.end() && !isAsce)
        return CreateFault(fault, kField, "IDS_QM_NEW_SPECTRUM_KIND", word, KindList());
    std::map<std::string, std::string> values;
    for (const std::string& pair : Split(text.substr(std::min(mark + 1, text.size())), ',')) {
        if (pair.empty()) continue;
        const std::size_t equal = pair.find('=');
        if (equal == pair.npos ||
            !values.emplace(pair.substr(0, equal), pair.substr(equal + 1)).second)
            return CreateFault(fault, kField, "IDS_QM_NEW_SPECTRUM_PAIR", pair);
    }
    const std::size_t kind = isAsce ? 0 : static_cast<std::size_t>(at - kSpectrumKinds.begin());
    CValues in(std::move(values), fault);
    T_SPFC_D read;
    read.name = in.Text("name", SpectrumNameOf(kind));
    if (isAsce)
        ReadAsce(in, read.data.emplace<T_SPFC_ATC40>());
    else
        ReadKind(kind, in, read);
    in.Finish();
    if (!in.Ok()) return 0;
    out = std::move(read);
    return 1;
}

std::string SpectrumText(const T_SPFC_D& spectrum)
{
    const std::size_t kind = spectrum.data.index();
    std::string words =
        std::visit([](const auto& data) { return Words(data); }, spectrum.data).substr(1);
    if (spectrum.name != SpectrumNameOf(kind)) words += ",name=" + spectrum.name;
    return std::string(kSpectrumKinds.at(kind)) + ":" + words;
}

int UserSpectrum(const std::string& text, T_SPFC_USER& out, T_FINDING& fault)
{
    constexpr const char* kTable = "table";
    T_PASTED_TABLE table;
    T_PASTED_FAULT why;
    if (!ReadPastedTable(text, PASTED_DECIMAL::Auto, table, why)) {
        if (why.line == 0) return CreateFault(fault, kTable, "IDS_QM_NEW_TEXT", why.text);
        return CreateFault(fault, kTable, "IDS_QM_NEW_LINE", std::to_string(why.line), why.text);
    }
    if (table.rows.front().cells.size() != 2)
        return CreateFault(fault, kTable, "IDS_QM_NEW_SPECTRUM_COLUMNS",
                           std::to_string(table.rows.front().cells.size()));
    T_SPFC_USER read;
    read.gravity = out.gravity;
    for (const T_PASTED_ROW& row : table.rows) {
        if (!read.T.empty() && !(row.cells[0] > read.T.back()))
            return CreateFault(fault, kTable, "IDS_QM_NEW_SPECTRUM_ASCEND",
                               std::to_string(row.line));
        read.T.push_back(row.cells[0]);
        read.Sa.push_back(row.cells[1]);
    }
    out = std::move(read);
    return 1;
}
