// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The process of the server: its output, its log, the service manager and the user that it runs as.

#include "tests/support/Requirement.h"
#include "tests/tools/ServeTest.h"

#include <gmock/gmock.h>

#include <fcntl.h>
#include <pwd.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <system_error>

namespace {

using namespace Testing;
using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;

// The socket on which systemd receives the notifications of a service.
class ServiceManager {
public:
    explicit ServiceManager(std::string path)
        : path_(std::move(path)), socket_(::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0))
    {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        path_.copy(address.sun_path, sizeof address.sun_path - 1);
        const timeval timeout{10, 0};
        if (::setsockopt(socket_, SOL_SOCKET, SO_RCVTIMEO, &timeout, sizeof timeout) != 0 ||
            ::bind(socket_, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0)
            throw std::system_error(errno, std::generic_category());
    }
    ~ServiceManager() { ::close(socket_); }
    ServiceManager(const ServiceManager&) = delete;
    ServiceManager& operator=(const ServiceManager&) = delete;

    const std::string& path() const { return path_; }

    // Returns the next message; an empty text when none arrives.
    std::string received() const
    {
        std::array<char, 256> text{};
        const ssize_t length = ::recv(socket_, text.data(), text.size(), 0);
        return length < 0 ? "" : std::string(text.data(), static_cast<std::size_t>(length));
    }

private:
    std::string path_;
    int socket_;
};

class ServeProcessTest : public ServeTest {
protected:
    // Returns the arguments of a server on any port that runs as the user of the tests.
    std::vector<std::string> asIs() const
    {
        std::vector<std::string> arguments = withModel({"serve", "--port", "0"});
        if (::geteuid() == 0)
            arguments.insert(arguments.end(), {"--user", "root"});
        return arguments;
    }

