#include "qm_rps/desk/modeltree.h"

#include "qm_base/say.h"
#include "qm_db/recordform.h"
#include "qm_rps/desk/gridorder.h"

#include <algorithm>

namespace {

using W = T_TREE_NODE::WHAT;

struct T_SUBJECT {
    const char* title;
    std::vector<RECORD_KIND> kinds;
};

const std::vector<T_SUBJECT>& Subjects()
{
    static const std::vector<T_SUBJECT> all{
        {"IDS_QM_TREE_GEOMETRY",
         {KindOf<T_NODE_D>(), KindOf<T_ELEM_D>(), KindOf<T_SECT_D>(), KindOf<T_MATL_D>(),
          KindOf<T_STOR_D>(), KindOf<T_DIAP_D>(), KindOf<T_EQDS_D>()}},
        {"IDS_QM_TREE_LOADS", {KindOf<T_STLD_D>(), KindOf<T_LCOM_D>()}},
        {"IDS_QM_TREE_STAGES", {KindOf<T_STAG_D>()}},
        {"IDS_QM_TREE_HINGES", {KindOf<T_PHGT_D>(), KindOf<T_PHGE_D>(), KindOf<T_IEHP_D>()}},
        {"IDS_QM_TREE_SPECTRA", {KindOf<T_SPFC_D>()}},
        {"IDS_QM_TREE_PUSHOVER",
         {kPushControlKind, KindOf<T_POLC_D>(), KindOf<T_POFC_D>(), KindOf<T_EVAL_D>(),
          KindOf<T_POVR_D>()}},
        {"IDS_QM_TREE_FACTORS", {KindOf<T_ULFC_D>(), KindOf<T_ULFI_D>(), KindOf<T_ULSI_D>()}},
        {"IDS_QM_TREE_MODES", {KindOf<T_EIGV_D>()}}};
    return all;
}

bool IsOnce(RECORD_KIND kind)
{
    return kind == kModelOptionsKind || kind == kPushControlKind;
}

/// "case G", "PX, 96 steps".
std::string TextOf(const T_SHAPE_SOURCE& source)
{
    using K = T_SHAPE_SOURCE::KIND;
    constexpr std::array<const char*, 5> kTexts{"", "IDS_QM_TREE_CASE", "IDS_QM_TREE_STAGE",
                                                "IDS_QM_TREE_PUSH", "IDS_QM_TREE_MODE"};
    if (source.kind == K::None) return {};
    return Say(kTexts[static_cast<std::size_t>(source.kind)], source.name,
               std::to_string(source.steps));
}

} // namespace

std::string TitleOfKind(RECORD_KIND kind)
{
    if (kind == kModelOptionsKind) return Say("IDS_QM_TREE_OPTIONS");
    if (kind == kPushControlKind) return Say("IDS_QM_TREE_CONTROL");
    const std::optional<EXPLORER_TABLE> table = TableOfKind(kind);
    return table ? Say(TitleKey(*table)) : std::string();
}

std::string CModelTree::TextOf(RECORD_KIND kind, int key) const
{
    const std::string name = NameOfRecord(Model(), kind, key);
    if (!name.empty()) return name;
    if (kind == KindOf<T_PHGE_D>())
        return Say("IDS_QM_TREE_HINGE_OF", std::to_string(key),
                   std::to_string(Model().hinges.at(key).element));
    if (kind == KindOf<T_POVR_D>()) return NameOfRecord(Model(), KindOf<T_POLC_D>(), key);
    return std::to_string(key);
}

std::vector<int> CModelTree::KeysListed(RECORD_KIND kind) const
{
    std::vector<int> keys = KeysOf(Model(), kind);
    if (!m_filter.empty())
        std::erase_if(keys, [&](int key) { return !HoldsText(TextOf(kind, key), m_filter); });
    return keys;
}

std::vector<T_TREE_NODE> CModelTree::Records(RECORD_KIND kind)
{
    std::vector<T_TREE_NODE> nodes;
    if (IsOnce(kind)) return nodes;
    const std::vector<int> keys = KeysListed(kind);
    const std::string id = KindWord(kind);
    for (std::size_t i = 0; i < std::min(keys.size(), kMostListed); ++i)
        nodes.push_back(
            {W::Record, TextOf(kind, keys[i]), id + ' ' + std::to_string(keys[i]), kind, keys[i]});
    if (keys.size() > kMostListed)
        nodes.push_back({W::More,
                         Say("IDS_QM_TREE_MORE", std::to_string(keys.size() - kMostListed)),
                         id + " more", kind});
    return nodes;
}

std::vector<T_TREE_NODE> CModelTree::Roots()
{
    std::vector<T_TREE_NODE> roots{
        {W::Kind, TitleOfKind(kModelOptionsKind), KindWord(kModelOptionsKind), kModelOptionsKind}};
    for (const T_SUBJECT& subject : Subjects())
        roots.push_back({W::Subject, Say(subject.title), subject.title});
    roots.push_back({W::Results, Say("IDS_QM_TREE_RESULTS"), "IDS_QM_TREE_RESULTS"});
    return roots;
}

bool CModelTree::HasChildren(const T_TREE_NODE& node)
{
    if (node.what == W::Kind) return !IsOnce(node.kind) && !KeysListed(node.kind).empty();
    return node.what == W::Subject || (node.what == W::Results && m_scene.Sources().size() > 1);
}

std::vector<T_TREE_NODE> CModelTree::Children(const T_TREE_NODE& node)
{
    std::vector<T_TREE_NODE> nodes;
    if (node.what == W::Kind) return Records(node.kind);
    if (node.what == W::Results) {
        for (const T_SHAPE_SOURCE& source : m_scene.Sources()) {
            const std::string text = ::TextOf(source);
            if (!text.empty()) nodes.push_back({W::Result, text, text, {}, source.key, source});
        }
    }
    if (node.what != W::Subject) return nodes;
    const auto it = std::ranges::find_if(
        Subjects(), [&](const T_SUBJECT& subject) { return node.id == subject.title; });
    for (const RECORD_KIND kind : it->kinds) {
        const std::size_t count = IsOnce(kind) ? 0 : KeysOf(Model(), kind).size();
        const std::string title = TitleOfKind(kind);
        if (!m_filter.empty() && !IsOnce(kind) && KeysListed(kind).empty()) continue;
        nodes.push_back({W::Kind, IsOnce(kind) ? title : title + " (" + std::to_string(count) + ")",
                         KindWord(kind), kind});
    }
    return nodes;
}

std::vector<std::string> CModelTree::PathTo(RECORD_KIND kind, int key)
{
    if (kind == kModelOptionsKind) return {KindWord(kind)};
    std::vector<std::string> path;
    for (const T_SUBJECT& subject : Subjects())
        if (std::ranges::find(subject.kinds, kind) != subject.kinds.end())
            path = {subject.title, KindWord(kind)};
    const std::vector<int> keys = KeysListed(kind);
    const auto it = std::ranges::find(keys, key);
    if (!IsOnce(kind) && it != keys.end() && it - keys.begin() < std::ptrdiff_t{kMostListed})
        path.push_back(std::string(KindWord(kind)) + ' ' + std::to_string(key));
    return path;
}
