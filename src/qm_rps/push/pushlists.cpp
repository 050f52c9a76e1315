#include "qm_rps/push/pushlists.h"

#include "qm_base/textformat.h"

#include <algorithm>

namespace {

std::string LoadCaseText(const T_MODEL& model, int key)
{
    const auto at = model.loadCases.find(key);
    return std::to_string(key) + " : " + (at == model.loadCases.end() ? "?" : at->second.name);
}

template <class LIST>
auto At(LIST& list, std::size_t row)
{
    return list.begin() + static_cast<std::ptrdiff_t>(row);
}

} // namespace

int SetListNumber(std::vector<double>& list, std::size_t row, const std::string& text)
{
    if (row > list.size()) return 0;
    if (text.empty()) {
        if (row < list.size()) list.erase(At(list, row));
        return 1;
    }
    const std::optional<double> value = ParseFinite(text);
    if (!value) return 0;
    if (row == list.size()) list.push_back(0.0);
    list[row] = *value;
    return 1;
}

std::string ListNumberText(const std::vector<double>& list, std::size_t row)
{
    return row < list.size() ? ShortestText(list[row]) : std::string();
}

std::string InitialLoadText(const T_MODEL& model, const std::vector<T_PUSH_INITIAL_LOAD>& loads,
                            std::size_t row, std::size_t column)
{
    if (row >= loads.size()) return {};
    return column == 0 ? LoadCaseText(model, loads[row].loadCase) : ShortestText(loads[row].factor);
}

std::vector<std::string> InitialLoadChoices(const T_MODEL& model)
{
    std::vector<std::string> texts{{}};
    for (const auto& [key, record] : model.loadCases)
        texts.push_back(LoadCaseText(model, key));
    return texts;
}

int SetInitialLoad(const T_MODEL& model, std::vector<T_PUSH_INITIAL_LOAD>& loads, std::size_t row,
                   std::size_t column, const std::string& text)
{
    if (row > loads.size()) return 0;
    if (text.empty()) {
        if (row < loads.size()) loads.erase(At(loads, row));
        return 1;
    }
    if (column == 1) {
        const std::optional<double> factor = ParseFinite(text);
        if (!factor || row == loads.size()) return 0;
        loads[row].factor = *factor;
        return 1;
    }
    for (const auto& [key, record] : model.loadCases) {
        if (LoadCaseText(model, key) != text) continue;
        if (row == loads.size()) loads.emplace_back();
        loads[row].loadCase = key;
        return 1;
    }
    return 0;
}

std::string FunctionRowText(const T_POFC_D& function, std::size_t row, std::size_t column)
{
    return ListNumberText(column == 0 ? function.step : function.factor, row);
}

int SetFunctionRow(T_POFC_D& function, std::size_t row, std::size_t column, const std::string& text)
{
    T_POFC_D changed = function;
    if (changed.step.size() != changed.factor.size()) return 0;
    if (text.empty() && row < changed.step.size()) {
        changed.step.erase(At(changed.step, row));
        changed.factor.erase(At(changed.factor, row));
    } else {
        std::vector<double>& other = column == 0 ? changed.factor : changed.step;
        if (!SetListNumber(column == 0 ? changed.step : changed.factor, row, text)) return 0;
        if (changed.step.size() != changed.factor.size())
            other.push_back(other.empty() ? 0.0 : other.back());
    }
    function = std::move(changed);
    return 1;
}

bool HingeTypeActs(const std::vector<int>& acting, int type)
{
    return acting.empty() || std::ranges::find(acting, type) != acting.end();
}

int SetHingeTypeActs(const T_MODEL& model, std::vector<int>& acting, int type, bool acts)
{
    std::vector<int> chosen;
    for (const auto& [key, record] : model.hingeTypes)
        if (key == type ? acts : HingeTypeActs(acting, key)) chosen.push_back(key);
    if (chosen.empty()) return 0;
    acting = chosen.size() == model.hingeTypes.size() ? std::vector<int>() : chosen;
    return 1;
}
