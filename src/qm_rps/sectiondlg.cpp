#include "qm_rps/sectiondlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/editscope.h"
#include "qm_db/recordfacts.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/desk/freename.h"
#include "qm_rps/dialog/unithead.h"

#include <algorithm>
#include <cmath>

CSectionDlg::CSectionDlg(CDBDoc& doc, int key) : m_doc(doc)
{
    const auto& sections = doc.Data().Model().sections;
    if (key == 0 && !sections.empty()) key = sections.begin()->first;
    const auto metres = [this](double value) { return FromSi(value, Units(), kDimLength); };
    m_detail.cover = metres(0.03);
    m_detail.stirrupDiameter = metres(0.008);
    m_detail.stirrupSpacing = metres(0.15);
    m_group.diameter = metres(0.016);
    Read(key);
}

void CSectionDlg::Read(int key)
{
    T_SECT_D section;
    m_key = m_doc.Attr().GetSect(key, section) ? key : 0;
    if (m_key == 0) {
        const auto& all = m_doc.Data().Model().sections;
        section.name = FreeName(all, NextKey(all));
        section.shape = SECT_SHAPE::Rectangle;
    }
    m_section = m_read = std::move(section);
    if (m_section.detailing) m_detail = *m_section.detailing;
    m_bar = -1;
    m_fillet = m_taper = 0.0;
    m_stock.clear();
    m_family.clear();
}

std::vector<std::string> CSectionDlg::Names() const
{
    std::vector<std::string> names;
    for (const auto& [key, section] : m_doc.Data().Model().sections)
        names.push_back(section.name);
    return names;
}

int CSectionDlg::Index() const
{
    const auto& all = m_doc.Data().Model().sections;
    const auto at = all.find(m_key);
    return at == all.end() ? -1 : static_cast<int>(std::distance(all.begin(), at));
}

bool CSectionDlg::MayLeave()
{
    constexpr const char* kAsk = "IDS_QM_UI_SECT_KEEP";
    return m_section == m_read || !AskYesNo(kAsk, Say(kAsk, m_section.name)) || Store();
}

void CSectionDlg::OnSelChange(int index)
{
    const auto& all = m_doc.Data().Model().sections;
    if (index < 0 || index >= std::ssize(all) || index == Index()) return;
    const int key = std::next(all.begin(), index)->first;
    if (MayLeave()) Read(key);
}

void CSectionDlg::OnNew()
{
    if (MayLeave()) Read(0);
}

void CSectionDlg::OnDetailing(bool on)
{
    if (on == HasDetailing()) return;
    if (!on) m_detail = *m_section.detailing;
    m_section.detailing = on ? std::optional(m_detail) : std::nullopt;
}

// ---- shape --------------------------------------------------------------------------------------

bool CSectionDlg::HasFillet() const
{
    return m_section.shape == SECT_SHAPE::IShape || m_section.shape == SECT_SHAPE::Box ||
           HasTaper();
}

bool CSectionDlg::HasTaper() const
{
    return m_section.shape == SECT_SHAPE::Channel;
}

void CSectionDlg::OnShape(SECT_SHAPE shape)
{
    if (shape == m_section.shape) return;
    if (shape == SECT_SHAPE::Value) m_section = Calculated();
    m_section.shape = shape;
    if (HasTaper() != (m_section.taper > 0.0)) std::swap(m_section.taper, m_taper);
    if (HasFillet() == (m_section.fillet > 0.0)) return;
    std::swap(m_section.fillet, m_fillet);
}

std::string CSectionDlg::ShearCentreText() const
{
    T_SECT_D sound;
    SECT_FAULT fault = SECT_FAULT::None;
    if (!HasTaper() || !CSectionProperties::Calc(m_section, sound, fault)) return {};
    const T_CHANNEL c = ChannelProperties(sound);
    const auto length = [this](double value) {
        return FormatText("%.4g", value) + " " + std::string(NameOf(Units().length));
    };
    return Say("IDS_QM_UI_SECT_CHANNEL", length(c.centroid), length(-c.shearCentre));
}

std::vector<std::string> CSectionDlg::FamilyTexts()
{
    std::vector<std::string> texts;
    for (const T_ROLLED_SHAPE& shape : SteelShapes())
        if (texts.empty() || texts.back() != shape.Family()) texts.push_back(shape.Family());
    return texts;
}

/// The rolled shape with these dimensions.
const T_ROLLED_SHAPE* CSectionDlg::Rolled() const
{
    const std::span<const T_ROLLED_SHAPE> all = SteelShapes();
    const auto at = std::ranges::find_if(all, [this](const auto& s) { return IsStock(s.name); });
    return at == all.end() ? nullptr : &*at;
}

std::string CSectionDlg::Family() const
{
    if (!m_family.empty()) return m_family;
    const T_ROLLED_SHAPE* const rolled = Rolled();
    return rolled ? rolled->Family() : FamilyTexts().front();
}

int CSectionDlg::FamilyIndex() const
{
    const std::vector<std::string> all = FamilyTexts();
    return static_cast<int>(std::ranges::find(all, Family()) - all.begin());
}

void CSectionDlg::OnFamily(int index)
{
    const std::vector<std::string> all = FamilyTexts();
    if (index >= 0 && index < std::ssize(all)) m_family = all[static_cast<std::size_t>(index)];
}

std::vector<std::string> CSectionDlg::StockTexts() const
{
    std::vector<std::string> texts{Say("IDS_QM_UI_SECT_STOCK_NONE")};
    const std::string family = Family();
    for (const T_ROLLED_SHAPE& shape : SteelShapes())
        if (shape.Family() == family) texts.push_back(shape.name);
    return texts;
}

