// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// sensor-profile-register registers, moves, upgrades and removes the providers in OpenPegasus and
// sfcb.

#include "tests/objectmanagers/Answer.h"
#include "tests/objectmanagers/FormerRelease.h"
#include "tests/objectmanagers/InstalledManager.h"
#include "tests/support/Texts.h"
#include "tests/tools/ChildProcess.h"

#include <gmock/gmock.h>

#include <fstream>
#include <set>

namespace {

using namespace Testing;
namespace fs = std::filesystem;

class RegistrationTest : public testing::TestWithParam<const InstalledManager*> {
protected:
    void SetUp() override { reset(); }
    void TearDown() override { manager_.stop(); }

    bool isSfcb() const { return &manager_ == &InstalledManager::sfcb(); }

    // Makes it what it was when it was installed. The commands of OpenPegasus need it running.
    void reset() const
    {
        manager_.reset();
        if (!isSfcb())
            start();
    }

    void start() const
    {
        manager_.start(
            {{"RYNLOG_LOG", "off"}, {"VORN_INSTRUMENTATION", "model:" SENSOR_PROFILE_SOURCE_DIR
                                                             "/schema/demo-model.json"}});
    }

    // Makes sfcb read its registrations, which it does when it starts.
    void restart() const
    {
        if (!isSfcb())
            return;
        manager_.stop();
        start();
    }

    // Returns the folder of provider libraries of an administrator who registered release 0.2.0:
    // the library of the computer system could not be beside that of OpenPegasus of the same name.
    std::string folderOfFormerLibraries() const
    {
        if (isSfcb())
            return manager_.folder() + "/lib/cmpi";
        const std::string folder = manager_.folder() + "/providers";
        fs::create_directory(folder);
        manager_.command(
            "cimconfig", {"-s", "providerDir=" + folder + ':' + manager_.folder() + "/lib", "-c"});
        return folder;
    }

    std::size_t count(const std::string& className, const std::string& space = "root/cimv2") const
    {
        return names(className, space).objects.size();
    }
    Answer names(const std::string& className, const std::string& space = "root/cimv2") const
    {
        return ask({"ein", manager_.url(className, space)});
    }

    // Returns the value of the class's qualifier Version.
    std::string versionOf(const std::string& className) const
    {
        const std::string xml =
            run({"-dx", "gc", manager_.url(className)}, {.program = "/usr/bin/wbemcli"}).err;
        const std::string qualifier = xml.substr(xml.find("<QUALIFIER NAME=\"Version\""));
        const std::size_t value = qualifier.find("<VALUE>") + 7;
        return qualifier.substr(value, qualifier.find('<', value) - value);
    }

