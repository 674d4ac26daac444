// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The RPM packages: their content, and their installation below a root of their own.

#include "tests/support/Requirement.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <unistd.h>

#include <regex>
#include <set>

namespace RpmTests {

using testing::AllOf;
using testing::Contains;
using testing::ContainsRegex;
using testing::Each;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;
using namespace Testing;
namespace fs = std::filesystem;

const std::string provider = "sensor-profile-provider";
const std::string tool = "sensor-profile";
const std::string settings = "etc/sensor-profile/serve.conf";

// Runs a command of the shell. rpm and rpmlint keep files of their own in the home folder.
Ended shell(const std::string& command)
{
    static const TemporaryFolder home;
    return run(
        {"-c", command}, {.program = "/bin/sh", .environment = {{"HOME", home.path().string()}}});
}

// Makes the packages of a release, with a restrictive umask.
class Packages {
public:
    explicit Packages(const std::string& release) : release_(release)
    {
        const Ended made =
            shell("umask 077 && '" SENSOR_PROFILE_CPACK "' -G RPM -D CPACK_RPM_PACKAGE_RELEASE=" +
                  release + " --config '" SENSOR_PROFILE_BINARY_DIR "/CPackConfig.cmake' -B '" +
                  folder_.path().string() + "'");
        if (made.code != 0)
            throw std::runtime_error(made.out + made.err);
    }

    std::string file(const std::string& package) const
    {
        return (folder_.path() / (package + "-" SENSOR_PROFILE_VERSION "-" + release_ + "." +
                                     SENSOR_PROFILE_PROCESSOR ".rpm"))
            .string();
    }

    std::string files() const { return file(provider) + " " + file(tool); }

private:
    TemporaryFolder folder_;
    std::string release_;
};

const Packages& packages()
{
    static const Packages packages("1");
    return packages;
}

std::vector<std::string> query(const std::string& package, const std::string& options)
{
    const Ended ended = shell("rpm -qp " + options + " " + packages().file(package));
    EXPECT_EQ(ended.code, 0) << ended.err;
    return linesOf(ended.out);
}

TEST(RpmTest, HasNothingForRpmlintToReport)
{
    const Ended ended =
        shell("rpmlint --config '" SENSOR_PROFILE_SOURCE_DIR "/tests/packaging/rpmlint.toml' " +
              packages().files());
    EXPECT_THAT(
        ended.out, HasSubstr("2 packages and 0 specfiles checked; 0 errors, 0 warnings, 0 badness"))
        << ended.err;
}

TEST(RpmTest, HasTheFoldersOfRpmDistributions)
{
    EXPECT_THAT(query(provider, "--list"),
        AllOf(Contains("/usr/lib64/cmpi/libSensorProfileProvider.so"),
            Contains("/usr/lib64/cmpi/libSensorProfileComputerSystem.so"),
            Contains("/usr/share/man/man8/sensor-profile-register.8.gz"),
            Not(Contains(StartsWith("/usr/lib/")))));
    EXPECT_THAT(query(tool, "--list"),
        AllOf(Contains("/usr/lib/systemd/system/sensor-profile.service"),
            Contains("/usr/lib/systemd/system/sensor-profile-collect.service"),
            Contains("/usr/lib/udev/rules.d/60-sensor-profile-collect.rules"),
            Contains("/usr/lib/sysusers.d/sensor-profile.conf"),
            Contains("/usr/share/man/man1/sensorctl.1.gz"), Not(Contains(StartsWith("/lib")))));
    EXPECT_THAT(query(tool, "--configfiles"), ElementsAre("/" + settings));
    for (const std::string& package : {provider, tool})
        EXPECT_THAT(query(package, "--licensefiles"),
            ElementsAre("/usr/share/licenses/" + package + "/LICENSE"));
}

// A folder belongs to the package that makes it, and those of the system to packages of the system.
TEST(RpmTest, OwnsItsFolders)
{
    const std::string folders = "--queryformat '[%{FILEMODES:perms} %{FILENAMES}\\n]' ";
    const auto of = [&](const std::string& package) {
        std::vector<std::string> names;
        for (const std::string& line : query(package, folders))
            if (line.starts_with("d") && line.find("/.build-id") == std::string::npos)
                names.push_back(line.substr(line.find(' ') + 1));
        return names;
    };
    EXPECT_THAT(of(provider),
        ElementsAre("/usr/lib64/cmpi", "/usr/share/doc/sensor-profile-provider",
            "/usr/share/licenses/sensor-profile-provider", "/usr/share/sensor-profile",
            "/usr/share/sensor-profile/register", "/usr/share/sensor-profile/registration"));
    EXPECT_THAT(of(tool),
        ElementsAre("/etc/sensor-profile", "/usr/libexec/sensor-profile",
            "/usr/share/bash-completion", "/usr/share/bash-completion/completions",
            "/usr/share/doc/sensor-profile", "/usr/share/licenses/sensor-profile",
            "/usr/share/sensor-profile/deploy", "/usr/share/sensor-profile/deploy/grafana",
            "/usr/share/sensor-profile/deploy/prometheus",
            "/usr/share/sensor-profile/deploy/prometheus/rules",
            "/usr/share/sensor-profile/deploy/prometheus/targets",
            "/usr/share/sensor-profile/deploy/victoria-metrics", "/usr/share/sensor-profile/web",
            "/usr/share/sensor-profile/web/languages", "/usr/share/sensor-profile/web/styles"));
}

TEST(RpmTest, BelongsToRootAndCanBeReadByEverybody)
{
    for (const std::string& package : {provider, tool}) {
        const auto entries = query(package, "--queryformat '[%{FILEMODES:perms} %{FILEUSERNAME} "
                                            "%{FILEGROUPNAME} %{FILENAMES}\\n]'");
        EXPECT_GT(entries.size(), 10U);
        for (const std::string& entry : entries)
            EXPECT_THAT(
                entry, ContainsRegex("^(drwxr-xr-x|lrwxrwxrwx|-rw[x-]r-[x-]r-[x-]) root root /"));
    }
}

TEST(RpmTest, ProvidesNoLibraries)
{
    for (const std::string& package : {provider, tool})
        EXPECT_THAT(query(package, "--provides"), Not(Contains(HasSubstr(".so"))));
}

// The library and sensorctl contain a copy of libsensors.
TEST(RpmTest, NamesTheVersionOfLibsensors)
{
    const std::string version =
        outputOf("dpkg-query --show --showformat='${source:Upstream-Version}' "
                 "libsensors-dev");
    EXPECT_NE(version, "");
    for (const std::string& package : {provider, tool})
        EXPECT_THAT(query(package, "--provides"), Contains("bundled(lm_sensors) = " + version));
}

TEST(RpmTest, SuggestsWhatTheDebianPackagesSuggest)
{
    EXPECT_THAT(query(tool, "--suggests"), ElementsAre("lm_sensors", "sblim-wbemcli"));
}

TEST(RpmTest, HasTheVersionOfItsLogOfChanges)
{
    for (const std::string& package : {provider, tool})
        EXPECT_THAT(
            query(package, "--changelog").at(0), HasSubstr(" - " SENSOR_PROFILE_VERSION "-1"));
}

// A root with programs and libraries of this machine, as one package.
class RpmRootTest : public testing::Test {
protected:
    void SetUp() override
    {
        if (::geteuid() != 0)
            return cannotRun("only root can run the scripts of RPM packages in another root");
        static const TemporaryFolder system;
        static const Ended made = shell(
            "'" SENSOR_PROFILE_SOURCE_DIR "/tests/packaging/rpm-system' " + system.path().string() +
            " " + sensorctl + " " + sensorctl + "-serve " + sensorLibrary + " " + systemLibrary);
        ASSERT_EQ(made.code, 0) << made.out << made.err;
        rpm("-i " + (system.path() / "system.rpm").string());
        before_ = entries();
    }

