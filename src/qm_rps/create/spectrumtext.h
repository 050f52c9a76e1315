// A spectrum as one word of a command: "ec8-2004:soil=C,ag=0.25".
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <string>
#include <vector>

/// KIND:KEY=VALUE,KEY=VALUE ... with the kinds and keys of a case file; what a kind leaves out
/// there may be left out here. Limit states of ntc are ag/F0/TC* ("SLV=0.261/2.36/0.35"), T and Sa
/// of user are parted by slashes ("T=0/0.5/2,Sa=0.4/1/0.25"). asce41:SXS=...,SX1=... is an atc40
/// spectrum with Ca = 0.4 SXS and Cv = SX1. `name` names it (by its kind when left out). `damping`
/// below 0.5 is a ratio. The spectrum is not checked beyond that: RecordFindings does it. 1 done; 0
/// fault filled (field "spectrum"), `out` as it was.
[[nodiscard]] int ParseSpectrum(const std::string& text, T_SPFC_D& out, T_FINDING& fault);

/// The shortest such text that reads back as the same spectrum.
std::string SpectrumText(const T_SPFC_D& spectrum);

/// The name of a spectrum of this kind where nobody gives one: "EC8", "NTC", "ATC", "USER".
std::string SpectrumNameOf(std::size_t kind);

/// T and Sa (g) from two columns of a text. 1 done; 0 fault filled (field "table").
[[nodiscard]] int UserSpectrum(const std::string& text, T_SPFC_USER& out, T_FINDING& fault);
