#include "viewtools.h"

#include "mainwindow.h"

#include "qm_base/say.h"
#include "qm_rps/view/parts.h"

#include <QMenu>

namespace {

QString Text(const char* key)
{
    return QString::fromStdString(Say(key));
}

const CSelection::T_KEYS& ChosenElements(CFramePane& pane)
{
    return pane.Selection().Chosen(EXPLORER_TABLE::Elements);
}

void HideChosen(CFramePane& pane)
{
    pane.Selection().Hide(CSelection::T_KEYS(ChosenElements(pane)));
}

void ShowChosenOnly(CFramePane& pane)
{
    pane.Selection().ShowOnly(pane.Doc().Data().Model(), CSelection::T_KEYS(ChosenElements(pane)));
}

void TogglePerspective(CFramePane& pane)
{
    T_CAMERA camera = pane.View().Camera();
    camera.perspective = !camera.perspective;
    pane.View().SetCamera(camera);
}

/// Sections, storeys and planes, each in a menu of its own.
void AddParts(QMenu& menu, const std::vector<T_MODEL_PART>& parts,
              const std::function<void(const CSelection::T_KEYS&)>& act)
{
    constexpr std::array<const char*, 3> kTitles{"IDS_QM_VIEW_BY_SECTION", "IDS_QM_VIEW_BY_STOREY",
                                                 "IDS_QM_VIEW_BY_PLANE"};
    std::array<QMenu*, 3> of{};
    for (const T_MODEL_PART& part : parts) {
        QMenu*& under = of[static_cast<std::size_t>(part.kind)];
        if (!under) under = menu.addMenu(Text(kTitles[static_cast<std::size_t>(part.kind)]));
        const QString name = QString::fromStdString(part.name).replace("&", "&&");
        QObject::connect(under->addAction(name), &QAction::triggered, under,
                         [act, elements = part.elements] { act(elements); });
    }
}

/// The main window with a quantity of the first load case.
T_WINDOW_EXAMPLE ExampleOf(const char* name, const char* example, VIEW_WHAT what)
{
    return {name, example, [what](CMainWindow& main) -> std::unique_ptr<QWidget> {
                (void)main.Desktop().frame.OnAnalyse(0, {});
                main.Refresh();
                T_VIEW_CHOICE choice;
                choice.what = what;
                main.Frame().SetChoice(choice);
                (void)main.Frame().Show(main.Frame().Sources().at(1), 1);
                return nullptr;
            }};
}

} // namespace

std::vector<T_WINDOW_EXAMPLE> ViewWindowExamples()
{
    return {ExampleOf("main-moments", "rc-frame-code-hinges", VIEW_WHAT::My),
            ExampleOf("main-loads", "cable-stayed-bridge", VIEW_WHAT::Loads)};
}

T_COMMANDS ViewPartCommands(CFramePane& pane, const char* menu)
{
    const auto chosen = [&pane] { return !ChosenElements(pane).empty(); };
    return {{menu},
            {menu, "IDS_QM_VIEW_FIT_CHOSEN", "", [&pane] { pane.View().FitChosen(); }},
            {menu,
             "IDS_QM_VIEW_PERSPECTIVE",
             "",
             [&pane] { TogglePerspective(pane); },
             {},
             [&pane] { return pane.View().Camera().perspective; }},
            {menu},
            {menu, "IDS_QM_VIEW_HIDE_CHOSEN", "", [&pane] { HideChosen(pane); }, chosen},
            {menu, "IDS_QM_VIEW_SHOW_CHOSEN", "", [&pane] { ShowChosenOnly(pane); }, chosen},
            {menu, "IDS_QM_VIEW_SHOW_ALL", "", [&pane] { pane.Selection().ShowAll(); },
             [&pane] { return !pane.Selection().Hidden().empty(); }}};
}

void ShowViewMenu(CFramePane& pane, QPoint global)
{
    auto* menu = new QMenu(&pane);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    for (const T_COMMAND& command : ViewPartCommands(pane, "")) {
        if (!*command.key) {
            menu->addSeparator();
            continue;
        }
        QAction* action = menu->addAction(Text(command.key));
        action->setEnabled(!command.enabled || command.enabled());
        action->setCheckable(command.checked != nullptr);
        if (command.checked) action->setChecked(command.checked());
        QObject::connect(action, &QAction::triggered, &pane, command.run);
    }
    const std::vector<T_MODEL_PART> parts = PartsOf(pane.Doc());
    AddParts(*menu->addMenu(Text("IDS_QM_VIEW_SHOW_ONLY")), parts,
             [&pane](const CSelection::T_KEYS& elements) {
                 pane.Selection().ShowOnly(pane.Doc().Data().Model(), elements);
             });
    AddParts(*menu->addMenu(Text("IDS_QM_VIEW_HIDE")), parts,
             [&pane](const CSelection::T_KEYS& elements) { pane.Selection().Hide(elements); });
    menu->popup(global);
}
