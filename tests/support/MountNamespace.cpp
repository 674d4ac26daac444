// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/MountNamespace.h"

#include "tests/support/Requirement.h"

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <stdexcept>
#include <system_error>
#include <vector>

#include <sys/mount.h>
#include <unistd.h>

namespace Testing {

namespace fs = std::filesystem;

namespace {

constexpr const char* insideVariable = "SENSOR_PROFILE_IN_MOUNT_NAMESPACE";

std::string& refusal()
{
    static std::string text = "the program did not call enterMountNamespace()";
    return text;
}

// Returns the command. It maps an ordinary user to root of a user namespace, who may mount.
std::vector<std::string> enterCommand()
{
    if (geteuid() == 0)
        return {SENSOR_PROFILE_PRIVATE_MOUNTS};
    return {"unshare", "--user", "--map-root-user", "--mount"};
}

// Returns why the command cannot mount; an empty text when it can.
std::string complaintOf(const std::vector<std::string>& command)
{
    std::string line;
    for (const std::string& word : command)
        line += word + ' ';
    FILE* pipe = popen((line + "mount --bind /tmp /sys/class 2>&1").c_str(), "r");
    if (pipe == nullptr)
        return "popen: " + std::generic_category().message(errno);
    std::string complaint;
    for (std::array<char, 256> block; fgets(block.data(), block.size(), pipe) != nullptr;)
        complaint += block.data();
    if (pclose(pipe) == 0)
        return {};
    return complaint.empty() ? line + "failed" : complaint;
}

void executeInside(char** argv)
{
    std::vector<std::string> words = enterCommand();
    words.emplace_back(fs::read_symlink("/proc/self/exe"));
    std::vector<char*> arguments;
    for (std::string& word : words)
        arguments.push_back(word.data());
    for (char** argument = argv + 1; *argument != nullptr; ++argument)
        arguments.push_back(*argument);
    arguments.push_back(nullptr);
    setenv(insideVariable, "1", 1);
    execvp(arguments.front(), arguments.data());
    refusal() = words.front() + ": " + std::generic_category().message(errno);
}

void writeFile(const fs::path& path, const std::string& text)
{
    std::ofstream file(path, std::ios::trunc);
    file << text << std::flush;
    if (!file)
        throw std::runtime_error("cannot write " + path.string());
}

void layOut(const fs::path& folder, const std::string& machine)
{
    const fs::path manifest =
        fs::path(SENSOR_PROFILE_SOURCE_DIR) / "tests/data/sysfs" / (machine + ".txt");
    std::ifstream lines(manifest);
    for (std::string line; std::getline(lines, line);) {
        const std::size_t blank = line.find(' ');
        const fs::path path = folder / line.substr(0, blank);
        const std::string content = line.substr(blank + 1);
        fs::create_directories(path.parent_path());
        if (content.starts_with("-> "))
            fs::create_symlink(content.substr(3), path);
        else
            writeFile(path, content + '\n');
    }
    if (!lines.eof())
        throw std::runtime_error("cannot read " + manifest.string());
}

// Returns the folder after it has filled it: members are initialised in order, so that the tree is
// complete before it is bound.
const fs::path& filled(const fs::path& folder, const std::string& machine)
{
    if (machine.empty())
        fs::create_directories(folder / "hwmon");
    else
        layOut(folder, machine);
    return folder;
}

const fs::path& written(const fs::path& path, const std::string& text)
{
    writeFile(path, text);
    return path;
}

} // namespace

void enterMountNamespace(char** argv)
{
    if (std::getenv(insideVariable) != nullptr)
        refusal().clear();
    else if (refusal() = complaintOf(enterCommand()); refusal().empty())
        executeInside(argv);
}

void MountNamespaceTest::SetUp()
{
    if (!refusal().empty())
        cannotRun("no mount namespace: " + refusal());
}

BindMount::BindMount(const fs::path& from, const fs::path& over) : over_(over)
{
    if (mount(from.c_str(), over.c_str(), nullptr, MS_BIND, nullptr) != 0)
        throw std::system_error(
            errno, std::generic_category(), "mount " + from.string() + " over " + over.string());
}

BindMount::~BindMount()
{
    umount2(over_.c_str(), MNT_DETACH);
}

BoundSysfs::BoundSysfs(const std::string& machine)
    : mount_(filled(tree_.path(), machine), "/sys/class")
{
}

void BoundSysfs::write(const std::string& relative, const std::string& text)
{
    writeFile(path(relative), text);
}

void BoundSysfs::remove(const std::string& relative)
{
    fs::remove_all(path(relative));
}

void BoundSysfs::rename(const std::string& from, const std::string& to)
{
    fs::rename(path(from), path(to));
}

void BoundSysfs::renew(const std::string& folder)
{
    const std::string copy = folder + ".copy";
    fs::copy(
        path(folder), path(copy), fs::copy_options::recursive | fs::copy_options::copy_symlinks);
    remove(folder);
    rename(copy, folder);
}

void BoundSysfs::addChip(const std::string& folder, const std::string& name, const std::string& bus,
    const std::string& address)
{
    const fs::path device = path("devices") / address;
    fs::create_directories(device);
    fs::create_symlink("../../bus/" + bus, device / "subsystem");
    const std::string chip = "hwmon/" + folder;
    fs::create_directories(path(chip));
    fs::create_symlink("../../devices/" + address, path(chip + "/device"));
    write(chip + "/name", name + "\n");
}

void BoundSysfs::addInterface(const std::string& address, const std::string& name)
{
    fs::create_directories(path("net"));
    fs::create_directories(path("devices") / address / "net" / name);
    fs::create_symlink("../devices/" + address + "/net/" + name, path("net/" + name));
}

BoundSensorsConfiguration::BoundSensorsConfiguration(const std::string& text)
    : file_(folder_.path() / "sensors3.conf"), mount_(written(file_, text), "/etc/sensors3.conf")
{
}

void BoundSensorsConfiguration::write(const std::string& text)
{
    writeFile(file_, text);
}

} // namespace Testing
