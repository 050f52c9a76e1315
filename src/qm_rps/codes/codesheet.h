// The sheet on which a code's formula is worked out: every number with its clause, what the user
// must be told about it, and why there is no answer.
//
// Everything in this wing is in SI (N, m, Pa, rad); axial force is positive in compression. A
// formula that its code prints in psi or MPa converts inside.
#pragma once

#include "qm_db/records.h"

#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// How a printed figure came here, from the surest to the least sure: worked out by ourselves from
/// the lines above; seen in two independent places; seen once; recalled from memory.
enum class CODE_MARK { Computed, SightedTwice, SightedOnce, Recalled };

/// One number of a code's calculation. The text is notation: no language.
struct T_CODE_TRACE {
    std::string symbol; // "theta_um"
    double value = 0.0; // SI
    T_DIM dim{};
    std::string clause; // "EN 1998-3 (A.1)"
    std::string text;   // the formula, or the rows of the table with their weights
    CODE_MARK mark = CODE_MARK::Computed;
};

/// What the user must know: a text of the message catalogue and what its places take.
struct T_CODE_WARNING {
    std::string key;
    std::vector<std::string> places;
    bool operator==(const T_CODE_WARNING&) const = default;
};
std::string WarningText(const T_CODE_WARNING& warning);

enum class CODE_REASON { NotFinite, NotPositive, Negative, OutOfRange, Missing, NoRow, Tension };

/// Why there is no answer.
struct T_CODE_FAULT {
    CODE_REASON reason = CODE_REASON::NotFinite;
    std::string member;   // of the input: "spacing"
    std::string detail{}; // the range that was asked for, or the table without a row
};
std::string FaultText(const T_CODE_FAULT& fault);

struct T_CODE_MEMBER {
    const char* name = "";
    double value = 0.0;
};

/// Once a fault stands, the lines of the sheet are not an answer: callers throw it away.
class CCodeSheet {
public:
    /// Writes a line and hands its value on. A value that is not finite is a fault of its symbol;
    /// a recalled line warns, once for each clause.
    double Put(std::string_view symbol, double value, T_DIM dim, std::string_view clause,
               std::string_view text, CODE_MARK mark);
    double Put(std::string_view symbol, double value, std::string_view clause,
               std::string_view text, CODE_MARK mark)
    {
        return Put(symbol, value, kDimNone, clause, text, mark);
    }

    /// The same warning stands once.
    void Warn(const char* key, std::vector<std::string> places);
    /// The variable lies outside its table: the nearest row, at `nearest`, is taken.
    void WarnOutside(std::string_view clause, std::string_view symbol, double value,
                     double nearest);
    /// The sources differ: what was taken, and what else is printed.
    void WarnConflict(std::string_view clause, std::string_view taken, std::string_view others);

    /// Refuses what is not kept; true while the sheet is sound. The first fault stays.
    bool Positive(std::initializer_list<T_CODE_MEMBER> members);
    bool NotNegative(std::initializer_list<T_CODE_MEMBER> members);
    bool Within(const char* name, double value, double low, double high);
    bool Finite(std::initializer_list<T_CODE_MEMBER> members);
    /// Always false, to be returned.
    bool Refuse(CODE_REASON reason, std::string_view member, std::string_view detail = {});

    bool Sound() const { return !m_fault; }
    const std::optional<T_CODE_FAULT>& Fault() const { return m_fault; }
    const std::vector<T_CODE_TRACE>& Trace() const { return m_trace; }
    const std::vector<T_CODE_WARNING>& Warnings() const { return m_warnings; }

private:
    std::vector<T_CODE_TRACE> m_trace;
    std::vector<T_CODE_WARNING> m_warnings;
    std::optional<T_CODE_FAULT> m_fault;
};

/// "0.25"; for texts of traces and warnings.
std::string CodeNumber(double value);

inline constexpr double kPascalsPerMpa = 1e6;
inline constexpr double kPascalsPerPsi = 6894.757293168;
inline constexpr double kPascalsPerKsi = 1000.0 * kPascalsPerPsi;
inline constexpr double kMetresPerInch = 0.0254;

/// The square root that codes take of a strength in psi or MPa, as a stress in Pa: sqrt(fc) psi,
/// sqrt(fc) MPa.
double RootPsi(double strength);
double RootMpa(double strength);

/// Between (x0, y0) and (x1, y1), flat outside; x0 < x1.
double LinearClamped(double x, double x0, double y0, double x1, double y1);
