// Where the optimizer of load factors gets responses from: the seam between its rule and a kind of
// analysis (static load cases, construction stages).
#pragma once

#include <array>
#include <compare>
#include <span>
#include <string>

/// Load case item of the optimizer. Static: 0 key of the load case, 1 known factor (below 1e-12 in
/// absolute value: unknown), 2 weight of an unknown case, 3 unused. Construction stage: 0 stage and
/// step whose results are read (see UlfStageNumber), 3 load group. Integers are stored as doubles.
using T_OPT_ITEM = std::array<double, 4>;

/// A response quantity of the structure.
struct T_OPT_QUANTITY {
    int kind = 0;      // 1 displacement, 2 reaction of a node, 3 force of a truss, 4 of a beam
    int id = 0;        // node or element
    int position = 0;  // of a beam, 1 I-end to 5 J-end; else 0
    int component = 0; // from 1
    int at = 0;        // stage and step where it is read (UlfStageNumber); 0: those of the item
    auto operator<=>(const T_OPT_QUANTITY&) const = default;
};

class IUlfResponse {
public:
    IUlfResponse() = default;
    IUlfResponse(const IUlfResponse&) = delete;
    IUlfResponse& operator=(const IUlfResponse&) = delete;
    virtual ~IUlfResponse() = default;

    /// Responses to each item alone at factor 1, in the document's current units:
    /// out[q * items.size() + i] is quantity q under item i. All at once, so that a source may
    /// select an item once and read everything of it. 1 done; 0 one of them can't be had or is not
    /// finite, Error() says which, `out` is not defined.
    [[nodiscard]] virtual int Read(std::span<const T_OPT_ITEM> items,
                                   std::span<const T_OPT_QUANTITY> what, std::span<double> out) = 0;
    /// Why the latest Read failed, in words.
    virtual std::string Error() const = 0;
};
