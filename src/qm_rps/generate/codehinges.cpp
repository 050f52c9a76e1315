#include "qm_rps/generate/codehinges.h"

#include "qm_base/say.h"
#include "qm_db/editscope.h"
#include "qm_rps/generate/steeljoint.h"

#include <algorithm>
#include <iterator>
#include <set>
#include <utility>

struct CCodeHinges::T_GROUP {
    std::vector<double> inputs;
    std::vector<int> elements;
    std::shared_ptr<T_CODE_HINGE> hinge; // null: refused
    std::string reason;
};

namespace {

T_HINGE_REFUSAL RefusalOf(int element, const std::string& reason)
{
    const std::string text =
        element == 0 ? reason : Say("IDS_QM_HINGE_ELEMENT", std::to_string(element), reason);
    return {element, "", reason, text};
}

/// What a type was made with; none: its code is not known.
std::optional<T_CODE_OPTIONS> OptionsOf(const T_GENERATED& made)
{
    const auto code = std::ranges::find(kHingeCodeNames, made.code);
    if (code == kHingeCodeNames.end()) return {};
    return T_CODE_OPTIONS{static_cast<HINGE_CODE>(code - kHingeCodeNames.begin()), made.secondary,
                          made.tie, made.axialRange, made.connection};
}

/// Beam elements, and trusses of steel.
std::vector<int> MembersOf(const T_MODEL& model)
{
    std::vector<int> ids;
    for (const auto& [id, element] : model.elements) {
        const auto material = model.materials.find(element.material);
        const bool steel =
            material != model.materials.end() && material->second.type == MATL_CLASS::Steel;
        if (element.kind == ELEM_KIND::Beam || (element.kind == ELEM_KIND::Truss && steel))
            ids.push_back(id);
    }
    return ids;
}

/// "ASCE41-17 column 30x50 2": the first number that is free.
std::string FreeName(const std::string& stem, std::map<std::string, int>& last,
                     const std::set<std::string>& taken)
{
    int& number = last[stem];
    std::string name;
    do
        name = stem + ' ' + std::to_string(++number);
    while (taken.contains(name));
    return name;
}

/// Hinges of the elements, then generated types that nothing uses.
void EraseOld(CDBDoc& doc, const std::set<int>& elements, CEditScope& edit)
{
    std::vector<int> hinges, types;
    for (const auto& [key, hinge] : doc.Data().Model().hinges)
        if (elements.contains(hinge.element)) hinges.push_back(key);
    for (const int key : hinges)
        (void)edit.Erase<T_PHGE_D>(key);
    const T_MODEL& model = doc.Data().Model();
    for (const auto& [key, type] : model.hingeTypes)
        if (type.generated && UsersOf(model, KindOf<T_PHGT_D>(), key).empty()) types.push_back(key);
    for (const int key : types)
        (void)edit.Erase<T_PHGT_D>(key);
}

/// V that the hinges were made with, as CPushedShears has it (M / V stays 0).
std::map<int, std::vector<double>> ShearsOf(const T_CODE_HINGES& hinges)
{
    std::map<int, std::vector<double>> out;
    for (const T_CODE_ELEMENT& element : hinges.elements) {
        const auto& axes = element.member.bending;
        std::vector<double> values(4 * axes.size());
        for (const T_CODE_COMPONENT& c : element.hinge->components) {
            const auto axis = std::ranges::find(axes, c.component) - axes.begin();
            const auto place = 4 * static_cast<std::size_t>(axis);
            if (place >= values.size()) continue;
            values[place] = c.ends.I.pos.shear;
            values[place + 2] = c.ends.J.pos.shear;
        }
        out.emplace(element.member.element, std::move(values));
    }
    return out;
}

} // namespace

int CCodeHinges::Analyse(std::string& reason)
{
    if (m_isAnalysed) return 1;
    m_isAnalysed = m_axial.Analyse(m_doc.Data().Model(), reason) != 0;
    return m_isAnalysed ? 1 : 0;
}

