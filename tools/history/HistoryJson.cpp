// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/history/HistoryJson.h"

#include "tools/output/JsonText.h"

#include <array>
#include <charconv>
#include <cmath>

namespace Tools {

namespace {

// An array of readings.
class Readings {
public:
    void add(float value)
    {
        json_ += json_.empty() ? "" : ",";
        if (!std::isfinite(value)) {
            json_ += "null";
            return;
        }
        std::array<char, 32> text{};
        const auto end = std::to_chars(text.data(), text.data() + text.size(), value).ptr;
        json_.append(text.data(), end);
    }

    void appendTo(std::string& json, const char* name) const
    {
        json.append(", \"").append(name).append("\": [").append(json_).append("]");
    }

private:
    std::string json_;
};

// The states one after another, each with the number of samples that it lasted.
class StateRuns {
public:
    void add(unsigned state)
    {
        if (count_ > 0 && state != state_)
            finishRun();
        state_ = state;
        ++count_;
    }

    void appendTo(std::string& json)
    {
        finishRun();
        json.append(", \"states\": [").append(json_).append("]");
    }

private:
    void finishRun()
    {
        json_ += json_.empty() ? "[" : ",[";
        if (state_ == 0)
            json_ += "null";
        else
            appendString(json_, stateNumbered(state_).word);
        json_.append(",").append(std::to_string(count_)).append("]");
        count_ = 0;
    }

    std::string json_;
    unsigned state_ = 0;
    unsigned count_ = 0;
};

void appendHour(
    std::string& json, std::string_view deviceId, const Readings& values, StateRuns& states)
{
    json += "{\"deviceId\": ";
    appendString(json, deviceId);
    values.appendTo(json, "values");
    states.appendTo(json);
    json += "}";
}

} // namespace

void appendHour(
    std::string& json, std::string_view deviceId, const Samples& samples, SlotNumber newest)
{
    Readings values;
    StateRuns states;
    for (SlotNumber slot = newest - Samples::slotsKept + 1; slot <= newest; ++slot) {
        const auto [value, state] = samples.ofSlot(slot);
        values.add(value);
        states.add(state);
    }
    appendHour(json, deviceId, values, states);
}

void appendThinnedHour(
    std::string& json, std::string_view deviceId, const Samples& samples, SlotNumber newest)
{
    Readings values;
    StateRuns states;
    SlotNumber slot = newest - Samples::slotsKept + 1;
    for (SlotNumber i = 0; i < thinnedSamples; ++i) {
        float sum = 0;
        int count = 0;
        unsigned mostUrgent = 0;
        for (const SlotNumber end = slot + slotsOfMinute; slot < end; ++slot) {
            const auto [value, state] = samples.ofSlot(slot);
            mostUrgent = moreUrgent(mostUrgent, state);
            if (std::isnan(value))
                continue;
            sum += value;
            ++count;
        }
        values.add(count == 0 ? Samples::absent : sum / static_cast<float>(count));
        states.add(mostUrgent);
    }
    appendHour(json, deviceId, values, states);
}

void appendDay(
    std::string& json, std::string_view deviceId, const Samples& samples, SlotNumber newest)
{
    Readings minima;
    Readings means;
    Readings maxima;
    StateRuns states;
    const SlotNumber newestMinute = minuteOf(newest);
    for (SlotNumber minute = newestMinute - Samples::minutesKept + 1; minute <= newestMinute;
         ++minute) {
        const auto sample = samples.ofMinute(minute);
        minima.add(sample.minimum);
        means.add(sample.mean);
        maxima.add(sample.maximum);
        states.add(sample.state);
    }
    json += "{\"deviceId\": ";
    appendString(json, deviceId);
    minima.appendTo(json, "minimum");
    means.appendTo(json, "mean");
    maxima.appendTo(json, "maximum");
    states.appendTo(json);
    json += "}";
}

} // namespace Tools
