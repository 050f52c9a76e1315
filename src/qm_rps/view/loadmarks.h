// Loads and reactions as a picture shows them: arrows, bands of distributed loads, words.
#pragma once

#include "qm_rps/view/viewresults.h"

/// Movement and Turn: displacements that are imposed at supports.
enum class MARK_KIND { Force, Moment, Movement, Turn };
inline constexpr std::size_t kMarkKinds = 4;

/// An arrow that acts at a place; of a moment or turn the axis by the right hand.
struct T_ARROW_MARK {
    MARK_KIND kind = MARK_KIND::Force;
    std::array<double, 3> at{};    // current lengths
    std::array<double, 3> along{}; // unit vector
    double value = 0.0;            // above 0, current units
    double size = 0.0;             // over the largest of its kind, 0 to 1
};

/// A distributed load on a line of the scene, straight from one end to the other.
struct T_BAND_MARK {
    std::array<double, 3> from{}, to{};       // places
    std::array<double, 3> along0{}, along1{}; // load over the largest one, as it acts
    std::array<double, 2> value{};            // with the sign of the larger one's direction
};

/// What is told in words at the middle of a line.
struct T_WORD_MARK {
    std::array<double, 3> at{};
    std::string text;
};

struct T_LOAD_MARKS {
    std::vector<T_ARROW_MARK> arrows;
    std::vector<T_BAND_MARK> bands;
    std::vector<T_WORD_MARK> words;
    std::vector<std::string> notes;           // of the whole case: self weight
    std::array<std::string, kMarkKinds> unit; // by kind of arrow
    std::string bandUnit;
    bool IsEmpty() const
    {
        return arrows.empty() && bands.empty() && words.empty() && notes.empty();
    }
};

/// Loads on what the scene shows. Forces at one node are added up and drawn as one arrow.
[[nodiscard]] T_LOAD_MARKS LoadMarksOf(const CViewFrame& frame, const T_FRAME_SCENE& scene,
                                       const solver::T_LOAD_CASE& loads, const T_UNITS& units);
/// Forces and moments of supports on the structure, by their global components.
[[nodiscard]] T_LOAD_MARKS ReactionMarksOf(const T_FRAME_SCENE& scene,
                                           const T_VIEW_RESULTS& results, const T_UNITS& units);
