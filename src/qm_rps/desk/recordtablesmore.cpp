// Tables of modes, nodes that move together, inelastic hinges, increment functions and limit-state
// steps.
#include "qm_db/recordfacts.h"
#include "qm_rps/desk/recordtable.h"
#include "qm_rps/desk/recordtables.h"

namespace {

std::string Joined(const auto& values, const auto& text)
{
    std::string all;
    for (const auto& value : values)
        all += (all.empty() ? "" : ", ") + text(value);
    return all;
}
std::string Ids(const std::vector<int>& ids)
{
    return Joined(ids, [](int id) { return std::to_string(id); });
}
std::string Numbers(const std::vector<double>& numbers)
{
    return Joined(numbers, ShortestText);
}

/// Modal masses are there where they were typed or analysed.
T_RECORD_COLUMN<T_EIGV_D> MassColumn(const char* head, std::size_t direction)
{
    auto c = FixedColumn<T_EIGV_D>(head, [direction](const T_MODEL&, const T_EIGV_D& r) {
        return r.massPercent ? ShortestText((*r.massPercent)[direction]) : std::string();
    });
    c.kind = CELL_KIND::Number;
    return c;
}

std::string Steps(const std::optional<std::array<int, 3>>& steps)
{
    return steps ? Joined(*steps, [](int step) { return std::to_string(step); }) : std::string();
}

} // namespace

std::unique_ptr<CRecordGrid> MakeModeGrid(CDBDoc& doc, const char* title)
{
    using R = T_EIGV_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"),
            NumberColumn<R>(
                "IDS_QM_FIELD_period", kDimNone, [](R& r) -> double& { return r.period; }, 0.0),
            MassColumn("IDS_QM_UI_HEAD_MASS_X", 0), MassColumn("IDS_QM_UI_HEAD_MASS_Y", 1),
            MassColumn("IDS_QM_UI_HEAD_MASS_Z", 2)});
}

std::unique_ptr<CRecordGrid> MakeDiaphragmGrid(CDBDoc& doc, const char* title)
{
    using R = T_DIAP_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"),
            FixedColumn<R>("IDS_QM_FIELD_normal",
                           [](const T_MODEL&, const R& r) {
                               return std::string(r.normal == 0 ? "X" : r.normal == 1 ? "Y" : "Z");
                           }),
            FixedColumn<R>("IDS_QM_UI_HEAD_NODES",
                           [](const T_MODEL&, const R& r) { return Ids(r.nodes); })});
}

std::unique_ptr<CRecordGrid> MakeEqualGrid(CDBDoc& doc, const char* title)
{
    using R = T_EQDS_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{KeyColumn<R>("IDS_QM_UI_HEAD_KEY"),
                            FixedColumn<R>("IDS_QM_FIELD_directions",
                                           [](const T_MODEL&, const R& r) {
                                               std::string names;
                                               for (std::size_t d = 0; d < r.directions.size(); ++d)
                                                   if (r.directions[d])
                                                       names += (names.empty() ? "" : ", ") +
                                                                std::string(kDirectionNames[d]);
                                               return names;
                                           }),
                            FixedColumn<R>("IDS_QM_UI_HEAD_NODES", [](const T_MODEL&, const R& r) {
                                return Ids(r.nodes);
                            })});
}

std::unique_ptr<CRecordGrid> MakeInelasticGrid(CDBDoc& doc, const char* title)
{
    using R = T_IEHP_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::inelasticHinges),
            FixedColumn<R>("IDS_QM_UI_HEAD_COMPONENTS", [](const T_MODEL&, const R& r) {
                std::string names;
                for (std::size_t i = 0; i < r.components.size(); ++i)
                    if (r.components[i])
                        names += (names.empty() ? "" : ", ") + std::string(kComponentNames[i]);
                return names;
            })});
}

std::unique_ptr<CRecordGrid> MakeFunctionGrid(CDBDoc& doc, const char* title)
{
    using R = T_POFC_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::incrementFunctions),
            FixedColumn<R>("IDS_QM_FIELD_step",
                           [](const T_MODEL&, const R& r) { return Numbers(r.step); }),
            FixedColumn<R>("IDS_QM_FIELD_factor",
                           [](const T_MODEL&, const R& r) { return Numbers(r.factor); })});
}

std::unique_ptr<CRecordGrid> MakeLimitStepGrid(CDBDoc& doc, const char* title)
{
    using R = T_POVR_D;
    return std::make_unique<CRecordTable<R>>(
        doc, title,
        T_RECORD_COLUMNS<R>{
            KeyColumn<R>("IDS_QM_UI_HEAD_KEY"),
            FixedColumn<R>("IDS_QM_UI_HEAD_EC8_STEPS",
                           [](const T_MODEL&, const R& r) { return Steps(r.ec8); }),
            FixedColumn<R>("IDS_QM_UI_HEAD_NTC_STEPS",
                           [](const T_MODEL&, const R& r) { return Steps(r.ntc); })});
}
