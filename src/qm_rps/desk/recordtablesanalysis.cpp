// Tables of loads, stages, pushover evaluation, hinges and unknown load factors.
#include "qm_base/msgfunction.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/desk/recordtable.h"
#include "qm_rps/desk/recordtables.h"
#include "qm_rps/factors/ulftexts.h"
#include "qm_rps/hinge/hingelabels.h"

namespace {

using zql::lib::MMSGFunction;

std::string TextOf(const char* key)
{
    return MMSGFunction::GetValue(key);
}

template <class T>
std::string NameOfKey(const T_TABLE<T>& table, int key)
{
    const auto it = table.find(key);
    return it == table.end() ? std::string() : it->second.name;
}

template <class R, class F>
T_RECORD_COLUMN<R> CountColumn(const char* head, F count)
{
    T_RECORD_COLUMN<R> c = FixedColumn<R>(
        head, [count](const T_MODEL&, const R& r) { return std::to_string(count(r)); });
    c.kind = CELL_KIND::Number;
    return c;
}

std::string CombinationText(const T_MODEL& model, const T_LCOM_D& c)
{
    std::string text;
    for (const T_LCOM_ITEM& item : c.items)
        text += (text.empty() ? "" : " + ") + ShortestText(item.factor) + " " +
                (item.combination ? NameOfKey(model.combinations, item.key)
                                  : NameOfKey(model.loadCases, item.key));
    return text;
}

std::string SpectrumKind(const T_SPFC_D& spectrum)
{
    constexpr std::array<const char*, 5> names{"ATC-40", "EN 1998-1:2004", "ENV 1998-1:1994", "NTC",
                                               "IDS_QM_UI_SPECTRUM_USER"};
    return TextOf(names.at(spectrum.data.index())); // names of codes stay
}

} // namespace

std::unique_ptr<CRecordGrid> MakeLoadCaseGrid(CDBDoc& doc, const char* title)
{
    using R = T_STLD_D;
    T_RECORD_COLUMNS<R> columns{KeyColumn<R>("IDS_QM_UI_HEAD_KEY"),
                                NameColumn(&T_MODEL::loadCases)};
    constexpr std::array<const char*, 3> heads{"gX", "gY", "gZ"};
    for (std::size_t d = 0; d < 3; ++d)
        columns.push_back(
            NumberColumn<R>(heads[d], kDimNone, [d](R& r) -> double& { return r.selfWeight[d]; }));
    columns.push_back(IndexColumn<R>(
        "IDS_QM_ULSI_HEAD_GROUP", [](R& r) -> int& { return r.group; },
        {"IDS_RPS_DL", "IDS_RPS_ER", "IDS_QM_UI_GROUP_REST"}, TextOf));
    columns.push_back(
        CountColumn<R>("IDS_QM_UI_HEAD_NODAL", [](const R& r) { return r.nodal.size(); }));
    columns.push_back(
        CountColumn<R>("IDS_QM_UI_HEAD_BEAM", [](const R& r) { return r.beam.size(); }));
    columns.push_back(CountColumn<R>("IDS_QM_UI_HEAD_PRETENSION",
                                     [](const R& r) { return r.pretension.size(); }));
    return std::make_unique<CRecordTable<R>>(doc, title, std::move(columns));
}

std::unique_ptr<CRecordGrid> MakeCombinationGrid(CDBDoc& doc, const char* title)
{
    using R = T_LCOM_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::combinations),
                            FixedColumn<R>("IDS_QM_UI_HEAD_ITEMS", CombinationText)});
}

std::unique_ptr<CRecordGrid> MakeStageGrid(CDBDoc& doc, const char* title)
{
    using R = T_STAG_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::stages),
            CountColumn<R>("IDS_QM_UI_HEAD_STEPS", [](const R& r) { return r.steps; }),
            NumberColumn<R>(
                "IDS_QM_UI_HEAD_DURATION", kDimNone, [](R& r) -> double& { return r.duration; },
                0.0),
            CountColumn<R>("IDS_QM_UI_HEAD_BORN",
                           [](const R& r) { return r.activate.elements.size(); }),
            CountColumn<R>("IDS_QM_UI_HEAD_GONE",
                           [](const R& r) { return r.deactivate.elements.size(); }),
            CountColumn<R>("IDS_QM_UI_HEAD_LOADS",
                           [](const R& r) { return r.activate.loads.size(); })});
}

