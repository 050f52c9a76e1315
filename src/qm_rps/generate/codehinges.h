// Hinges of members as a code gives them: from section, bars and initial loads to hinge types that
// members share and the hinges of elements.
#pragma once

#include "qm_rps/generate/codehingetype.h"
#include "qm_rps/generate/pushedshear.h"
#include "qm_rps/hinge/hingefindings.h"
#include "qm_rps/hinge/hingegenerator.h"

#include <memory>

struct T_CODE_REQUEST {
    T_CODE_OPTIONS options;
    std::vector<int> elements; // empty: every beam element of the model, and trusses of steel
    bool keepGoing = false;    // leave out what can't have a hinge
    /// By element, as T_GENERATED has it; others have V of the strengths at both ends.
    std::map<int, std::vector<double>> pushed{};
};

/// The hinge of one element.
struct T_CODE_ELEMENT {
    T_HINGE_MEMBER member;
    std::shared_ptr<const T_CODE_HINGE> hinge; // its type has the name
};
/// One push of an iteration.
struct T_CODE_ITERATION {
    T_SHEAR_CHANGE change;
    std::string outcome; // of the push
};
struct T_CODE_HINGES {
    std::vector<T_CODE_ELEMENT> elements;
    std::vector<T_CODE_ITERATION> iterations;
    std::vector<T_HINGE_REFUSAL> skipped;
    std::vector<T_CODE_WARNING> warnings;
    std::size_t types = 0;
};

/// How a generated type stands to the model as it is.
enum class CODE_TYPE_STATE {
    Fresh,
    Stale,     // section, material, member or loads are not those that it was made of
    Edited,    // they are, and its curves are others
    NotChecked // its code, or today's inputs, are not known
};

class CCodeHinges {
public:
    explicit CCodeHinges(CDBDoc& doc) : m_doc(doc) {}

    /// What Generate would give, its types without names; the document stays as it is. 1 done; 0 as
    /// Generate.
    [[nodiscard]] int Preview(const T_CODE_REQUEST& request, T_CODE_HINGES& out,
                              T_HINGE_REFUSAL& refusal);

    /// As one undoable edit, or as a part of the one that is open: the elements' hinges are
    /// replaced, generated types that are left without a hinge go. Members with the same section,
    /// material, lengths and axial forces share a type. 1 done; 0 with the first element that can't
    /// have a hinge, the document unchanged.
    [[nodiscard]] int Generate(const T_CODE_REQUEST& request, T_CODE_HINGES& out,
                               T_HINGE_REFUSAL& refusal);

    /// Generates, pushes a load case and generates again with the shear of the push (CPushedShears)
    /// until no V changes by kSameShear of itself, at most kMostPushes times; each push is told.
    /// What the push could not settle is said as a warning. 1 done; 0 with the refusal, also where
    /// the load case can't be pushed or `progress`, told the steps of each push, asks to stop; the
    /// document unchanged.
    [[nodiscard]] int GenerateFromPush(T_CODE_REQUEST request, int loadCase,
                                       const PUSH_PROGRESS_FN& progress, T_CODE_HINGES& out,
                                       T_HINGE_REFUSAL& refusal);
    static constexpr double kSameShear = 0.01;
    static constexpr int kMostPushes = 8;

    /// Generates the hinges of the elements of every stale type again, by the type's code and
    /// level (tie force, axial range and V of a push, too), as one undoable edit; the types of
    /// these elements are new ones. 1 done, `out` without elements where no type is stale; 0 as
    /// Generate.
    [[nodiscard]] int Regenerate(T_CODE_HINGES& out, T_HINGE_REFUSAL& refusal);

    /// Of a generated type, with what is to be said of it.
    CODE_TYPE_STATE StateOf(int hingeType, std::string& text);
    /// The same as findings; a fresh type has none.
    std::vector<T_FINDING> TypeFindings(int hingeType);

private:
    struct T_GROUP;
    int Analyse(std::string& reason);
    int Make(const T_CODE_REQUEST& request, std::vector<T_GROUP>& groups, T_CODE_HINGES& out,
             T_HINGE_REFUSAL& refusal);
    int Group(const T_CODE_REQUEST& request, std::vector<T_GROUP>& groups, T_CODE_HINGES& out,
              T_HINGE_REFUSAL& refusal);
    int Store(std::vector<T_GROUP>& groups, const T_CODE_REQUEST& request,
              T_HINGE_REFUSAL& refusal);
    void Warn(T_CODE_HINGES& out) const;

    CDBDoc& m_doc;
    CInitialAxial m_axial;
    bool m_isAnalysed = false;
};
