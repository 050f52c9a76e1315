#include "shell/menus.h"

#include <algorithm>
#include <array>
#include <string_view>
#include <tuple>

namespace {

constexpr const char *kFile = "IDS_QM_UI_MENU_FILE", *kEdit = "IDS_QM_UI_MENU_EDIT",
                     *kModel = "IDS_QM_UI_MENU_MODEL", *kLoads = "IDS_QM_UI_MENU_LOADS",
                     *kAnalysis = "IDS_QM_UI_MENU_ANALYSIS", *kHinges = "IDS_QM_UI_MENU_HINGES",
                     *kPushover = "IDS_QM_UI_MENU_PUSHOVER", *kFactors = "IDS_QM_UI_MENU_ULF",
                     *kResults = "IDS_QM_UI_MENU_RESULTS", *kView = "IDS_QM_UI_MENU_VIEW",
                     *kWindow = "IDS_QM_UI_MENU_WINDOW", *kHelp = "IDS_QM_UI_MENU_HELP";
constexpr std::array kMenus{kFile,     kEdit,    kModel,   kLoads, kAnalysis, kHinges,
                            kPushover, kFactors, kResults, kView,  kWindow,   kHelp};

/// Groups count from 1 within a menu; commands of a group stand in the order of the table.
struct T_PLACE {
    const char* command;
    const char* menu;
    int group;
};
constexpr T_PLACE kPlaces[] = {
    {"IDS_QM_UI_NEW", kFile, 1},
    {"IDS_QM_UI_NEW_CURVE", kFile, 1},
    {"IDS_QM_UI_NEW_FRAME", kFile, 1},
    {"IDS_QM_UI_OPEN", kFile, 1},
    {"IDS_QM_UI_SAVE", kFile, 2},
    {"IDS_QM_UI_SAVE_AS", kFile, 2},
    {"IDS_QM_UI_EXPORT_CASE", kFile, 2},
    {"IDS_QM_UI_REPORT_COMMAND", kFile, 3},
    {"IDS_QM_UI_REPORT_DATA", kFile, 3},
    {"IDS_QM_UI_EXPORT_PICTURE", kFile, 3},
    {"IDS_QM_UI_PRINT", kFile, 3},
    {"IDS_QM_UI_EXIT", kFile, 99},
    {"IDS_QM_UI_UNDO", kEdit, 1},
    {"IDS_QM_UI_REDO", kEdit, 1},
    {"IDS_QM_UI_ADD_RECORD", kEdit, 2},
    {"IDS_QM_UI_DELETE_RECORD", kEdit, 2},
    {"IDS_QM_UI_PREFERENCES", kEdit, 99},
    {"IDS_QM_UI_SECT_MENU", kModel, 1},
    {"IDS_QM_UI_MATL_MENU", kModel, 1},
    {"IDS_QM_UI_SECC_CMD", kModel, 2},
    {"IDS_QM_UI_ANALYSE", kAnalysis, 1},
    {"IDS_QM_UI_HINGE_TYPES", kHinges, 1},
    {"IDS_QM_UI_GEN_MENU", kHinges, 1},
    {"IDS_QM_UI_HINGES_GENERATED", kHinges, 1},
    {"IDS_QM_UI_HINGE_TABLE", kHinges, 2},
    {"IDS_QM_UI_IEHP_MENU", kHinges, 2},
    {"IDS_QM_UI_HINGE_OPTIONS_CMD", kHinges, 3},
    {"IDS_QM_UI_FIGURE_MENU_0", kHinges, 4},
    {"IDS_QM_UI_FIGURE_MENU_E", kHinges, 4},
    {"IDS_QM_UI_FIGURE_MENU_UNLOAD", kHinges, 4},
    {"IDS_QM_UI_POLC_LIST", kPushover, 1},
    {"IDS_QM_UI_POGC_MENU", kPushover, 1},
    {"IDS_QM_UI_POFC_MENU", kPushover, 1},
    {"IDS_QM_UI_PUSH_RUN", kPushover, 2},
    {"IDS_QM_UI_PUSH_CURVE", kPushover, 3},
    {"IDS_QM_UI_PUSH_NEW_CURVE", kPushover, 3},
    {"IDS_QM_UI_PUSH_CHOOSE_CASE", kPushover, 3},
    {"IDS_QM_UI_PUSH_COMPARE_ALL", kPushover, 3},
    {"IDS_QM_UI_PUSH_STATES", kResults, 1},
    {"IDS_QM_UI_PUSH_STOREYS", kResults, 1},
    {"IDS_QM_UI_EXPLORER", kWindow, 1},
    {"IDS_QM_UI_MESSAGES", kWindow, 1},
    {"IDS_QM_UI_START_PAGE", kWindow, 99},
    {"IDS_QM_UI_HELP", kHelp, 1},
    {"IDS_QM_UI_WHATS_THIS", kHelp, 1},
    {"IDS_QM_UI_EXAMPLES", kHelp, 1},
    {"IDS_QM_UI_ABOUT", kHelp, 2},
};
constexpr int kUnknownGroup = 50; // of commands that the table does not know, and beyond

struct T_PLACED {
    T_COMMAND command;
    std::size_t menu = 0;
    int group = 0;
    std::size_t row = 0; // of the table, or its size
};

std::size_t RankOf(std::string_view menu)
{
    return static_cast<std::size_t>(
        std::ranges::find(kMenus, menu, [](const char* m) { return std::string_view(m); }) -
        kMenus.begin());
}

} // namespace

void ArrangeMenus(T_COMMANDS& commands)
{
    std::vector<T_PLACED> placed;
    int ownGroup = kUnknownGroup;
    for (T_COMMAND& command : commands) {
        if (!*command.key) {
            ++ownGroup;
            continue;
        }
        const auto* const at =
            std::ranges::find(kPlaces, std::string_view(command.key),
                              [](const T_PLACE& p) { return std::string_view(p.command); });
        const bool isKnown = at != std::end(kPlaces);
        if (isKnown) command.menu = at->menu;
        placed.push_back({std::move(command), 0, isKnown ? at->group : ownGroup,
                          static_cast<std::size_t>(at - kPlaces)});
        placed.back().menu = RankOf(placed.back().command.menu);
    }
    std::ranges::stable_sort(placed, {}, [](const T_PLACED& p) {
        return std::tuple(p.menu, std::string_view(p.command.menu), p.group, p.row);
    });
    commands.clear();
    for (std::size_t i = 0; i < placed.size(); ++i) {
        const bool isLine = i > 0 && placed[i].group != placed[i - 1].group &&
                            std::string_view(placed[i].command.menu) == placed[i - 1].command.menu;
        if (isLine) commands.push_back({placed[i].command.menu});
        commands.push_back(std::move(placed[i].command));
    }
}
