#include "qm_rps/create/spectrumvalues.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_cmd/etc_design_spect.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

/// The spectrum of each curve, with its name.
struct T_PART {
    std::string name;
    std::unique_ptr<CETC_DESIGN_SPECT> spectrum;
    LIMIT_STATE state = LIMIT_STATE::SLO;
};

std::vector<T_PART> PartsOf(const T_SPFC_D& record)
{
    constexpr int kNoFloors = 3; // structural behaviour: the ordinates are not reduced here
    std::vector<T_PART> parts;
    const bool isNtc = std::holds_alternative<T_SPFC_NTC>(record.data);
    for (std::size_t i = 0; i < (isNtc ? kLimitStateNames.size() : 1); ++i) {
        const auto state = static_cast<LIMIT_STATE>(i);
        if (auto made = MakeDesignSpectrum(record, kNoFloors, state))
            parts.push_back({isNtc ? kLimitStateNames[i] : record.name, std::move(made), state});
    }
    return parts;
}

/// One row of the table of values.
struct T_ROW {
    const char* symbol;
    const char* unit;
    const char* meaning; // key
    double (*value)(const T_PART&, const T_SPFC_D&);
};

double AgOf(const T_PART& part, const T_SPFC_D& record)
{
    if (const auto* r = std::get_if<T_SPFC_EURO2003>(&record.data)) return r->ag;
    if (const auto* r = std::get_if<T_SPFC_EURO1996>(&record.data)) return r->ag;
    const auto& state =
        std::get<T_SPFC_NTC>(record.data).states[static_cast<std::size_t>(part.state)];
    return state->ag;
}

/// Largest amplification of the code: plateau = ag S eta F0.
double AmplificationOf(const T_PART& part, const T_SPFC_D& record)
{
    constexpr double kEuropean = 2.5;
    const auto* r = std::get_if<T_SPFC_NTC>(&record.data);
    return r ? r->states[static_cast<std::size_t>(part.state)]->F0 : kEuropean;
}

double SoilOf(const T_PART& part, const T_SPFC_D& record)
{
    return part.spectrum->Shape().a0 / AgOf(part, record);
}
double EtaOf(const T_PART& part, const T_SPFC_D& record)
{
    const T_SPECT_SHAPE& shape = part.spectrum->Shape();
    return shape.plateau / (shape.a0 * AmplificationOf(part, record));
}
double CcOf(const T_PART& part, const T_SPFC_D& record)
{
    const auto& states = std::get<T_SPFC_NTC>(record.data).states;
    return part.spectrum->Shape().TC / states[static_cast<std::size_t>(part.state)]->TCstar;
}
double PlateauOf(const T_PART& part, const T_SPFC_D&)
{
    return part.spectrum->Shape().plateau;
}
double TbOf(const T_PART& part, const T_SPFC_D&)
{
    return part.spectrum->Shape().TB;
}
double TcOf(const T_PART& part, const T_SPFC_D&)
{
    return part.spectrum->CornerPeriod();
}
double TdOf(const T_PART& part, const T_SPFC_D&)
{
    return part.spectrum->Shape().TD;
}
double SxsOf(const T_PART&, const T_SPFC_D& record)
{
    constexpr double kPlateau = 2.5; // over Ca: ATC-40 4.4.3
    return kPlateau * std::get<T_SPFC_ATC40>(record.data).Ca;
}

constexpr T_ROW kS{"S", "-", "IDS_QM_NEW_VALUE_S", SoilOf};
constexpr T_ROW kEta{"eta", "-", "IDS_QM_NEW_VALUE_ETA", EtaOf};
constexpr T_ROW kTb{"TB", "s", "IDS_QM_NEW_VALUE_TB", TbOf};
constexpr T_ROW kTc{"TC", "s", "IDS_QM_NEW_VALUE_TC", TcOf};
constexpr T_ROW kTd{"TD", "s", "IDS_QM_NEW_VALUE_TD", TdOf};
constexpr T_ROW kPlateau{"Sa,max", "g", "IDS_QM_NEW_VALUE_PLATEAU", PlateauOf};

