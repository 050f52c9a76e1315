// The hinges of a model as the engine takes them.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/push/law/lawcurve.h"

#include <functional>
#include <span>

/// A law of the engine in the words of the model.
struct T_PUSH_LAW_PLACE {
    int element = 0;                // id
    std::string end;                // "I", "J", "C", or the number of an integration point
    std::size_t hinge = 0, law = 0; // of the engine's hinges
    HINGE_COMPONENT component = HINGE_COMPONENT::My;
    T_SIDES<std::string> letters; // see T_PUSH_LAW
    bool criteria = false, fails = false;
};

struct T_PUSH_HINGES {
    std::vector<solver::T_PUSH_HINGE> hinges;
    std::vector<T_PUSH_LAW_PLACE> laws; // law after law, hinge after hinge: as a step has them
};

struct T_PUSH_LAW_OPTIONS {
    std::vector<int> types; // keys of the hinge types that act; empty: all
    solver::HINGE_FLOW flow = solver::HINGE_FLOW::Rotations;
    /// Axial force of the initial loads in an element (index) at a place, tension positive. Asked
    /// for where curves hang on it; may be empty: no initial loads.
    std::function<double(std::size_t element, double at)> axial;
};

/// The generated hinges of the types that act, in SI. The positive side of every record is that of
/// the forces that an analysis prints as positive (solver::T_RESULT); links and springs work in
/// global axes. elements: ids by the engine's index, ascending.
/// 1 done; 0 with what is wrong, naming element, type and component; `out` unchanged. Refused:
/// stale or missing strengths, a kind of element or a component that does not fit, a released end,
/// two hinges of a component at one place, ratios below 0, acceptance criteria out of order
/// (PushFindings), and what MakeLaw refuses.
[[nodiscard]] int BuildPushHinges(CDBDoc& doc, std::span<const int> elements,
                                  const T_PUSH_LAW_OPTIONS& options, T_PUSH_HINGES& out,
                                  std::string& error);

/// The strengths or curves of some hinge that acts hang on the axial force of the initial loads.
bool NeedsInitialAxial(const T_MODEL& model, const std::vector<int>& types);
