// Rolled and hollow steel shapes by name. Lengths in m.
#pragma once

#include <array>
#include <optional>
#include <span>
#include <string>

enum class STOCK_SHAPE { I, Channel, Box, Pipe };
/// Sizes in the order of the sections of a model; `fillet` of a box: outer radius of the corners.
struct T_STOCK_SHAPE {
    STOCK_SHAPE kind = STOCK_SHAPE::I;
    std::array<double, 4> size{};
    double fillet = 0.0;
    double taper = 0.0; // of the flanges of a channel
};

/// A rolled shape of a table.
struct T_ROLLED_SHAPE {
    std::string name; // "IPE 300"
    T_STOCK_SHAPE shape;

    std::string Family() const; // "IPE": the letters that the name begins with
};
/// By family, each from the smallest to the largest.
std::span<const T_ROLLED_SHAPE> SteelShapes();

/// One of SteelShapes, or a hollow shape with its dimensions in mm: "CHS 168.3x8", "SHS 100x5",
/// "RHS 200x100x8" (hot finished, EN 10210-2, corners of 1.5 and 1 times the wall), "CFSHS",
/// "CFRHS" (cold formed, EN 10219-2: 2 and 1 times up to 6 mm, 2.5 and 1.5 times up to 10 mm, no
/// thicker ones). Blanks and case do not matter. None: there is no such shape.
std::optional<T_STOCK_SHAPE> FindShape(const std::string& name);

/// The rolled shape of the family whose numbers are the nearest to those of the name, height first;
/// without such a family the one with the nearest name. Empty: none is near.
std::string NearestShape(const std::string& name);
/// That there is no such shape, and which one is near.
std::string NoShapeText(const std::string& name);
