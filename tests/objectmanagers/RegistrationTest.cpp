// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// sensor-profile-register in OpenPegasus and sfcb.

#include "tests/objectmanagers/Answer.h"
#include "tests/objectmanagers/ObjectManager.h"
#include "tests/support/Texts.h"

#include <gtest/gtest.h>

#include <fstream>
#include <set>
#include <sstream>

namespace {

using namespace Testing;
namespace fs = std::filesystem;

// An installation whose classes are changed.
class ChangedInstallation {
public:
    ChangedInstallation() { fs::copy(movedInstallation(), prefix(), fs::copy_options::recursive); }

    // Makes them those of an earlier release.
    void downgrade() const
    {
        std::istringstream lines(contentOf(movedInstallation() / classes_));
        std::ofstream changed(prefix() / classes_);
        for (std::string line; std::getline(lines, line);) {
            if (const auto at = line.find("Version(\""); at != std::string::npos)
                line.replace(at, line.find(')', at) - at, "Version(\"0.0.1\"");
            changed << line << '\n';
            if (line.starts_with("class ZUMLO_NumericSensor"))
                changed << "string FormerProperty;\n";
        }
    }

    void upgrade() const
    {
        fs::copy_file(movedInstallation() / classes_, prefix() / classes_,
            fs::copy_options::overwrite_existing);
    }

    // Makes them such that no object manager compiles them.
    void damage() const { std::ofstream(prefix() / classes_, std::ios::app) << "class {\n"; }

    fs::path prefix() const { return folder_.path() / "installation"; }

private:
    const fs::path classes_ = "share/sensor-profile/sensor-profile.mof";
    TemporaryFolder folder_;
};

// What an object manager keeps of registrations, but for the classes of this product.
struct Registrations {
    std::set<std::string> classes;
    std::string providers;
    std::vector<std::string> libraries;
    std::vector<std::string> staged;

    bool operator==(const Registrations&) const = default;
};

class RegistrationTest : public testing::TestWithParam<const ObjectManager*> {
protected:
    void SetUp() override
    {
        manager_.reset();
        if (!isSfcb())
            start();
    }
    void TearDown() override { manager_.stop(); }

    bool isSfcb() const { return &manager_ == &ObjectManager::sfcb(); }

    void start() const
    {
        manager_.start(
            {{"RYNLOG_LOG", "off"}, {"VORN_INSTRUMENTATION", "model:" SENSOR_PROFILE_SOURCE_DIR
                                                             "/schema/demo-model.json"}});
    }

    // sfcb takes notice when it starts.
    void runRegister(const std::vector<std::string>& arguments,
        const fs::path& installation = movedInstallation()) const
    {
        if (isSfcb())
            manager_.stop();
        manager_.runRegister(arguments, installation);
        if (isSfcb())
            start();
    }

    std::size_t count(const std::string& className, const std::string& space = "root/cimv2") const
    {
        return names(className, space).objects.size();
    }
    Answer names(const std::string& className, const std::string& space = "root/cimv2") const
    {
        return ask({"ein", manager_.url(className, space)});
    }

    // Returns the paths of the sensors that conform to the registered profile.
    std::set<std::string> conformingSensors() const
    {
        const Answer answer = ask({"ain", "-ac", "ZUMLO_SensorElementConformsToProfile",
            manager_.url(
                "ZUMLO_SensorRegisteredProfile.InstanceID=\"ZUMLO:DSP1009\"", manager_.interop())});
        std::set<std::string> paths;
        for (const auto& [path, properties] : answer.objects)
            paths.insert(path);
        return paths;
    }

    // Returns the paths of the sensors in the namespace.
    std::set<std::string> sensorsIn(const std::string& space) const
    {
        std::set<std::string> paths;
        for (const auto& [path, properties] : names("ZUMLO_NumericSensor", space).objects)
            paths.insert(space + ':' + path);
        return paths;
    }

    // In OpenPegasus a namespace must have the classes above ours.
    void compileAncestors(const std::string& space) const
    {
        const fs::path share = movedInstallation() / "share/sensor-profile";
        std::string text;
        for (const std::string name : {"qualifiers.mof", "cim-core.mof", "cim-ancestors.mof"})
            text += replaced(contentOf(share / name), "#pragma include", "//");
        manager_.command(
            "/opt/openpegasus/bin/cimmof", {"-n", space, folder_.write("cim.mof", text)});
    }

