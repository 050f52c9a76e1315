#include "qm_rps/generate/codehingerows.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/law/lawaxial.h"

#include <algorithm>
#include <cmath>
#include <set>

namespace {

bool Near(double a, double b)
{
    constexpr double kDigits = 1e-9;
    return std::fabs(a - b) <= kDigits * std::max(std::fabs(a), std::fabs(b));
}

bool Alike(const T_CODE_POINT& a, const T_CODE_POINT& b)
{
    return Near(a.deform, b.deform) && Near(a.strength, b.strength);
}

bool Alike(const T_CODE_SIDE& a, const T_CODE_SIDE& b)
{
    const T_CODE_BACKBONE &p = a.bone, &q = b.bone;
    return Near(a.strength, b.strength) && Near(a.shear, b.shear) &&
           Near(a.shearStrength, b.shearStrength) && Near(p.yieldDeform, q.yieldDeform) &&
           Alike(p.C, q.C) && Alike(p.D, q.D) && Alike(p.E, q.E);
}

std::string Power(std::string_view unit, int exponent)
{
    return std::string(unit) + (exponent == 1 ? "" : std::to_string(exponent));
}

/// Rows of both ends of a component at axial forces.
void AppendRows(const T_CODE_ELEMENT& element, const T_CODE_COMPONENT& b,
                const T_ENDS<T_SIDES<T_CODE_SIDE>>& ends, const T_ENDS<double>& axial,
                std::vector<T_CODE_ROW_OF_HINGE>& rows)
{
    const bool middle = b.location == HINGE_LOCATION::Center;
    const bool same = b.location == HINGE_LOCATION::BothEnds && Alike(ends.I.pos, ends.J.pos) &&
                      Alike(ends.I.neg, ends.J.neg);
    for (const bool atI : {true, false}) {
        if (b.location == (atI ? HINGE_LOCATION::JEnd : HINGE_LOCATION::IEnd)) continue;
        if ((same || middle) && !atI) continue;
        const T_SIDES<T_CODE_SIDE>& sides = atI ? ends.I : ends.J;
        const auto put = [&](const char* side, bool positive) {
            const bool own = positive != IsSectionSignOpposite(b.component);
            rows.push_back({element.member.element, element.member.kind,
                            middle ? "C"
                            : same ? "I, J"
                            : atI  ? "I"
                                   : "J",
                            b.component, side,
                            !element.member.HasAxial() ? 0.0
                            : atI                      ? axial.I
                                                       : axial.J,
                            own ? &sides.pos : &sides.neg});
        };
        if (Alike(sides.pos, sides.neg)) {
            put("+-", true);
        } else {
            put("+", true);
            put("-", false);
        }
    }
}

std::string Digits(double value)
{
    return FormatText("%.5g", value);
}

} // namespace

std::vector<T_CODE_ROW_OF_HINGE> HingeRows(const T_CODE_ELEMENT& element)
{
    std::vector<T_CODE_ROW_OF_HINGE> rows;
    for (const T_CODE_COMPONENT& b : element.hinge->components) {
        AppendRows(element, b, b.ends, element.member.axial, rows);
        for (const T_CODE_AXIAL& at : b.byAxial)
            AppendRows(element, b, at.ends, {at.axial, at.axial}, rows);
    }
    return rows;
}

std::vector<std::string> HingeRowHeads(const T_CODE_HINGES& hinges, bool chord,
                                       const T_UNITS& units)
{
    const std::string force(NameOf(units.force)), moment = UnitText(kDimMoment, units);
    bool forces = false, moments = false;
    for (const T_CODE_ELEMENT& element : hinges.elements)
        for (const T_CODE_COMPONENT& c : element.hinge->components)
            (c.component < HINGE_COMPONENT::Mx ? forces : moments) = true;
    std::vector<std::string> heads{
        Say("IDS_QM_GEN_END"),
        Say("IDS_QM_GEN_AXIS"),
        "+/-",
        "N (" + force + ")",
        forces ? "F, M (" + UnitText(kDimForce, units) + ", " + moment + ")" : "M (" + moment + ")",
        "V/Vn"};
    const std::string lengths = UnitText(kDimLength, units);
    const std::string unit = !forces ? "rad" : moments ? "rad, " + lengths : lengths;
    const std::vector<std::string> more =
        chord
            ? std::vector<std::string>{forces && !moments ? "Delta_y" : "theta_y", "DL", "SD", "NC"}
            : std::vector<std::string>{"a", "b", "c", "IO", "LS", "CP"};
    for (const std::string& head : more)
        heads.push_back(head == "c" ? head : head + " (" + unit + ")");
    return heads;
}

