// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/ipmi/IpmiSource.h"
#include "platform/instrumentation/machinefile/MachineFileWriter.h"
#include "tools/collect/Collector.h"
#include "tools/collect/IpmiDevice.h"
#include "tools/commands/Commands.h"
#include "tools/output/FileReplacement.h"
#include "tools/output/JsonText.h"
#include "tools/output/Output.h"
#include "tools/serve/ServiceManager.h"

#include <CLI/CLI.hpp>

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <filesystem>
#include <stdexcept>
#include <string>
#include <system_error>
#include <thread>
#include <utility>
#include <vector>

namespace Tools {

namespace {

using Period = std::chrono::steady_clock::duration;

constexpr const char* discreteReading = "discretereading";
constexpr const char* ignoreScanningDisabled = "ignorescanningdisabled";
constexpr const char* assumeBmcOwner = "assumebmcowner";

constexpr const char* collectFooter =
    "The file describes the fans, voltages and temperatures of /dev/ipmi0; the source\n"
    "`ipmi` or `ipmi:FILE` of VORN_INSTRUMENTATION publishes them. Without --once, it\n"
    "is renewed until a signal ends the command.\n"
    "\n"
    "Workarounds, for controllers that deviate from IPMI:\n"
    "  discretereading         sensors with readings have a discrete type\n"
    "  ignorescanningdisabled  the BMC says of every sensor that it is not scanned\n"
    "  assumebmcowner          all sensors are the BMC's, whatever their records say";

// Keeps other collectors from the same file during its lifetime.
class CollectionLock {
public:
    // Throws std::runtime_error when another process has the lock, or when there can be none. The
    // file of the lock is never removed: a process that has just opened it could lock nothing then.
    explicit CollectionLock(const std::string& collection)
    {
        const std::string path = collection + ".lock";
        file_ = ::open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW, 0600);
        if (file_ < 0)
            throw std::system_error(errno, std::generic_category(), path);
        if (::flock(file_, LOCK_EX | LOCK_NB) == 0)
            return;
        const int error = errno;
        ::close(file_);
        if (error == EWOULDBLOCK)
            throw std::runtime_error("another process renews " + collection + " already");
        throw std::system_error(error, std::generic_category(), path);
    }
    ~CollectionLock() { ::close(file_); }
    CollectionLock(const CollectionLock&) = delete;
    CollectionLock& operator=(const CollectionLock&) = delete;

private:
    int file_;
};

// Reports a problem to standard error when it begins and when it is over.
class Condition {
public:
    explicit Condition(std::string good) : good_(std::move(good)) {}

    // An empty problem is none.
    void report(const std::string& problem)
    {
        if (problem != reported_)
            complain(problem.empty() ? good_ : problem);
        reported_ = problem;
    }

private:
    std::string good_;
    std::string reported_;
};

class CollectCommand : public Command {
public:
    explicit CollectCommand(CLI::App& tool)
        : Command(tool, "collect", "Read the sensors of the BMC into a file again and again")
    {
        parser().add_flag("--once", once_, "Write the file once and exit");
        parser()
            .add_option("-o,--output", file_, "Renew this file")
            ->type_name("FILE")
            ->capture_default_str();
        parser()
            .add_option("--interval", interval_, "Read every so many seconds, or more slowly")
            ->type_name("SECONDS")
            ->check(CLI::Range(1U, 3600U).description(""))
            ->capture_default_str();
        parser().add_flag("--only-present", onlyPresent_, "Leave out what has never been readable");
        parser()
            .add_option("--workaround", workarounds_, "Allow for a deviation; may be repeated")
            ->type_name("NAME")
            ->check(CLI::IsMember({discreteReading, ignoreScanningDisabled, assumeBmcOwner})
                        .description(""))
            ->expected(1)
            ->take_all();
        parser().footer(collectFooter);
    }

    ExitCode run(Output& /*out*/) override
    {
        {
            const Ipmi::IpmiDevice device; // throws where there is none, or none may be used
        }
        if (file_ == Vorn::defaultCollection)
            std::filesystem::create_directory(std::filesystem::path(file_).parent_path());
        const CollectionLock lock(file_);
        period_ = interval();
        Ipmi::Collector collector({.readsDiscrete = has(discreteReading),
            .ignoresScanning = has(ignoreScanningDisabled),
            .assumesBmcOwner = has(assumeBmcOwner)});
        if (once_) {
            read(collector);
            write(collector);
            return ExitCode::success;
        }
        collectForever(collector);
    }

private:
    bool has(const std::string& workaround) const
    {
        return std::find(workarounds_.begin(), workarounds_.end(), workaround) !=
               workarounds_.end();
    }

    [[noreturn]] void collectForever(Ipmi::Collector& collector)
    {
        Condition reading("the sensors are read again");
        Condition writing(file_ + " is written again");
        for (bool isFirst = true;; isFirst = false) {
            const auto begin = std::chrono::steady_clock::now();
            try {
                read(collector);
                reading.report("");
            } catch (const std::exception& error) {
                reading.report(error.what());
                collector.loseAll();
            }
            try {
                write(collector);
                writing.report("");
            } catch (const std::exception& error) {
                writing.report(error.what());
            }
            if (isFirst)
                notifyServiceManager("READY=1");
            std::this_thread::sleep_until(begin + period_);
        }
    }

    void read(Ipmi::Collector& collector)
    {
        constexpr int shareOfTime = 5; // a slow BMC is used for a fifth of the time at most
        const auto begin = std::chrono::steady_clock::now();
        // The device is opened for each pass, since the kernel may have removed it meanwhile.
        Ipmi::IpmiDevice device;
        collector.pass(device, period_);
        period_ =
            std::max<Period>(interval(), shareOfTime * (std::chrono::steady_clock::now() - begin));
    }

    Period interval() const { return std::chrono::seconds(interval_); }

    // Does nothing before the sensors are known: a file of an earlier process says which there are.
    void write(const Ipmi::Collector& collector)
    {
        if (!collector.knowsSensors())
            return;
        const Vorn::Renewal renewal{
            std::chrono::duration<double>(period_).count(), Vorn::secondsSinceStart()};
        const auto nodes = onlyPresent_ ? collector.presentNodes() : collector.nodes();
        replaceFile(file_, escapeUnprintable(Vorn::writeMachineFile({nodes, renewal})));
    }

    std::string file_ = Vorn::defaultCollection;
    bool once_ = false;
    bool onlyPresent_ = false;
    unsigned interval_ = 10; // in seconds
    std::vector<std::string> workarounds_;
    Period period_{};
};

} // namespace

std::unique_ptr<Command> makeCollectCommand(CLI::App& tool)
{
    return std::make_unique<CollectCommand>(tool);
}

} // namespace Tools
