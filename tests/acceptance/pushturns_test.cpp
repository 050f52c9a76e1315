// Evaluations of a load case that its static angle has pushed in several directions.
#include "pushcase.h"

namespace {

class PushTurns : public CPushTest {
protected:
    /// The building with PX in steps of 90 degrees ("P"), and PY as it stands.
    static json Building()
    {
        json file = json::parse(ReadText(ExampleCase("eccentric-building")));
        json& pushes = file["pushover"];
        pushes.erase(pushes.begin() + 2, pushes.end());
        for (json& push : pushes)
            push.erase("stops");
        pushes[0]["name"] = "P";
        pushes[0]["control"]["generate_static_angle"] = true;
        pushes[0]["control"]["static_angle"] = 90;
        json evaluation = file["evaluations"][0];
        file["pushover_control"]["steps"] = 50; // too few: drops of strength fall between them
        file["evaluations"] = json::array();
        for (const char* const push : {"P", "PY", "P@90"}) {
            evaluation["name"] = std::string("of ") + push;
            evaluation["push"] = push;
            file["evaluations"].push_back(evaluation);
        }
        return file;
    }
};

void ExpectSame(const json& a, const json& b)
{
    for (const char* const key : {"gamma", "alpha", "mass"})
        EXPECT_NEAR(a.at("factors").at(key).get<double>(), b.at("factors").at(key), 1e-9) << key;
    for (std::size_t i = 0; i < 3; ++i)
        EXPECT_NEAR(a.at("limit_states")[i].at("demand").get<double>(),
                    b.at("limit_states")[i].at("demand"), 1e-9);
    ASSERT_EQ(a.at("hinges_at").size(), b.at("hinges_at").size());
    ASSERT_FALSE(a["hinges_at"].empty());
    for (std::size_t i = 0; i < a["hinges_at"].size(); ++i) {
        const json &at = a["hinges_at"][i], &other = b["hinges_at"][i];
        EXPECT_EQ(at.at("states"), other.at("states"));
        for (std::size_t k = 0; k < 3; ++k)
            for (const char* const key : {"drift", "shear"})
                EXPECT_NEAR(at.at("storeys")[k].at(key).get<double>(),
                            other.at("storeys")[k].at(key), 1e-6)
                    << key;
    }
}

TEST_F(PushTurns, EveryDirectionIsEvaluated)
{
    Write("c.json", Building().dump(1));
    const json all = Json("evaluate c.json");
    ASSERT_EQ(5U, all.size());
    const char* const pushes[] = {"P@90", "P@180", "P@270", "PY", "P@90"};
    for (std::size_t i = 0; i < 5; ++i)
        EXPECT_EQ(pushes[i], all[i].at("push"));
    EXPECT_EQ("of P, P@180", all[1].at("name"));
    ExpectSame(all[0], all[3]); // 90 degrees from X is Y
    ExpectSame(all[4], all[3]);
    EXPECT_EQ(all[3].at("messages"), all[0].at("messages"));
    ExpectHolds(all[0].at("messages").dump(), {"miss a vertex"});
    EXPECT_NE(all[0]["limit_states"][0]["demand"], all[1]["limit_states"][0]["demand"]);
    const auto at = [](const char* angle) { // the sign itself stands for an example's name
        return std::string("$(printf 'P\\100") + angle + "')";
    };
    const json one = Json("evaluate c.json --push " + at("180"));
    ASSERT_EQ(1U, one.size());
    EXPECT_EQ(all[1].at("target"), one[0].at("target"));
    EXPECT_EQ(3U, Json("evaluate c.json --only \"of P\"").size());
    ExpectRefused("evaluate c.json --push " + at("45"), 2, "P@45");
    const T_RUN compared = Run("compare c.json --push " + at("90") + " --spectrum \"EC8 soil C\"");
    EXPECT_EQ(1, compared.code); // ATC-40 A finds no point
    ExpectHolds(compared.out, {"EC8 SD"});
    Done("push c.json -o m.qmdb");
    ExpectHolds(Done("info m.qmdb"),
                {"P@90 ended at 0.25 m", "P@180 ended at 0.25 m", "P@270 ended at 0.25 m"});
    ExpectHolds(Done("push m.qmdb --case P --hinges " + at("270")), {"Hinges of P@270"});
}

TEST_F(PushTurns, NamesOfDirectionsAreThoseOfTheAngle)
{
    json file = Building();
    file["evaluations"][2]["push"] = "P@45";
    Write("c.json", file.dump(1));
    ExpectRefused("evaluate c.json", 3, "P@45");
}

} // namespace
