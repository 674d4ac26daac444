// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An installation that was moved to another folder works there.

#include "tests/packaging/Installation.h"
#include "tests/support/ExportedNames.h"
#include "tests/tools/ServerProcess.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <csignal>

namespace InstallTests {

using nlohmann::json;
using testing::AllOf;
using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::HasSubstr;
using testing::Not;
using namespace Testing;
namespace fs = std::filesystem;

RunOptions installedTool(std::map<std::string, std::string> environment = {})
{
    return {.program = installedFile("bin/sensorctl"), .environment = std::move(environment)};
}

const std::vector<std::string> providerFiles = {"lib/cmpi/libSensorProfileComputerSystem.so",
    "lib/cmpi/libSensorProfileProvider.so", "sbin/sensor-profile-register",
    "share/doc/sensor-profile-provider/changelog.gz",
    "share/doc/sensor-profile-provider/operations.md", "share/man/man5/sensor-profile-model.5.gz",
    "share/man/man7/sensor-profile.7.gz", "share/man/man8/sensor-profile-register.8.gz",
    "share/sensor-profile/cim-ancestors.mof", "share/sensor-profile/cim-core.mof",
    "share/sensor-profile/qualifiers.mof", "share/sensor-profile/register/libraries.sh",
    "share/sensor-profile/register/openpegasus.sh", "share/sensor-profile/register/sfcb.sh",
    "share/sensor-profile/register/steps.sh",
    "share/sensor-profile/registration/sensor-profile-registration.mof",
    "share/sensor-profile/registration/sensor-profile.reg",
    "share/sensor-profile/sensor-profile-computer-system.mof",
    "share/sensor-profile/sensor-profile-conformance.mof",
    "share/sensor-profile/sensor-profile-model.schema.json",
    "share/sensor-profile/sensor-profile-registered-profile.mof",
    "share/sensor-profile/sensor-profile.mof"};

const std::vector<std::string> toolFiles = {"bin/sensorctl", "etc/sensor-profile/serve.conf",
    "lib/systemd/system/sensor-profile-collect.service",
    "lib/systemd/system/sensor-profile.service", "lib/udev/rules.d/60-sensor-profile-collect.rules",
    "libexec/sensor-profile/sensorctl-collect", "libexec/sensor-profile/sensorctl-serve",
    "share/bash-completion/completions/sensorctl", "share/doc/sensor-profile/changelog.gz",
    "share/doc/sensor-profile/fleet.md", "share/man/man1/sensorctl.1.gz",
    "share/sensor-profile/demo-model.json", "share/sensor-profile/deploy/grafana/fleet.json",
    "share/sensor-profile/deploy/grafana/machine.json",
    "share/sensor-profile/deploy/prometheus/alertmanager.yml",
    "share/sensor-profile/deploy/prometheus/prometheus.yml",
    "share/sensor-profile/deploy/prometheus/rules/alerts.yml",
    "share/sensor-profile/deploy/prometheus/rules/recording.yml",
    "share/sensor-profile/deploy/prometheus/targets/example.yml",
    "share/sensor-profile/deploy/victoria-metrics/remote-write.yml",
    "share/sensor-profile/deploy/victoria-metrics/victoria-metrics.default",
    "share/sensor-profile/host.mof", "share/sensor-profile/interop.mof",
    "share/sensor-profile/sensor-profile-api.openapi.yaml",
    "share/sensor-profile/sensorctl-list.schema.json"};

TEST(InstalledTest, AreTheProviderAndTheTool)
{
    std::vector<std::string> all = providerFiles;
    all.insert(all.end(), toolFiles.begin(), toolFiles.end());
    all.emplace_back("share/doc/sensor-profile-provider/LICENSE");
    const std::string web = "share/sensor-profile/web/";
    std::vector<std::string> served = filesBelow(SENSOR_PROFILE_SOURCE_DIR "/web");
    std::erase(served, "CMakeLists.txt");
    served.emplace_back("dygraph.min.js");
    for (const std::string& name : served)
        all.insert(all.end(), {web + name, web + name + ".gz"});
    std::erase(all, web + "page.html.gz"); // the page is filled in for each request
    all.push_back(web + "dygraphs-copyright.txt");
    std::sort(all.begin(), all.end());
    EXPECT_THAT(filesBelow(movedInstallation()), ElementsAreArray(all));
}

TEST(InstalledTest, ProviderCanBeHadAlone)
{
    const TemporaryFolder folder;
    install({"--component", "provider", "--prefix", folder.path().string()});
    EXPECT_THAT(filesBelow(folder.path()), ElementsAreArray(providerFiles));
}

TEST(InstalledTest, ToolShowsTheDemonstration)
{
    const Ended ended =
        run({"list", "--model", installedFile("share/sensor-profile/demo-model.json")},
            installedTool({{"COLUMNS", "80"}, {"LC_ALL", "C.UTF-8"}}));
    EXPECT_EQ(ended.err, "");
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(
        ended.out, contentOf(SENSOR_PROFILE_SOURCE_DIR "/tests/data/tools/demonstration-list.txt"));
}

TEST(InstalledTest, ServerFindsItsFiles)
{
    const std::string model = installedFile("share/sensor-profile/demo-model.json");
    ServerProcess server({"--model", model}, {}, installedFile("bin/sensorctl"));
    EXPECT_THAT(server.log(), Not(HasSubstr("the page is not installed")));
    EXPECT_EQ(server.end(SIGTERM).code, 0);
}

TEST(InstalledTest, ToolFindsTheCatalogs)
{
    for (const auto& [language, text] :
        std::map<std::string, std::string>{{"de_DE.UTF-8", "Numerischer Sensor"},
            {"fr_FR.UTF-8", "Capteur"}, {"es_ES.UTF-8", "Sensor num"}, {"C", "Numeric sensor"}}) {
        const Ended ended = run({"get", "12 V", "--cim", "--model",
                                    installedFile("share/sensor-profile/demo-model.json")},
            installedTool({{"LC_ALL", language}}));
        ASSERT_EQ(ended.code, 0) << ended.err;
        EXPECT_THAT(
            json::parse(ended.out)["instances"][0]["properties"]["Description"], HasSubstr(text));
    }
}

TEST(InstalledTest, ToolFollowsTheAssociationsThroughBothLibraries)
{
    const Ended ended =
        run({"walk", "--model", installedFile("share/sensor-profile/demo-model.json")},
            installedTool({{"LC_ALL", "C.UTF-8"}}));
    EXPECT_EQ(ended.code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("(ZUMLO_ComputerSystem)"));
    EXPECT_THAT(ended.out, HasSubstr("PSU 2 Fan"));
}

// The name of the folder of libraries differs between distributions.
TEST(InstalledTest, LibrariesAreFoundInEveryFolderOfLibraries)
{
    const TemporaryFolder folder;
    const fs::path prefix = folder.path() / "usr";
    fs::copy(movedInstallation(), prefix, fs::copy_options::recursive);
    fs::create_directory(folder.path() / "bin");
    for (const char* const name : {"cimmof", "cimprovider"})
        fs::create_symlink("/bin/true", folder.path() / "bin" / name);
    fs::path place = prefix / "lib";
    for (const char* const next : {"lib64", "lib/" SENSOR_PROFILE_ARCHITECTURE}) {
        fs::create_directories((prefix / next).parent_path());
        fs::rename(place / "cmpi", prefix / "cmpi");
        fs::create_directories(prefix / next);
        fs::rename(prefix / "cmpi", prefix / next / "cmpi");
        place = prefix / next;
        EXPECT_EQ(
            run({"list", "--model", (prefix / "share/sensor-profile/demo-model.json").string()},
                {.program = (prefix / "bin/sensorctl").string()})
                .code,
            0)
            << next;
        const Ended ended = run({"register", "--dry-run", "--provider-folder", "/"},
            {.program = (prefix / "sbin/sensor-profile-register").string(),
                .environment = {{"PATH", (folder.path() / "bin").string() + ":/usr/bin:/bin"}}});
        EXPECT_THAT(ended.out, HasSubstr("ln -s " + (place / "cmpi").string())) << ended.err;
    }
}

// The service, installed to a prefix below another root (DESTDIR).
class InstalledServiceTest : public testing::Test {
protected:
    void installFor(const std::string& prefix) const
    {
        install(
            {"--component", "tool", "--prefix", prefix}, {{"DESTDIR", folder_.path().string()}});
    }

