// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/SensorMetrics.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

namespace SensorMetricsThreadsTests {

using Tools::ExpositionForm;

std::string textOf(
    Tools::SensorMetrics& metrics, const Tools::Sensors& sensors, ExpositionForm form)
{
    Tools::Exposition exposition(form);
    metrics.addTo(exposition, sensors);
    return std::move(exposition).finish();
}

TEST(SensorMetricsThreadsTest, ScrapesOfBothFormsAtOnceHaveTheLinesOfTheirSensors)
{
    Tools::SensorMetrics metrics(100);
    const auto scrape = [&](ExpositionForm form) {
        for (unsigned round = 0; round < 30; ++round) {
            Tools::Sensors sensors(round % 3 + 1);
            for (Tools::Sensor& sensor : sensors) {
                sensor.setNames("Sensor", "/chip/" + std::to_string(&sensor - sensors.data()));
                sensor.health = round % 2 * 5;
            }
            Tools::SensorMetrics fresh(0);
            EXPECT_EQ(textOf(metrics, sensors, form), textOf(fresh, sensors, form));
        }
    };
    std::vector<std::jthread> threads;
    for (const auto form : {ExpositionForm::text, ExpositionForm::openMetrics, ExpositionForm::text,
             ExpositionForm::openMetrics})
        threads.emplace_back(scrape, form);
}

} // namespace SensorMetricsThreadsTests
