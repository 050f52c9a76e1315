#include "qm_db/casefile/casewritertable.h"

void WriteHingeTables(CJsonWriter& out, const T_MODEL& model)
{
    WriteTable(out, nullptr, "increment_functions", model.incrementFunctions);
    WriteTable(out, nullptr, "hinge_types", model.hingeTypes);
    WriteTable(out, nullptr, "hinges", model.hinges);
    WriteTable(out, nullptr, "inelastic_hinges", model.inelasticHinges);
}
