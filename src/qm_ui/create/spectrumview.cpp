#include "qm_rps/spectrumdlg.h"
#include "qm_ui/create/createfields.h"
#include "qm_ui/create/createplots.h"
#include "qm_ui/create/createviews.h"
#include "qm_ui/section/structurefields.h"

namespace {

using DLG = CSpectrumDlg;

CFormField& AddPlot(CFormView& form, DLG& d, SPECTRUM_AXES axes, const char* name)
{
    CFormField& picture =
        form.Picture([&d, axes] { return SpectrumPlot(d.m_edit.Record(), axes, d.Units()); });
    picture.name = name;
    picture.widget->setMinimumSize(420, 230);
    return picture;
}

void Build(CFormView& form, DLG& d)
{
    form.Columns();
    AddChoice(form, d, "IDS_QM_NEW_KIND_OF");
    AddSpectrumFields(form, d.m_edit, {}, true);
    // The symbols of a kind are columns, too: a note says them as lines.
    form.Note([&d] {
            std::string text;
            const T_TEXT_TABLE values = d.Values();
            for (const auto& row : values.rows) {
                text += (text.empty() ? "" : "\n") + row.front() + " =";
                for (std::size_t i = 1; i + 2 < row.size(); ++i)
                    text += (i > 1 ? ", " : " ") + row[i] +
                            (row.size() > 4 ? " (" + values.columns[i].head + ")" : "");
                text += (row[row.size() - 2] == "-" ? "" : " " + row[row.size() - 2]) + ": " +
                        row.back();
            }
            return text;
        })
        .name = "values";
    form.Text(KeyText("IDS_QM_NEW_COMMAND"), {[&d] { return d.CommandText(); }, {}}).name =
        "command";
    form.Space();
    form.NextColumn(1);
    AddPlot(form, d, SPECTRUM_AXES::Periods, "plotT");
    AddPlot(form, d, SPECTRUM_AXES::Displacement, "plotSd");
    form.EndColumns();
    form.SetFindings([&d] { return d.Findings(); });
    form.m_isChanged = [&d] { return d.IsChanged(); };
}

} // namespace

void RegisterSpectrumView(CViewFactory& factory)
{
    T_VIEW view;
    view.size = {1080, 760};
    factory.Register<DLG>(KeyText("IDS_QM_NEW_SPECTRUM_TITLE"), Build, view);
}
