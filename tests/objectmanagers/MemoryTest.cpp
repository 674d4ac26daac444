// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The processes in which OpenPegasus and sfcb run our providers, under valgrind: no error and no
// leak has a function of ours on its stack.

#include "tests/objectmanagers/Agents.h"
#include "tests/objectmanagers/Answer.h"
#include "tests/objectmanagers/ObjectManager.h"
#include "tests/objectmanagers/Request.h"
#include "tests/support/WaitUntil.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <csignal>
#include <fstream>
#include <sstream>

namespace {

using namespace Testing;
namespace fs = std::filesystem;

struct Instrumented {
    const ObjectManager& manager;
    std::string program; // of the object manager, which runs the providers
    // Whether everything is asked and leaks are searched for; else, requests have no filter but the
    // association.
    bool isWhole;

    friend std::ostream& operator<<(std::ostream& stream, const Instrumented& instrumented)
    {
        return stream << instrumented.manager.name();
    }
};

class MemoryTest : public ToolTest, public testing::WithParamInterface<Instrumented> {
protected:
    // Makes the program start under valgrind.
    void instrument() const
    {
        const fs::path program = manager_.folder() + '/' + GetParam().program;
        const fs::path real = program.string() + ".real";
        fs::rename(program, real);
        const std::string leaks = GetParam().isWhole ? "full --show-leak-kinds=definite" : "no";
        std::ofstream(program) << "#!/bin/sh\nexec valgrind --keep-debuginfo=yes --leak-check="
                               << leaks
                               << " --suppressions=" SENSOR_PROFILE_SOURCE_DIR
                                  "/tests/objectmanagers/known-errors.supp"
                               << " --log-file=" << folder_.path().string() << "/log-%p "
                               << real.string() << " \"$@\"\n";
        fs::permissions(program, fs::perms::owner_all);
    }

    void askAll() const
    {
        const auto requests = allRequests([this](const std::string& className) {
            std::vector<std::string> paths;
            for (const auto& [path, properties] : ask({"ein", manager_.url(className)}).objects)
                paths.push_back(path);
            return paths;
        });
        for (const Request& request : requests)
            if (GetParam().isWhole || !request.isFiltered())
                ask(request.arguments(manager_.url(request.object)));
    }

    // Returns the errors that have one of our libraries on their stack.
    std::vector<std::string> errorsOfOurs() const
    {
        std::vector<std::string> errors;
        for (const auto& entry : fs::directory_iterator(folder_.path())) {
            if (!entry.path().filename().string().starts_with("log-"))
                continue;
            std::istringstream lines(contentOf(entry.path()));
            std::string error;
            for (std::string line; std::getline(lines, line);) {
                error += line.substr(line.find(' ') + 1) + '\n';
                if (!line.ends_with("== "))
                    continue;
                // Where a block was allocated is below its address.
                if (error.substr(0, error.find("\n Address ")).find("libSensorProfile") !=
                    std::string::npos)
                    errors.push_back(error);
                error.clear();
            }
        }
        return errors;
    }

    const ObjectManager& manager_ = GetParam().manager;
};

TEST_P(MemoryTest, HasNoErrorOfOurs)
{
    manager_.reset();
    instrument();
    manager_.startWithProviders(
        {{"RYNLOG_LOG", "off"}, {"VORN_INSTRUMENTATION", "model:" + smallModel()}});
    askAll();
    const auto agents = agentsBelow(manager_.folder());
    EXPECT_FALSE(agents.empty());
    for (const ::pid_t agent : agents)
        EXPECT_THAT(fs::read_symlink(processFolder(agent) / "exe").string(),
            testing::HasSubstr("valgrind"));
    const ::pid_t server = std::stoi(contentOf(manager_.folder() + "/var/run/server.pid"));
    EXPECT_EQ(::kill(server, SIGTERM), 0);
    // They search for leaks when the libraries are unloaded already.
    for (const ::pid_t agent : agents) {
        EXPECT_TRUE(waitUntil([&] { return !hasMapped(processFolder(agent), {"valgrind"}); }));
        const std::string log = contentOf(folder_.path() / ("log-" + std::to_string(agent)));
        if (GetParam().isWhole) {
            EXPECT_EQ(countOf(log, "HEAP SUMMARY"), 1U) << log;
        }
    }
    for (const std::string& error : errorsOfOurs())
        ADD_FAILURE() << error;
}

INSTANTIATE_TEST_SUITE_P(ObjectManagers, MemoryTest,
    testing::Values(Instrumented{ObjectManager::openPegasus(), "bin/cimprovagt", true},
        // It forks a process for each connection, which takes long, and kills those of providers.
        Instrumented{ObjectManager::sfcb(), "sbin/sfcbd", false}),
    [](const auto& each) { return each.param.manager.name(); });

} // namespace