    Ended tryRpm(const std::string& arguments) const
    {
        return shell("rpm --root '" + root_.path().string() +
                     "' --dbpath /var/lib/rpm --noplugins --force-debian " + arguments);
    }

    // Expects that rpm succeeds and reports nothing but new users. Returns its output.
    std::string rpm(const std::string& arguments) const
    {
        const Ended ended = tryRpm(arguments);
        EXPECT_EQ(ended.code, 0) << arguments;
        EXPECT_THAT(linesOf(ended.err), Each(StartsWith("Creating "))) << arguments;
        return ended.out;
    }

    std::string inRoot(const std::string& command) const
    {
        const Ended ended =
            run({root_.path().string(), "/bin/sh", "-c", command}, {.program = "/usr/sbin/chroot"});
        EXPECT_EQ(ended.code, 0) << command << ": " << ended.err;
        return ended.out;
    }

    bool isEnabled() const
    {
        return fs::is_symlink(
            root_.path() / "etc/systemd/system/multi-user.target.wants/sensor-profile.service");
    }

    // Returns the calls of systemctl and udevadm since the last time.
    std::vector<std::string> calls() const
    {
        const fs::path file = root_.path() / "calls";
        std::vector<std::string> lines = linesOf(contentOf(file));
        fs::remove(file);
        return lines;
    }

    // Returns the files and folders that the packages brought, without those of rpm and the lists
    // of users.
    std::set<std::string> newEntries() const
    {
        static const std::regex others("var/lib/rpm/.*|calls|etc/\\.pwd\\.lock|"
                                       "etc/g?(passwd|group|shadow)-?");
        std::set<std::string> found;
        for (const std::string& entry : entries())
            if (!before_.contains(entry) && !std::regex_match(entry, others))
                found.insert(entry);
        return found;
    }

    const TemporaryFolder root_;

private:
    std::set<std::string> entries() const
    {
        std::set<std::string> found;
        for (const fs::directory_entry& entry : fs::recursive_directory_iterator(root_.path()))
            found.insert(entry.path().lexically_relative(root_.path()).string());
        return found;
    }

