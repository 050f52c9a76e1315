#include "qm_rps/create/buildinggrid.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/create/createfault.h"

#include <set>

namespace {

std::vector<double> PlacesOf(const std::vector<double>& widths, const T_UNITS& units)
{
    std::vector<double> places{0.0};
    double sum = 0.0;
    for (const double width : widths)
        places.push_back(ToSi(sum += width, units, kDimLength));
    return places;
}

} // namespace

CBuildingGrid::CBuildingGrid(const T_BUILDING& in)
    : m_in(in), m_x(PlacesOf(in.baysX, in.units)), m_y(PlacesOf(in.baysY, in.units)),
      m_z(PlacesOf(in.storeys, in.units))
{
    constexpr int kNext = 10;
    while (static_cast<std::size_t>(m_stride) <= m_x.size() * m_y.size())
        m_stride *= kNext;
}

int CBuildingGrid::Id(std::size_t ix, std::size_t iy, std::size_t level) const
{
    return static_cast<int>(level) * m_stride + static_cast<int>(iy * m_x.size() + ix) + 1;
}

int CBuildingGrid::ReadBays(const std::vector<std::string>& names, std::vector<T_BRACED_BAY>& out,
                            T_FINDING& fault) const
{
    constexpr const char* kField = "braceBays";
    if (names.empty()) return CreateFault(fault, kField, "IDS_QM_NEW_NO_BAYS");
    std::vector<T_BRACED_BAY> bays;
    std::set<std::pair<bool, std::size_t>> taken;
    for (const std::string& name : names) {
        const bool alongX = name.starts_with('x') || name.starts_with('X');
        const bool alongY = name.starts_with('y') || name.starts_with('Y');
        const std::size_t count = alongX ? m_in.baysX.size() : m_in.baysY.size();
        const auto number = name.empty() ? std::nullopt : ParseFinite(name.substr(1));
        const bool isThere = (alongX || alongY) && number && *number >= 1.0 &&
                             *number <= static_cast<double>(count) &&
                             *number == static_cast<double>(static_cast<std::size_t>(*number));
        if (!isThere) return CreateFault(fault, kField, "IDS_QM_NEW_NO_BAY", name);
        const auto i = static_cast<std::size_t>(*number);
        if (!taken.emplace(alongX, i).second)
            return CreateFault(fault, kField, "IDS_QM_NEW_BAY_TWICE", name);
        const std::size_t last = (alongX ? m_y.size() : m_x.size()) - 1;
        for (std::size_t line = 0; line <= last; line += last > 0 ? last : 1)
            bays.push_back(alongX ? T_BRACED_BAY{{i - 1, line}, {i, line}}
                                  : T_BRACED_BAY{{line, i - 1}, {line, i}});
    }
    out = std::move(bays);
    return 1;
}

std::string CBuildingGrid::PlanText() const
{
    const auto length = [this](double si) {
        return FormatText("%.6g", FromSi(si, m_in.units, kDimLength));
    };
    const std::string unit(NameOf(m_in.units.length));
    if (IsPlane())
        return Say("IDS_QM_NEW_PLANE_PLAN", std::to_string(m_in.baysX.size()), length(m_x.back()),
                   unit);
    return Say("IDS_QM_NEW_PLAN", std::to_string(m_in.baysX.size()),
               std::to_string(m_in.baysY.size()), length(m_x.back()), length(m_y.back()), unit);
}