std::unique_ptr<CRecordGrid> MakePushoverGrid(CDBDoc& doc, const char* title)
{
    using R = T_POLC_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::pushovers, true),
            CountColumn<R>("IDS_QM_UI_HEAD_CONTROL", [](const R& r) { return r.controlNode; }),
            FixedColumn<R>("IDS_QM_UI_HEAD_DIRECTION",
                           [](const T_MODEL&, const R& r) {
                               const auto d = static_cast<std::size_t>(r.direction - 1);
                               return std::string(d < 6 ? kDirectionNames[d] : "");
                           }),
            FixedColumn<R>("IDS_QM_UI_HEAD_PATTERN", [](const T_MODEL&, const R& r) {
                const auto kind = static_cast<std::size_t>(r.patternKind);
                return std::string(kind < kPatternNames.size() ? kPatternNames[kind] : "");
            })});
}

std::unique_ptr<CRecordGrid> MakeHingeTypeGrid(CDBDoc& doc, const char* title)
{
    using R = T_PHGT_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::hingeTypes, true),
            FixedColumn<R>("IDS_RPS_PO_Element_Type",
                           [](const T_MODEL&, const R& r) { return ElementText(r.element); }),
            FixedColumn<R>("IDS_QM_UI_HEAD_COMPONENTS", [](const T_MODEL&, const R& r) {
                std::string names;
                for (std::size_t i = 0; i < r.components.size(); ++i)
                    if (r.components[i].active)
                        names += (names.empty() ? "" : ", ") + std::string(kComponentNames[i]);
                return names;
            })});
}

std::unique_ptr<CRecordGrid> MakeHingeGrid(CDBDoc& doc, const char* title)
{
    using R = T_PHGE_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"),
            CountColumn<R>("IDS_QM_UI_HEAD_ELEMENT", [](const R& r) { return r.element; }),
            FixedColumn<R>("IDS_QM_UI_HEAD_HINGE_TYPE", [](const T_MODEL& model, const R& r) {
                return NameOfKey(model.hingeTypes, r.hingeType);
            })});
}

std::unique_ptr<CRecordGrid> MakeSpectrumGrid(CDBDoc& doc, const char* title)
{
    using R = T_SPFC_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::spectra, true),
                            FixedColumn<R>("IDS_QM_UI_HEAD_KIND", [](const T_MODEL&, const R& r) {
                                return SpectrumKind(r);
                            })});
}

std::unique_ptr<CRecordGrid> MakeEvaluationGrid(CDBDoc& doc, const char* title)
{
    using R = T_EVAL_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::evaluations),
                            FixedColumn<R>("IDS_QM_UI_HEAD_PUSHOVER",
                                           [](const T_MODEL&, const R& r) { return r.push; }),
                            FixedColumn<R>("IDS_QM_UI_HEAD_METHOD",
                                           [](const T_MODEL&, const R& r) {
                                               return std::string(MethodName(r.method));
                                           }),
                            FixedColumn<R>("IDS_QM_UI_HEAD_SPECTRUM",
                                           [](const T_MODEL&, const R& r) { return r.spectrum; })});
}

std::unique_ptr<CRecordGrid> MakeConstraintGrid(CDBDoc& doc, const char* title)
{
    using R = T_ULFC_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{KeyColumn<R>("IDS_QM_UI_HEAD_KEY"),
                            NameColumn(&T_MODEL::ulfConstraints, true),
                            FixedColumn<R>("IDS_QM_UI_HEAD_RULE", [](const T_MODEL&, const R& r) {
                                return UlfDescription(r);
                            })});
}

std::unique_ptr<CRecordGrid> MakeUlfItemGrid(CDBDoc& doc, const char* title)
{
    using R = T_ULFI_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::ulfItems),
            FixedColumn<R>("IDS_QM_UI_HEAD_COMBINATION",
                           [](const T_MODEL& model, const R& r) {
                               return NameOfKey(model.combinations, r.combination);
                           }),
            CountColumn<R>("IDS_QM_UI_HEAD_UNKNOWNS", [](const R& r) { return r.unknowns.size(); }),
            CountColumn<R>("IDS_QM_UI_HEAD_CONSTRAINTS",
                           [](const R& r) { return r.constraints.size(); })});
}

std::unique_ptr<CRecordGrid> MakeStageItemGrid(CDBDoc& doc, const char* title)
{
    using R = T_ULSI_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::ulfStageItems),
                            CountColumn<R>("IDS_QM_UI_HEAD_UNKNOWNS",
                                           [](const R& r) {
                                               return std::ranges::count_if(r.rows,
                                                                            &T_ULSI_ROW::unknown);
                                           }),
                            CountColumn<R>("IDS_QM_UI_HEAD_CONSTRAINTS",
                                           [](const R& r) { return r.constraints.size(); })});
}
