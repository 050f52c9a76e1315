// The strengths that a section is calculated with: which value of its material, by which code. SI.
#pragma once

#include "qm_rps/codes/codesheet.h"

#include <array>

enum class SECTION_VALUES {
    Characteristic, // as entered: fck, fyk, Fy
    Mean,           // the material's mean values
    Expected,       // ASCE 41-17: means, or the entered strengths times the factors of its tables
    LowerBound,     // ASCE 41-17: as entered
    Design,         // EN 1992-1-1, EN 1993-1-1: over the partial factors of the recommended values
    Assessed,       // EN 1998-3: means over the confidence factor
};
inline constexpr std::array<const char*, 6> kSectionValueNames{
    "characteristic", "mean", "expected", "lower", "design", "assessed"};

enum class SECTION_LAW { Eurocode, Aci };
inline constexpr std::array<const char*, 2> kSectionLawNames{"eurocode", "aci"};

/// The core within the stirrups; the cover then spalls.
enum class SECTION_CORE { Plain, Mander, Eurocode, Ntc, En1998 };
inline constexpr std::array<const char*, 5> kSectionCoreNames{"no", "mander", "eurocode", "ntc",
                                                              "en1998"};

struct T_SECTION_OPTIONS {
    SECTION_VALUES values = SECTION_VALUES::Characteristic;
    SECTION_LAW law = SECTION_LAW::Eurocode;
    SECTION_CORE core = SECTION_CORE::Plain;
    double alphaCc = 1.0;     // EN 1992-1-1 3.1.6, of design values
    double steelStrain = 0.0; // where bars or steel end; 0: bars nowhere, steel 15 Fy / E
    double hardening = 0.0;   // modulus beyond yield over the elastic modulus
    double hoopStrain = 0.0;  // of stirrups at their largest stress (Mander); 0: not known
    bool operator==(const T_SECTION_OPTIONS&) const = default;
};

struct T_SECTION_STRENGTHS {
    double fc = 0.0;      // concrete; 0: the section is of steel
    double fcClass = 0.0; // the strength that the strains of its law follow from
    double fy = 0.0;      // bars or steel
    double fyw = 0.0;     // stirrups
    double E = 0.0;       // bars or steel
};
/// Refuses a material that has no such value, with the member that is missing.
std::optional<T_SECTION_STRENGTHS>
SectionStrengths(const T_MATL_D& material, const T_SECTION_OPTIONS& options, CCodeSheet& sheet);
