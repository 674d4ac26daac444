// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Object paths, strings and points in time made of a table, with the oddities of real and of
// broken brokers.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

#include <cstring>
#include <deque>
#include <optional>
#include <string>
#include <vector>

namespace Testing {

// Returns a key's value of a type, whose member of CMPIValue is a number or a pointer.
template <typename Member>
CMPIData valueOf(CMPIType type, Member member)
{
    CMPIData data{};
    data.type = type;
    data.state = CMPI_keyValue;
    std::memcpy(&data.value, &member, sizeof member);
    return data;
}

// A broker's string. Without text its character pointer is null.
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

// A point in time whose standard form is the text.
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

    // Each returns the path, so that keys can be listed in a row.
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

// A value that must not be looked at: its pointer leads nowhere.
CMPIData poisoned(CMPIType type, CMPIValueState state);

} // namespace Testing