int CCodeHinges::Group(const T_CODE_REQUEST& request, std::vector<T_GROUP>& groups,
                       T_CODE_HINGES& out, T_HINGE_REFUSAL& refusal)
{
    const T_MODEL& model = m_doc.Data().Model();
    std::map<std::pair<int, int>, std::vector<std::size_t>> alike; // by section and material
    const auto refuse = [&](int element, const std::string& reason) {
        refusal = RefusalOf(element, reason);
        if (request.keepGoing) out.skipped.push_back(refusal);
        return request.keepGoing;
    };
    const std::vector<int> ids = request.elements.empty() ? MembersOf(model) : request.elements;
    for (const int id : ids) {
        T_HINGE_MEMBER member;
        std::string reason;
        if (!ReadMember(model, id, m_axial, member, reason)) {
            if (!refuse(id, reason)) return 0;
            continue;
        }
        if (request.options.connection &&
            !ReadSteelJoints(model, *request.options.connection, member, reason)) {
            if (!refuse(id, reason)) return 0;
            continue;
        }
        if (const auto pushed = request.pushed.find(id); pushed != request.pushed.end())
            member.pushed = pushed->second;
        const std::vector<double> inputs = InputsOf(model, member);
        auto& same = alike[{member.section, member.material}];
        auto found = std::ranges::find_if(
            same, [&](std::size_t i) { return SameInputs(groups[i].inputs, inputs); });
        if (found == same.end()) {
            T_GROUP& group = groups.emplace_back();
            group.inputs = inputs;
            auto hinge = std::make_shared<T_CODE_HINGE>();
            if (MakeCodeHinge(model, member, request.options, *hinge, group.reason))
                group.hinge = std::move(hinge);
            same.push_back(groups.size() - 1);
            found = same.end() - 1;
        }
        T_GROUP& group = groups[*found];
        if (!group.hinge) {
            if (!refuse(id, group.reason)) return 0;
            continue;
        }
        group.elements.push_back(id);
        out.elements.push_back({std::move(member), group.hinge});
    }
    std::erase_if(groups, [](const T_GROUP& group) { return !group.hinge; });
    if (!out.elements.empty()) return 1;
    if (out.skipped.empty()) refusal = RefusalOf(0, Say("IDS_QM_GEN_NO_ELEMENTS"));
    return 0;
}

int CCodeHinges::Store(std::vector<T_GROUP>& groups, const T_CODE_REQUEST& request,
                       T_HINGE_REFUSAL& refusal)
{
    CEditScope edit(m_doc, "hinges of a code", EDIT_STEP::Join);
    std::set<int> elements;
    for (const T_GROUP& group : groups)
        elements.insert(group.elements.begin(), group.elements.end());
    EraseOld(m_doc, elements, edit);
    const T_MODEL& model = m_doc.Data().Model();
    std::set<std::string> taken;
    for (const auto& entry : model.hingeTypes)
        taken.insert(entry.second.name);
    std::map<std::string, int> last;
    int key = NextKey(model.hingeTypes);
    std::vector<int> keys;
    for (T_GROUP& group : groups) {
        const T_ELEM_D& first = model.elements.at(group.elements.front());
        T_PHGT_D& type = group.hinge->type;
        type.name = FreeName(kHingeCodeNames[static_cast<std::size_t>(request.options.code)] +
                                 (' ' + model.sections.at(first.section).name),
                             last, taken);
        T_PHGT_D shown = type;
        RecordFromSi(shown, m_doc.Unit().Units());
        keys.push_back(key);
        (void)edit.Put(key++, shown);
    }
    CHingeGenerator generator(m_doc);
    for (std::size_t i = 0; i < groups.size(); ++i)
        if (!generator.Generate(keys[i], groups[i].elements, refusal)) return 0;
    if (edit.Commit()) return 1;
    refusal = RefusalOf(0, Say("IDS_QM_HINGE_NOT_STORED"));
    return 0;
}

