#include "qm_rps/pushover/overview/factcells.h"

#include "qm_base/say.h"
#include "qm_rps/pushover/explain/evaluationfacts.h"

#include <algorithm>

namespace {

constexpr std::size_t kColumns = 6;

void AddGroup(T_TEXT_TABLE& table, const std::string& title, const std::vector<T_FACT>& facts)
{
    std::vector<std::string> head(kColumns);
    head[2] = title;
    table.rows.push_back(std::move(head));
    for (const T_FACT& f : facts) {
        const std::string value = f.ValueText();
        // What an input is stands in words; a number may say in words where it is from.
        const std::string definition =
            f.value && !f.text.empty() ? f.definition + " (" + f.text + ")" : f.definition;
        table.rows.push_back({f.symbol, value, definition, f.clause, f.formula, f.numbers});
    }
}

} // namespace

T_TEXT_TABLE FactCells(const T_PUSH_EVALUATION& e, const T_SPFC_D* spectrum)
{
    T_TEXT_TABLE table;
    for (const char* const key :
         {"IDS_QM_EVAL_SYMBOL", "IDS_QM_UI_PUSH_VALUE", "IDS_QM_EVAL_DEFINITION",
          "IDS_QM_EVAL_CLAUSE", "IDS_QM_EVAL_FORMULA", "IDS_QM_EVAL_NUMBERS"})
        table.columns.push_back({Say(key)});
    if (e.capacity.Sd.empty()) return table;
    std::vector<T_FACT_GROUP> groups = FactsOf(e);
    std::ranges::reverse(groups); // the answer first
    for (const T_FACT_GROUP& group : groups)
        AddGroup(table, group.title, group.facts);
    AddGroup(table, Say("IDS_QM_EVAL_INPUTS"), InputsOf(e, spectrum));
    return table;
}

std::string InputLine(const T_PUSH_EVALUATION& e, const T_SPFC_D* spectrum)
{
    std::string line;
    for (const T_FACT& f : InputsOf(e, spectrum))
        line += (line.empty() ? "" : "; ") + f.definition + " " + f.ValueText();
    return line;
}
