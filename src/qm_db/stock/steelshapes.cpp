#include "qm_db/stock/steelshapes.h"

#include "qm_base/nearname.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/stock/rolledtables.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <iterator>
#include <vector>

namespace {

// EN 10365: height, width, web, flange, root radius, mm. Taken from two public tables that share no
// text and agree in every dimension; area, second moments and plastic modulus, calculated from the
// dimensions, agree with the printed ones to 0.6 % (they have three or four digits; the plastic
// modulus of HEM 220 to 0.8 %). The larger HEM are left out: there the tables differ.
struct T_ROW {
    const char* name;
    double height, width, web, flange, fillet;
};
// clang-format off
constexpr T_ROW kRows[] = {
    {"IPE 80", 80, 46, 3.8, 5.2, 5},
    {"IPE 100", 100, 55, 4.1, 5.7, 7},
    {"IPE 120", 120, 64, 4.4, 6.3, 7},
    {"IPE 140", 140, 73, 4.7, 6.9, 7},
    {"IPE 160", 160, 82, 5, 7.4, 9},
    {"IPE 180", 180, 91, 5.3, 8, 9},
    {"IPE 200", 200, 100, 5.6, 8.5, 12},
    {"IPE 220", 220, 110, 5.9, 9.2, 12},
    {"IPE 240", 240, 120, 6.2, 9.8, 15},
    {"IPE 270", 270, 135, 6.6, 10.2, 15},
    {"IPE 300", 300, 150, 7.1, 10.7, 15},
    {"IPE 330", 330, 160, 7.5, 11.5, 18},
    {"IPE 360", 360, 170, 8, 12.7, 18},
    {"IPE 400", 400, 180, 8.6, 13.5, 21},
    {"IPE 450", 450, 190, 9.4, 14.6, 21},
    {"IPE 500", 500, 200, 10.2, 16, 21},
    {"IPE 550", 550, 210, 11.1, 17.2, 24},
    {"IPE 600", 600, 220, 12, 19, 24},
    {"HEA 100", 96, 100, 5, 8, 12},
    {"HEA 120", 114, 120, 5, 8, 12},
    {"HEA 140", 133, 140, 5.5, 8.5, 12},
    {"HEA 160", 152, 160, 6, 9, 15},
    {"HEA 180", 171, 180, 6, 9.5, 15},
    {"HEA 200", 190, 200, 6.5, 10, 18},
    {"HEA 220", 210, 220, 7, 11, 18},
    {"HEA 240", 230, 240, 7.5, 12, 21},
    {"HEA 260", 250, 260, 7.5, 12.5, 24},
    {"HEA 280", 270, 280, 8, 13, 24},
    {"HEA 300", 290, 300, 8.5, 14, 27},
    {"HEA 320", 310, 300, 9, 15.5, 27},
    {"HEA 340", 330, 300, 9.5, 16.5, 27},
    {"HEA 360", 350, 300, 10, 17.5, 27},
    {"HEA 400", 390, 300, 11, 19, 27},
    {"HEA 450", 440, 300, 11.5, 21, 27},
    {"HEA 500", 490, 300, 12, 23, 27},
    {"HEA 550", 540, 300, 12.5, 24, 27},
    {"HEA 600", 590, 300, 13, 25, 27},
    {"HEA 650", 640, 300, 13.5, 26, 27},
    {"HEA 700", 690, 300, 14.5, 27, 27},
    {"HEA 800", 790, 300, 15, 28, 30},
    {"HEA 900", 890, 300, 16, 30, 30},
    {"HEA 1000", 990, 300, 16.5, 31, 30},
    {"HEB 100", 100, 100, 6, 10, 12},
    {"HEB 120", 120, 120, 6.5, 11, 12},
    {"HEB 140", 140, 140, 7, 12, 12},
    {"HEB 160", 160, 160, 8, 13, 15},
    {"HEB 180", 180, 180, 8.5, 14, 15},
    {"HEB 200", 200, 200, 9, 15, 18},
    {"HEB 220", 220, 220, 9.5, 16, 18},
    {"HEB 240", 240, 240, 10, 17, 21},
    {"HEB 260", 260, 260, 10, 17.5, 24},
    {"HEB 280", 280, 280, 10.5, 18, 24},
    {"HEB 300", 300, 300, 11, 19, 27},
    {"HEB 320", 320, 300, 11.5, 20.5, 27},
    {"HEB 340", 340, 300, 12, 21.5, 27},
    {"HEB 360", 360, 300, 12.5, 22.5, 27},
    {"HEB 400", 400, 300, 13.5, 24, 27},
    {"HEB 450", 450, 300, 14, 26, 27},
    {"HEB 500", 500, 300, 14.5, 28, 27},
    {"HEB 550", 550, 300, 15, 29, 27},
    {"HEB 600", 600, 300, 15.5, 30, 27},
    {"HEB 650", 650, 300, 16, 31, 27},
    {"HEB 700", 700, 300, 17, 32, 27},
    {"HEB 800", 800, 300, 17.5, 33, 30},
    {"HEB 900", 900, 300, 18.5, 35, 30},
    {"HEB 1000", 1000, 300, 19, 36, 30},
    {"HEM 100", 120, 106, 12, 20, 12},
    {"HEM 120", 140, 126, 12.5, 21, 12},
    {"HEM 140", 160, 146, 13, 22, 12},
    {"HEM 160", 180, 166, 14, 23, 15},
    {"HEM 180", 200, 186, 14.5, 24, 15},
    {"HEM 200", 220, 206, 15, 25, 18},
    {"HEM 220", 240, 226, 15.5, 26, 18},
    {"HEM 240", 270, 248, 18, 32, 21},
    {"HEM 260", 290, 268, 18, 32.5, 24},
    {"HEM 280", 310, 288, 18.5, 33, 24},
    {"HEM 300", 340, 310, 21, 39, 27},
};
// clang-format on
constexpr double kMm = 1e-3;

/// Capital letters and digits without blanks.
std::string Plain(const std::string& name)
{
    std::string out;
    for (const char c : name)
        if (c != ' ') out += static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
    return out;
}

/// "200X100X8" as numbers above 0; empty: it is none.
std::vector<double> Dimensions(const std::string& text)
{
    std::vector<double> out;
    for (std::size_t from = 0; from <= text.size();) {
        const std::size_t to = std::min(text.find('X', from), text.size());
        const std::optional<double> value = ParseFinite(text.substr(from, to - from));
        if (!value || !(*value > 0.0)) return {};
        out.push_back(*value * kMm);
        from = to + 1;
    }
    return out;
}

/// "CHS", "SHS", "RHS" with what follows.
std::optional<T_STOCK_SHAPE> Hollow(const std::string& plain)
{
    const bool cold = plain.starts_with("CF");
    const std::string rest = plain.substr(cold ? 2 : 0);
    if (rest.size() < 4) return {};
    const std::string kind = rest.substr(0, 3);
    const std::vector<double> size = Dimensions(rest.substr(3));
    if (size.empty()) return {};
    const double wall = size.back();
    if (kind == "CHS") {
        if (size.size() != 2 || !(2.0 * wall < size[0])) return {};
        return T_STOCK_SHAPE{STOCK_SHAPE::Pipe, {size[0], wall, 0.0, 0.0}, 0.0};
    }
    const bool square =
        kind == "SHS" && (size.size() == 2 || (size.size() == 3 && size[0] == size[1]));
    if (!square && !(kind == "RHS" && size.size() == 3)) return {};
    constexpr double kEven = 1.0 + 1e-9; // a wall that came through mm
    if (cold && wall > 10.0 * kMm * kEven) return {};
    const double corner = (!cold ? 1.5 : wall <= 6.0 * kMm * kEven ? 2.0 : 2.5) * wall;
    const double height = size[0], width = size[size.size() - 2];
    if (!(2.0 * corner < std::min(height, width))) return {};
    return T_STOCK_SHAPE{STOCK_SHAPE::Box, {height, width, wall, wall}, corner};
}

/// "IPE" of "IPE 300".
std::string Letters(const std::string& name)
{
    const auto letter = [](char c) { return c >= 'A' && c <= 'Z'; };
    return {name.begin(), std::ranges::find_if_not(name, letter)};
}

/// How far the numbers of two names of a family lie apart; empty: they are not of one.
std::vector<double> Apart(const std::string& a, const std::string& b)
{
    const std::string family = Letters(a);
    if (family != Letters(b)) return {};
    const std::vector<double> p = Dimensions(a.substr(family.size()));
    const std::vector<double> q = Dimensions(b.substr(family.size()));
    std::vector<double> out;
    for (std::size_t i = 0; p.size() == q.size() && i < p.size(); ++i)
        out.push_back(std::fabs(p[i] - q[i]));
    return out;
}

} // namespace

