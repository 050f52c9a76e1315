#include "qm_rps/desk/tracetable.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/generate/codehingerows.h"

T_TEXT_TABLE TraceTable(const std::vector<T_CODE_TRACE>& trace, const T_UNITS& units)
{
    T_TEXT_TABLE table;
    for (const char* key : {"IDS_QM_UI_GEN_SYMBOL", "IDS_QM_UI_GEN_VALUE", "IDS_QM_UI_GEN_UNIT",
                            "IDS_QM_UI_GEN_FORMULA", "IDS_QM_UI_GEN_CLAUSE", "IDS_QM_UI_GEN_MARK"})
        table.columns.push_back({Say(key), table.columns.size() == 1});
    for (const T_CODE_TRACE& line : trace)
        table.rows.push_back({line.symbol, FormatText("%.5g", FromSi(line.value, units, line.dim)),
                              UnitText(line.dim, units), line.text, line.clause,
                              MarkText(line.mark)});
    return table;
}
