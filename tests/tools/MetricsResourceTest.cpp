// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/MetricsResource.h"

#include <gtest/gtest.h>

namespace {

using Host::Http::HttpError;
using Host::Http::RequestHead;
using Tools::Exposition;
using Tools::Harvest;

class MetricsResourceTest : public testing::Test {
protected:
    Tools::SingleFlight<Harvest> harvests_{[this] {
        ++harvestCount_;
        return std::make_shared<const Harvest>();
    }};
    int harvestCount_ = 0;
    const RequestHead head_{"GET", "/metrics", "HTTP/1.1", {}};
};

TEST_F(MetricsResourceTest, EachScrapeAfterTheOtherHasAHarvestOfItsOwn)
{
    Tools::MetricsResource metrics(harvests_, [](Exposition&) {});
    const auto first = metrics.represent(head_);
    const auto second = metrics.represent(head_);
    EXPECT_EQ(harvestCount_, 2);
    EXPECT_NE(first.content, second.content);
}

TEST_F(MetricsResourceTest, TextThatClientsHaveYetToFetchIsBounded)
{
    const std::string large(std::size_t{25} << 20, 'x');
    Tools::MetricsResource metrics(
        harvests_, [&](Exposition& exposition) { exposition.append(large); });
    auto first = metrics.represent(head_);
    const auto second = metrics.represent(head_);
    try {
        metrics.represent(head_);
        ADD_FAILURE() << "a third text";
    } catch (const HttpError& error) {
        EXPECT_EQ(error.status(), 503U);
    }
    EXPECT_EQ(harvestCount_, 2); // the third was refused without one
    first = {};
    EXPECT_GT(metrics.represent(head_).content->size(), large.size());
}

} // namespace
