#include "qm_rps/push/pushstates.h"

#include <algorithm>
#include <cmath>

namespace {

/// By the criteria of the side on which the deformation lies.
PUSH_STATE ByCriteria(const solver::T_HINGE_LAW& law, double deformation)
{
    const std::vector<double>& marks = (deformation < 0.0 ? law.negative : law.positive).marks;
    const auto passed =
        std::ranges::count_if(marks, [&](double mark) { return std::fabs(deformation) >= mark; });
    return static_cast<PUSH_STATE>(static_cast<int>(PUSH_STATE::BtoIO) + static_cast<int>(passed));
}

} // namespace

PUSH_STATE StateOf(const T_PUSH_LAW_PLACE& place, const solver::T_HINGE_LAW& law,
                   const solver::T_HINGE_STATE& state)
{
    if (state.place == 0) return PUSH_STATE::Elastic;
    const std::string& letters = state.place < 0 ? place.letters.neg : place.letters.pos;
    const auto last =
        std::min<std::size_t>(static_cast<std::size_t>(std::abs(state.place)), letters.size());
    const char at = last == 0 ? 'B' : letters[last - 1];
    if (last == letters.size() && place.fails) return PUSH_STATE::Failed;
    if (at == 'C') return PUSH_STATE::CtoD;
    if (at >= 'D') return PUSH_STATE::DtoE;
    return place.criteria ? ByCriteria(law, state.deformation) : PUSH_STATE::BtoC;
}

std::string EventTarget(const T_PUSH_LAW_PLACE& place, const solver::T_HINGE_EVENT& event)
{
    constexpr const char* kTurns[] = {"",     "unload",  "reload",
                                      "slip", "contact", "leap"}; // of HINGE_TURN
    if (event.turn != solver::HINGE_TURN::Point) return kTurns[static_cast<int>(event.turn)];
    const std::string& letters = event.positive ? place.letters.pos : place.letters.neg;
    const auto at = static_cast<std::size_t>(event.point - 1);
    return at < letters.size() ? std::string(1, letters[at]) : std::string();
}
