// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The providers answer in OpenPegasus and sfcb what they answer in `sensorctl serve`, but for the
// differences that are known.

#include "tests/objectmanagers/Differences.h"
#include "tests/objectmanagers/InstalledManager.h"
#include "tests/tools/ServerProcess.h"
#include "tests/tools/ToolTest.h"

#include <algorithm>
#include <future>
#include <memory>

namespace {

using namespace Testing;

struct Peer {
    const InstalledManager& manager;
    std::span<const Difference> differences;
    std::vector<Answer> answers = {}; // one for each request
    Declarations declarations = {};
};

std::vector<Answer> askAll(
    const InstalledManager& manager, const std::vector<ClientRequest>& requests)
{
    std::vector<Answer> answers;
    for (const ClientRequest& request : requests)
        answers.push_back(ask(request.arguments(manager.url(request.object))));
    return answers;
}

Declarations declarationsIn(const InstalledManager& manager)
{
    Declarations declarations;
    for (const std::string& name : servedClasses)
        declarations[name] = ask({"gc", manager.url(name)}).objects.begin()->second;
    return declarations;
}

// Asks all that the tests compare, once.
class AskedMachine : public ToolTest {
public:
    AskedMachine()
    {
        requests = allRequests([this](const std::string& className) {
            std::vector<std::string> paths;
            for (const auto& [path, properties] : askService({"ein", className}).objects)
                paths.push_back(path);
            return paths;
        });
        std::vector<std::future<std::vector<Answer>>> asking;
        for (Peer& peer : peers) {
            peer.manager.reset();
            peer.manager.startWithProviders(settings_);
            peer.declarations = declarationsIn(peer.manager);
            asking.push_back(
                std::async(std::launch::async, [&] { return askAll(peer.manager, requests); }));
        }
        for (const ClientRequest& request : requests)
            askService(request);
        for (std::size_t i = 0; i < peers.size(); ++i)
            peers[i].answers = asking[i].get();
    }

    const Answer& askService(const ClientRequest& request)
    {
        const auto known = serviceAnswers_.find(request);
        if (known != serviceAnswers_.end())
            return known->second;
        const std::string url =
            "http://127.0.0.1:" + std::to_string(service_.port()) +
            (InstalledManager::isInterop(request.object) ? "/root/interop:" : "/root/cimv2:") +
            request.object;
        return serviceAnswers_.emplace(request, ask(request.arguments(url))).first->second;
    }

    std::vector<ClientRequest> requests;
    std::vector<Peer> peers = {{InstalledManager::openPegasus(), differencesOfOpenPegasus()},
        {InstalledManager::sfcb(), differencesOfSfcb()}};

private:
    void TestBody() override {}

    const std::map<std::string, std::string> settings_ = {
        {"RYNLOG_LOG", "off"}, {"VORN_INSTRUMENTATION", "model:" + smallModel()}};
    ServerProcess service_{{}, settings_};
    std::map<ClientRequest, Answer> serviceAnswers_;
};

class AnswersTest : public testing::TestWithParam<std::size_t> {
protected:
    static void SetUpTestSuite() { machine_ = std::make_unique<AskedMachine>(); }
    static void TearDownTestSuite() { machine_.reset(); }

    // Returns what the service answers to all that the request is equivalent to by these
    // differences.
    static Equivalent equivalentOf(
        const ClientRequest& request, const std::vector<const Difference*>& differences)
    {
        Equivalent equivalent{.requests = {request}};
        for (const Difference* difference : differences) {
            if (difference->equivalentOf == nullptr)
                continue;
            std::vector<ClientRequest> requests;
            for (const ClientRequest& each : equivalent.requests) {
                const auto found = difference->equivalentOf(each);
                if (found && found->error != 0)
                    return *found;
                const std::vector<ClientRequest> same = {each};
                const std::vector<ClientRequest>& more = found ? found->requests : same;
                requests.insert(requests.end(), more.begin(), more.end());
            }
            equivalent.requests = requests;
        }
        return equivalent;
    }

    Answer expectedOf(
        const ClientRequest& request, const std::vector<const Difference*>& differences) const
    {
        const Equivalent equivalent = equivalentOf(request, differences);
        Answer answer{.error = equivalent.error};
        for (const ClientRequest& each : equivalent.requests) {
            Answer part = machine_->askService(each);
            for (const Difference* difference : differences)
                if (difference->change != nullptr)
                    difference->change(each, peer_.declarations, part);
            answer.error = std::max(answer.error, part.error);
            answer.objects.merge(part.objects);
        }
        return answer;
    }

    // Returns the differences but for one.
    std::vector<const Difference*> differencesBut(const Difference* left = nullptr) const
    {
        std::vector<const Difference*> all;
        for (const Difference& each : peer_.differences)
            if (&each != left)
                all.push_back(&each);
        return all;
    }

    // Returns how many requests are answered otherwise than expected.
    std::size_t unexpected(const std::vector<const Difference*>& differences) const
    {
        std::size_t count = 0;
        for (std::size_t i = 0; i < machine_->requests.size(); ++i)
            if (peer_.answers[i] != expectedOf(machine_->requests[i], differences))
                ++count;
        return count;
    }

    static inline std::unique_ptr<AskedMachine> machine_;
    const Peer& peer_ = machine_->peers.at(GetParam());
};

TEST_P(AnswersTest, AreThoseOfTheServiceButForTheDifferences)
{
    RecordProperty("requests", static_cast<int>(machine_->requests.size()));
    int shown = 0;
    for (std::size_t i = 0; i < machine_->requests.size() && shown < 5; ++i) {
        const ClientRequest& request = machine_->requests[i];
        const Answer expected = expectedOf(request, differencesBut());
        EXPECT_EQ(describe(peer_.answers[i]), describe(expected)) << request;
        shown += peer_.answers[i] == expected ? 0 : 1;
    }
}

TEST_P(AnswersTest, EachDifferenceIsSeen)
{
    for (const Difference& difference : peer_.differences)
        EXPECT_GT(unexpected(differencesBut(&difference)), 0U) << difference.what;
}

INSTANTIATE_TEST_SUITE_P(ObjectManagers, AnswersTest, testing::Values(0, 1),
    [](const auto& each) { return each.param == 0 ? "openpegasus" : "sfcb"; });

} // namespace
