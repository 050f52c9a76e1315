// Pictures and tables of results through the program.
#include "program.h"

#include <algorithm>

namespace {

class ViewCommands : public CProgramTest {};

} // namespace

TEST_F(ViewCommands, ReactionsCarryTheLoads)
{
    const json table =
        Json("results @rc-frame-code-hinges --case G --case TRIANGLE --what reactions");
    ASSERT_EQ("FX (kN)", table.at("columns").at(2));
    double up = 0.0, along = 0.0;
    for (const json& row : table.at("rows")) {
        if (row.at(0) == "G") up += row.at(4).get<double>();
        if (row.at(0) == "TRIANGLE") along += row.at(2).get<double>();
    }
    EXPECT_NEAR(4 * 32.6 * 4.6, up, 1e-6); // on the flexible lengths of four beams
    EXPECT_NEAR(-300.0, along, 1e-6);
    ExpectHolds(Done("results @rc-frame-code-hinges --envelope --csv e.csv --xlsx e.xlsx"),
                {"load cases and combinations\n"});
    ExpectHolds(Text("e.csv"), {"Element,Position,Component,Unit,Smallest,in,Largest,in\n",
                                "\n11,member,My,kN*m,"});
    EXPECT_EQ("PK", Text("e.xlsx").substr(0, 2));
}

TEST_F(ViewCommands, PicturesSayWhatTheyShowAndWhatIsNotThere)
{
    Done("picture @rc-frame-code-hinges --case G --what My -o my.svg");
    ExpectHolds(Text("my.svg"), {"moment My", "kN*m", "tension"});
    Done("picture @cable-stayed-bridge --case DEAD --what loads --look iso --perspective -o l.svg");
    ExpectHolds(Text("l.svg"), {"loads"});
    Done("picture @rc-frame-code-hinges --push PX --step 20 --elements 1-4 -o h.svg");
    ExpectHolds(Text("h.svg"), {"step 20 of", "hidden elements"});
    ExpectRefused("picture @rc-frame-code-hinges --mode 1 --what My -o no.svg", 1, "no forces");
    ExpectRefused("picture @rc-frame-code-hinges --case none -o no.svg", 2, "none");
    ExpectRefused("results @rc-frame-code-hinges --case G --elements 999", 2, "999");
    EXPECT_FALSE(std::filesystem::exists(m_folder / "no.svg"));
}

TEST_F(ViewCommands, AnEnvelopeHasTheCombinationsAndFiltersHaveAnEffect)
{
    // Upward loads alone, with the weight turned: their sum lifts most.
    Write("up.json",
          With(ReadText(ExampleCase("tuned-beam")), R"("W", "factor": 1)", R"("W", "factor": -1)"));
    Done("results up.json --envelope --what displacements --csv up.csv");
    const auto lines = Lines(Text("up.csv"));
    EXPECT_EQ(4, std::ranges::count_if(lines, [](const std::string& line) {
                  return line.find(",DZ,m,") == 1 && line.ends_with(",ALL");
              }));
    ExpectHolds(Done("results up.json --envelope"),
                {"Envelope over 6 load cases and combinations\n"});
    // 3 rigid floors of 3 by 3 nodes, 12 beams each; the columns lie in none.
    const char* const rigid = "36 members lie between nodes of one rigid diaphragm";
    ExpectHolds(Done("results @space-frame-3d"), {rigid});
    ExpectHolds(Done("picture @space-frame-3d --case G --what N -o n.svg"), {rigid});
    const json modes = Json("results @space-frame-3d --mode 1 --what displacements");
    EXPECT_EQ("DX (-)", modes.at("columns").at(2));
    EXPECT_EQ("RZ (rad/m)", modes.at("columns").at(7));
    ExpectRefused("results @rc-frame-code-hinges --case G --nodes 1", 2, "--nodes");
    ExpectRefused("results @rc-frame-code-hinges --what reactions --elements 1", 2, "--elements");
    ExpectRefused("results @rc-frame-code-hinges --what displacements --case G --mode 1", 1,
                  "mode");
    for (const char* option : {"--scale nan", "--size nan", "--scale inf", "--size -nan"})
        ExpectRefused("picture @rc-frame-code-hinges --case G -o no.svg " + std::string(option), 2,
                      "no number");
    EXPECT_FALSE(std::filesystem::exists(m_folder / "no.svg"));
}