    // Writes a shell script with this line. Returns its path.
    std::string script(const std::string& line) const
    {
        const std::string file = folder_.write("script", "#!/bin/bash\n" + line + "\n");
        std::filesystem::permissions(file, std::filesystem::perms::owner_all);
        return file;
    }
};

TEST_F(ServeProcessTest, LogThatCannotBeWrittenAtTheStartIsAFailure)
{
    for (const auto& [file, problem] :
        {std::pair("/dev/full", "cannot write the log file /dev/full: No space left on device"),
            {"/nowhere/log", "cannot open the log file /nowhere/log: No such file or directory"}}) {
        const Ended ended =
            run(asIs(), {.environment = {{"RYNLOG_LOG", std::string("file:") + file}}});
        EXPECT_EQ(ended.code, 1);
        EXPECT_EQ(ended.out, "");
        EXPECT_EQ(ended.err, std::string("sensorctl: ") + problem + "\n");
    }
}

TEST_F(ServeProcessTest, StandardOutputReportsAFullStandardError)
{
    const Ended ended = run(asIs(), {.program = script("exec " + sensorctl + " \"$@\" 2>/dev/full"),
                                        .environment = {{"RYNLOG_LOG", ""}}});
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(
        ended.out, "sensorctl: cannot write the log to standard error: No space left on device\n");
}

TEST_F(ServeProcessTest, LogThatIsFullLaterDoesNotHinderIt)
{
    const std::string log = (folder_.path() / "log").string();
    const std::string limited = script("ulimit -f 1\nexec " + sensorctl + " \"$@\"");
    ServerProcess server(withModel({"--passwords", secret("passwords", userLine)}),
        {{"RYNLOG_LOG", "file:" + log}}, limited);
    for (int i = 0; i < 20; ++i) {
        server.signal(SIGHUP);
        EXPECT_EQ(ask(HttpClient(server.port()), request(asAnn)).status, 200);
    }
    const Ended ended = server.end(SIGTERM);
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(std::filesystem::file_size(log) % 512, 0U);
    EXPECT_THAT(contentOf(log), Not(HasSubstr("ending")));
}

TEST_F(ServeProcessTest, LogWhoseReaderIsGoneDoesNotHinderIt)
{
    const std::string pipe = (folder_.path() / "pipe").string();
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    const int reader = ::open(pipe.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
    ServerProcess server(withModel(), {{"RYNLOG_LOG", "file:" + pipe}});
    ::close(reader);
    server.signal(SIGHUP);
    EXPECT_EQ(ask(HttpClient(server.port())).status, 200);
    EXPECT_EQ(server.end(SIGTERM).code, 0);
}

TEST_F(ServeProcessTest, LogThatNobodyReadsDoesNotHinderIt)
{
    // The pipe of 64 KiB has room for the first lines only.
    ServerProcess server(withModel(), {{"RYNLOG_LEVEL", "4000"}},
        script("exec 2> >(sleep 30)\nhead -c 60K /dev/zero >&2\nexec " + sensorctl + " \"$@\""));
    for (int i = 0; i < 50; ++i)
        EXPECT_EQ(ask(HttpClient(server.port())).status, 200);
    EXPECT_EQ(server.end(SIGTERM).code, 0);
}

TEST_F(ServeProcessTest, OutputThatCannotBeWrittenIsAFailure)
{
    const Ended ended = run(asIs(), {.out = RunOptions::Out::file, .outFile = "/dev/full"});
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, HasSubstr("No space left on device"));
}

TEST_F(ServeProcessTest, OutputThatNobodyReadsIsAFailure)
{
    const Ended ended = run(asIs(), {.out = RunOptions::Out::abandonedPipe});
    EXPECT_EQ(ended.signal, 0);
    EXPECT_EQ(ended.code, 1);
    EXPECT_EQ(ended.err, "sensorctl: cannot write the output: Broken pipe\n");
}

TEST_F(ServeProcessTest, ReaderOfTheGreetingMayLeave)
{
    ServerProcess server(
        withModel(), {}, script("exec " + sensorctl + " \"$@\" > >(head --lines=2)"));
    EXPECT_EQ(ask(HttpClient(server.port())).status, 200);
    EXPECT_EQ(server.end(SIGTERM).code, 0);
}

TEST_F(ServeProcessTest, ServiceManagerIsNotifiedOfItsState)
{
    const ServiceManager manager(folder_.path() / "notify");
    ServerProcess server(withModel(), {{"NOTIFY_SOCKET", manager.path()}});
    EXPECT_EQ(manager.received(), "READY=1");
    server.signal(SIGHUP);
    EXPECT_EQ(manager.received(), "RELOADING=1");
    EXPECT_EQ(manager.received(), "READY=1");
    EXPECT_EQ(server.end(SIGTERM).code, 0);
    EXPECT_EQ(manager.received(), "STOPPING=1");
}

TEST_F(ServeProcessTest, JournalGetsPrioritiesAndNoSecondTime)
{
    ServerProcess server(withModel({"--passwords", secret("passwords", userLine)}), {},
        script("JOURNAL_STREAM=$(stat --dereference --format=%d:%i /dev/stderr) exec " + sensorctl +
               " \"$@\""));
    folder_.write("passwords", "ann\n");
    server.signal(SIGHUP);
    EXPECT_TRUE(server.waitForLog("stays in force"));
    const Ended ended = server.end(SIGTERM);
    EXPECT_THAT(linesOf(ended.err),
        testing::ElementsAre(testing::StartsWith("<6>serving as "),
            testing::ContainsRegex("^<3>.*/passwords:1: .*stays in force$"), "<6>ending"));
}

TEST_F(ServeProcessTest, JournalGetsThePriorityOfTheLastMessage)
{
    const Ended ended = run({"serve", "--model", "/no/such/model"},
        {.program = script("JOURNAL_STREAM=$(stat --dereference --format=%d:%i /dev/stderr) exec " +
                           sensorctl + " \"$@\"")});
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, testing::StartsWith("<3>sensorctl: model file /no/such/model: "));
}

TEST_F(ServeProcessTest, AllocatorKeepsManyBlocksUnlessTheUserConfiguresIt)
{
    const auto environmentOf = [](const ServerProcess& server) {
        return contentOf("/proc/" + std::to_string(server.id()) + "/environ");
    };
    EXPECT_THAT(environmentOf(ServerProcess(withModel())),
        HasSubstr("GLIBC_TUNABLES=glibc.malloc.tcache_count=1000"));
    const std::string own = "glibc.malloc.tcache_count=9";
    EXPECT_THAT(environmentOf(ServerProcess(withModel(), {{"GLIBC_TUNABLES", own}})),
        HasSubstr("GLIBC_TUNABLES=" + own));
}

