// Pushes that can't do what was asked: what does not push, stops that can't act.
#include "pushcase.h"

namespace {

class PushWarns : public CPushTest {
protected:
    std::string Refused(const json& file) const
    {
        Write("c.json", file.dump(1));
        return ExpectRefused("push c.json", 3, "\"P\"");
    }
};

/// Every load at a node as it is, times this.
json Turned(json file, double alongX, double alongY)
{
    for (json& load : file["load_cases"][0]["nodal"])
        load["load"] = {alongX * load["load"][0].get<double>(),
                        alongY * load["load"][0].get<double>(),
                        0,
                        0,
                        0,
                        0};
    return file;
}

TEST_F(PushWarns, RefusesLoadsThatDoNotPush)
{
    const json file = Data("pc_two_storey");
    json cancels = file;
    cancels["load_cases"].push_back(file["load_cases"][0]);
    cancels["load_cases"][1]["name"] = "again";
    json& rows = cancels["pushover"][0]["patterns"];
    rows.push_back(rows[0]);
    rows[0]["factor"] = 0.3;
    rows[1]["factor"] = -0.1 * 3.0; // 0.3 but for rounding
    rows[1]["number"] = 2;
    ExpectHolds(Refused(cancels), {"cancel each other"});
    for (const double rounding : {0.0, 6e-17}) // the cosine of 90 degrees
        ExpectHolds(Refused(Turned(file, rounding, 1.0)), {"DX", "choose the direction"});
    // A small part is a push; upwards 1000 times as much takes the columns out of balance with DX.
    Write("c.json", Turned(file, 1.0, 1e-3).dump(1));
    EXPECT_EQ("reached", Json("push c.json")[0].at("status"));
    json byLoad = Turned(file, 0.0, 1.0);
    byLoad["pushover"][0]["control"] = {{"increment_method", "force"}};
    Write("c.json", byLoad.dump(1));
    EXPECT_EQ("reached", Json("push c.json")[0].at("status"));
}

TEST_F(PushWarns, SaysThatAPushIsElastic)
{
    const json file = Data("pc_two_storey");
    json left = file, none = file;
    left["hinge_types"].push_back(file["hinge_types"][0]);
    left["hinge_types"].back()["name"] = "spare";
    left["pushover_control"]["hinge_types"] = {"spare"};
    none.erase("hinges");
    for (const auto& [model, text] :
         {std::pair{left, "No hinge acts: the push is elastic"},
          std::pair{none, "The model has no hinges: the push is elastic"}}) {
        Write("c.json", model.dump(1));
        for (const char* const command : {"push c.json", "case check c.json"})
            ExpectHolds(Done(command), {text});
        ExpectHolds(Json("push c.json")[0].at("warnings").at(0), {text});
    }
}

TEST_F(PushWarns, RefusesStoreysFromTopToBottom)
{
    json file = Data("pc_two_storey");
    std::swap(file["storeys"][0], file["storeys"][1]);
    const char* const text = "\"S1\" stands lower than \"S2\"";
    ExpectHolds(Refused(file), {text});
    const T_RUN check = Run("case check c.json");
    EXPECT_EQ(1, check.code);
    ExpectHolds(check.out, {text, "1 findings"});
}

TEST_F(PushWarns, SaysWhichStopsCantAct)
{
    json file = Data("pc_two_storey"); // without acceptance criteria
    file["pushover"][0]["stops"] = {{"drift", 0.03}, {"state", "LS"}};
    const json storeys = file["storeys"];
    file.erase("storeys");
    Write("c.json", file.dump(1));
    const std::initializer_list<const char*> both = {"stops.drift: ", "no storeys",
                                                     "stops.state: ", "acceptance criteria"};
    for (const char* const command : {"push c.json", "push setup c.json", "case check c.json"})
        ExpectHolds(Done(command), both);
    EXPECT_EQ(2U, Json("push c.json")[0].at("warnings").size());
    EXPECT_EQ(2U, Json("push setup c.json").at("pushover")[0].at("warnings").size());
    ExpectHolds(Done("case check c.json"), {"0 findings", "2 warnings"});

    file["storeys"] = storeys;
    file["pushover"][0]["stops"] = {{"drift", 0.03}};
    Write("c.json", file.dump(1));
    EXPECT_FALSE(Json("push c.json")[0].contains("warnings"));
    for (const double fraction : {0.0, 1.0, 1.5}) {
        file["pushover"][0]["stops"] = {{"fraction_of_peak", fraction}};
        Write("c.json", file.dump(1));
        ExpectRefused("push c.json", 3, "between 0 and 1");
    }
}

} // namespace