    // Returns the instances and the declarations of our classes.
    std::string answers() const
    {
        std::string texts;
        for (const std::string& name : servedClasses)
            for (const std::string operation : {"ei", "gc"})
                texts += describe(ask({operation, manager_.url(name)}));
        return texts;
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

    // Returns what the object manager keeps of registrations, but for classes. sfcb need not run.
    std::string registrations() const
    {
        const fs::path folder = manager_.folder();
        if (isSfcb())
            return contentOf(folder / "var/lib/sfcb/registration/providerRegister") +
                   listOf(folder / "lib/cmpi") + listOf(folder / "var/lib/sfcb/stage");
        std::string found = listOf(folder / "lib") + listOf(folder / "providers");
        for (const std::string name :
            {"PG_ProviderModule", "PG_Provider", "PG_ProviderCapabilities"})
            found += describe(ask({"ei", manager_.url(name, "root/PG_InterOp")}));
        return found;
    }

    // Returns the paths of the files below a folder, each on a line. There may be no such folder.
    static std::string listOf(const fs::path& folder)
    {
        std::string list;
        if (fs::exists(folder))
            for (const std::string& name : filesBelow(folder))
                list += (folder / name).string() + '\n';
        return list;
    }

    // Returns the names of all classes.
    std::set<std::string> classNames() const
    {
        std::set<std::string> names;
        for (const auto& [name, properties] : ask({"ecn", manager_.url("")}).objects)
            names.insert(name);
        return names;
    }

    const InstalledManager& manager_ = *GetParam();
    const TemporaryFolder folder_;
};

TEST_P(RegistrationTest, MovesToAnotherNamespace)
{
    manager_.runRegister({"register"});
    if (!isSfcb())
        compileAncestors("root/sensors");
    manager_.runRegister({"register", "--namespace", "root/sensors"});
    restart();
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice", "root/sensors"), 40U);
    EXPECT_EQ(conformingSensors(), sensorsIn("root/sensors"));
    EXPECT_EQ(conformingSensors().size(), 40U);
    // OpenPegasus keeps the classes, which no provider serves.
    EXPECT_EQ(count("ZUMLO_NumericSensor"), 0U);
    EXPECT_EQ(names("ZUMLO_NumericSensor").error, isSfcb() ? 5 : 0);
}

TEST_P(RegistrationTest, ReplacesTheFormerReleaseAndIsRemovedWhole)
{
    const std::string folder = folderOfFormerLibraries();
    const FormerRelease release;
    const std::string before = registrations();
    // In sfcb, which does not run yet, the namespace has none.
    const std::set<std::string> classesBefore = isSfcb() ? std::set<std::string>() : classNames();
    release.registerIn(manager_, folder);
    restart();
    EXPECT_EQ(versionOf("ZUMLO_NumericSensor"), FormerRelease::version);
    EXPECT_EQ(count("ZUMLO_ComputerSystem"), 1U);
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice"), 40U);

    release.upgrade();
    const std::vector<std::string> inFolder = {"register", "--provider-folder", folder};
    manager_.runRegister(inFolder, release.prefix());
    restart();
    for (const std::string& name : servedClasses)
        EXPECT_EQ(versionOf(name), SENSOR_PROFILE_VERSION) << name;
    EXPECT_FALSE(fs::is_symlink(folder + "/libComputerSystemProvider.so"));
    const std::string upgraded = registrations();
    const std::string upgradedAnswers = answers();
    EXPECT_EQ(conformingSensors(), sensorsIn("root/cimv2"));
    // OpenPegasus finds its own library of the former name again.
    if (!isSfcb()) {
        EXPECT_EQ(count("PG_ComputerSystem"), 1U);
    }

    manager_.runRegister({"remove", "--provider-folder", folder}, release.prefix());
    restart();
    EXPECT_EQ(registrations(), before);
    for (const std::string space : {"root/cimv2", "root/PG_InterOp"})
        for (const std::string& name : servedClasses)
            EXPECT_NE(ask({"gc", manager_.url(name, space)}).error, 0) << space << ':' << name;
    EXPECT_EQ(classNames(), classesBefore);

    reset();
    folderOfFormerLibraries();
    manager_.runRegister(inFolder);
    restart();
    EXPECT_EQ(registrations(), upgraded);
    EXPECT_EQ(answers(), upgradedAnswers);
}

TEST_P(RegistrationTest, WorksWithoutComputerSystem)
{
    manager_.runRegister({"register", "--without-computer-system"});
    restart();
    EXPECT_EQ(count("ZUMLO_NumericSensor"), 40U);
    EXPECT_EQ(count("ZUMLO_SensorElementCapabilities"), 40U);
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice"), 0U);
    EXPECT_EQ(conformingSensors().size(), 40U);
}

TEST_P(RegistrationTest, StaysAsItWasWhenClassesDoNotCompile)
{
    const TemporaryFolder folder;
    const fs::path prefix = folder.path() / "installation";
    fs::copy(movedInstallation(), prefix, fs::copy_options::recursive);
    manager_.runRegister({"register"}, prefix);
    const std::string before = registrations();
    std::ofstream(prefix / "share/sensor-profile/sensor-profile.mof", std::ios::app) << "class {\n";
    try {
        manager_.runRegister({"register"}, prefix);
        FAIL() << "The classes were compiled.";
    } catch (const std::runtime_error& error) {
        // OpenPegasus has compiled the first file, which is undone.
        EXPECT_THAT(error.what(),
            testing::HasSubstr(isSfcb() ? "Nothing was changed."
                                        : " register --object-manager openpegasus --namespace "
                                          "root/cimv2 --provider-folder"));
    }
    restart();
    EXPECT_EQ(count("ZUMLO_SensorSystemDevice"), 40U);
    EXPECT_EQ(registrations(), before);
}

INSTANTIATE_TEST_SUITE_P(ObjectManagers, RegistrationTest,
    testing::Values(&InstalledManager::openPegasus(), &InstalledManager::sfcb()),
    [](const auto& each) { return each.param->name(); });

} // namespace
