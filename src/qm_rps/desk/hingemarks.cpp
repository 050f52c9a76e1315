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
            mark.shown = record->second.kind == ELEM_KIND::Spring;
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

const T_HINGE_MARKS* CShownHinges::Marks(const T_SHAPE_SOURCE& source, int step,
                                         const T_FRAME_SCENE& scene)
{
    if (source.kind != T_SHAPE_SOURCE::KIND::Pushover) return nullptr;
    const long revision = m_doc.Data().Revision();
    if (m_revision != revision || m_key != source.key || m_turn != source.turn) {
        m_revision = revision;
        m_key = source.key;
        m_turn = source.turn;
        m_run = {};
        std::string why; // said where the results are read; here they are left out
        if (!CPushRun(m_doc).Read(source.key, source.turn, m_run, why)) m_run = {};
        m_variant = -1;
    }
    if (m_variant != scene.variant) {
        m_variant = scene.variant;
        m_marks = PlaceHinges(m_run, scene, m_doc.Data().Model());
    }
    if (m_marks.hinges.empty() || step < 1 || step > std::ssize(m_run.loadFactor)) return nullptr;
    ShowStates(m_run, step, -1, m_marks);
    return &m_marks;
}
