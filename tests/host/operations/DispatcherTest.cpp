// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The arguments of provider calls for an operation, and the responses from their results.

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "tests/host/operations/ScriptedManager.h"

#include <vector>

namespace OperationTests {

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

std::vector<std::string> listed(const char** names)
{
    if (names == nullptr)
        return {"all"};
    std::vector<std::string> list;
    for (; *names != nullptr; ++names)
        list.emplace_back(*names);
    return list;
}

std::string list(const std::vector<std::string>& names)
{
    std::string values;
    for (const std::string& name : names)
        values += "<VALUE>" + name + "</VALUE>";
    return parameter("PropertyList", "<VALUE.ARRAY>" + values + "</VALUE.ARRAY>");
}

class DispatcherTest : public testing::Test {
protected:
    // Passes the calls of the provider to a function of the test.
    void onThings(const std::function<void(const ProviderCall&)>& look)
    {
        manager_.script("Things", [this, look](const ProviderCall& asked) {
            look(asked);
            ++calls_;
            return manager_.deliver(asked, "Thing", "a");
        });
    }

    std::string ask(const std::string& operation, const std::string& parameters)
    {
        const std::string answer = answerTo(*manager_, call(operation, parameters));
        EXPECT_EQ(errorIn(answer), "");
        return answer;
    }

    ScriptedManager manager_;
    int calls_ = 0;
    const std::string ofThing_ = classOf("ClassName", "Thing");
};

TEST_F(DispatcherTest, PropertyListsArriveSpelledAsDeclaredAndWithoutWhatSaysNothing)
{
    std::vector<std::vector<std::string>> seen;
    onThings([&seen](const ProviderCall& asked) { seen.push_back(listed(asked.properties)); });
    const std::string name = parameter("InstanceName", thing());
    ask("GetInstance", name);
    ask("GetInstance", name + list({}));
    ask("GetInstance", name + list({"label", "Unheard", "LABEL", "unheard"}));
    ask("GetInstance", name + list({"Unheard", "Unseen"}));
    ask("GetInstance", name + list({"since", "LABEL", "Since"}));
    ask("GetProperty", name + valueOf("PropertyName", "ISON"));
    EXPECT_THAT(
        seen, ElementsAre(ElementsAre("all"), ElementsAre(), ElementsAre("Label"),
                  ElementsAre("Unheard"), ElementsAre("Since", "Label"), ElementsAre("IsOn")));
}

TEST_F(DispatcherTest, WithoutDeepInheritanceTheListEndsWithTheClass)
{
    std::vector<std::vector<std::string>> seen;
    onThings([&seen](const ProviderCall& asked) { seen.push_back(listed(asked.properties)); });
    const std::string flat = ofThing_ + valueOf("DeepInheritance", "FALSE");
    ask("EnumerateInstances", flat);
    ask("EnumerateInstances", flat + list({"Percent", "Label"}));
    ask("OpenEnumerateInstances", flat + list({"Percent"}) + valueOf("MaxObjectCount", "1"));
    EXPECT_THAT(seen,
        ElementsAre(ElementsAre("Name", "Index", "Label", "IsOn", "Levels", "Since", "Reading"),
            ElementsAre("Label"), ElementsAre()));
}

TEST_F(DispatcherTest, AClassWithoutSubclassesLeavesNothingOut)
{
    manager_.script("Gauges", [this](const ProviderCall& asked) {
        EXPECT_EQ(asked.properties, nullptr);
        ++calls_;
        return ok;
    });
    ask("EnumerateInstances", classOf("ClassName", "Gauge") + valueOf("DeepInheritance", "FALSE"));
    EXPECT_EQ(calls_, 1);
}

TEST_F(DispatcherTest, TheFiltersOfAssociationsArrive)
{
    manager_.script("Links", [this](const ProviderCall& asked) {
        EXPECT_STREQ(asked.role, "Owner");
        if (asked.operation.starts_with("associator")) {
            EXPECT_STREQ(asked.resultRole, "Part");
        }
        ++calls_;
        return ok;
    });
    const std::string source = thing();
    const std::string associators = classOf("AssocClass", "Link") + valueOf("Role", "Owner") +
                                    valueOf("ResultRole", "Part") +
                                    classOf("ResultClass", "Single");
    const std::string references = classOf("ResultClass", "Link") + valueOf("Role", "Owner");
    for (const char* const operation : {"Associators", "AssociatorNames"})
        ask(operation, parameter("ObjectName", source) + associators);
    for (const char* const operation : {"OpenAssociatorInstances", "OpenAssociatorInstancePaths"})
        ask(operation, parameter("InstanceName", source) + associators);
    for (const char* const operation : {"References", "ReferenceNames"})
        ask(operation, parameter("ObjectName", source) + references);
    for (const char* const operation : {"OpenReferenceInstances", "OpenReferenceInstancePaths"})
        ask(operation, parameter("InstanceName", source) + references);
    EXPECT_EQ(calls_, 8);
}

TEST_F(DispatcherTest, APathWithoutHostGetsTheManagersAndItsNamespace)
{
    manager_.deliverThings(1);
    const std::string answer =
        ask("OpenEnumerateInstancePaths", ofThing_ + valueOf("MaxObjectCount", "5"));
    EXPECT_THAT(answer, HasSubstr("<NAMESPACEPATH><HOST>host.example</HOST><LOCALNAMESPACEPATH>"
                                  "<NAMESPACE NAME=\"root\"></NAMESPACE>"
                                  "<NAMESPACE NAME=\"test\"></NAMESPACE>"));
}

TEST_F(DispatcherTest, ThePathsHostIsNamedAsItIsNow)
{
    manager_.deliverThings(1);
    manager_.renameHost("renamed.example");
    EXPECT_THAT(ask("OpenEnumerateInstancePaths", ofThing_ + valueOf("MaxObjectCount", "5")),
        HasSubstr("<HOST>renamed.example</HOST>"));
}

} // namespace

} // namespace OperationTests
