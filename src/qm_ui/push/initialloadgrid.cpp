#include "qm_base/msgfunction.h"
#include "qm_rps/push/pushlists.h"
#include "qm_ui/push/pushsetupviews.h"

T_GRID_BINDING
InitialLoadGrid(const CRPSDlgBase& dialog, std::function<std::vector<T_PUSH_INITIAL_LOAD>*()> loads)
{
    const auto model = [&dialog]() -> const T_MODEL& {
        static const T_MODEL none;
        return dialog.Doc() ? dialog.Doc()->Data().Model() : none;
    };
    T_GRID_BINDING grid;
    grid.columns = {{KeyText("IDS_QM_UI_POLC_LOAD"), CELL_KIND::Choice, true,
                     [model] { return InitialLoadChoices(model()); }},
                    {KeyText("IDS_QM_UI_POLC_FACTOR"), CELL_KIND::Number, true}};
    grid.rows = [loads] { return loads() ? loads()->size() + 1 : 0; };
    grid.text = [model, loads](std::size_t row, std::size_t column) {
        return loads() ? InitialLoadText(model(), *loads(), row, column) : std::string();
    };
    grid.set = [model, loads](std::size_t row, std::size_t column, const std::string& text) {
        return loads() ? SetInitialLoad(model(), *loads(), row, column, text) : 0;
    };
    grid.rowHead = [loads](std::size_t row) {
        return loads() && row < loads()->size() ? std::to_string(row + 1) : std::string("+");
    };
    grid.mark = [&dialog](std::size_t row, std::size_t column) {
        const std::string field =
            "initialLoads[" + std::to_string(row) + "]." + (column == 0 ? "loadCase" : "factor");
        for (const T_FINDING& finding : dialog.Findings())
            if (finding.field == field) return finding.text;
        return std::string();
    };
    return grid;
}

std::vector<std::string> PDeltaTexts()
{
    return KeyTexts(
        {"IDS_QM_UI_P_DELTA_NONE", "IDS_QM_UI_P_DELTA_INITIAL", "IDS_QM_UI_P_DELTA_UPDATED"})();
}

std::vector<std::string> FailureTexts()
{
    return KeyTexts(
        {"IDS_QM_UI_FAILURE_DROP", "IDS_QM_UI_FAILURE_STOP", "IDS_QM_UI_FAILURE_LEAP"})();
}
