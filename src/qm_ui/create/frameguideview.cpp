#include "qm_base/say.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_rps/frameguidedlg.h"
#include "qm_ui/create/createfields.h"
#include "qm_ui/create/createviews.h"
#include "qm_ui/frame/frameview.h"

namespace {

using DLG = CFrameGuideDlg;

/// The frame as it would be.
class CPreviewField : public CFormField {
public:
    CPreviewField(DLG& dialog, QWidget* parent) : m_dialog(dialog), m_view(new CFrameView(parent))
    {
        widget = m_view;
    }
    void Show() override
    {
        const T_FRAME_SCENE& scene = m_dialog.Scene();
        const int flat = CFrameScene::FlatAxis(scene);
        if (flat != m_flat) m_view->SetCamera(CameraFor(flat));
        m_flat = flat;
        T_FRAME_PICTURE picture;
        picture.scene = &scene;
        m_view->SetPicture(std::move(picture));
    }

private:
    DLG& m_dialog;
    CFrameView* m_view;
    int m_flat = -2; // of no scene
};

/// Adds named fields that tell the model of their changes.
struct T_ADD {
    CFormView& form;
    DLG& d;
    std::function<void()> tell;

    CFormField& Text(const char* key, std::string& value, const char* name,
                     std::optional<T_DIM> dim = {})
    {
        return Named(form.Text(Head(key, dim), Told(value, tell)), name);
    }
    CFormField& LineLoad(const char* key, double& value, const char* name)
    {
        const auto head = [this_ = &d, key] { return Say(key) + " (" + this_->LineUnit() + ")"; };
        return Named(form.Number(head, Told(value, tell)), name);
    }
    TextFn Head(const char* key, std::optional<T_DIM> dim) const
    {
        return [this_ = &d, key, dim] { return HeadWithUnit(Say(key), dim, this_->Units()); };
    }
    static CFormField& Named(CFormField& field, const char* name)
    {
        field.name = name;
        return field;
    }
};

void AddUnits(T_ADD& add)
{
    T_UNITS& units = add.d.m_building.units;
    const auto names = [](const auto& all) {
        return [&all] { return std::vector<std::string>(all.begin(), all.end()); };
    };
    add.form.Columns();
    add.form
        .Choice(KeyText("IDS_QM_NEW_FORCE_UNIT"), ToldIndex(units.force, add.tell),
                names(kForceNames))
        .name = "force";
    add.form.NextColumn();
    add.form
        .Choice(KeyText("IDS_QM_NEW_LENGTH_UNIT"), ToldIndex(units.length, add.tell),
                names(kLengthNames))
        .name = "length";
    add.form.EndColumns();
}

void AddGeometry(T_ADD& add)
{
    DLG& d = add.d;
    add.form.Page(KeyText("IDS_QM_NEW_PAGE_GEOMETRY"));
    add.Text("IDS_QM_NEW_TITLE_OF", d.m_building.title, "title");
    AddUnits(add);
    add.form.Note(KeyText("IDS_QM_NEW_FRAME_LISTS"));
    add.Text("IDS_QM_NEW_BAYS_X", d.m_baysX, "baysX", kDimLength);
    add.Text("IDS_QM_NEW_BAYS_Y", d.m_baysY, "baysY", kDimLength);
    add.Text("IDS_QM_NEW_HEIGHTS_OF", d.m_storeys, "storeys", kDimLength);
    add.form.Flag(KeyText("IDS_QM_NEW_PINNED"), Told(d.m_building.isPinned, add.tell)).name =
        "pinned";
    add.form.Flag(KeyText("IDS_QM_NEW_DIAPHRAGMS"), Told(d.m_building.hasDiaphragms, add.tell))
        .name = "diaphragms";
    add.form.Space();
}

void AddSections(T_ADD& add)
{
    T_BUILDING& b = add.d.m_building;
    add.form.Page(KeyText("IDS_QM_NEW_PAGE_SECTIONS"));
    add.form.Note(KeyText("IDS_QM_NEW_SECTIONS_HOW"));
    add.Text("IDS_QM_NEW_COLUMN_SECTION", b.columns, "columns");
    add.Text("IDS_QM_NEW_COLUMN_GRADE", b.columnGrade, "grade.columns");
    add.Text("IDS_QM_NEW_BEAM_SECTION", b.beams, "beams");
    add.Text("IDS_QM_NEW_BEAM_GRADE", b.beamGrade, "grade.beams");
    add.form
        .Choice(KeyText("IDS_QM_NEW_BRACES"), ToldIndex(b.braces, add.tell),
                KeyTexts({"IDS_QM_NEW_BRACES_NONE", "IDS_QM_NEW_BRACES_DIAGONAL",
                          "IDS_QM_NEW_BRACES_X"}))
        .name = "braces";
    const auto has = [&b] { return b.braces != BUILDING_BRACES::None; };
    add.Text("IDS_QM_NEW_BRACE_BAYS", add.d.m_braceBays, "braceBays").shown = has;
    add.Text("IDS_QM_NEW_BRACE_SECTION", b.braceSection, "braceSection").shown = has;
    add.Text("IDS_QM_NEW_BRACE_GRADE", b.braceGrade, "grade.braceSection").shown = has;
    add.form.Space();
}

void AddLoads(T_ADD& add)
{
    T_BUILDING& b = add.d.m_building;
    add.form.Page(KeyText("IDS_QM_NEW_PAGE_LOADS"));
    add.form.Note(KeyText("IDS_QM_NEW_LOADS_HOW"));
    add.LineLoad("IDS_QM_NEW_DEAD", b.dead, "dead");
    add.LineLoad("IDS_QM_NEW_LIVE", b.live, "live");
    add.LineLoad("IDS_QM_NEW_DEAD_ROOF", b.deadRoof, "roofDead");
    add.LineLoad("IDS_QM_NEW_LIVE_ROOF", b.liveRoof, "roofLive");
    add.form
        .Choice(KeyText("IDS_QM_NEW_LOADED"), ToldIndex(b.loaded, add.tell),
                KeyTexts({"IDS_QM_NEW_LOADED_ALL", "IDS_QM_NEW_LOADED_X", "IDS_QM_NEW_LOADED_Y"}))
        .name = "loaded";
    add.form.Number(KeyText("IDS_QM_NEW_LIVE_IN_MASS"), Told(b.liveInMass, add.tell)).name =
        "massLive";
    add.form.Integer(KeyText("IDS_QM_NEW_MODE_COUNT"), Told(add.d.m_modes, add.tell)).name =
        "modes";
    add.form.Flag(KeyText("IDS_QM_NEW_PUSH_CASES"), Told(add.d.m_push, add.tell)).name = "push";
    add.form.Space();
}

void Build(CFormView& form, DLG& d)
{
    T_ADD add{form, d, [&d] { d.OnChange(); }};
    form.Columns();
    AddGeometry(add);
    AddSections(add);
    AddLoads(add);
    form.EndPages();
    form.NextColumn(1);
    CFormField& frame = form.Custom({}, std::make_unique<CPreviewField>(d, form.Host()));
    frame.name = "preview";
    frame.widget->setMinimumSize(420, 300);
    AddReadTable(
        form, [&d] { return d.Levels(); }, "levels", {420, 150}, 220);
    form.Note([&d] { return d.NotesText(); }).name = "notes";
    form.Text(KeyText("IDS_QM_NEW_COMMAND"), {[&d] { return d.CommandText(); }, {}}).name =
        "command";
    form.EndColumns();
    form.SetFindings([&d] { return d.Findings(); });
}

} // namespace

void RegisterFrameGuideView(CViewFactory& factory)
{
    T_VIEW view;
    view.size = {1160, 800};
    view.accept = [](const zql::frx::MDialog&) { return Say("IDS_QM_NEW_MAKE"); };
    factory.Register<DLG>(KeyText("IDS_QM_NEW_FRAME_TITLE"), Build, view);
}
