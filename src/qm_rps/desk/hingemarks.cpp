#include "qm_rps/desk/hingemarks.h"

#include <algorithm>

T_HINGE_MARKS PlaceHinges(const T_PUSH_RUN& run, const T_FRAME_SCENE& scene, const T_MODEL& model)
{
    std::map<int, long> lines;
    std::map<int, std::size_t> nodes;
    for (std::size_t i = 0; i < scene.lines.size(); ++i)
        lines[scene.lines[i].id] = static_cast<long>(i);
    for (std::size_t i = 0; i < scene.nodes.size(); ++i)
        nodes[scene.nodes[i].id] = i;
    T_HINGE_MARKS out;
    for (std::size_t i = 0; i < run.hinges.size(); ++i) {
        T_HINGE_MARK& mark = out.hinges.emplace_back();
        const int element = run.hinges[i].place.element;
        mark.at = run.data.hinges[i].at;
        if (const auto line = lines.find(element); line != lines.end()) mark.line = line->second;
        const auto record = model.elements.find(element);
        if (mark.line < 0 && record != model.elements.end()) {
            const auto node = nodes.find(record->second.nodeI);
            if (node != nodes.end()) mark.node = node->second;
        }
        for (const PUSH_STATE state : run.hinges[i].state)
            out.occurs[static_cast<std::size_t>(state)] = true;
    }
    return out;
}

void ShowStates(const T_PUSH_RUN& run, int step, long chosen, T_HINGE_MARKS& marks)
{
    for (std::size_t i = 0; i < marks.hinges.size(); ++i) {
        marks.hinges[i].state = run.hinges[i].state.at(static_cast<std::size_t>(step - 1));
        marks.hinges[i].chosen = static_cast<long>(i) == chosen;
    }
}
