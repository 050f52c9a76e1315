// Records of the model database. Plain data; in the store every quantity is in SI.
#pragma once

#include "qm_db/records/hingerecords.h"
#include "qm_db/records/loadrecords.h"
#include "qm_db/records/namedrecords.h"
#include "qm_db/records/pushrecords.h"
#include "qm_db/records/stagerecords.h"
#include "qm_db/records/units.h"

#include <array>
#include <map>
#include <optional>
#include <string>
#include <variant>
#include <vector>

/// Six components in the order X, Y, Z, RX, RY, RZ.
using T_DOF6 = std::array<double, 6>;

/// Names of the design codes that the model is checked by ("Eurocode2:04"); absent: none chosen.
struct T_DESIGN_CODES {
    std::optional<std::string> concrete{};
    std::optional<std::string> steel{};
    bool operator==(const T_DESIGN_CODES&) const = default;
};

/// What the title block of a report says, which chapters it has, and how long its tables are.
struct T_REPORT_D {
    std::string project, author, checker, date;
    std::vector<std::string> chapters; // their names (kReportChapterNames); empty: all
    int rows = 200;                    // of a table at most; 0: all
    bool operator==(const T_REPORT_D&) const = default;
};

/// Plane of a plane model; the displacements out of it are restrained at every node.
enum class MODEL_PLANE { XY, XZ, YZ };

/// Structure type: what holds for the whole model.
struct T_STYP_D {
    std::string title;
    T_UNITS units;                   // current units of the document
    std::optional<double> gravity{}; // m/s2 in the store; absent: 9.80665 m/s2
    T_DESIGN_CODES designCodes{};
    // Options of plastic hinges.
    bool alternativeHysteresis = false;   // alternative hysteresis models are in use
    bool wallStrengthDegradation = false; // wall types offer the strength degradation curve
    bool gsd = false;                     // My and Mz offer the section-based curve
    // Stiffness reduction ratios of new multilinear curves, (+) and (-).
    std::array<double, 2> defaultAlpha1{}, defaultAlpha2{};
    std::optional<MODEL_PLANE> plane{}; // absent: a space model
    T_STCT_D stageControl{};
    T_REPORT_D report{};
    bool operator==(const T_STYP_D&) const = default;
};

struct T_NODE_D {
    int id = 0;
    std::array<double, 3> xyz{};    // coordinates
    std::array<double, 3> mass{};   // lumped mass in X, Y, Z
    std::array<int, 6> restraint{}; // 1 restrained, 0 free
    bool operator==(const T_NODE_D&) const = default;
};

struct T_STOR_D {
    std::string name;
    double height = 0.0;    // storey height
    std::vector<int> nodes; // nodes of the level, as listed
    bool operator==(const T_STOR_D&) const = default;
};

/// One eigen mode. Shape and participation belong to the same normalisation.
struct T_EIGV_D {
    double period = 0.0;                 // s
    std::map<int, T_DOF6> shape;         // by node id
    std::optional<T_DOF6> participation; // absent: follows from masses and shape
    std::optional<T_DOF6> massPercent;   // effective modal mass in per cent; absent: as above
    bool operator==(const T_EIGV_D&) const = default;
};

/// Spectrum function records; ordinates in g, periods in s, damping in per cent.
struct T_SPFC_ATC40 {
    double Ca = 0.0; // ATC-40 (1996) 4.4.3
    double Cv = 0.0;
    std::optional<bool> floors; // lower bounds of SRA and SRV (Table 8-2); absent: true
    bool operator==(const T_SPFC_ATC40&) const = default;
};

struct T_SPFC_EURO2003 { // EN 1998-1:2004 3.2.2.2
    int type = 1;        // 1 or 2
    char soil = 'A';     // A to E
    double ag = 0.0;
    std::optional<double> damping;       // absent: 5
    std::optional<double> S, TB, TC, TD; // override the table
    bool operator==(const T_SPFC_EURO2003&) const = default;
};

struct T_SPFC_EURO1996 { // ENV 1998-1-1:1994 4.2.2
    char soil = 'A';     // A to C
    double ag = 0.0;
    std::optional<double> damping; // absent: 5
    bool operator==(const T_SPFC_EURO1996&) const = default;
};

/// Limit states of NTC in their fixed order.
enum class LIMIT_STATE { SLO, SLD, SLV, SLC };
inline constexpr std::array<const char*, 4> kLimitStateNames{"SLO", "SLD", "SLV", "SLC"};

struct T_SPFC_NTC_STATE {
    double ag = 0.0;
    double F0 = 0.0;
    double TCstar = 0.0; // s
    bool operator==(const T_SPFC_NTC_STATE&) const = default;
};

struct T_SPFC_NTC {                                        // NTC 2008/2018 3.2.3.2.1
    char soil = 'A';                                       // A to E
    int topography = 1;                                    // T1 to T4
    std::optional<double> damping;                         // absent: 5
    std::array<std::optional<T_SPFC_NTC_STATE>, 4> states; // by LIMIT_STATE; absent: not enabled
    bool operator==(const T_SPFC_NTC&) const = default;
};

