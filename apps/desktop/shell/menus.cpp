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

constexpr std::string_view kPrefix = "IDS_QM_";

/// Groups count from 1 within a menu; commands of a group stand in the order of the table.
struct T_PLACE {
    std::string_view command; // the key of its text, without what all keys begin with
    const char* menu;
    int group;
};
constexpr T_PLACE kPlaces[] = {
    {"UI_NEW", kFile, 1},
    {"NEW_CURVE_MENU", kFile, 1},
    {"NEW_FRAME_MENU", kFile, 1},
    {"UI_OPEN", kFile, 1},
    {"UI_SAVE", kFile, 2},
    {"UI_SAVE_AS", kFile, 2},
    {"UI_EXPORT_CASE", kFile, 2},
    {"UI_REPORT_COMMAND", kFile, 3},
    {"UI_REPORT_DATA", kFile, 3},
    {"UI_EXPORT_PICTURE", kFile, 3},
    {"UI_PRINT", kFile, 3},
    {"UI_EXIT", kFile, 99},
    {"UI_UNDO", kEdit, 1},
    {"UI_REDO", kEdit, 1},
    {"UI_ADD_RECORD", kEdit, 2},
    {"UI_DELETE_RECORD", kEdit, 2},
    {"UI_PREFERENCES", kEdit, 99},
    {"UI_SECT_MENU", kModel, 1},
    {"UI_MATL_MENU", kModel, 1},
    {"NEW_STOREYS_MENU", kModel, 1},
    {"UI_SECC_CMD", kModel, 2},
    {"NEW_SPECTRUM_MENU", kLoads, 1},
    {"UI_ANALYSE", kAnalysis, 1},
    {"MODES_MENU", kAnalysis, 1},
    {"UI_HINGE_TYPES", kHinges, 1},
    {"UI_GEN_MENU", kHinges, 1},
    {"UI_HINGES_GENERATED", kHinges, 1},
    {"UI_HINGE_TABLE", kHinges, 2},
    {"UI_IEHP_MENU", kHinges, 2},
    {"UI_HINGE_OPTIONS_CMD", kHinges, 3},
    {"UI_FIGURE_MENU_0", kHinges, 4},
    {"UI_FIGURE_MENU_E", kHinges, 4},
    {"UI_FIGURE_MENU_UNLOAD", kHinges, 4},
    {"UI_POLC_LIST", kPushover, 1},
    {"UI_POGC_MENU", kPushover, 1},
    {"UI_POFC_MENU", kPushover, 1},
    {"UI_PUSH_RUN", kPushover, 2},
    {"UI_PUSH_CURVE", kPushover, 3},
    {"UI_PUSH_NEW_CURVE", kPushover, 3},
    {"UI_PUSH_CHOOSE_CASE", kPushover, 3},
    {"UI_PUSH_COMPARE_ALL", kPushover, 3},
    {"UI_PUSH_STATES", kResults, 1},
    {"UI_PUSH_STOREYS", kResults, 1},
    {"VIEW_FIT_CHOSEN", kView, 51},
    {"VIEW_PERSPECTIVE", kView, 51},
    {"VIEW_HIDE_CHOSEN", kView, 52},
    {"VIEW_SHOW_CHOSEN", kView, 52},
    {"VIEW_SHOW_ALL", kView, 52},
    {"UI_EXPLORER", kWindow, 1},
    {"UI_PROPERTIES", kWindow, 1},
    {"UI_TABLES", kWindow, 1},
    {"VIEW_RESULTS", kWindow, 1},
    {"UI_MESSAGES", kWindow, 1},
    {"UI_START_PAGE", kWindow, 99},
    {"UI_HELP", kHelp, 1},
    {"UI_WHATS_THIS", kHelp, 1},
    {"UI_EXAMPLES", kHelp, 1},
    {"UI_ABOUT", kHelp, 2},
};
constexpr int kUnknownGroup = 50; // of commands that the table does not know, and beyond

struct T_PLACED {
    T_COMMAND command;
    std::size_t menu = 0;
    int group = 0;
    std::size_t row = 0; // of the table, or its size
};

std::string_view NameOf(std::string_view key)
{
    return key.starts_with(kPrefix) ? key.substr(kPrefix.size()) : key;
}

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
        const auto* const at = std::ranges::find(kPlaces, NameOf(command.key), &T_PLACE::command);
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
