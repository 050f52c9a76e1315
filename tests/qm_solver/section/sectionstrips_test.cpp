// Random sections against strips: tests/data/section/strips.txt was made by
// tests/oracle/section.py, which knows nothing of the program.
#include "sections.h"

#include <cmath>
#include <fstream>
#include <sstream>

using namespace solver;

namespace {

/// A line of the file that describes the section; false where it asks for something.
bool Describe(const std::string& word, std::istream& line, T_SECTION_MODEL& m)
{
    if (word == "section") {
        m = {};
    } else if (word == "law") {
        int kind = 0;
        T_STRESS_LAW l;
        line >> kind >> l.strength >> l.peakStrain >> l.limitStrain >> l.exponent >> l.blockDepth >>
            l.modulus >> l.hardening >> l.spalls;
        l.kind = static_cast<STRESS_LAW>(kind);
        m.laws.push_back(l);
    } else if (word == "region") {
        m.regions.emplace_back();
        line >> m.regions.back().law;
    } else if (word == "ring") {
        std::size_t count = 0;
        line >> count;
        T_RING ring(count);
        for (T_CORNER& c : ring)
            line >> c.y >> c.z >> c.bulge;
        m.regions.back().rings.push_back(ring);
    } else if (word == "bar") {
        T_SECTION_BAR bar;
        line >> bar.y >> bar.z >> bar.area >> bar.law;
        m.bars.push_back(bar);
    } else
        return false;
    EXPECT_FALSE(line.fail()) << word;
    return true;
}

} // namespace

TEST(SectionStrips, CapacitiesAndCurvaturesAgree)
{
    std::ifstream file(QM_TEST_DATA "/section/strips.txt");
    std::string text, word;
    T_SECTION_MODEL m;
    int compared = 0;
    while (std::getline(file, text)) {
        std::istringstream line(text);
        line >> word;
        if (word == "#" || Describe(word, line, m)) continue;
        const CSectionSolver s = Prepared(m);
        T_CURVATURE_REQUEST request;
        double My = 0.0, Mz = 0.0;
        line >> request.direction >> request.axial;
        if (word == "bent") line >> request.maxCurvature;
        line >> My >> Mz;
        ASSERT_FALSE(line.fail()) << text;
        T_CAPACITY got;
        T_SECTION_ERROR error;
        T_MOMENT_CURVATURE path;
        if (word == "bent") {
            ASSERT_EQ(1, s.MomentCurvature(request, path, error)) << text;
            ASSERT_EQ(CURVATURE_END::MaxCurvature, path.end) << text;
            got.My = path.points.back().My, got.Mz = path.points.back().Mz;
        } else if (word == "capacity") {
            ASSERT_EQ(1, s.AtAxial(request.direction, request.axial, got, error)) << text;
        } else {
            ASSERT_EQ(1, s.TowardsMoment(request.direction, request.axial, got, error)) << text;
        }
        const double size = std::hypot(My, Mz);
        EXPECT_NEAR(My, got.My, 1e-6 * size) << text;
        EXPECT_NEAR(Mz, got.Mz, 1e-6 * size) << text;
        ++compared;
    }
    EXPECT_EQ(43, compared);
}