struct T_SPFC_USER {
    std::vector<double> T;         // s, strictly ascending, at least two
    std::vector<double> Sa;        // g, same length
    std::optional<double> gravity; // m/s2 in the store; serves the whole evaluation
    bool operator==(const T_SPFC_USER&) const = default;
};

struct T_SPFC_D {
    std::string name;
    std::variant<T_SPFC_ATC40, T_SPFC_EURO2003, T_SPFC_EURO1996, T_SPFC_NTC, T_SPFC_USER> data;
    bool operator==(const T_SPFC_D&) const = default;
};

/// Evaluation methods; the codes are also those of the spectral plot types.
enum class PUSH_METHOD { Fema440 = 4, Atc40 = 5, Ec8Opcm = 6, Ntc2008 = 7, Ntc2018 = 8 };

/// Options of the bilinear capacity spectrum of the target-displacement methods.
struct T_EVAL_BILINEAR {
    std::optional<std::string> rule; // "ec8", "ntc" or "masonry"; absent: the method's own
    std::optional<double> secant;    // fraction of the strength that fixes the stiffness, (0, 1]
    std::optional<double> drop;      // fraction of the strength that ends the curve, (0, 1]
    std::optional<bool> iterate;     // EN 1998-1 B.3 iteration; absent: false
    std::optional<std::string> strength{}; // yield strength: "rule" or "peak"; absent: "rule"
    bool operator==(const T_EVAL_BILINEAR&) const = default;
};

/// Most further nodes that an evaluation follows.
inline constexpr std::size_t kMostMonitoredNodes = 4;

/// One evaluation: a pushover load case, a method, a spectrum. Absent options have defaults.
struct T_EVAL_D {
    std::string name;
    std::string push; // name of the pushover load case
    PUSH_METHOD method = PUSH_METHOD::Atc40;
    std::optional<char> procedure;                    // 'A', 'B', 'C'; absent: A
    std::string spectrum;                             // name of the spectrum
    std::optional<int> behavior;                      // 0 to 3; absent: 0
    std::optional<double> elasticDamping;             // per cent; absent: 5
    std::optional<std::array<double, 4>> userDamping; // beta1, kappa1, beta2, kappa2
    std::optional<bool> eigenFactors;                 // absent: true
    std::optional<bool> masonry;                      // absent: false
    std::optional<int> driftKind;                     // 1 or 2; absent: 1
    std::optional<int> plotType;                      // 0 to 8; absent: the method's own
    std::optional<bool> alphaInPercent;               // absent: false
    std::optional<T_EVAL_BILINEAR> bilinear;
    std::optional<double> weight{};    // force; stands in where the model has no vertical mass
    std::vector<int> monitoredNodes{}; // further nodes whose displacement is shown, up to 4
    bool operator==(const T_EVAL_D&) const = default;
};

/// Limit-state steps that an evaluation stored for a pushover load case; -2: not found.
struct T_POVR_D {
    std::optional<std::array<int, 3>> ec8; // DL, SD, NC
    std::optional<std::array<int, 3>> ntc; // SLD, SLV, SLC
    bool operator==(const T_POVR_D&) const = default;
};

template <class T>
using T_TABLE = std::map<int, T>;

/// The whole model but its results, in SI.
struct T_MODEL {
    T_STYP_D styp;
    T_POGC_D pushControl;
    T_TABLE<T_NODE_D> nodes;              // by node id
    T_TABLE<T_STOR_D> storeys;            // 1, 2, ... bottom to top
    T_TABLE<T_EIGV_D> modes;              // by mode number
    T_TABLE<T_SPFC_D> spectra;            // 1, 2, ... in the order of definition
    T_TABLE<T_POLC_D> pushovers;          // likewise
    T_TABLE<T_EVAL_D> evaluations;        // likewise
    T_TABLE<T_POVR_D> poverSteps;         // by the key of the pushover load case
    T_TABLE<T_MATL_D> materials;          // 1, 2, ... in the order of definition
    T_TABLE<T_SECT_D> sections;           // likewise
    T_TABLE<T_ELEM_D> elements;           // by element id
    T_TABLE<T_PHGT_D> hingeTypes;         // 1, 2, ... in the order of definition
    T_TABLE<T_PHGE_D> hinges;             // likewise
    T_TABLE<T_IEHP_D> inelasticHinges;    // likewise
    T_TABLE<T_POFC_D> incrementFunctions; // likewise
    T_TABLE<T_DIAP_D> diaphragms;         // likewise
    T_TABLE<T_EQDS_D> equalDisplacements; // likewise
    T_TABLE<T_STLD_D> loadCases;          // likewise
    T_TABLE<T_LCOM_D> combinations;       // likewise
    T_TABLE<T_ULFC_D> ulfConstraints;     // likewise
    T_TABLE<T_ULFI_D> ulfItems;           // likewise
    T_TABLE<T_STAG_D> stages;             // likewise
    T_TABLE<T_ULSI_D> ulfStageItems;      // likewise
    bool operator==(const T_MODEL&) const = default;
};
