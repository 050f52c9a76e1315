#include "qm_rps/pushoverstoreydlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushquantity.h"

#include <algorithm>
#include <cmath>

const std::vector<double>& ValuesOf(const T_PUSH_STOREY_SERIES& storey, STOREY_VALUE value)
{
    if (value == STOREY_VALUE::Displacement) return storey.displacement;
    return value == STOREY_VALUE::Drift ? storey.drift : storey.shear;
}

double Envelope(const std::vector<double>& values)
{
    return *std::ranges::max_element(values, {}, [](double v) { return std::fabs(v); });
}

T_TEXT_TABLE CPushOverStoreyDlg::Table() const
{
    const T_PUSH_QUANTITY length{kDimLength, Units()}, force{kDimForce, Units()};
    const std::string most = ", " + Say("IDS_QM_UI_STOREY_LARGEST");
    T_TEXT_TABLE table;
    table.columns = {{Say("IDS_QM_UI_STOREY_NAME")},
                     {length.Head("IDS_QM_UI_STOREY_HEIGHT"), true}};
    for (const std::string& head :
         {length.Head("IDS_QM_UI_STOREY_DISPLACEMENT"), Say("IDS_QM_UI_STOREY_DRIFT"),
          force.Head("IDS_QM_UI_STOREY_SHEAR")}) {
        table.columns.push_back({head, true});
        table.columns.push_back({head + most, true});
    }
    const auto& storeys = Run().storeys;
    for (auto s = storeys.rbegin(); HasStoreys() && s != storeys.rend(); ++s) {
        std::vector<std::string>& row = table.rows.emplace_back();
        row = {s->name, FormatText("%.5g", length.Shown(s->elevation))};
        for (const auto value :
             {STOREY_VALUE::Displacement, STOREY_VALUE::Drift, STOREY_VALUE::Shear}) {
            const std::vector<double>& v = ValuesOf(*s, value);
            const auto text = [&](double si) {
                if (value == STOREY_VALUE::Drift) return FormatText("%.4g", si + 0.0);
                return FormatText("%.5g",
                                  (value == STOREY_VALUE::Shear ? force : length).Shown(si));
            };
            const std::string unknown = Say("IDS_QM_UI_STOREY_UNKNOWN");
            row.push_back(v.empty() ? unknown : text(v[static_cast<std::size_t>(Step() - 1)]));
            row.push_back(v.empty() ? unknown : text(Envelope(v)));
        }
    }
    return table;
}
