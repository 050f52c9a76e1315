#include "qm_ui/loadcase/loadcasepages.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/push/pushlists.h"
#include "qm_ui/push/pushsetupviews.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

using D = CPO_LoadCaseDlg;
using zql::lib::MMSGFunction;

/// A choice whose first text is "as the global control says", with what that is.
template <class T>
CFormField& OwnChoice(CFormView& form, const char* caption, std::optional<T>& value,
                      std::function<T()> global, std::vector<std::string> (*texts)())
{
    const T_BINDING<int> index{[&value] { return value ? static_cast<int>(*value) + 1 : 0; },
                               [&value](const int& i) {
                                   if (i == 0)
                                       value.reset();
                                   else
                                       value = static_cast<T>(i - 1);
                               }};
    return form.Choice(KeyText(caption), index, [global, texts] {
        std::vector<std::string> all = texts();
        all.insert(all.begin(), MMSGFunction::Format("IDS_QM_UI_POLC_AS_GLOBAL",
                                                     {all.at(static_cast<std::size_t>(global()))}));
        return all;
    });
}

/// A choice that may be none.
template <class T>
T_BINDING<int> OrNone(std::optional<T>& value)
{
    return {[&value] { return value ? static_cast<int>(*value) + 1 : 0; },
            [&value](const int& i) {
                if (i == 0)
                    value.reset();
                else
                    value = static_cast<T>(i - 1);
            }};
}

/// A whole number that may be missing. Another number becomes 0, which the rules refuse.
T_BINDING<std::optional<double>> OptionalWhole(std::optional<int>& value)
{
    return {[&value] { return value ? std::optional<double>(*value) : std::nullopt; },
            [&value](const std::optional<double>& v) {
                constexpr double kMost = std::numeric_limits<int>::max();
                value.reset();
                if (v)
                    value =
                        std::trunc(*v) == *v && std::fabs(*v) <= kMost ? static_cast<int>(*v) : 0;
            }};
}

T_GRID_BINDING AdditionalGrid(D& d)
{
    std::vector<double>& list = d.m_case.additionalDisplacements;
    T_GRID_BINDING grid;
    grid.columns = {{[&d] { return LoadCaseDisplacement(d).Head("IDS_QM_UI_POLC_ADDITIONAL"); },
                     CELL_KIND::Number, true}};
    grid.rows = [&list] { return list.size() + 1; };
    grid.text = [&list](std::size_t row, std::size_t) { return ListNumberText(list, row); };
    grid.set = [&list](std::size_t row, std::size_t, const std::string& text) {
        return SetListNumber(list, row, text);
    };
    grid.rowHead = [&list](std::size_t row) {
        return row < list.size() ? std::to_string(row + 1) : std::string("+");
    };
    return grid;
}

} // namespace

T_PUSH_QUANTITY LoadCaseDisplacement(const D& d)
{
    return DisplacementIn(static_cast<std::size_t>(std::max(d.m_case.direction, 1) - 1),
                          d.Doc() ? d.Doc()->Unit().Units() : T_UNITS());
}

void BuildLoadCaseStart(CFormView& form, D& d)
{
    const auto startsAs = [&d](D::START start) {
        return [&d, start] { return d.Start() == start; };
    };
    form.Choice(KeyText("IDS_QM_UI_POLC_START"),
                {[&d] { return static_cast<int>(d.Start()); },
                 [&d](const int& i) { d.SetStart(static_cast<D::START>(i)); }},
                KeyTexts({"IDS_QM_UI_POLC_START_GLOBAL", "IDS_QM_UI_POLC_START_OWN",
                          "IDS_QM_UI_POLC_START_OTHER"}))
        .name = "start";
    CFormField& other =
        form.Choice(KeyText("IDS_QM_UI_POLC_INITIAL_CASE"),
                    {[&d] {
                         const std::vector<std::string> names = d.OtherCases();
                         const auto at = std::ranges::find(names, d.m_case.initialCase);
                         return at == names.end() ? -1 : static_cast<int>(at - names.begin());
                     },
                     [&d](const int& i) {
                         d.m_case.initialCase = d.OtherCases().at(static_cast<std::size_t>(i));
                     }},
                    [&d] { return d.OtherCases(); });
    other.name = "initialCase";
    other.shown = startsAs(D::START::OtherCase);
    CFormField& loads = form.Grid(InitialLoadGrid(
        d, [&d] { return d.m_case.initialLoads ? &*d.m_case.initialLoads : nullptr; }));
    loads.name = "initialLoads";
    loads.shown = startsAs(D::START::Own);
    OwnChoice<PUSH_P_DELTA>(
        form, "IDS_QM_UI_POGC_P_DELTA", d.m_case.pDelta, [&d] { return d.GlobalControl().pDelta; },
        PDeltaTexts)
        .name = "pDelta";
    OwnChoice<PUSH_FAILURE>(
        form, "IDS_QM_UI_POGC_FAILURE", d.m_case.onFailure,
        [&d] { return d.GlobalControl().onFailure; }, FailureTexts)
        .name = "onFailure";
    form.Space();
}

void BuildLoadCaseStops(CFormView& form, D& d)
{
    form.Optional(
            [&d] {
                return MMSGFunction::Format("IDS_QM_UI_POLC_STEPS",
                                            {std::to_string(d.GlobalControl().steps)});
            },
            OptionalWhole(d.m_case.steps))
        .name = "steps";
    form.Group(KeyText("IDS_QM_UI_POLC_STOPS"));
    form.Optional(KeyText("IDS_QM_UI_POLC_DRIFT"), Ref(d.m_case.stops.drift)).name = "stops.drift";
    form.Choice(KeyText("IDS_QM_UI_POLC_STATE"), OrNone(d.m_case.stops.state),
                KeyTexts({"IDS_QM_UI_STATE_NONE", "IDS_QM_UI_STATE_LS", "IDS_QM_UI_STATE_CP",
                          "IDS_QM_UI_STATE_FAILED"}))
        .name = "stops.state";
    form.Optional(KeyText("IDS_QM_UI_POLC_PEAK"), Ref(d.m_case.stops.fractionOfPeak)).name =
        "stops.fractionOfPeak";
    form.EndGroup();
    form.Grid(AdditionalGrid(d)).name = "additionalDisplacements";
    form.Flag(KeyText("IDS_QM_UI_POLC_EVALUATIONS"), Ref(d.m_case.additionalEvaluations)).name =
        "additionalEvaluations";
}