void CCodeHinges::Warn(T_CODE_HINGES& out) const
{
    if (!m_axial.IsLoaded()) out.warnings.push_back({"IDS_QM_GEN_WARN_NO_LOADS", {}});
    if (!m_doc.Data().Model().pushControl.hingeTypes.empty())
        out.warnings.push_back({"IDS_QM_GEN_WARN_ACTING", {}});
}

/// The hinges of the request, the document as it is.
int CCodeHinges::Make(const T_CODE_REQUEST& request, std::vector<T_GROUP>& groups,
                      T_CODE_HINGES& out, T_HINGE_REFUSAL& refusal)
{
    std::string reason;
    if (!Analyse(reason)) {
        refusal = RefusalOf(0, reason);
        return 0;
    }
    if (!Group(request, groups, out, refusal)) return 0;
    Warn(out);
    out.types = groups.size();
    return 1;
}

int CCodeHinges::Preview(const T_CODE_REQUEST& request, T_CODE_HINGES& out,
                         T_HINGE_REFUSAL& refusal)
{
    T_CODE_HINGES made;
    std::vector<T_GROUP> groups;
    if (!Make(request, groups, made, refusal)) return 0;
    out = std::move(made);
    return 1;
}

int CCodeHinges::Generate(const T_CODE_REQUEST& request, T_CODE_HINGES& out,
                          T_HINGE_REFUSAL& refusal)
{
    T_CODE_HINGES made;
    std::vector<T_GROUP> groups;
    if (!Make(request, groups, made, refusal) || !Store(groups, request, refusal)) return 0;
    out = std::move(made);
    return 1;
}

int CCodeHinges::GenerateFromPush(T_CODE_REQUEST request, int loadCase,
                                  const PUSH_PROGRESS_FN& progress, T_CODE_HINGES& out,
                                  T_HINGE_REFUSAL& refusal)
{
    CEditScope edit(m_doc, "hinges of a code by a push"); // undone as one
    T_CODE_HINGES made;
    std::vector<T_CODE_ITERATION> iterations;
    if (!Generate(request, made, refusal)) return 0;
    while (iterations.size() < kMostPushes) {
        std::vector<T_HINGE_MEMBER> members;
        for (const T_CODE_ELEMENT& element : made.elements)
            members.push_back(element.member);
        CPushedShears shears(members);
        std::vector<T_PUSH_RUN> runs;
        std::string error;
        CPushRun push(m_doc);
        push.TellForces([&shears](const T_STEP_FORCES& step) { shears.Take(step); });
        const int done = push.Run(loadCase, progress, runs, error);
        if (!done || runs.back().cancelled) {
            refusal = RefusalOf(0, done ? Say("IDS_QM_PUSH_END_CANCELLED") : error);
            return 0;
        }
        auto now = shears.Values();
        iterations.push_back({LargestChange(ShearsOf(made), now), runs.front().outcome});
        request.pushed = std::move(now);
        if (request.pushed.empty()) break;
        if (iterations.size() > 1 && iterations.back().change.change < kSameShear) break;
        if (!Generate(request, made, refusal)) return 0;
    }
    if (request.pushed.empty())
        made.warnings.push_back({"IDS_QM_GEN_WARN_NO_SHEAR", {}});
    else if (!(iterations.back().change.change < kSameShear))
        made.warnings.push_back({"IDS_QM_GEN_WARN_NOT_SETTLED", {std::to_string(kMostPushes)}});
    if (!edit.Commit()) {
        refusal = RefusalOf(0, Say("IDS_QM_HINGE_NOT_STORED"));
        return 0;
    }
    made.iterations = std::move(iterations);
    out = std::move(made);
    return 1;
}

