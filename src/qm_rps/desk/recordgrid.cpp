#include "qm_rps/desk/recordgrid.h"

#include "qm_rps/desk/recordtables.h"

namespace {

struct T_TABLE_ENTRY {
    const char* title;
    std::size_t (*count)(const T_MODEL&);
    bool (*has)(const T_MODEL&, int key);
    std::unique_ptr<CRecordGrid> (*make)(CDBDoc&, const char* title);
};

template <class R>
std::size_t Count(const T_MODEL& model)
{
    return TableOf<R>(model).size();
}

template <class R>
bool Has(const T_MODEL& model, int key)
{
    return TableOf<R>(model).contains(key);
}

// By EXPLORER_TABLE.
constexpr T_TABLE_ENTRY kTables[] = {
    {"IDS_QM_UI_TABLE_NODES", Count<T_NODE_D>, Has<T_NODE_D>, MakeNodeGrid},
    {"IDS_QM_UI_TABLE_ELEMENTS", Count<T_ELEM_D>, Has<T_ELEM_D>, MakeElementGrid},
    {"IDS_QM_UI_TABLE_SECTIONS", Count<T_SECT_D>, Has<T_SECT_D>, MakeSectionGrid},
    {"IDS_QM_UI_TABLE_MATERIALS", Count<T_MATL_D>, Has<T_MATL_D>, MakeMaterialGrid},
    {"IDS_QM_UI_TABLE_STOREYS", Count<T_STOR_D>, Has<T_STOR_D>, MakeStoreyGrid},
    {"IDS_QM_UI_TABLE_LOADS", Count<T_STLD_D>, Has<T_STLD_D>, MakeLoadCaseGrid},
    {"IDS_QM_UI_TABLE_COMBINATIONS", Count<T_LCOM_D>, Has<T_LCOM_D>, MakeCombinationGrid},
    {"IDS_QM_UI_TABLE_STAGES", Count<T_STAG_D>, Has<T_STAG_D>, MakeStageGrid},
    {"IDS_QM_UI_TABLE_PUSHOVERS", Count<T_POLC_D>, Has<T_POLC_D>, MakePushoverGrid},
    {"IDS_QM_UI_TABLE_HINGE_TYPES", Count<T_PHGT_D>, Has<T_PHGT_D>, MakeHingeTypeGrid},
    {"IDS_QM_UI_TABLE_HINGES", Count<T_PHGE_D>, Has<T_PHGE_D>, MakeHingeGrid},
    {"IDS_QM_UI_TABLE_SPECTRA", Count<T_SPFC_D>, Has<T_SPFC_D>, MakeSpectrumGrid},
    {"IDS_QM_UI_TABLE_EVALUATIONS", Count<T_EVAL_D>, Has<T_EVAL_D>, MakeEvaluationGrid},
    {"IDS_QM_UI_TABLE_CONSTRAINTS", Count<T_ULFC_D>, Has<T_ULFC_D>, MakeConstraintGrid},
    {"IDS_QM_UI_TABLE_ITEMS", Count<T_ULFI_D>, Has<T_ULFI_D>, MakeUlfItemGrid},
    {"IDS_QM_UI_TABLE_STAGE_ITEMS", Count<T_ULSI_D>, Has<T_ULSI_D>, MakeStageItemGrid},
};
static_assert(std::size(kTables) == static_cast<std::size_t>(EXPLORER_TABLE::Count));

const T_TABLE_ENTRY& Entry(EXPLORER_TABLE table)
{
    return kTables[static_cast<std::size_t>(table)];
}

} // namespace

const char* TitleKey(EXPLORER_TABLE table)
{
    return Entry(table).title;
}

std::size_t RecordCount(const CDBDoc& doc, EXPLORER_TABLE table)
{
    return Entry(table).count(doc.Data().Model());
}

bool RecordExists(const CDBDoc& doc, EXPLORER_TABLE table, int key)
{
    return Entry(table).has(doc.Data().Model(), key);
}

std::unique_ptr<CRecordGrid> MakeRecordGrid(CDBDoc& doc, EXPLORER_TABLE table)
{
    return Entry(table).make(doc, Entry(table).title);
}
