// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs the processes in which OpenPegasus and sfcb have our providers under valgrind, which finds
// no error and no leak in a function of ours.

#include "tests/objectmanagers/Agents.h"
#include "tests/objectmanagers/Answer.h"
#include "tests/objectmanagers/ClientRequest.h"
#include "tests/objectmanagers/InstalledManager.h"
#include "tests/support/WaitUntil.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <csignal>
#include <fstream>
#include <regex>
#include <set>

namespace {

using namespace Testing;
namespace fs = std::filesystem;

struct Instrumented {
    const InstalledManager& manager;
    std::string program; // of the object manager, which runs the providers

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
        std::ofstream(program) << "#!/bin/sh\nexec valgrind --keep-debuginfo=yes --leak-check=full"
                                  " --show-leak-kinds=definite --xml=yes --xml-file="
                               << folder_.path().string()
                               << "/log-%p --suppressions=" SENSOR_PROFILE_SOURCE_DIR
                                  "/tests/objectmanagers/known-errors.supp "
                               << real.string() << " \"$@\"\n";
        fs::permissions(program, fs::perms::owner_all);
    }

    void askAll() const
    {
        auto requests = allRequests([this](const std::string& className) {
            std::vector<std::string> paths;
            for (const auto& [path, properties] : ask({"ein", manager_.url(className)}).objects)
                paths.push_back(path);
            return paths;
        });
        if (isSfcb())
            keepEachFilter(requests);
        RecordProperty("requests", static_cast<int>(requests.size()));
        for (const ClientRequest& request : requests)
            ask(request.arguments(manager_.url(request.object)));
    }

    // Keeps a request of each operation for each kind of filter of each class, and for each value
    // of a filter. sfcb forks a process for each connection, which takes long under valgrind.
    static void keepEachFilter(std::vector<ClientRequest>& requests)
    {
        std::set<std::vector<std::string>> known;
        std::erase_if(requests, [&](const ClientRequest& request) {
            const std::size_t before = known.size();
            const std::string className = request.object.substr(0, request.object.find('.'));
            const auto add = [&](const std::string& filter, const std::string& value) {
                known.insert({request.operation, className, value.empty() ? "" : filter});
                known.insert({filter, value});
            };
            add("association", request.association);
            add("result class", request.resultClass);
            add("role", request.role);
            add("result role", request.resultRole);
            add("properties", request.hasEmptyList ? "none" : request.properties);
            return known.size() == before;
        });
    }

    bool isSfcb() const { return &manager_ == &InstalledManager::sfcb(); }

    // Returns the errors that have one of our libraries on the stack on which they were found, or
    // on which a leaked block was allocated. Other stacks explain where an address belongs.
    std::vector<std::string> errorsOfOurs() const
    {
        static const std::regex objectOfOurs("<obj>[^<]*/libSensorProfile");
        std::vector<std::string> errors;
        for (const auto& entry : fs::directory_iterator(folder_.path())) {
            const std::string log = contentOf(entry.path());
            for (auto at = log.find("<error>"); at != log.npos; at = log.find("<error>", at + 1)) {
                const std::string error = log.substr(at, log.find("</stack>", at) - at);
                if (std::regex_search(error, objectOfOurs))
                    errors.push_back(error);
            }
        }
        return errors;
    }

    const InstalledManager& manager_ = GetParam().manager;
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
    for (const ::pid_t agent : agents) {
        EXPECT_TRUE(waitUntil([&] { return !hasMapped(processFolder(agent), {"valgrind"}); }));
        const std::string log = contentOf(folder_.path() / ("log-" + std::to_string(agent)));
        // It ends with the search for leaks, but sfcb kills some of its processes before.
        if (!isSfcb()) {
            EXPECT_EQ(countOf(log, "<state>FINISHED</state>"), 1U) << agent;
        }
    }
    for (const std::string& error : errorsOfOurs())
        ADD_FAILURE() << error;
}

INSTANTIATE_TEST_SUITE_P(ObjectManagers, MemoryTest,
    testing::Values(Instrumented{InstalledManager::openPegasus(), "bin/cimprovagt"},
        Instrumented{InstalledManager::sfcb(), "sbin/sfcbd"}),
    [](const auto& each) { return each.param.manager.name(); });

} // namespace
