// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/objectmanagers/InstalledManager.h"

#include "tests/tools/ChildProcess.h"

#include <stdexcept>
#include <utility>

namespace Testing {

InstalledManager::InstalledManager(
    std::string name, unsigned port, std::vector<std::string> registerOptions)
    : name_(std::move(name)), port_(port), registerOptions_(std::move(registerOptions))
{
}

const InstalledManager& InstalledManager::openPegasus()
{
    static const InstalledManager manager(
        "openpegasus", 25988, {"--provider-folder", "/opt/openpegasus/lib"});
    return manager;
}

const InstalledManager& InstalledManager::sfcb()
{
    // Its configuration, beside its commands, names its folders.
    static const InstalledManager manager("sfcb", 15988, {});
    return manager;
}

std::string InstalledManager::url(const std::string& object, const std::string& space) const
{
    return "http://127.0.0.1:" + std::to_string(port_) + '/' + space + ':' + object;
}

void InstalledManager::start(const std::map<std::string, std::string>& environment) const
{
    std::vector<std::string> settings = {"LC_ALL=C"};
    for (const auto& [name, value] : environment)
        settings.push_back(name + '=' + value);
    command(folder_ + "/start", settings);
}

void InstalledManager::stop() const
{
    command(folder_ + "/stop", {});
}

void InstalledManager::reset() const
{
    command(folder_ + "/reset", {});
}

void InstalledManager::startWithProviders(
    const std::map<std::string, std::string>& environment) const
{
    // sfcb reads its registrations when it starts; the commands of OpenPegasus need it running.
    if (this == &sfcb())
        runRegister({"register"});
    start(environment);
    if (this == &openPegasus())
        runRegister({"register"});
}

std::string InstalledManager::command(
    const std::string& program, std::vector<std::string> arguments) const
{
    arguments.insert(arguments.begin(), program);
    const Ended ended =
        run(arguments, {.program = "/usr/bin/env",
                           .environment = {{"PEGASUS_HOME", "/opt/openpegasus"},
                               {"PATH", folder_ + "/bin:" + folder_ + "/sbin:/usr/bin:/bin"}}});
    if (ended.code != 0)
        throw std::runtime_error(program + ": " + ended.out + ended.err);
    return ended.out;
}

std::string InstalledManager::runRegister(
    std::vector<std::string> arguments, const std::filesystem::path& installation) const
{
    arguments.insert(arguments.begin(), registerOptions_.begin(), registerOptions_.end());
    arguments.insert(arguments.begin(), {"--object-manager", name_});
    return command(installation / "sbin/sensor-profile-register", arguments);
}

} // namespace Testing