    std::string content(const std::string& file) const
    {
        return contentOf(folder_.path().string() + file);
    }

    std::vector<std::string> files() const
    {
        std::vector<std::string> found;
        for (const std::string& file : filesBelow(folder_.path()))
            if (file.ends_with(".service") || file.ends_with(".conf") || file.ends_with(".rules"))
                found.push_back("/" + file);
        return found;
    }

    const TemporaryFolder folder_;
    const std::string shippedUnit_ =
        contentOf(SENSOR_PROFILE_SOURCE_DIR "/packaging/sensor-profile.service");
};

TEST_F(InstalledServiceTest, BelowUsrIsTheSystems)
{
    installFor("/usr");
    EXPECT_THAT(files(), ElementsAre("/etc/sensor-profile/serve.conf",
                             "/lib/systemd/system/sensor-profile-collect.service",
                             "/lib/systemd/system/sensor-profile.service",
                             "/lib/udev/rules.d/60-sensor-profile-collect.rules"));
    EXPECT_EQ(content("/etc/sensor-profile/serve.conf"),
        contentOf(SENSOR_PROFILE_SOURCE_DIR "/packaging/serve.conf"));
    EXPECT_EQ(content("/lib/systemd/system/sensor-profile.service"), shippedUnit_);
}

TEST_F(InstalledServiceTest, HasThePathsOfItsPrefix)
{
    for (const auto& [prefix, settings] :
        std::map<std::string, std::string>{{"/usr/local", "/usr/local/etc/sensor-profile"},
            {"/opt/sensors", "/etc/opt/sensors/sensor-profile"},
            {"/srv/sensors", "/srv/sensors/etc/sensor-profile"}}) {
        installFor(prefix);
        EXPECT_THAT(content(prefix + "/lib/systemd/system/sensor-profile.service"),
            AllOf(HasSubstr("\nExecStart=" + prefix + "/bin/sensorctl serve --config " + settings +
                            "/serve.conf\n"),
                HasSubstr("\nPrivateTmp=yes\n")));
        EXPECT_THAT(content(settings + "/serve.conf"),
            AllOf(HasSubstr("#key = " + settings + "/key.pem\n"),
                HasSubstr("#model = " + prefix + "/share/sensor-profile/demo-model.json\n")));
    }
}

// The unit hides home folders from the service.
TEST_F(InstalledServiceTest, IsNotInstalledWhereItCannotStart)
{
    for (const char* const prefix : {"/home/somebody/sensors", "/root/sensors", "/root"})
        installFor(prefix);
    EXPECT_THAT(files(), testing::IsEmpty());
}

// A unit would have to quote the characters of such a prefix.
TEST_F(InstalledServiceTest, IsNotInstalledBelowAnOddPrefix)
{
    for (const char* const prefix : {"/srv/our sensors", "/srv/100%", "/srv/$HOME"})
        installFor(prefix);
    EXPECT_THAT(files(), testing::IsEmpty());
    EXPECT_TRUE(fs::exists(folder_.path() / "srv/our sensors/bin/sensorctl"));
}

TEST_F(InstalledServiceTest, HasWholePathsBelowARelativePrefix)
{
    const std::string prefix = folder_.path().string() + "/relative";
    EXPECT_THAT(outputOf("cd '" + folder_.path().string() +
                         "' && '" SENSOR_PROFILE_CMAKE "' --install '" SENSOR_PROFILE_BINARY_DIR
                         "' --component tool --prefix relative 2>&1"),
        HasSubstr("relative/etc/sensor-profile/serve.conf\n"));
    EXPECT_THAT(content("/relative/lib/systemd/system/sensor-profile.service"),
        HasSubstr("\nExecStart=" + prefix + "/bin/sensorctl serve --config " + prefix +
                  "/etc/sensor-profile/serve.conf\n"));
}

// Several processes, and other users than its owner, can install from one build at the same time.
TEST_F(InstalledServiceTest, IsNotMadeInTheBuild)
{
    const auto inTheBuild = [] {
        std::map<std::string, fs::file_time_type> times;
        const fs::path build = SENSOR_PROFILE_BINARY_DIR "/packaging";
        for (const std::string& file : filesBelow(build))
            times[file] = fs::last_write_time(build / file);
        return times;
    };
    const auto before = inTheBuild();
    installFor("/srv/sensors");
    EXPECT_EQ(inTheBuild(), before);
}

TEST_F(InstalledServiceTest, SeesTheTemporaryFolderThatItIsTriedIn)
{
    installFor("/tmp/sensors");
    EXPECT_THAT(content("/tmp/sensors/lib/systemd/system/sensor-profile.service"),
        HasSubstr("\nPrivateTmp=no\n"));
}

// A script of the test installs it, since the list in the build folder is that of the last
// installation.
TEST_F(InstalledServiceTest, IsInTheListOfWhatIsInstalled)
{
    const std::string script = folder_.write("script.cmake",
        "include(\"" SENSOR_PROFILE_BINARY_DIR "/packaging/cmake_install.cmake\")\n"
        "file(WRITE \"" +
            folder_.path().string() + "/list\" \"${CMAKE_INSTALL_MANIFEST_FILES}\")");
    const TemporaryFolder root;
    const Ended ended =
        run({"-DCMAKE_INSTALL_PREFIX=/usr", "-DCMAKE_INSTALL_COMPONENT=tool", "-P", script},
            {.program = SENSOR_PROFILE_CMAKE, .environment = {{"DESTDIR", root.path().string()}}});
    ASSERT_EQ(ended.code, 0) << ended.err;
    std::string list = contentOf(folder_.path().string() + "/list");
    std::replace(list.begin(), list.end(), ';', '\n');
    std::vector<std::string> installed;
    for (const std::string& file : filesBelow(root.path()))
        installed.push_back("/" + file);
    EXPECT_THAT(linesOf(list), testing::UnorderedElementsAreArray(installed));
    EXPECT_THAT(installed, testing::Contains("/lib/systemd/system/sensor-profile.service"));
}

TEST_F(InstalledServiceTest, HasAUnitThatSystemdUnderstands)
{
    const std::string prefix = folder_.path().string();
    install({"--component", "tool", "--prefix", prefix});
    for (const char* const unit : {"sensor-profile", "sensor-profile-collect"})
        EXPECT_EQ(outputOf("systemd-analyze verify --man=no '" + prefix + "/lib/systemd/system/" +
                           unit + ".service' 2>&1"),
            "");
}

// systemd-analyze rates the exposure, here in tenths. What remains is the network, the host name,
// and addresses that the administrator chooses; of the other service, the device and its owner,
// root.
TEST_F(InstalledServiceTest, IsShutInAsFarAsItCanBe)
{
    for (const auto& [unit, tenths] :
        {std::pair("sensor-profile", "12"), {"sensor-profile-collect", "7"}}) {
        const std::string verdict = outputOf(
            std::string("systemd-analyze security --offline=yes --no-pager --threshold=") + tenths +
            " '" SENSOR_PROFILE_SOURCE_DIR "/packaging/" + unit + ".service' 2>&1 && echo passed");
        EXPECT_THAT(verdict, testing::EndsWith("passed\n"));
    }
}

TEST_F(InstalledServiceTest, LeavesTheSettingsOfTheAdministrator)
{
    installFor("/usr/local");
    folder_.write("usr/local/etc/sensor-profile/serve.conf", "port = 7000\n");
    installFor("/usr/local");
    EXPECT_EQ(content("/usr/local/etc/sensor-profile/serve.conf"), "port = 7000\n");
}

TEST(InstalledTest, NothingNamesTheBuildTheSourcesOrTheFirstPrefix)
{
    for (const std::string& name : filesBelow(movedInstallation())) {
        if (name.ends_with(".service") || name.ends_with(".conf"))
            continue; // the service needs absolute paths
        const std::string content = contentOf(movedInstallation() / name);
        EXPECT_THAT(content.find(SENSOR_PROFILE_BINARY_DIR), std::string::npos) << name;
        EXPECT_THAT(content.find(SENSOR_PROFILE_SOURCE_DIR), std::string::npos) << name;
        EXPECT_THAT(content.find("made/for"), std::string::npos) << name;
    }
}

} // namespace InstallTests
