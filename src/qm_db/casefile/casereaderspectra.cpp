#include "qm_db/casefile/casereader.h"
#include "qm_db/casefile/jsonnames.h"

#include <algorithm>
#include <utility>

namespace {

void CheckAbove(CJsonReader& in, std::string_view key, double value)
{
    in.Check(key, value > 0.0, "the value must be above 0");
}

char ReadSoil(CJsonReader& in, std::size_t count)
{
    return *kSoils[static_cast<std::size_t>(
        in.Choice("soil", std::span(kSoils).first(count), "soil"))];
}

void ReadDamping(CJsonReader& in, std::optional<double>& damping)
{
    in.Get("damping", damping);
    in.CheckIf("damping", damping, IsZeroOrAbove, "damping can't be negative");
}

T_SPFC_ATC40 ReadAtc40(CJsonReader& in)
{
    T_SPFC_ATC40 s;
    in.Keys({"name", "kind", "Ca", "Cv", "floors"});
    in.Get("Ca", s.Ca);
    in.Get("Cv", s.Cv);
    in.Get("floors", s.floors);
    CheckAbove(in, "Ca", s.Ca);
    CheckAbove(in, "Cv", s.Cv);
    return s;
}

/// Corner periods that are given ascend; the others come from the table of the code.
void CheckCorners(CJsonReader& in, const T_SPFC_EURO2003& s)
{
    const auto ordered = [](const std::optional<double>& a, const std::optional<double>& b) {
        return !a || !b || *a <= *b;
    };
    in.Check("TC", ordered(s.TB, s.TC), "TC is below TB");
    in.Check("TD", ordered(s.TB, s.TD), "TD is below TB");
    in.Check("TD", ordered(s.TC, s.TD), "TD is below TC");
}

T_SPFC_EURO2003 ReadEuro2003(CJsonReader& in)
{
    T_SPFC_EURO2003 s;
    in.Keys({"name", "kind", "type", "soil", "ag", "damping", "S", "TB", "TC", "TD"});
    in.Get("type", s.type);
    in.Check("type", s.type == 1 || s.type == 2, "the type is 1 or 2");
    s.soil = ReadSoil(in, 5);
    in.Get("ag", s.ag);
    CheckAbove(in, "ag", s.ag);
    ReadDamping(in, s.damping);
    const std::pair<const char*, std::optional<double>*> rows[] = {
        {"S", &s.S}, {"TB", &s.TB}, {"TC", &s.TC}, {"TD", &s.TD}};
    for (const auto& [key, value] : rows) {
        in.Get(key, *value);
        in.CheckIf(key, *value, IsAboveZero, "the value must be above 0");
    }
    CheckCorners(in, s);
    return s;
}

T_SPFC_EURO1996 ReadEuro1996(CJsonReader& in)
{
    T_SPFC_EURO1996 s;
    in.Keys({"name", "kind", "soil", "ag", "damping"});
    s.soil = ReadSoil(in, 3);
    in.Get("ag", s.ag);
    CheckAbove(in, "ag", s.ag);
    ReadDamping(in, s.damping);
    return s;
}

T_SPFC_NTC_STATE ReadNtcState(CJsonReader in)
{
    T_SPFC_NTC_STATE state;
    in.Keys({"ag", "F0", "TC*"});
    const std::pair<const char*, double*> rows[] = {
        {"ag", &state.ag}, {"F0", &state.F0}, {"TC*", &state.TCstar}};
    for (const auto& [key, value] : rows) {
        in.Get(key, *value);
        CheckAbove(in, key, *value);
    }
    return state;
}

T_SPFC_NTC ReadNtc(CJsonReader& in)
{
    T_SPFC_NTC s;
    in.Keys({"name", "kind", "soil", "topography", "damping", "limit_states"});
    s.soil = ReadSoil(in, 5);
    s.topography = 1 + in.Choice("topography", kTopographies, "topography");
    ReadDamping(in, s.damping);
    CJsonReader states = in.Member("limit_states");
    states.Keys({"SLO", "SLD", "SLV", "SLC"});
    for (std::size_t i = 0; i < kLimitStateNames.size(); ++i) {
        if (states.Has(kLimitStateNames[i]))
            s.states[i] = ReadNtcState(states.Member(kLimitStateNames[i]));
    }
    return s;
}

T_SPFC_USER ReadUser(CJsonReader& in)
{
    T_SPFC_USER s;
    in.Keys({"name", "kind", "T", "Sa", "gravity"});
    in.Get("T", s.T);
    in.Get("Sa", s.Sa);
    in.Check("T", s.T.size() >= 2, "a spectrum needs at least 2 points");
    if (s.Sa.size() != s.T.size())
        in.FailAt("Sa",
                  std::to_string(s.Sa.size()) + " values, expected " + std::to_string(s.T.size()));
    in.CheckEach("T", s.T, IsZeroOrAbove, "a period can't be negative");
    double before = -1.0;
    in.CheckEach(
        "T", s.T, [&](double T) { return T > std::exchange(before, T); }, "periods must ascend");
    in.CheckEach("Sa", s.Sa, IsZeroOrAbove, "Sa can't be negative");
    in.Get("gravity", s.gravity);
    in.CheckIf("gravity", s.gravity, IsAboveZero, "gravity must be above 0");
    return s;
}

void ReadSpectrum(CJsonReader& in, std::size_t index, T_MODEL& model, std::set<std::string>& taken)
{
    T_SPFC_D spectrum;
    in.GetName("name", spectrum.name, taken);
    switch (in.Choice("kind", kSpectrumKinds, "spectrum kind")) {
    case 0:
        spectrum.data = ReadAtc40(in);
        break;
    case 1:
        spectrum.data = ReadEuro2003(in);
        break;
    case 2:
        spectrum.data = ReadEuro1996(in);
        break;
    case 3:
        spectrum.data = ReadNtc(in);
        break;
    default:
        spectrum.data = ReadUser(in);
        break;
    }
    RecordToSiChecked(in, spectrum, model.styp.units);
    model.spectra[static_cast<int>(index) + 1] = std::move(spectrum);
}

} // namespace

void ReadSpectra(CJsonReader& root, T_MODEL& model)
{
    std::set<std::string> taken;
    ForEachRecord(root, "spectra", [&](CJsonReader& item, std::size_t index) {
        ReadSpectrum(item, index, model, taken);
    });
}