/// Dimensions have gone through the units of the document.
bool CSectionDlg::IsStock(const std::string& name) const
{
    std::optional<T_SECT_D> named = NamedShape(name);
    if (!named || named->shape != m_section.shape) return false;
    RecordFromSi(*named, Units());
    const auto same = [](double a, double b) {
        constexpr double kRounding = 1e-9;
        return std::fabs(a - b) <= kRounding * std::max(std::fabs(a), std::fabs(b));
    };
    return std::ranges::equal(named->size, m_section.size, same) &&
           same(named->fillet, m_section.fillet) && same(named->taper, m_section.taper);
}

int CSectionDlg::StockIndex() const
{
    const T_ROLLED_SHAPE* const rolled = Rolled();
    const std::vector<std::string> all = StockTexts();
    const auto at = rolled ? std::ranges::find(all, rolled->name) : all.end();
    return at == all.end() ? 0 : static_cast<int>(at - all.begin());
}

void CSectionDlg::OnStock(int index)
{
    const std::vector<std::string> all = StockTexts();
    if (index > 0 && index < std::ssize(all))
        (void)OnStockName(all[static_cast<std::size_t>(index)]);
}

std::string CSectionDlg::StockName() const
{
    if (!m_stock.empty() && IsStock(m_stock)) return m_stock;
    const T_ROLLED_SHAPE* const rolled = Rolled();
    return rolled ? rolled->name : std::string();
}

int CSectionDlg::OnStockName(const std::string& name)
{
    if (name.empty()) return 1; // the dimensions stay
    std::optional<T_SECT_D> named = NamedShape(name);
    if (!named) {
        ShowMessage("IDS_QM_SECC_NO_SHAPE", NoShapeText(name) + ". " + Say("IDS_QM_SECC_HOLLOW"));
        return 0;
    }
    RecordFromSi(*named, Units());
    m_section.shape = named->shape;
    m_section.size = named->size;
    m_section.fillet = named->fillet;
    m_section.taper = named->taper;
    if (m_key == 0 && m_section.name == m_read.name) m_section.name = name;
    m_stock = name;
    m_family.clear();
    return 1;
}

T_SECT_D CSectionDlg::Calculated() const
{
    T_SECT_D out = m_section;
    SECT_FAULT fault = SECT_FAULT::None;
    (void)CSectionProperties::Calc(m_section, out, fault); // else as entered
    return out;
}

int CSectionDlg::OnAddBars()
{
    std::vector<T_REBAR> bars;
    std::string reason;
    if (!LayBars(m_section, m_group, bars, reason)) {
        ShowMessage("IDS_QM_UI_SECT_NO_BARS", Say("IDS_QM_UI_SECT_NO_BARS", reason));
        return 0;
    }
    m_section.bars.insert(m_section.bars.end(), bars.begin(), bars.end());
    return 1;
}

void CSectionDlg::OnDeleteBar(int row)
{
    if (row < 0 || row >= std::ssize(m_section.bars)) return;
    m_section.bars.erase(m_section.bars.begin() + row);
    m_bar = std::min(row, static_cast<int>(std::ssize(m_section.bars)) - 1);
}

std::string CSectionDlg::CellText(std::size_t row, COLUMN column) const
{
    if (row >= m_section.bars.size()) return {};
    const T_REBAR& bar = m_section.bars[row];
    const double values[] = {bar.y, bar.z, BarDiameter(bar), bar.area};
    return column == Diameter ? FormatText("%.6g", values[column]) : ShortestText(values[column]);
}

int CSectionDlg::SetCell(std::size_t row, COLUMN column, const std::string& text)
{
    const std::optional<double> number = ParseFinite(text);
    if (row >= m_section.bars.size() || !number) return 0;
    T_REBAR& bar = m_section.bars[row];
    if (column >= Diameter && *number < 0.0) return 0;
    if (column == Diameter)
        bar.area = BarArea(*number);
    else
        (column == Y ? bar.y : column == Z ? bar.z : bar.area) = *number;
    return 1;
}

std::string CSectionDlg::ColumnHead(COLUMN column) const
{
    constexpr T_DIM kArea{0, 2};
    const std::string heads[] = {"y", "z", Say("IDS_QM_UI_SECT_DIAMETER"),
                                 Say("IDS_QM_UI_SECT_AREA")};
    return HeadWithUnit(heads[column], column == Area ? kArea : kDimLength, Units());
}

std::string CSectionDlg::BarsText() const
{
    if (m_section.bars.empty()) return Say("IDS_QM_UI_SECT_BARS_NONE");
    double area = 0.0;
    for (const T_REBAR& bar : m_section.bars)
        area += bar.area;
    const double gross = Calculated().area;
    const std::string unit = std::string(NameOf(Units().length)) + "2";
    const std::string share = gross > 0.0 ? FormatText("%.3g", 100.0 * area / gross) : "-";
    return Say("IDS_QM_UI_SECT_BARS", std::to_string(m_section.bars.size()),
               FormatText("%.5g", area) + " " + unit, share);
}

std::vector<T_FINDING> CSectionDlg::Findings() const
{
    return RecordFindings(m_doc.Data().Model(), m_section, m_key);
}

int CSectionDlg::Store()
{
    if (!CheckData()) return 0;
    const int key = m_key ? m_key : NextKey(m_doc.Data().Model().sections);
    CEditScope edit(m_doc, m_section.name);
    if (edit.Put(key, m_section) && edit.Commit()) {
        m_key = key;
        m_read = m_section;
        return 1;
    }
    ShowMessage("IDS_QM_UI_EDIT_BUSY");
    return 0;
}

int CSectionDlg::OnOK()
{
    return m_key != 0 && m_section == m_read ? 1 : Store();
}