    std::set<std::string> before_;
};

TEST_F(RpmRootTest, WorksOnceItIsInstalled)
{
    rpm("-i " + packages().files());
    EXPECT_EQ(rpm("-V " + provider + " " + tool), "");
    const fs::path usr = root_.path() / "usr";
    EXPECT_EQ(run({"list", "--model", usr / "share/sensor-profile/demo-model.json"},
                  {.program = usr / "bin/sensorctl",
                      .environment = {{"COLUMNS", "80"}, {"LC_ALL", "C.UTF-8"}}})
                  .out,
        contentOf(SENSOR_PROFILE_SOURCE_DIR "/tests/data/tools/demonstration-list.txt"));
    EXPECT_THAT(inRoot("sensor-profile-register --help"), HasSubstr("register"));
}

TEST_F(RpmRootTest, NeedsTheLibrariesThatItLoads)
{
    rpm("-e system");
    const std::string missing = tryRpm("-i " + packages().files()).err;
    for (const std::string name : {"libfmt\\.so[^ ]*", "libsystemd\\.so[^ ]*", "/usr/bin/find"})
        EXPECT_THAT(missing, ContainsRegex("\t" + name + " is needed by sensor-profile-provider-"));
    for (const std::string name :
        {"libmicrohttpd\\.so[^ ]*", "libprometheus-cpp-core\\.so[^ ]*", "systemd"})
        EXPECT_THAT(missing, ContainsRegex("\t" + name + " is needed by sensor-profile-[0-9]"));
}

TEST_F(RpmRootTest, ToolNeedsTheProviderOfItsBuild)
{
    EXPECT_NE(tryRpm("-i " + packages().file(tool)).code, 0);
    rpm("-i " + packages().file(provider));
    EXPECT_THAT(newEntries(), Not(Contains("usr/bin/sensorctl")));
    rpm("-i " + packages().file(tool));
    EXPECT_NE(tryRpm("-e " + provider).code, 0);
}

TEST_F(RpmRootTest, ServiceHasAUserAndIsNotStarted)
{
    rpm("-i " + packages().files());
    EXPECT_THAT(contentOf(root_.path() / "etc/passwd"),
        ContainsRegex("sensor-profile:[^\n]*:Sensor profile service:[^\n]*/nologin\n"));
    EXPECT_FALSE(isEnabled());
    EXPECT_THAT(calls(), ElementsAre("--no-reload preset sensor-profile.service", "daemon-reload",
                             "udevadm control --reload", "udevadm trigger --subsystem-match=ipmi"));
}

TEST_F(RpmRootTest, ServiceIsEnabledWhereTheDistributionPresetsIt)
{
    std::ofstream(root_.path() / "usr/lib/systemd/system-preset/50-own.preset")
        << "enable sensor-profile.service\n";
    rpm("-i " + packages().files());
    EXPECT_TRUE(isEnabled());
}

TEST_F(RpmRootTest, InstallsWhereSystemdDoesNotRun)
{
    for (const char* const program : {"systemctl", "systemd-sysusers", "udevadm"})
        std::ofstream(root_.path() / "usr/bin" / program) << "#!/bin/sh\nexit 1\n";
    rpm("-i " + packages().files());
    rpm("-e " + provider + " " + tool);
    EXPECT_THAT(newEntries(), IsEmpty());
}

TEST_F(RpmRootTest, UpgradeKeepsSettingsAndRestartsTheService)
{
    static const Packages higher("2");
    rpm("-i " + packages().files());
    inRoot("systemctl enable sensor-profile && echo 'port = 1' >>/" + settings);
    const std::string changed = contentOf(root_.path() / settings);
    calls();
    rpm("-U " + higher.files());
    EXPECT_EQ(contentOf(root_.path() / settings), changed);
    EXPECT_TRUE(isEnabled());
    EXPECT_THAT(calls(), ElementsAre("daemon-reload", "udevadm control --reload",
                             "udevadm trigger --subsystem-match=ipmi", "daemon-reload",
                             "try-restart sensor-profile.service sensor-profile-collect.service"));
    EXPECT_EQ(
        rpm("-q " + tool), tool + "-" SENSOR_PROFILE_VERSION "-2." SENSOR_PROFILE_PROCESSOR "\n");
}

TEST_F(RpmRootTest, RemovalLeavesChangedSettingsOnly)
{
    rpm("-i " + packages().files());
    inRoot("systemctl enable sensor-profile && echo 'port = 1' >>/" + settings);
    calls();
    const Ended ended = tryRpm("-e " + provider + " " + tool);
    EXPECT_EQ(ended.code, 0);
    EXPECT_THAT(ended.err, HasSubstr("saved as /" + settings + ".rpmsave"));
    EXPECT_THAT(
        calls(), ElementsAre("--no-reload disable --now sensor-profile.service",
                     "stop sensor-profile-collect.service",
                     "clean --what=runtime sensor-profile-collect.service", "daemon-reload"));
    EXPECT_THAT(newEntries(), ElementsAre("etc/sensor-profile", settings + ".rpmsave"));
}

} // namespace RpmTests