int CCodeHinges::Regenerate(T_CODE_HINGES& out, T_HINGE_REFUSAL& refusal)
{
    const T_MODEL& model = m_doc.Data().Model();
    std::vector<T_CODE_REQUEST> stale; // types that were asked for alike have one request
    std::string text;
    for (const auto& [key, type] : model.hingeTypes) {
        if (!type.generated || StateOf(key, text) != CODE_TYPE_STATE::Stale) continue;
        const T_GENERATED& made = *type.generated;
        T_CODE_REQUEST request;
        request.options = *OptionsOf(made); // a stale type has a code
        request.elements = ElementsWithHingeType(model, key);
        for (const int id : request.elements)
            if (!made.pushed.empty()) request.pushed[id] = made.pushed;
        const auto alike = std::ranges::find_if(
            stale, [&](const T_CODE_REQUEST& other) { return other.options == request.options; });
        if (alike == stale.end()) {
            stale.push_back(std::move(request));
            continue;
        }
        std::ranges::copy(request.elements, std::back_inserter(alike->elements));
        alike->pushed.merge(request.pushed);
    }
    CEditScope edit(m_doc, "hinges of a code");
    T_CODE_HINGES all;
    for (const T_CODE_REQUEST& request : stale) {
        T_CODE_HINGES made;
        if (!Generate(request, made, refusal)) return 0;
        all.types += made.types;
        all.warnings = std::move(made.warnings); // of the model: the same of each
        std::ranges::move(made.elements, std::back_inserter(all.elements));
    }
    if (!stale.empty() && !edit.Commit()) {
        refusal = RefusalOf(0, Say("IDS_QM_HINGE_NOT_STORED"));
        return 0;
    }
    out = std::move(all);
    return 1;
}

CODE_TYPE_STATE CCodeHinges::StateOf(int hingeType, std::string& text)
{
    const T_MODEL& model = m_doc.Data().Model();
    const T_PHGT_D& type = model.hingeTypes.at(hingeType);
    const std::optional<T_CODE_OPTIONS> options = OptionsOf(*type.generated);
    const auto notChecked = [&text](std::string words) {
        text = std::move(words);
        return CODE_TYPE_STATE::NotChecked;
    };
    if (!options) return notChecked(Say("IDS_QM_GEN_CODE", type.generated->code));
    std::string reason;
    if (!Analyse(reason)) return notChecked(Say("IDS_QM_GEN_NOT_CHECKED", reason));
    T_HINGE_MEMBER member;
    for (const int id : ElementsWithHingeType(model, hingeType)) {
        if (!ReadMember(model, id, m_axial, member, reason) ||
            (options->connection && !ReadSteelJoints(model, *options->connection, member, reason)))
            return notChecked(Say("IDS_QM_GEN_NOT_CHECKED",
                                  Say("IDS_QM_HINGE_ELEMENT", std::to_string(id), reason)));
        member.pushed = type.generated->pushed;
        const INPUT_STATE state = InputStateOf(*type.generated, InputsOf(model, member));
        if (state == INPUT_STATE::Same) continue;
        const bool isStale = state == INPUT_STATE::Stale;
        text = isStale ? Say("IDS_QM_GEN_STALE", std::to_string(id)) : Say("IDS_QM_GEN_EDITED");
        return isStale ? CODE_TYPE_STATE::Stale : CODE_TYPE_STATE::Edited;
    }
    text.clear();
    if (member.element == 0) return CODE_TYPE_STATE::Fresh; // no element has it
    T_CODE_HINGE today;
    if (!MakeCodeHinge(model, member, *options, today, reason))
        return notChecked(Say("IDS_QM_GEN_NOT_CHECKED", reason));
    if (SameHinge(type, today.type)) return CODE_TYPE_STATE::Fresh;
    text = Say("IDS_QM_GEN_EDITED");
    return CODE_TYPE_STATE::Edited;
}

std::vector<T_FINDING> CCodeHinges::TypeFindings(int hingeType)
{
    const auto found = m_doc.Data().Model().hingeTypes.find(hingeType);
    if (found == m_doc.Data().Model().hingeTypes.end() || !found->second.generated) return {};
    std::string fault;
    if (StateOf(hingeType, fault) == CODE_TYPE_STATE::Fresh) return {};
    T_FINDING finding;
    finding.field = "generated";
    finding.ruleText = found->second.generated->code;
    finding.text = fault;
    return {finding};
}
