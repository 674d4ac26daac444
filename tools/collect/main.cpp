// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The program that `sensorctl collect` executes. It runs as long as the machine, and so without the
// libraries of the other commands in its memory.

#include "platform/instrumentation/machinefile/MachineFileWriter.h"
#include "tools/collect/CollectOptions.h"
#include "tools/collect/Collector.h"
#include "tools/collect/IpmiDevice.h"
#include "tools/output/FileReplacement.h"
#include "tools/output/JsonText.h"
#include "tools/output/Output.h"
#include "tools/serve/ServiceManager.h"

#include <algorithm>
#include <chrono>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <optional>
#include <stdexcept>
#include <string>
#include <system_error>
#include <thread>
#include <utility>

namespace {

using namespace Tools;

using Period = std::chrono::steady_clock::duration;

// Makes the folder that all users may enter, unless there is one.
void makeReadableFolder(const std::filesystem::path& folder)
{
    using std::filesystem::perms;
    std::error_code error;
    const bool isNew = std::filesystem::create_directory(folder, error);
    if (error)
        throw std::runtime_error(folder.string() + ": " + error.message());
    if (isNew)
        std::filesystem::permissions(folder, perms::owner_all | perms::group_read |
                                                 perms::group_exec | perms::others_read |
                                                 perms::others_exec);
}

// Reports a problem to standard error when it begins and when it is over.
class Condition {
public:
    explicit Condition(std::string good) : good_(std::move(good)) {}

    // An empty problem is none.
    void report(const std::string& problem)
    {
        if (problem == reported_)
            return;
        reported_ = problem;
        if (problem.empty())
            inform(good_);
        else
            complain(problem);
    }

private:
    std::string good_;
    std::string reported_;
};

class Collection {
public:
    // The options must outlive the object.
    explicit Collection(const CollectOptions& options) : options_(options) {}

    // Writes the file once, or again and again. Throws std::exception where it cannot begin.
    void run()
    {
        device_.emplace();
        if (options_.file == Vorn::defaultCollection)
            makeReadableFolder(std::filesystem::path(options_.file).parent_path());
        file_.emplace(options_.file);
        period_ = interval();
        Ipmi::Collector collector({.readsDiscrete = has(discreteReading),
            .ignoresScanning = has(ignoreScanningDisabled),
            .assumesBmcOwner = has(assumeBmcOwner)});
        if (options_.isOnce) {
            read(collector);
            write(collector);
            return;
        }
        collectForever(collector);
    }

private:
    bool has(const std::string& workaround) const
    {
        return std::find(options_.workarounds.begin(), options_.workarounds.end(), workaround) !=
               options_.workarounds.end();
    }

    [[noreturn]] void collectForever(Ipmi::Collector& collector)
    {
        Condition reading("the sensors are read again");
        Condition writing(options_.file + " is written again");
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
        if (!device_)
            device_.emplace();
        try {
            collector.pass(*device_, period_);
        } catch (const std::system_error&) {
            device_.reset(); // the kernel may have removed it
            throw;
        } catch (const Ipmi::SilentBmc& silence) {
            if (!silence.hasWaited())
                device_.reset(); // its connection to the BMC may be lost
            throw;
        }
        readAt_ = Vorn::secondsSinceStart();
        period_ =
            std::max<Period>(interval(), shareOfTime * (std::chrono::steady_clock::now() - begin));
    }

    Period interval() const { return std::chrono::seconds(options_.interval); }

    // Does nothing before the sensors have been read: a file of an earlier process says which there
    // are.
    void write(const Ipmi::Collector& collector)
    {
        if (!readAt_)
            return;
        const Vorn::Renewal renewal{std::chrono::duration<double>(period_).count(), *readAt_};
        const auto nodes = options_.isOnlyPresent ? collector.presentNodes() : collector.nodes();
        file_->renew(escapeUnprintable(Vorn::writeMachineFile({nodes, renewal})));
    }

    const CollectOptions& options_;
    std::optional<Ipmi::IpmiDevice> device_; // open between passes, too, for its lock
    std::optional<RenewedFile> file_;
    Period period_{};
    std::optional<double> readAt_; // the end of the last pass that the BMC answered
};

int collect(int argc, const char* const* argv)
{
    CollectOptions options;
    if (const std::optional<int> ended = options.parse(argc, argv))
        return *ended;
    Collection(options).run();
    return EXIT_SUCCESS;
}

} // namespace

int main(int argc, char** argv)
{
    std::signal(SIGPIPE, SIG_IGN); // the reader of standard error may end first
    try {
        return collect(argc, argv);
    } catch (const std::exception& error) {
        complain(error.what());
        return EXIT_FAILURE;
    }
}
