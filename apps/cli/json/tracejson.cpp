#include "json/tracejson.h"

#include "qm_rps/generate/codehingerows.h"

void WriteWarnings(CJsonText& w, const std::vector<T_CODE_WARNING>& warnings)
{
    std::vector<std::string> texts;
    for (const T_CODE_WARNING& warning : warnings)
        texts.push_back(WarningText(warning));
    w.Items("warnings", texts, kJsonNested);
}

void WriteTrace(CJsonText& w, const char* name, const std::vector<T_CODE_TRACE>& trace,
                const T_UNITS& units)
{
    w.Key(name).List();
    for (const T_CODE_TRACE& line : trace) {
        w.Object(kJsonOneLine);
        w.Member("symbol", line.symbol).Member("value", FromSi(line.value, units, line.dim));
        w.Member("unit", UnitText(line.dim, units)).Member("clause", line.clause);
        w.Member("formula", line.text)
            .Member("mark", kMarkWords[static_cast<std::size_t>(line.mark)]);
        w.End();
    }
    w.End();
}