    Registrations registrations() const
    {
        Registrations found;
        for (const auto& [name, properties] : ask({"ecn", manager_.url("")}).objects)
            if (isSfcb() || !name.starts_with("ZUMLO_"))
                found.classes.insert(name);
        const fs::path folder = manager_.folder();
        if (isSfcb()) {
            found.providers = contentOf(folder / "var/lib/sfcb/registration/providerRegister");
            found.libraries = filesBelow(folder / "lib/cmpi");
            found.staged = filesBelow(folder / "var/lib/sfcb/stage");
        } else {
            for (const std::string name :
                {"PG_ProviderModule", "PG_Provider", "PG_ProviderCapabilities"})
                found.providers += describe(ask({"ei", manager_.url(name, "root/PG_InterOp")}));
            found.libraries = filesBelow(folder / "lib");
        }
        return found;
    }

    const ObjectManager& manager_ = *GetParam();
    const TemporaryFolder folder_;
};

TEST_P(RegistrationTest, MovesToAnotherNamespace)
{
    runRegister({"register"});
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice"), 40U);
    EXPECT_EQ(conformingSensors(), sensorsIn("root/cimv2"));
    if (!isSfcb())
        compileAncestors("root/sensors");
    runRegister({"register", "--namespace", "root/sensors"});
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice", "root/sensors"), 40U);
    EXPECT_EQ(conformingSensors(), sensorsIn("root/sensors"));
    EXPECT_EQ(conformingSensors().size(), 40U);
    // OpenPegasus keeps the classes, which nobody serves.
    EXPECT_EQ(count("ZUMLO_NumericSensor"), 0U);
    EXPECT_EQ(names("ZUMLO_NumericSensor").error, isSfcb() ? 5 : 0);
}

TEST_P(RegistrationTest, ReplacesTheClassesOfAnEarlierRelease)
{
    const auto declared = [this] {
        return ask({"gc", manager_.url("ZUMLO_NumericSensor")}).objects.begin()->second;
    };
    const ChangedInstallation installation;
    installation.downgrade();
    runRegister({"register"}, installation.prefix());
    EXPECT_TRUE(declared().contains("FormerProperty"));
    EXPECT_EQ(count("ZUMLO_NumericSensor"), 40U);
    installation.upgrade();
    runRegister({"register"}, installation.prefix());
    EXPECT_FALSE(declared().contains("FormerProperty"));
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice"), 40U);
}

TEST_P(RegistrationTest, LeavesNothingBehind)
{
    if (isSfcb())
        start();
    const Registrations before = registrations();
    runRegister({"register"});
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice"), 40U);
    EXPECT_NE(registrations().providers, before.providers);
    runRegister({"remove"});
    const Registrations after = registrations();
    EXPECT_EQ(after.classes, before.classes);
    EXPECT_EQ(after.providers, before.providers);
    EXPECT_EQ(after.libraries, before.libraries);
    EXPECT_EQ(after.staged, before.staged);
}

TEST_P(RegistrationTest, WorksWithoutComputerSystem)
{
    runRegister({"register", "--without-computer-system"});
    EXPECT_EQ(count("ZUMLO_NumericSensor"), 40U);
    EXPECT_EQ(count("ZUMLO_SensorElementCapabilities"), 40U);
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice"), 0U);
    EXPECT_EQ(conformingSensors().size(), 40U);
}

TEST_P(RegistrationTest, StaysAsItWasWhenClassesDoNotCompile)
{
    const ChangedInstallation installation;
    runRegister({"register"}, installation.prefix());
    const Registrations before = registrations();
    installation.damage();
    EXPECT_THROW(runRegister({"register"}, installation.prefix()), std::runtime_error);
    if (isSfcb())
        start();
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice"), 40U);
    EXPECT_EQ(registrations(), before);
}

INSTANTIATE_TEST_SUITE_P(ObjectManagers, RegistrationTest,
    testing::Values(&ObjectManager::openPegasus(), &ObjectManager::sfcb()),
    [](const auto& each) { return each.param->name(); });

} // namespace
