// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Test doubles for object paths, strings and date-times, which can behave as real and as broken
// brokers do.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

#include <cstring>
#include <deque>
#include <optional>
#include <string>
#include <vector>

namespace Testing {

// Returns a key's value of the type that belongs to the member of CMPIValue.
template <typename Member>
CMPIData valueOf(CMPIType type, Member member)
{
    CMPIData data{};
    data.type = type;
    data.state = CMPI_keyValue;
    std::memcpy(&data.value, &member, sizeof member);
    return data;
}

// A broker's string. Its character pointer is null where there is no text.
class FakeString {
public:
    explicit FakeString(std::optional<std::string> text);
    FakeString(const FakeString&) = delete;
    FakeString& operator=(const FakeString&) = delete;

    CMPIString* get() { return &object_; }
    void loseHandle() { object_.hdl = nullptr; }

    std::optional<std::string> text;
    CMPIrc outcome = CMPI_RC_OK;

private:
    CMPIString object_{};
};

// A date-time whose string format is the text.
class FakeDateTime {
public:
    explicit FakeDateTime(std::optional<std::string> form);
    FakeDateTime(const FakeDateTime&) = delete;
    FakeDateTime& operator=(const FakeDateTime&) = delete;

    CMPIDateTime* get() { return &object_; }

    FakeString form;
    CMPIrc outcome = CMPI_RC_OK;

private:
    CMPIDateTime object_{};
};

class FakePath {
public:
    FakePath(std::optional<std::string> nameSpace, std::optional<std::string> className);
    FakePath(const FakePath&) = delete;
    FakePath& operator=(const FakePath&) = delete;

    const CMPIObjectPath* get() const { return &object_; }
    CMPIObjectPath* get() { return &object_; }
    void loseHandle() { object_.hdl = nullptr; }

    // Each returns the path, so that calls can be chained.
    FakePath& key(const std::string& name, const CMPIData& value);
    FakePath& text(const std::string& name, std::optional<std::string> value);
    FakePath& chars(const std::string& name, const char* value)
    {
        return key(name, valueOf(CMPI_chars, value));
    }
    FakePath& reference(const std::string& name, CMPIObjectPath* value)
    {
        return key(name, valueOf(CMPI_ref, value));
    }
    FakePath& dateTime(const std::string& name, std::optional<std::string> form);

    struct Key {
        Key(const std::string& text, const CMPIData& value) : name(text), data(value) {}

        FakeString name;
        CMPIData data;
    };

    FakeString nameSpace;
    FakeString className;
    FakeString hostName{std::nullopt};
    std::deque<Key> keys;
    CMPIrc countOutcome = CMPI_RC_OK;
    std::optional<CMPICount> failingKey;
    std::optional<CMPICount> namelessKey;

private:
    CMPIObjectPath object_{};
    std::deque<FakeString> texts_;
    std::deque<FakeDateTime> dateTimes_;
};

// Returns a value that must not be read: its pointer is invalid.
CMPIData poisoned(CMPIType type, CMPIValueState state);

} // namespace Testing
