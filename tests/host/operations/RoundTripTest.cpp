// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// GetInstance returns an object for every path in a response.

#include "tests/host/operations/ShippedManager.h"

#include <set>
#include <vector>

namespace OperationTests {

namespace {

constexpr std::string_view startOfName = "<INSTANCENAME ";
constexpr std::string_view endOfName = "</INSTANCENAME>";

// Returns the instance names in the text, without those nested in others.
std::vector<std::string> namesIn(const std::string& text)
{
    std::vector<std::string> names;
    for (auto from = text.find(startOfName); from != std::string::npos;) {
        auto to = from;
        for (int depth = 0;;) {
            const auto begin = text.find(startOfName, to);
            const auto end = text.find(endOfName, to);
            depth += begin < end ? 1 : -1;
            to = begin < end ? begin + startOfName.size() : end + endOfName.size();
            if (depth == 0)
                break;
        }
        names.push_back(text.substr(from, to - from));
        from = text.find(startOfName, to);
    }
    return names;
}

// Returns the text without instances, whose properties may contain paths.
std::string withoutInstances(std::string text)
{
    constexpr std::string_view last = "</INSTANCE>";
    for (auto at = text.find("<INSTANCE "); at != std::string::npos; at = text.find("<INSTANCE "))
        text.erase(at, text.find(last, at) + last.size() - at);
    return text;
}

class RoundTripTest : public testing::Test {
protected:
    std::string ask(const std::string& operation, const std::string& parameters)
    {
        return askIn(nameSpace_, operation, parameters);
    }

    std::string askIn(
        const std::string& nameSpace, const std::string& operation, const std::string& parameters)
    {
        const std::string answer = answerTo(*manager_, callIn(nameSpace, operation, parameters));
        EXPECT_EQ(errorIn(answer), "") << operation << ' ' << parameters;
        return answer;
    }

    // Returns the paths of the objects in the response. Expects GetInstance to find each of them,
    // and those in properties.
    std::vector<std::string> found(const std::string& operation, const std::string& parameters)
    {
        const std::string answer = ask(operation, parameters);
        for (const std::string& name : namesIn(answer))
            expectFound(name);
        std::vector<std::string> names = namesIn(withoutInstances(answer));
        EXPECT_FALSE(names.empty()) << operation;
        return names;
    }

    void expectFound(const std::string& name)
    {
        const std::string className = between(name, "CLASSNAME=\"", "\"");
        EXPECT_EQ(
            countOf(askIn(nameSpaceOf(className), "GetInstance", parameter("InstanceName", name)),
                "<INSTANCE CLASSNAME=\"" + className + "\">"),
            1U)
            << name;
        tried_.insert(className);
    }

    // Returns the namespace of the request, unless an association can lead from it to the class.
    std::string nameSpaceOf(const std::string& className) const
    {
        if (className == "ZUMLO_SensorRegisteredProfile")
            return "root/interop";
        return className == "ZUMLO_NumericSensor" ? "root/cimv2" : nameSpace_;
    }

    void followFrom(const std::string& source)
    {
        for (const char* const operation :
            {"Associators", "AssociatorNames", "References", "ReferenceNames"})
            found(operation, parameter("ObjectName", source));
        for (const char* const operation :
            {"OpenAssociatorInstances", "OpenAssociatorInstancePaths", "OpenReferenceInstances",
                "OpenReferenceInstancePaths"})
            found(operation, parameter("InstanceName", source) + valueOf("MaxObjectCount", "100"));
    }

    ShippedManager manager_;
    std::string nameSpace_ = "root/cimv2";
    std::set<std::string> tried_; // the classes of these paths
};

TEST_F(RoundTripTest, PathsOfEnumerations)
{
    for (const char* const root : {"CIM_ManagedElement", "CIM_Component", "CIM_ElementCapabilities",
             "CIM_ElementConformsToProfile"}) {
        const std::string whole = classOf("ClassName", root);
        const auto names = found("EnumerateInstanceNames", whole);
        EXPECT_EQ(found("EnumerateInstances", whole), names);
        const std::string atOnce = whole + valueOf("MaxObjectCount", "100");
        EXPECT_EQ(found("OpenEnumerateInstances", atOnce), names);
        EXPECT_EQ(found("OpenEnumerateInstancePaths", atOnce), names);
    }
    EXPECT_EQ(tried_.size(), 7U);
}

TEST_F(RoundTripTest, PathsOfWhatIsAssociated)
{
    for (const std::string& source :
        found("EnumerateInstanceNames", classOf("ClassName", "CIM_ManagedElement")))
        followFrom(source);
    EXPECT_EQ(tried_.size(), 7U);
}

TEST_F(RoundTripTest, PathsThatArePulled)
{
    const std::string opened = ask("OpenEnumerateInstances",
        classOf("ClassName", "CIM_ManagedElement") + valueOf("MaxObjectCount", "0"));
    const std::string pulled = ask("PullInstancesWithPath",
        valueOf("EnumerationContext", contextIn(opened)) + valueOf("MaxObjectCount", "100"));
    EXPECT_TRUE(isEndOfSequence(pulled));
    const auto names = namesIn(pulled);
    EXPECT_EQ(names.size(), 5U);
    for (const std::string& name : names)
        expectFound(name);
}

TEST_F(RoundTripTest, PathsOfTheObjectManagerItself)
{
    nameSpace_ = "root/interop";
    const std::string whole = classOf("ClassName", "CIM_ManagedElement");
    const auto names = found("EnumerateInstanceNames", whole);
    EXPECT_EQ(names.size(), 4U);
    EXPECT_EQ(found("EnumerateInstances", whole), names);
    EXPECT_EQ(tried_.size(), 3U);
}

TEST_F(RoundTripTest, PathsFromTheProfileToItsSensors)
{
    nameSpace_ = "root/interop";
    const std::string profiles = classOf("ClassName", "CIM_RegisteredProfile");
    for (const std::string& profile : found("EnumerateInstanceNames", profiles))
        followFrom(profile);
    EXPECT_EQ(tried_.size(), 3U);
}

} // namespace

} // namespace OperationTests
