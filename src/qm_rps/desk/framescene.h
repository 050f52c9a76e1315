// What a picture of the frame shows: the frame itself, and how it moves under a result.
#pragma once

#include "qm_db/dbdoc.h"

#include <map>
#include <set>

struct T_SCENE_NODE {
    int id = 0;
    std::array<double, 3> xyz{};
    T_DIRS6 held{};    // directions of the support; what holds every node is none
    bool shown = true; // false: every element at it is hidden
};

struct T_SCENE_LINE {
    int id = 0;               // of the element
    std::size_t i = 0, j = 0; // nodes by index
    ELEM_KIND kind = ELEM_KIND::Beam;
    bool hingeI = false, hingeJ = false;        // plastic hinges that were generated
    std::array<double, 3> offsetI{}, offsetJ{}; // rigid, from the node to the end
};

/// Lengths in the document's current units.
struct T_FRAME_SCENE {
    std::string title, lengthUnit;
    std::vector<T_SCENE_NODE> nodes; // ascending ids
    std::vector<T_SCENE_LINE> lines;
    long revision = 0; // of the document
    long variant = 0;  // another number when other elements are hidden
};

/// A result that the frame can be shown under.
struct T_SHAPE_SOURCE {
    enum class KIND { None, Static, Stage, Pushover, Mode, Combination };
    KIND kind = KIND::None;
    int key = 0; // of the load case, combination, stage, pushover load case; the mode's number
    std::string name;
    int steps = 0;        // of a stage or pushover load case; else 0
    int turn = 0;         // of a pushover load case: so many times its static angle
    bool analysed = true; // false: it has loads alone, results are missing or old
    bool operator==(const T_SHAPE_SOURCE&) const = default;
};

/// Drift of a storey as a bar beside the frame.
struct T_SCENE_DRIFT {
    std::string name;
    double bottom = 0.0, top = 0.0; // heights
    double drift = 0.0;             // ratio, with its sign
};

/// Translations of the scene's nodes in current units from displacements (SI) of nodes with these
/// ids, ascending; nodes without any stay.
std::vector<std::array<double, 3>> MovesOf(const T_FRAME_SCENE& scene, const std::vector<int>& ids,
                                           const std::vector<T_DOF6>& displacement,
                                           const T_UNITS& units);

/// The document must outlive the object. Everything is read again when the document has changed.
class CFrameScene {
public:
    explicit CFrameScene(CDBDoc& doc) : m_doc(doc) {}

    const T_FRAME_SCENE& Scene();
    /// The frame as a source shows it: of a stage what stands then. Nodes are those of Scene.
    const T_FRAME_SCENE& SceneOf(const T_SHAPE_SOURCE& source);
    /// The same without the hidden elements, and nodes with hidden ones alone not shown; valid
    /// until the next call.
    const T_FRAME_SCENE& Shown(const T_SHAPE_SOURCE& source, const std::set<int>& hidden);
    /// None first, then every load case, combination and stage, pushover cases and modes that have
    /// results.
    std::vector<T_SHAPE_SOURCE> Sources();
    /// Translations of the scene's nodes in current units (of a mode in its own normalisation), at
    /// the end of the step, from 1. A pushover case of another solver has results in its direction
    /// of control alone; nodes without results stay. 1 done; 0 Error says why, `out` as it was.
    [[nodiscard]] int Read(const T_SHAPE_SOURCE& source, int step,
                           std::vector<std::array<double, 3>>& out);
    /// Drifts of a step of a pushover load case; empty where there are none.
    std::vector<T_SCENE_DRIFT> Drifts(const T_SHAPE_SOURCE& source, int step);
    /// The axis normal to a frame that lies in a plane of axes: 0 X, 1 Y, 2 Z; -1: none.
    static int FlatAxis(const T_FRAME_SCENE& scene);
    /// The largest displacement on a picture over the frame's size.
    static constexpr double kShown = 0.05;
    /// A factor on the displacements, a round number, that makes the largest at most kShown times
    /// the frame's size.
    static double RoundScale(const T_FRAME_SCENE& scene,
                             const std::vector<std::array<double, 3>>& displacement);
    const std::string& Error() const { return m_error; }

private:
    using T_MOVES = std::vector<std::array<double, 3>>;
    void Build();
    void AddPushes(std::vector<T_SHAPE_SOURCE>& sources);
    void AddStatic(std::vector<T_SHAPE_SOURCE>& sources);
    int ReadPushover(const T_SHAPE_SOURCE& source, int step, T_MOVES& out);
    int ReadSeries(int key);
    template <class F>
    int ReadNodes(F read, T_MOVES& out);

    CDBDoc& m_doc;
    T_FRAME_SCENE m_scene;
    std::map<int, T_FRAME_SCENE> m_stages; // by key, those that were asked for
    T_FRAME_SCENE m_shown;                 // of m_shownOf, without m_hidden
    const T_FRAME_SCENE* m_shownOf = nullptr;
    std::set<int> m_hidden;
    long m_variant = 0;
    long m_revision = -1;
    std::string m_error;
    // Of the pushover load case that was read last: displacements by node, all steps. A node
    // without results has none.
    int m_pushover = 0;
    std::vector<std::vector<double>> m_series;
};
