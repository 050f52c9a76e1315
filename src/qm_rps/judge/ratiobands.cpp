#include "qm_rps/judge/ratiobands.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/judge/judgementtable.h"

#include <algorithm>

namespace {

/// An end that is not fulfilled is never among those within their limit.
std::size_t BandOf(const T_JUDGED_ROW& row)
{
    if (row.verdict == VERDICT::NotChecked) return kBandUnchecked;
    if (!row.ratio) return kBandBeyond;
    const auto at =
        std::ranges::find_if(kRatioBands, [&](double end) { return *row.ratio <= end; });
    return static_cast<std::size_t>(at - kRatioBands.begin());
}

/// What is not fulfilled counts before what is not checked.
bool IsWorse(std::size_t a, std::size_t b)
{
    const auto rank = [](std::size_t band) {
        if (band != kBandUnchecked) return 2 * band;
        return std::size_t{2 * 2 + 1}; // behind ratios up to 1
    };
    return rank(a) > rank(b);
}

} // namespace

T_RATIO_BANDS RatioBands(const T_JUDGEMENT& judgement, const T_JUDGED_STATE& state,
                         const T_FRAME_SCENE& scene)
{
    std::map<std::pair<int, bool>, std::size_t> bands;
    std::map<int, std::size_t> joints;
    const auto put = [](auto& to, const auto& key, std::size_t band) {
        const auto [at, isNew] = to.try_emplace(key, band);
        if (!isNew && IsWorse(band, at->second)) at->second = band;
    };
    for (const T_JUDGED_ROW& row : state.rows) {
        const T_JUDGED_END& end = judgement.ends[row.end];
        const std::pair place(end.place.element, end.place.atJ);
        if (end.joint)
            put(joints, end.joint->node, BandOf(row));
        else
            put(bands, place, BandOf(row));
        if (end.kind == JUDGED_KIND::Brace || end.kind == JUDGED_KIND::Spring)
            put(bands, std::pair(place.first, true), BandOf(row));
    }
    T_RATIO_BANDS out;
    for (std::size_t i = 0; i < scene.lines.size(); ++i)
        for (const bool atJ : {false, true})
            if (const auto band = bands.find({scene.lines[i].id, atJ}); band != bands.end()) {
                out.halves.push_back({i, atJ, band->second});
                ++out.count[band->second];
            }
    for (std::size_t n = 0; n < scene.nodes.size(); ++n)
        if (const auto band = joints.find(scene.nodes[n].id); band != joints.end()) {
            out.nodes.push_back({n, band->second});
            ++out.count[band->second];
        }
    return out;
}

std::string BandText(std::size_t band)
{
    if (band == kBandUnchecked) return VerdictText(VERDICT::NotChecked);
    if (band == kBandBeyond)
        return Say("IDS_QM_JUDGE_BAND_ABOVE", ShortestText(kRatioBands.back()));
    return Say("IDS_QM_JUDGE_BAND_TO", ShortestText(kRatioBands[band]));
}
