// Rolled and hollow steel shapes by name. Lengths in m.
#pragma once

#include <array>
#include <optional>
#include <span>
#include <string>

/// A rolled I or H.
struct T_ROLLED_SHAPE {
    const char* name = ""; // "IPE 300"
    double height = 0.0, width = 0.0, web = 0.0, flange = 0.0, fillet = 0.0;
};
std::span<const T_ROLLED_SHAPE> SteelShapes();

enum class STOCK_SHAPE { I, Box, Pipe };
/// Sizes in the order of the sections of a model; `fillet` of a box: outer radius of the corners.
struct T_STOCK_SHAPE {
    STOCK_SHAPE kind = STOCK_SHAPE::I;
    std::array<double, 4> size{};
    double fillet = 0.0;
};

/// One of SteelShapes, or a hollow shape with its dimensions in mm: "CHS 168.3x8", "SHS 100x5",
/// "RHS 200x100x8" (hot finished, EN 10210-2, corners of 1.5 and 1 times the wall), "CFSHS",
/// "CFRHS" (cold formed, EN 10219-2: 2 and 1 times up to 6 mm, 2.5 and 1.5 times up to 10 mm, no
/// thicker ones). Blanks and case do not matter. None: there is no such shape.
std::optional<T_STOCK_SHAPE> FindShape(const std::string& name);