std::vector<std::string> HingeRowCells(const T_CODE_ROW_OF_HINGE& row, bool chord,
                                       const T_UNITS& units)
{
    const T_CODE_SIDE& side = *row.of;
    const T_CODE_BACKBONE& bone = side.bone;
    const T_DIM dim = DeformDim(row.component, HINGE_DEFINITION::MomentRotation);
    const auto deform = [&](double value) { return Digits(FromSi(value, units, dim)); };
    std::vector<std::string> cells{
        row.end,
        kComponentNames[static_cast<std::size_t>(row.component)],
        row.side,
        Digits(FromSi(row.axial, units, kDimForce)),
        Digits(FromSi(side.strength, units, StrengthDim(row.component))),
        side.shearStrength > 0.0 ? Digits(side.shear / side.shearStrength) : std::string("-")};
    if (chord) {
        cells.push_back(deform(bone.yieldDeform));
    } else {
        cells.push_back(deform(bone.Plastic(bone.C.deform)));
        cells.push_back(deform(bone.Plastic(bone.E.deform)));
        cells.push_back(Digits(bone.D.strength));
    }
    if (!bone.acceptance) cells.insert(cells.end(), 3, "-"); // not known
    for (std::size_t i = 0; bone.acceptance && i < bone.acceptance->size(); ++i) {
        const double level = (*bone.acceptance)[i];
        cells.push_back(deform(chord ? level : bone.Plastic(level)));
    }
    return cells;
}

std::vector<const T_CODE_ELEMENT*> FirstsOfTypes(const T_CODE_HINGES& hinges)
{
    std::vector<const T_CODE_ELEMENT*> firsts;
    std::set<const T_CODE_HINGE*> seen;
    for (const T_CODE_ELEMENT& element : hinges.elements)
        if (seen.insert(element.hinge.get()).second) firsts.push_back(&element);
    return firsts;
}

std::vector<std::pair<std::string, std::vector<const T_CODE_ELEMENT*>>>
HingeWarnings(const T_CODE_HINGES& hinges)
{
    std::vector<std::pair<std::string, std::vector<const T_CODE_ELEMENT*>>> all;
    const auto add = [&](const T_CODE_WARNING& warning, const T_CODE_ELEMENT* of) {
        const std::string text = WarningText(warning);
        auto at = std::ranges::find(all, text, [](const auto& entry) { return entry.first; });
        if (at == all.end()) at = all.insert(all.end(), {text, {}});
        if (of && (at->second.empty() || at->second.back() != of)) at->second.push_back(of);
    };
    for (const T_CODE_WARNING& warning : hinges.warnings)
        add(warning, nullptr);
    for (const T_CODE_ELEMENT* element : FirstsOfTypes(hinges)) {
        for (const T_CODE_WARNING& warning : element->hinge->warnings)
            add(warning, element);
        for (const T_CODE_ROW_OF_HINGE& row : HingeRows(*element))
            for (const T_CODE_WARNING& warning : row.of->warnings)
                add(warning, element);
    }
    return all;
}

std::string MarkText(CODE_MARK mark)
{
    constexpr std::array<const char*, 4> kKeys{"IDS_QM_GEN_COMPUTED", "IDS_QM_GEN_SIGHTED_TWICE",
                                               "IDS_QM_GEN_SIGHTED_ONCE", "IDS_QM_GEN_RECALLED"};
    return Say(kKeys[static_cast<std::size_t>(mark)]);
}

std::string TraceLine(const T_CODE_TRACE& line, const T_UNITS& units)
{
    const std::string unit = UnitText(line.dim, units);
    std::string text = line.symbol + " = " + Digits(FromSi(line.value, units, line.dim)) +
                       (unit.empty() ? "" : " " + unit);
    for (const std::string& part : {line.clause, line.text, MarkText(line.mark)})
        if (!part.empty()) text += "; " + part;
    return text;
}

std::string UnitText(T_DIM dim, const T_UNITS& units)
{
    std::string over = dim.force > 0 ? Power(NameOf(units.force), dim.force) : "";
    if (dim.length > 0) over += (over.empty() ? "" : " ") + Power(NameOf(units.length), dim.length);
    if (dim.length >= 0) return over;
    return (over.empty() ? "1" : over) + '/' + Power(NameOf(units.length), -dim.length);
}
