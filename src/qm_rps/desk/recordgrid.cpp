#include "qm_rps/desk/recordgrid.h"

#include "qm_rps/desk/recordtables.h"

#include <algorithm>

namespace {

struct T_TABLE_ENTRY {
    const char* title;
    std::size_t (*count)(const T_MODEL&);
    bool (*has)(const T_MODEL&, int key);
    std::unique_ptr<CRecordGrid> (*make)(CDBDoc&, const char* title);
    RECORD_KIND kind;
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

template <class R>
constexpr T_TABLE_ENTRY Entry(const char* title,
                              std::unique_ptr<CRecordGrid> (*make)(CDBDoc&, const char* title))
{
    return {title, Count<R>, Has<R>, make, KindOf<R>()};
}

// By EXPLORER_TABLE.
constexpr T_TABLE_ENTRY kTables[] = {
    Entry<T_NODE_D>("IDS_QM_UI_TABLE_NODES", MakeNodeGrid),
    Entry<T_ELEM_D>("IDS_QM_UI_TABLE_ELEMENTS", MakeElementGrid),
    Entry<T_SECT_D>("IDS_QM_UI_TABLE_SECTIONS", MakeSectionGrid),
    Entry<T_MATL_D>("IDS_QM_UI_TABLE_MATERIALS", MakeMaterialGrid),
    Entry<T_STOR_D>("IDS_QM_UI_TABLE_STOREYS", MakeStoreyGrid),
    Entry<T_STLD_D>("IDS_QM_UI_TABLE_LOADS", MakeLoadCaseGrid),
    Entry<T_LCOM_D>("IDS_QM_UI_TABLE_COMBINATIONS", MakeCombinationGrid),
    Entry<T_STAG_D>("IDS_QM_UI_TABLE_STAGES", MakeStageGrid),
    Entry<T_POLC_D>("IDS_QM_UI_TABLE_PUSHOVERS", MakePushoverGrid),
    Entry<T_PHGT_D>("IDS_QM_UI_TABLE_HINGE_TYPES", MakeHingeTypeGrid),
    Entry<T_PHGE_D>("IDS_QM_UI_TABLE_HINGES", MakeHingeGrid),
    Entry<T_SPFC_D>("IDS_QM_UI_TABLE_SPECTRA", MakeSpectrumGrid),
    Entry<T_EVAL_D>("IDS_QM_UI_TABLE_EVALUATIONS", MakeEvaluationGrid),
    Entry<T_ULFC_D>("IDS_QM_UI_TABLE_CONSTRAINTS", MakeConstraintGrid),
    Entry<T_ULFI_D>("IDS_QM_UI_TABLE_ITEMS", MakeUlfItemGrid),
    Entry<T_ULSI_D>("IDS_QM_UI_TABLE_STAGE_ITEMS", MakeStageItemGrid),
    Entry<T_EIGV_D>("IDS_QM_UI_TABLE_MODES", MakeModeGrid),
    Entry<T_DIAP_D>("IDS_QM_UI_TABLE_DIAPHRAGMS", MakeDiaphragmGrid),
    Entry<T_EQDS_D>("IDS_QM_UI_TABLE_EQUAL", MakeEqualGrid),
    Entry<T_IEHP_D>("IDS_QM_UI_TABLE_INELASTIC", MakeInelasticGrid),
    Entry<T_POFC_D>("IDS_QM_UI_TABLE_FUNCTIONS", MakeFunctionGrid),
    Entry<T_POVR_D>("IDS_QM_UI_TABLE_LIMIT_STEPS", MakeLimitStepGrid),
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

RECORD_KIND KindOfTable(EXPLORER_TABLE table)
{
    return Entry(table).kind;
}

std::optional<EXPLORER_TABLE> TableOfKind(RECORD_KIND kind)
{
    const auto it = std::ranges::find(kTables, kind, &T_TABLE_ENTRY::kind);
    if (it == std::end(kTables)) return {};
    return static_cast<EXPLORER_TABLE>(it - std::begin(kTables));
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
