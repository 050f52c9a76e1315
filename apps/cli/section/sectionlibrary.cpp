#include "section/sectionlibrary.h"

#include "console/tabletext.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/codes/codesheet.h"

#include <cstdio>

namespace {

std::string Number(double value)
{
    return FormatText("%.5g", value);
}

/// The name without blanks, in capitals.
bool Begins(const std::string& name, const std::string& with)
{
    const auto plain = [](const std::string& text) {
        std::string out;
        for (const char c : text)
            if (c != ' ') out += (c >= 'a' && c <= 'z') ? static_cast<char>(c - 'a' + 'A') : c;
        return out;
    };
    return plain(name).starts_with(plain(with));
}

std::vector<std::string> Heads()
{
    return {"D1 (mm)",
            "D2 (mm)",
            "D3 (mm)",
            "D4 (mm)",
            "r (mm)",
            "A (cm2)",
            "Iy (cm4)",
            "Iz (cm4)",
            "Zy (cm3)",
            "Zz (cm3)",
            "yG (mm)",
            "yS (mm)",
            Say("IDS_QM_SECC_HEAD_SHAPE")};
}

/// yG, yS: centroid and shear centre of a channel from the back of its web.
std::vector<std::string> Row(const std::string& name, const T_SECT_D& shape)
{
    T_SECT_D s;
    SECT_FAULT fault = SECT_FAULT::None;
    if (!CSectionProperties::Calc(shape, s, fault)) return {};
    std::vector<std::string> row;
    for (const double size : s.size)
        row.push_back(Number(1e3 * size));
    for (const double value :
         {1e3 * s.fillet, 1e4 * s.area, 1e8 * s.Iyy, 1e8 * s.Izz, 1e6 * s.Zy, 1e6 * s.Zz})
        row.push_back(Number(value));
    const bool channel = s.shape == SECT_SHAPE::Channel;
    const T_CHANNEL c = channel ? ChannelProperties(s) : T_CHANNEL();
    row.push_back(channel ? Number(1e3 * c.centroid) : "");
    row.push_back(channel ? Number(1e3 * c.shearCentre) : "");
    row.push_back(name);
    return row;
}

} // namespace

EXIT_CODE RunSectionShapes(const std::string& find)
{
    std::vector<std::pair<std::string, T_TABLE_ROWS>> families;
    const auto add = [&](const std::string& family, const std::string& name) {
        if (families.empty() || families.back().first != family)
            families.emplace_back(family, T_TABLE_ROWS{Heads()});
        families.back().second.push_back(Row(name, *NamedShape(name)));
    };
    for (const T_ROLLED_SHAPE& shape : SteelShapes())
        if (Begins(shape.name, find)) add(shape.Family(), shape.name);
    if (families.empty()) {
        if (!NamedShape(find)) return Complain(EXIT_CODE::Usage, NoShapeText(find));
        add(Say("IDS_QM_SECC_HEAD_SHAPE"), find);
    }
    std::string text;
    for (const auto& [family, rows] : families)
        text += family + "\n" + TableText(rows) + "\n";
    text += Say("IDS_QM_SECC_HOLLOW") + "\n" + Say("IDS_QM_SECC_CHANNELS") + "\n";
    std::fwrite(text.data(), 1, text.size(), stdout);
    return EXIT_CODE::Done;
}

EXIT_CODE RunSectionGrades()
{
    T_TABLE_ROWS rows{{Say("IDS_QM_SECC_HEAD_GRADE"), "f (MPa)", "E (GPa)", "nu", "rho (kg/m3)",
                       "alpha", Say("IDS_QM_SECC_HEAD_SOURCE")}};
    for (const T_MATL_GRADE& g : MaterialGrades())
        rows.push_back({g.name, Number(g.strength / kPascalsPerMpa), Number(g.modulus / 1e9),
                        Number(g.nu), Number(g.density), Number(g.alpha), g.clause});
    const std::string text = TableText(rows) + Say("IDS_QM_SECC_GRADES_NOTE") + "\n";
    std::fwrite(text.data(), 1, text.size(), stdout);
    return EXIT_CODE::Done;
}
