#include "qm_rps/po_loadcaselistdlg.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/po_loadcasedlg.h"
#include "qm_rps/pushovercasegeneratordlg.h"

using zql::lib::MMSGFunction;

namespace {
constexpr const char* kTitle = "IDS_QM_UI_TABLE_PUSHOVERS";
constexpr std::size_t kNamedUsers = 10; // a message names no more than these
} // namespace

std::vector<T_LOADCASE_ROW> CPO_LoadCaseListDlg::Rows() const
{
    return Doc() ? LoadCaseRows(*Doc()) : std::vector<T_LOADCASE_ROW>();
}

bool CPO_LoadCaseListDlg::CheckChoice()
{
    if (Doc() && Doc()->Data().Model().pushovers.contains(m_selected)) return true;
    ShowMessage("IDS_QM_UI_POLC_NONE_CHOSEN");
    return false;
}

int CPO_LoadCaseListDlg::RunItem(int key)
{
    CPO_LoadCaseDlg item;
    item.SetDoc(Doc());
    item.SetView(View());
    if (!item.SetKey(key) || !item.DoModal()) return 0;
    m_selected = item.Key();
    return 1;
}

int CPO_LoadCaseListDlg::OnCopy()
{
    T_POLC_D copy;
    if (!CheckChoice() || !Doc()->Attr().GetPolc(m_selected, copy)) return 0;
    const T_POLC_D fresh = CPO_LoadCaseDlg::MakeNew(*Doc());
    int taken = 0;
    std::string name = MMSGFunction::Format("IDS_QM_UI_COPY_NAME", {copy.name});
    copy.name = Doc()->Attr().FindPolc(name, taken) ? fresh.name : name;
    if (!copy.control) copy.control = fresh.control;
    const int key = CPO_LoadCaseDlg::NextKey(*Doc());
    if (!Edit(kTitle, [&](CEditScope& edit) { return edit.Put(key, copy) != 0; })) return 0;
    m_selected = key;
    return 1;
}

int CPO_LoadCaseListDlg::OnGenerate()
{
    CPushOverCaseGeneratorDlg generator;
    generator.SetDoc(Doc());
    generator.SetView(View());
    if (!generator.DoModal()) return 0;
    ShowMessage("IDS_QM_UI_POLC_EIGHT", generator.BasisText());
    return 1;
}

int CPO_LoadCaseListDlg::OnDelete()
{
    if (!CheckChoice()) return 0;
    const auto erase = [&](CEditScope& edit) {
        T_RECORD_USERS users;
        if (edit.Erase<T_POLC_D>(m_selected, users)) return true;
        std::string names;
        for (std::size_t i = 0; i < users.size() && i < kNamedUsers; ++i)
            names += (i ? ", " : "") + DescribeUser(Doc()->Data().Model(), users[i]);
        if (users.size() > kNamedUsers) names += ", ...";
        constexpr const char* kUsed = "IDS_QM_UI_RECORD_USED";
        ShowMessage(kUsed, MMSGFunction::Format(kUsed, {std::to_string(m_selected), names}));
        return false;
    };
    if (!Edit(kTitle, erase)) return 0;
    m_selected = 0;
    return 1;
}