std::vector<T_ROW> RowsOf(const T_SPFC_D& record)
{
    if (std::holds_alternative<T_SPFC_ATC40>(record.data))
        return {{"SXS", "g", "IDS_QM_NEW_VALUE_SXS", SxsOf},
                {"TA", "s", "IDS_QM_NEW_VALUE_TB", TbOf},
                {"TS", "s", "IDS_QM_NEW_VALUE_TS", TcOf}};
    if (std::holds_alternative<T_SPFC_USER>(record.data))
        return {{"TC", "s", "IDS_QM_NEW_VALUE_CORNER", TcOf}};
    std::vector<T_ROW> rows{kS, kEta, kPlateau, kTb, kTc, kTd};
    if (std::holds_alternative<T_SPFC_NTC>(record.data))
        rows.insert(rows.begin() + 1, {"CC", "-", "IDS_QM_NEW_VALUE_CC", CcOf});
    return rows;
}

} // namespace

std::vector<T_SPECTRUM_CURVE> SpectrumCurves(const T_SPFC_D& spectrum, double gravity)
{
    std::vector<T_SPECTRUM_CURVE> out;
    const bool isTable = std::holds_alternative<T_SPFC_USER>(spectrum.data);
    for (const T_PART& part : PartsOf(spectrum)) {
        T_SPECTRUM_CURVE& curve = out.emplace_back();
        curve.name = part.name;
        for (const double T : part.spectrum->Periods()) {
            if (!isTable && T > kShownPeriod) break;
            const double Sa = part.spectrum->CalcSaAt(T);
            const double w = T / (2.0 * std::numbers::pi);
            curve.T.push_back(T);
            curve.Sa.push_back(Sa);
            curve.Sd.push_back(Sa * gravity * w * w);
        }
    }
    return out;
}

T_TEXT_TABLE SpectrumValues(const T_SPFC_D& spectrum)
{
    const std::vector<T_PART> parts = PartsOf(spectrum);
    T_TEXT_TABLE table;
    table.columns = {{Say("IDS_QM_NEW_HEAD_SYMBOL")}};
    for (const T_PART& part : parts)
        table.columns.push_back({part.name, true});
    table.columns.push_back({Say("IDS_QM_NEW_HEAD_UNIT")});
    table.columns.push_back({Say("IDS_QM_NEW_HEAD_MEANING")});
    for (const T_ROW& row : RowsOf(spectrum)) {
        std::vector<std::string> cells{row.symbol};
        for (const T_PART& part : parts)
            cells.push_back(FormatText("%.4g", row.value(part, spectrum)));
        cells.push_back(row.unit);
        cells.push_back(Say(row.meaning));
        table.rows.push_back(std::move(cells));
    }
    return table;
}

namespace {

// No code maps as much: 3.5 stands for m/s2.
constexpr double kMostAg = 1.5, kMostSa = 5.0; // g
constexpr double kPlateauOfCa = 2.5;           // ATC-40 4.4.3

bool IsOdd(const T_SPFC_ATC40& r)
{
    return kPlateauOfCa * r.Ca > kMostSa || r.Ca > kMostAg;
}
bool IsOdd(const T_SPFC_EURO2003& r)
{
    return r.ag > kMostAg;
}
bool IsOdd(const T_SPFC_EURO1996& r)
{
    return r.ag > kMostAg;
}
bool IsOdd(const T_SPFC_NTC& r)
{
    return std::ranges::any_of(r.states, [](const auto& s) { return s && s->ag > kMostAg; });
}
bool IsOdd(const T_SPFC_USER& r)
{
    return std::ranges::any_of(r.Sa, [](double Sa) { return Sa > kMostSa; });
}

} // namespace

std::string SpectrumDoubt(const T_SPFC_D& spectrum)
{
    const bool isOdd = std::visit([](const auto& r) { return IsOdd(r); }, spectrum.data);
    return isOdd ? Say("IDS_QM_NEW_ODD_SPECTRUM") : "";
}
