// The registry of record kinds: one row for each. Case file, model file, undo, references and names
// run over it; what a record of the kind holds is its list of members (fieldwords.h).
#pragma once

#include "qm_db/records.h"

#include <string_view>
#include <tuple>

/// How the case file gives the key of a record: it counts 1, 2, 3, ... and is stated where it does
/// not; it always counts; it is one of the record's own members.
enum class CASE_KEY { Stated, Counted, Member };

template <class R>
struct T_RECORD_ROW {
    T_TABLE<R> T_MODEL::*table;
    const char* store;  // table of the model file
    const char* member; // of the case file; null: it stands in another record
    CASE_KEY key;
    std::string_view noun; // catalogue key; empty: other records do not refer to it
    /// As a record that refers to others: its place among the kinds in a message, and what it is
    /// called there; empty: it refers to none.
    int place = 0;
    std::string_view user = "";
};

// clang-format off
/// In the order of the case file: a record refers to those of rows above, and of its own.
inline constexpr std::tuple kRecords{
    T_RECORD_ROW<T_NODE_D>{&T_MODEL::nodes, "nodes", "nodes", CASE_KEY::Member,
                           "IDS_QM_NOUN_NODE"},
    T_RECORD_ROW<T_STOR_D>{&T_MODEL::storeys, "storeys", "storeys", CASE_KEY::Counted, "",
                           7, "IDS_QM_DB_USER_STOREY"},
    T_RECORD_ROW<T_EIGV_D>{&T_MODEL::modes, "modes", "modes", CASE_KEY::Counted, ""},
    T_RECORD_ROW<T_MATL_D>{&T_MODEL::materials, "materials", "materials",
                           CASE_KEY::Stated, "IDS_QM_NOUN_MATERIAL"},
    T_RECORD_ROW<T_SECT_D>{&T_MODEL::sections, "sections", "sections",
                           CASE_KEY::Stated, "IDS_QM_NOUN_SECTION"},
    T_RECORD_ROW<T_ELEM_D>{&T_MODEL::elements, "elements", "elements",
                           CASE_KEY::Member, "IDS_QM_NOUN_ELEMENT", 1, "IDS_QM_DB_USER_ELEMENT"},
    T_RECORD_ROW<T_DIAP_D>{&T_MODEL::diaphragms, "diaphragms", "diaphragms",
                           CASE_KEY::Stated, "", 2, "IDS_QM_DB_USER_DIAPHRAGM"},
    T_RECORD_ROW<T_EQDS_D>{&T_MODEL::equalDisplacements, "equal_displacements",
                           "equal_displacements", CASE_KEY::Stated, "",
                           3, "IDS_QM_DB_USER_EQUAL"},
    T_RECORD_ROW<T_STLD_D>{&T_MODEL::loadCases, "load_cases", "load_cases",
                           CASE_KEY::Stated, "IDS_QM_NOUN_LOAD_CASE",
                           4, "IDS_QM_DB_USER_LOAD_CASE"},
    T_RECORD_ROW<T_LCOM_D>{&T_MODEL::combinations, "combinations", "combinations",
                           CASE_KEY::Stated, "IDS_QM_NOUN_COMBINATION", 5, "IDS_QM_DB_USER_LCOM"},
    T_RECORD_ROW<T_STAG_D>{&T_MODEL::stages, "stages", "stages", CASE_KEY::Stated,
                           "IDS_QM_NOUN_STAGE", 12, "IDS_QM_DB_USER_STAGE"},
    T_RECORD_ROW<T_ULFC_D>{&T_MODEL::ulfConstraints, "ulf_constraints", "ulf_constraints",
                           CASE_KEY::Stated, "IDS_QM_NOUN_CONSTRAINT",
                           11, "IDS_QM_DB_USER_ULF_CONSTRAINT"},
    T_RECORD_ROW<T_ULFI_D>{&T_MODEL::ulfItems, "ulf_items", "ulf_items",
                           CASE_KEY::Stated, "", 6, "IDS_QM_DB_USER_ULF_ITEM"},
    T_RECORD_ROW<T_ULSI_D>{&T_MODEL::ulfStageItems, "ulf_stage_items", "ulf_stage_items",
                           CASE_KEY::Stated, "", 13, "IDS_QM_DB_USER_ULF_STAGE_ITEM"},
    T_RECORD_ROW<T_POFC_D>{&T_MODEL::incrementFunctions, "increment_functions",
                           "increment_functions", CASE_KEY::Stated, ""},
    T_RECORD_ROW<T_PHGT_D>{&T_MODEL::hingeTypes, "hinge_types", "hinge_types",
                           CASE_KEY::Stated, "IDS_QM_NOUN_HINGE_TYPE",
                           9, "IDS_QM_DB_USER_HINGE_TYPE"},
    T_RECORD_ROW<T_PHGE_D>{&T_MODEL::hinges, "hinges", "hinges", CASE_KEY::Stated, "",
                           8, "IDS_QM_DB_USER_HINGE"},
    T_RECORD_ROW<T_IEHP_D>{&T_MODEL::inelasticHinges, "inelastic_hinges", "inelastic_hinges",
                           CASE_KEY::Stated, ""},
    T_RECORD_ROW<T_SPFC_D>{&T_MODEL::spectra, "spectra", "spectra", CASE_KEY::Counted,
                           "IDS_QM_NOUN_SPECTRUM"},
    T_RECORD_ROW<T_POLC_D>{&T_MODEL::pushovers, "pushovers", "pushover",
                           CASE_KEY::Counted, "IDS_QM_NOUN_PUSHOVER",
                           10, "IDS_QM_DB_USER_PUSHOVER"},
    T_RECORD_ROW<T_POVR_D>{&T_MODEL::poverSteps, "limit_state_steps", nullptr,
                           CASE_KEY::Counted, ""},
    T_RECORD_ROW<T_EVAL_D>{&T_MODEL::evaluations, "evaluations", "evaluations",
                           CASE_KEY::Counted, "", 14, "IDS_QM_DB_USER_EVALUATION"}};
// clang-format on

/// A kind of record: the number of its row.
enum class RECORD_KIND : std::size_t {};

template <class R>
constexpr const T_RECORD_ROW<R>& RowOf()
{
    return std::get<T_RECORD_ROW<R>>(kRecords);
}

/// Calls f(row) for each row in order.
template <class F>
constexpr void ForEachKind(F&& f)
{
    std::apply([&](const auto&... rows) { (f(rows), ...); }, kRecords);
}

template <class R>
constexpr RECORD_KIND KindOf()
{
    std::size_t at = 0, found = 0;
    ForEachKind([&](const auto& row) {
        if constexpr (std::is_same_v<std::decay_t<decltype(row)>, T_RECORD_ROW<R>>) found = at;
        ++at;
    });
    return RECORD_KIND{found};
}

/// Calls f(row) with the row of the kind.
template <class F>
constexpr void WithKind(RECORD_KIND kind, F&& f)
{
    std::size_t at = 0;
    ForEachKind([&](const auto& row) {
        if (RECORD_KIND{at++} == kind) f(row);
    });
}

template <class R>
constexpr bool kHasName = requires(R& r)
{
    r.name;
};

/// Units of the store.
inline constexpr T_UNITS kSiUnits{FORCE_UNIT::N, LENGTH_UNIT::m};

/// Table of a record type: nodes for T_NODE_D, and so on.
template <class R>
T_TABLE<R>& TableOf(T_MODEL& model)
{
    return model.*RowOf<R>().table;
}
template <class R>
const T_TABLE<R>& TableOf(const T_MODEL& model)
{
    return model.*RowOf<R>().table;
}
