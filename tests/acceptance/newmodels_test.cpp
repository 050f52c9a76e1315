// Models made by commands: a pasted curve evaluates as the example with the same numbers does, a
// generated frame stands and carries what it was given.
#include "program.h"

#include <algorithm>
#include <cmath>

namespace {

class NewModels : public CProgramTest {
protected:
    void ExpectSame(const json& a, const json& b, const std::string& place) const
    {
        if (a.is_object()) {
            for (const auto& [key, value] : a.items())
                if (key != "name" && key != "load_factor")
                    ExpectSame(value, b.at(key), place + "/" + key);
        } else if (a.is_array()) {
            ASSERT_EQ(a.size(), b.size()) << place;
            for (std::size_t i = 0; i < a.size(); ++i)
                ExpectSame(a[i], b[i], place + "/" + std::to_string(i));
        } else if (a.is_number()) {
            const double value = a.get<double>(); // shape and period of the example have 15 digits
            EXPECT_NEAR(value, b.get<double>(), 1e-9 * std::max(1.0, std::fabs(value))) << place;
        } else {
            EXPECT_EQ(a, b) << place;
        }
    }
    double Sum(const json& byNode, std::size_t direction) const
    {
        double sum = 0.0;
        for (const auto& [node, values] : byNode.items())
            sum += values.at(direction).get<double>();
        return sum;
    }
};

TEST_F(NewModels, ACurveEvaluatesAsTheExampleWithTheSameNumbers)
{
    const auto folder = ProjectFolder() / "examples" / "first-steps";
    std::filesystem::copy_file(folder / "curve.txt", m_folder / "curve.txt");
    const std::string base =
        "new --curve curve.txt --columns V,d,d1,d2 --units kN,m --mass 3x100 --height 3x3 ";
    Done(base + "--spectrum atc40:Ca=0.4,Cv=0.6 --method ATC-40:A --method ATC-40:B "
                "--method FEMA440:A --method FEMA440:B --method FEMA440:C -o atc.json");
    Done(base + "--spectrum ec8-2004:soil=C,ag=0.35,damping=5 --method EC8/OPCM -o ec8.json");
    Done(base + "--spectrum ntc:soil=C,SLO=0.079/2.4/0.27,SLD=0.104/2.33/0.28,"
                "SLV=0.261/2.36/0.35,SLC=0.334/2.4/0.36,damping=5 --method NTC2008 -o ntc.json");
    const json all = Json("evaluate @first-steps");
    json made = Json("evaluate atc.json");
    made.push_back(Json("evaluate ec8.json").at(0));
    made.push_back(Json("evaluate ntc.json").at(0));
    ASSERT_EQ(7U, made.size());
    for (std::size_t i = 0; i < made.size(); ++i)
        ExpectSame(all.at(i), made.at(i), all.at(i).at("name"));
}

TEST_F(NewModels, ACurveInOtherUnitsHasTheSamePoint)
{
    Write("mm.csv", "d (mm);V (kN)\n0;0\n36;720\n180;864\n");
    Write("m.txt", "0 0\n720 0.036\n864 0.18\n");
    const std::string rest = " --spectrum ec8-2004:soil=C,ag=0.35 -o ";
    Done("new --curve mm.csv --units kN,mm --height 3x3000 --mass 3x100 --mass-unit t" + rest +
         "mm.json");
    Done("new --curve m.txt --columns V,d --units kN,m --height 3x3 --mass 3x980.665 "
         "--mass-unit weight" +
         rest + "m.json");
    const json mm = Json("evaluate mm.json"), m = Json("evaluate m.json");
    const double demand = m.at(0).at("limit_states").at(1).at("demand").get<double>();
    EXPECT_GT(demand, 0.0);
    EXPECT_NEAR(1000.0 * demand, mm.at(0).at("limit_states").at(1).at("demand").get<double>(),
                1e-6 * demand);
}

TEST_F(NewModels, RefusalsNameFileLineAndOption)
{
    Write("falls.txt", "0 0\n10 2\n20 4\n21 3\n");
    Write("good.txt", "0 0\n10 2\n20 4\n");
    const std::string rest = " --units kN,mm --height 3000 --spectrum ec8-2004:soil=C,ag=0.25";
    ExpectRefused("new --curve falls.txt --columns V,d --mass 1" + rest + " -o a.json", 3,
                  "falls.txt: line 4");
    ExpectRefused("new --curve good.txt --mass 1" + rest + " -o a.json", 2, "V,d or d,V");
    ExpectRefused("new --curve good.txt --columns V,d" + rest + " -o a.json", 2, "--total-mass");
    ExpectRefused("new --curve none.txt --columns V,d --mass 1" + rest + " -o a.json", 4,
                  "none.txt");
    ExpectRefused("new --curve good.txt --columns V,d --mass 1" + rest, 2, "-o");
    ExpectRefused("new frame --bays-x 5 --storeys 3 --columns 0.4x0.4 --beams IPE301 "
                  "--concrete C25/30 -o a.json",
                  2, "--beams");
    ExpectRefused("--lang it new frame --bays-x 0 --storeys 3 --columns 0.4x0.4 --beams 0.3x0.5 "
                  "--concrete C25/30 -o a.json",
                  2, "lunghezze");
    EXPECT_FALSE(std::filesystem::exists(m_folder / "a.json"));
}

TEST_F(NewModels, AFrameCarriesWhatItWasGiven)
{
    Done("new frame --bays-x 5,5 --bays-y 4 --storeys 3.5,3 --columns 0.4x0.4 --beams 0.3x0.5 "
         "--concrete C25/30 --dead 20 --live 8 --live-roof 4 --modes 4 --push -o f.json");
    const json results = Json("analyse f.json");
    // Beams: 2 x 10 + 3 x 4 = 32 m a level; columns 6 x 6.5 m; 24.516625 kN/m3.
    const double self = 24.516625 * (2 * 32 * 0.15 + 39 * 0.16);
    const std::pair<const char*, double> cases[] = {
        {"SELF", self}, {"DEAD", 2 * 32 * 20.0}, {"LIVE", 32 * 8.0 + 32 * 4.0}};
    for (const auto& [name, weight] : cases)
        EXPECT_NEAR(weight, Sum(results.at("reactions").at(name), 2), 1e-6 * weight) << name;
    const json model = json::parse(Done("export f.json"));
    double mass = 0.0;
    for (const json& node : model.at("nodes"))
        if (node.contains("mass")) mass += node.at("mass").at(0).get<double>();
    const double ground = 24.516625 * 6 * 0.5 * 3.5 * 0.16; // lower half of the columns
    EXPECT_NEAR((self - ground + 2 * 32 * 20.0 + 0.3 * 32 * 12.0) / 9.80665, mass, 1e-6 * mass);
    EXPECT_EQ(4U, model.at("modes").size());
    EXPECT_EQ(8U, model.at("pushover").size());
    ExpectHolds(Done("storeys f.json"), {"1F", "2F", "3.5"});
    EXPECT_NE(std::string::npos, Done("push f.json --case 'PX+ uniform'").find("PX+ uniform"));
}

TEST_F(NewModels, ASpectrumIsAddedChangedAndRemoved)
{
    ExpectHolds(Done("spectrum @first-steps"), {"ATC: atc40:Ca=0.4,Cv=0.6", "1.15"});
    Done("spectrum @first-steps --set ec8-2004:soil=B,ag=0.2,name=weak -o a.json");
    Done("spectrum a.json --set ec8-2004:soil=D,ag=0.2,name=weak -o b.json");
    const json spectra = json::parse(Done("export b.json")).at("spectra");
    ASSERT_EQ(4U, spectra.size());
    EXPECT_EQ("D", spectra.at(3).at("soil"));
    Done("spectrum b.json --remove weak -o c.json");
    EXPECT_EQ(3U, json::parse(Done("export c.json")).at("spectra").size());
    ExpectRefused("spectrum a.json --set ec8-2004:soil=F,ag=0.2 -o d.json", 2, "soil");
    ExpectRefused("spectrum a.json --remove weak", 2, "-o");
    ExpectRefused("spectrum a.json --remove ATC -o d.json", 2, "ATC");
}

} // namespace