std::string T_ROLLED_SHAPE::Family() const
{
    return Letters(name);
}

std::span<const T_ROLLED_SHAPE> SteelShapes()
{
    static const std::vector<T_ROLLED_SHAPE> kShapes = [] {
        std::vector<T_ROLLED_SHAPE> out;
        for (const T_ROW& r : kRows)
            out.push_back({r.name,
                           {STOCK_SHAPE::I,
                            {r.height * kMm, r.width * kMm, r.web * kMm, r.flange * kMm},
                            r.fillet * kMm}});
        for (const auto family : {EuropeanChannels, AiscWideFlanges, AiscChannels})
            std::ranges::move(family(), std::back_inserter(out));
        return out;
    }();
    return kShapes;
}

std::optional<T_STOCK_SHAPE> FindShape(const std::string& name)
{
    const std::string plain = Plain(name);
    for (const T_ROLLED_SHAPE& s : SteelShapes())
        if (Plain(s.name) == plain) return s.shape;
    return Hollow(plain);
}

std::string NearestShape(const std::string& name)
{
    std::vector<std::string_view> names;
    std::vector<double> least;
    std::string_view nearest;
    for (const T_ROLLED_SHAPE& s : SteelShapes()) {
        names.push_back(s.name);
        const std::vector<double> apart = Apart(Plain(name), Plain(s.name));
        if (apart.empty() || (!least.empty() && !(apart < least))) continue;
        least = apart;
        nearest = s.name;
    }
    return nearest.empty() ? NearestName(name, names) : std::string(nearest);
}

std::string NoShapeText(const std::string& name)
{
    const std::string near = NearestShape(name);
    return near.empty() ? Say("IDS_QM_SECC_NO_SHAPE", name)
                        : Say("IDS_QM_SECC_NEAR_SHAPE", name, near);
}
