// The tree of a model: its subjects, the kinds of records below them, the records, and the results
// that are there. What a window shows of it is asked for node by node.
#pragma once

#include "qm_rps/desk/framescene.h"
#include "qm_rps/desk/recordgrid.h"

struct T_TREE_NODE {
    enum class WHAT {
        Subject, // "Geometry"
        Kind,    // "Nodes (16)"
        Record,
        More,    // how many records of the kind are not listed
        Results, // the subject of the results
        Result
    };
    WHAT what = WHAT::Subject;
    std::string text;
    std::string id; // the same as long as the node means the same: what is open stays open
    RECORD_KIND kind{};
    int key = 0;
    T_SHAPE_SOURCE source{}; // of a result
    bool operator==(const T_TREE_NODE&) const = default;
};

/// The document and the scene must outlive the tree.
class CModelTree {
public:
    CModelTree(CDBDoc& doc, CFrameScene& scene) : m_doc(doc), m_scene(scene) {}

    /// Records that hold this text alone are listed, and the kinds that have some; empty: all.
    void SetFilter(const std::string& text) { m_filter = text; }
    const std::string& Filter() const { return m_filter; }

    /// The options of the model, and the subjects.
    std::vector<T_TREE_NODE> Roots();
    std::vector<T_TREE_NODE> Children(const T_TREE_NODE& node);
    /// Whether it has children, without making them.
    bool HasChildren(const T_TREE_NODE& node);
    /// The nodes from a root down to the record, which is the last one; the record may be among
    /// those that are not listed, then its kind is.
    std::vector<std::string> PathTo(RECORD_KIND kind, int key);

    static constexpr std::size_t kMostListed = 200; // records of one kind

private:
    std::vector<T_TREE_NODE> Records(RECORD_KIND kind);
    std::string TextOf(RECORD_KIND kind, int key) const;
    std::vector<int> KeysListed(RECORD_KIND kind) const;
    const T_MODEL& Model() const { return m_doc.Data().Model(); }

    CDBDoc& m_doc;
    CFrameScene& m_scene;
    std::string m_filter;
};

/// "Nodes" for the kind of nodes, in the user's language.
std::string TitleOfKind(RECORD_KIND kind);