TEST_F(ServeProcessTest, UserIsNamed)
{
    if (::geteuid() != 0)
        return cannotRun("only root can start it as another user");
    const std::string file = smallModel();
    ::chmod(folder_.path().c_str(), 0711);
    ::chmod(file.c_str(), 0444);
    const ServerProcess server({"--model", file, "--user", "nobody"}, {},
        script(
            "exec setpriv --reuid=nobody --regid=nogroup --clear-groups " + sensorctl + " \"$@\""));
    EXPECT_TRUE(server.waitForLog("serving as nobody\n"));
}

TEST_F(ServeProcessTest, RootIsRenounced)
{
    if (::geteuid() != 0)
        return cannotRun("only root can renounce root");
    const std::string model = smallModel();
    ::chmod(folder_.path().c_str(), 0711);
    ::chmod(model.c_str(), 0444);
    // A process that has renounced root may not trace its threads, as the search for leaks does.
    ServerProcess server(
        {"--model", model, "--user", "nobody", "--passwords", secret("passwords", userLine)},
        {{"ASAN_OPTIONS", "detect_leaks=0"}});
    const std::string status = contentOf("/proc/" + std::to_string(server.id()) + "/status");
    const std::string id = std::to_string(::getpwnam("nobody")->pw_uid);
    EXPECT_THAT(status, AllOf(HasSubstr("Uid:\t" + id + "\t" + id + "\t" + id + "\t" + id),
                            HasSubstr("CapPrm:\t0000000000000000"),
                            HasSubstr("CapEff:\t0000000000000000"), HasSubstr("NoNewPrivs:\t1")));
    EXPECT_EQ(ask(HttpClient(server.port()), request(asAnn)).status, 200);
    server.signal(SIGHUP);
    EXPECT_TRUE(server.waitForLog("Permission denied; what was read before stays in force"));
    EXPECT_EQ(sensorsIn(ask(HttpClient(server.port()), request(asAnn)).body), 5U);
    EXPECT_EQ(server.end(SIGTERM).code, 0);
}

// The server loads all files before it renounces root.
TEST_F(ServeProcessTest, RootIsRenouncedWhereOnlyRootCanReadTheTool)
{
    if (::geteuid() != 0)
        return cannotRun("only root can renounce root");
    const std::string tool = install(); // in a folder that only root can read
    std::filesystem::copy(SENSOR_PROFILE_BINARY_DIR "/lib", folder_.path() / "lib");
    const std::string readable = smallModel();
    ::chmod(readable.c_str(), 0444);
    const int model = ::open(readable.c_str(), O_RDONLY);
    ServerProcess server({"--model", "/dev/fd/" + std::to_string(model), "--user", "nobody"},
        {{"ASAN_OPTIONS", "detect_leaks=0"}, {"LC_ALL", "fr_FR.UTF-8"}}, tool);
    ::close(model);
    EXPECT_TRUE(server.waitForLog("serving as nobody"));
    const std::string answer =
        ask(HttpClient(server.port()), request("", "EnumerateInstances")).body;
    EXPECT_NE(answer.find("<VALUE>Capteur CPU 1</VALUE>"), std::string::npos);
    EXPECT_EQ(server.end(SIGTERM).code, 0);
}

TEST_F(ServeProcessTest, ModelThatTheUserCannotReadIsReported)
{
    if (::geteuid() != 0)
        return cannotRun("only root can renounce root");
    const std::string file = smallModel();
    for (const std::vector<std::string>& option :
        {std::vector<std::string>{"--model", file}, std::vector<std::string>{}}) {
        std::vector<std::string> arguments{"serve", "--port", "0", "--user", "nobody"};
        arguments.insert(arguments.end(), option.begin(), option.end());
        const Ended ended = run(arguments, {.environment = {{"ASAN_OPTIONS", "detect_leaks=0"},
                                                {"VORN_INSTRUMENTATION", "model:" + file}}});
        EXPECT_EQ(ended.code, 1);
        EXPECT_EQ(ended.err, "sensorctl: " + file +
                                 ", which the server needs as the user it runs as (--user names "
                                 "another): Permission denied\n");
    }
}

TEST_F(ServeProcessTest, UserThatIsNotThereIsReported)
{
    const Ended ended = failing(withModel({"--port", "0", "--user", "no-such-user"}));
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, HasSubstr("no-such-user"));
}

} // namespace
