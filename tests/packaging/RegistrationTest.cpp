// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Compares the registration documents with the table of the embedded object manager.

#include "host/manager/SensorProfile.h"
#include "host/repository/Repository.h"
#include "tests/support/ShippedClasses.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <map>
#include <regex>
#include <set>

namespace RegistrationTests {

using testing::UnorderedElementsAreArray;

const std::string folder = SENSOR_PROFILE_SOURCE_DIR "/schema/registration/";

struct Registration {
    std::string className;
    std::string provider;
    std::string location; // the library without lib and .so
    std::string kinds;
    std::string nameSpaces; // with blanks between them

    auto operator<=>(const Registration&) const = default;
};

void PrintTo(const Registration& each, std::ostream* out)
{
    *out << each.className << " by " << each.provider << " in " << each.location << " ("
         << each.kinds << ", " << each.nameSpaces << ")";
}

// Returns the namespaces that have the class.
std::string nameSpacesOf(const Host::Repository& classes, const std::string& className)
{
    std::string found;
    for (const auto& nameSpace : classes.namespaces())
        if (nameSpace->findClass(className) != nullptr)
            found += (found.empty() ? "" : " ") + nameSpace->name();
    return found;
}

std::vector<Registration> embeddedTable()
{
    const auto classes = Testing::shippedClasses();
    std::vector<Registration> table;
    for (const Host::ProviderRegistration& each :
        Host::registeredProfileProviders("SensorProfileProvider", "SensorProfileComputerSystem")) {
        const std::string kinds = each.servesAssociations ? "instance association" : "instance";
        table.push_back({each.className, each.providerName, each.libraryFile, kinds,
            nameSpacesOf(*classes, each.className)});
    }
    return table;
}

using Properties = std::map<std::string, std::string>;

// Returns the instances in a MOF document by class, with values as written but without quotes.
std::multimap<std::string, Properties> readInstances(const std::string& text)
{
    static const std::regex head(R"(instance of (\w+) \{)");
    static const std::regex property(R"re( +(\w+) = (?:"([^"]*)"|(\{.*\}));.*)re");
    std::multimap<std::string, Properties> instances;
    auto current = instances.end();
    std::smatch match;
    for (const std::string& line : Testing::linesOf(text)) {
        if (std::regex_match(line, match, head))
            current = instances.emplace(match[1], Properties());
        else if (current != instances.end() && std::regex_match(line, match, property))
            current->second[match[1]] = match[2].str() + match[3].str();
        else
            EXPECT_TRUE(line.empty() || line == "};" || line.starts_with("//")) << line;
    }
    return instances;
}

std::vector<Registration> readBlocks(const std::string& text)
{
    static const std::regex head(R"(\[(\w+)\])");
    static const std::regex member(R"( +(\w+): (.*))");
    std::vector<Registration> blocks;
    std::smatch match;
    for (const std::string& line : Testing::linesOf(text)) {
        if (std::regex_match(line, match, head)) {
            blocks.emplace_back().className = match[1];
            continue;
        }
        if (line == "#")
            continue;
        if (blocks.empty() || !std::regex_match(line, match, member)) {
            ADD_FAILURE() << line;
            continue;
        }
        const std::map<std::string, std::string*> members = {{"provider", &blocks.back().provider},
            {"location", &blocks.back().location}, {"type", &blocks.back().kinds},
            {"namespace", &blocks.back().nameSpaces}};
        *members.at(match[1]) = match[2];
    }
    return blocks;
}

TEST(RegistrationFileTest, SaysWhatTheEmbeddedManagerKnows)
{
    EXPECT_THAT(readBlocks(Testing::contentOf(folder + "sensor-profile.reg")),
        UnorderedElementsAreArray(embeddedTable()));
}

TEST(RegistrationMofTest, SaysWhatTheEmbeddedManagerKnows)
{
    const auto instances =
        readInstances(Testing::contentOf(folder + "sensor-profile-registration.mof"));
    const std::map<std::string, std::string> kinds = {
        {"{2}", "instance"}, {"{2, 3}", "instance association"}};
    // OpenPegasus has another name for root/interop.
    const std::map<std::string, std::string> nameSpaces = {{"{\"root/cimv2\"}", "root/cimv2"},
        {"{\"root/PG_InterOp\"}", "root/interop"},
        {"{\"root/cimv2\", \"root/PG_InterOp\"}", "root/cimv2 root/interop"}};

    std::map<std::string, std::string> locations; // by module
    auto [module, lastModule] = instances.equal_range("PG_ProviderModule");
    for (; module != lastModule; ++module) {
        const Properties& properties = module->second;
        EXPECT_TRUE(locations.emplace(properties.at("Name"), properties.at("Location")).second);
        EXPECT_EQ(properties.at("InterfaceType"), "CMPI");
        EXPECT_EQ(properties.at("InterfaceVersion"), "2.0.0");
        EXPECT_EQ(properties.at("Version"), SENSOR_PROFILE_VERSION);
    }
    EXPECT_EQ(locations.size(), 3U);

    std::set<std::pair<std::string, std::string>> providers; // with their modules
    auto [provider, lastProvider] = instances.equal_range("PG_Provider");
    for (; provider != lastProvider; ++provider) {
        const Properties& properties = provider->second;
        EXPECT_TRUE(
            providers.emplace(properties.at("ProviderModuleName"), properties.at("Name")).second);
    }
    EXPECT_EQ(providers.size(), embeddedTable().size());

    std::vector<Registration> registrations;
    auto [each, last] = instances.equal_range("PG_ProviderCapabilities");
    for (; each != last; ++each) {
        const Properties& properties = each->second;
        const std::string name = properties.at("ProviderName");
        const std::string moduleName = properties.at("ProviderModuleName");
        EXPECT_TRUE(providers.contains({moduleName, name})) << name;
        registrations.push_back({properties.at("ClassName"), name, locations.at(moduleName),
            kinds.at(properties.at("ProviderType")), nameSpaces.at(properties.at("Namespaces"))});
    }
    EXPECT_THAT(registrations, UnorderedElementsAreArray(embeddedTable()));
}

std::vector<std::string> matches(const std::string& text, const char* pattern)
{
    const std::regex group(pattern);
    return {std::sregex_token_iterator(text.begin(), text.end(), group, 1), {}};
}

// OpenPegasus replaces a class only by one of another version.
TEST(RegisteredClassesTest, HaveTheVersionOfTheProduct)
{
    for (const std::string name : {"sensor-profile.mof", "sensor-profile-computer-system.mof",
             "sensor-profile-conformance.mof", "sensor-profile-registered-profile.mof"}) {
        const std::string text = Testing::contentOf(SENSOR_PROFILE_SOURCE_DIR "/schema/" + name);
        const auto versions = matches(text, R"re(\bVersion\("([^"]*)"\))re");
        EXPECT_THAT(versions, testing::Each(SENSOR_PROFILE_VERSION)) << name;
        EXPECT_EQ(versions.size(), matches(text, "\nclass (\\w+)").size()) << name;
    }
}

} // namespace RegistrationTests
