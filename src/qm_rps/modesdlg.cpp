#include "qm_rps/modesdlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/editscope.h"
#include "qm_rps/create/numberlist.h"

#include <algorithm>

namespace {

/// In current units.
std::vector<T_EIGV_D> ModesOf(const CDBDoc& doc)
{
    std::vector<T_EIGV_D> modes;
    for (const auto& [number, mode] : doc.Data().Model().modes)
        modes.push_back(mode); // a shape has no units
    return modes;
}

bool NamesAMode(const T_POLC_D& push)
{
    constexpr int kMode = 2; // and mode times storey mass
    return !push.modes.empty() ||
           std::ranges::any_of(push.patterns, [](const auto& p) { return p.kind >= kMode; });
}

} // namespace

int CModesDlg::Refuse(const char* key, const std::string& text)
{
    ShowMessage(key, text);
    return 0;
}

int CModesDlg::OnFind()
{
    constexpr int kMost = 1000;
    if (m_count < 1 || m_count > kMost) return Refuse("IDS_QM_NEW_MODES", Say("IDS_QM_NEW_MODES"));
    T_ANALYSIS_OPTIONS options;
    options.allCases = false;
    options.modes = m_count;
    T_ANALYSIS_ERROR error;
    const auto work = [&](TELL_FN tell) {
        options.progress = std::move(tell);
        return m_doc.RunAnalysis(options, error);
    };
    if (m_withProgress ? m_withProgress(work) : work({})) return 1;
    return Refuse("IDS_QM_NEW_NO_MODES", Say("IDS_QM_NEW_NO_MODES", error.text));
}

/// All modes again, numbered from 1.
int CModesDlg::PutModes(const std::vector<T_EIGV_D>& modes)
{
    CEditScope edit(m_doc, Say("IDS_QM_MODES_TITLE"));
    bool done = edit.IsOpen();
    for (std::size_t i = 0; i < modes.size(); ++i)
        done = done && edit.Put(static_cast<int>(i) + 1, modes[i]);
    for (const int number : m_doc.Attr().GetKeys<T_EIGV_D>())
        if (number > std::ssize(modes)) done = done && edit.Erase<T_EIGV_D>(number);
    if (done && edit.Commit()) return 1;
    return Refuse("IDS_QM_UI_EDIT_BUSY", Say("IDS_QM_UI_EDIT_BUSY"));
}

int CModesDlg::OnAdd()
{
    std::string why;
    const auto shape = ParseNumberList(m_shape, why);
    if (!shape) return Refuse("IDS_QM_NEW_LIST", why);
    T_EIGV_D mode;
    T_FINDING fault;
    if (!MakeTypedMode(m_doc.Data().Model(), {m_period, m_direction, *shape}, mode, fault))
        return Refuse(fault.messageKey.c_str(), fault.text);
    std::vector<T_EIGV_D> modes = ModesOf(m_doc);
    modes.push_back(std::move(mode));
    return PutModes(modes);
}

int CModesDlg::OnDelete()
{
    std::vector<T_EIGV_D> modes = ModesOf(m_doc);
    const auto& pushes = m_doc.Data().Model().pushovers;
    const bool isNamed =
        std::ranges::any_of(pushes, [](const auto& push) { return NamesAMode(push.second); });
    if (m_chosen < 0 || m_chosen >= std::ssize(modes) || isNamed)
        return Refuse("IDS_QM_MODES_KEEP", Say("IDS_QM_MODES_KEEP"));
    modes.erase(modes.begin() + m_chosen);
    m_chosen = -1;
    return PutModes(modes);
}

T_TEXT_TABLE CModesDlg::Table()
{
    T_TEXT_TABLE table;
    table.columns = {{Say("IDS_QM_MODES_NUMBER"), true},
                     {"T (s)", true},
                     {Say("IDS_QM_MODES_MASS", "X"), true},
                     {Say("IDS_QM_MODES_MASS", "Y"), true},
                     {Say("IDS_QM_MODES_MASS", "Z"), true}};
    for (const auto& [number, mode] : m_doc.Data().Model().modes) {
        std::vector<std::string> row{std::to_string(number), FormatText("%.5g", mode.period)};
        T_MPAM_D mass;
        const bool has = m_doc.Post().GetEiMpam(number, mass) != 0;
        for (std::size_t d = 0; d < 3; ++d)
            row.push_back(has ? FormatText("%.2f", mass.percent[d]) : "");
        table.rows.push_back(std::move(row));
    }
    return table;
}

std::string CModesDlg::PushesText() const
{
    std::string names;
    for (const auto& [key, push] : m_doc.Data().Model().pushovers)
        if (NamesAMode(push)) names += (names.empty() ? "" : ", ") + push.name;
    return names.empty() ? names : Say("IDS_QM_MODES_NAMED", names);
}

std::string CModesDlg::NotesText() const
{
    const std::string pushes = PushesText();
    return Say("IDS_QM_MODES_COUNT", std::to_string(m_doc.Data().Model().modes.size()),
               std::to_string(m_doc.Data().Model().storeys.size())) +
           (pushes.empty() ? "" : "\n" + pushes);
}
