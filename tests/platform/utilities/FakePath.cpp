// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/platform/utilities/FakePath.h"

#include <utility>

namespace Testing {

namespace {

// Returns the double behind an object; the header sets differ in the constness of handles.
template <typename Double, typename Object>
Double& behind(const Object* object)
{
    return *static_cast<Double*>(const_cast<void*>(static_cast<const void*>(object->hdl)));
}

void report(CMPIStatus* status, CMPIrc outcome)
{
    if (status != nullptr)
        *status = {outcome, nullptr};
}

const CMPIStringFT& stringTable()
{
    static const CMPIStringFT table = [] {
        CMPIStringFT made{};
        made.getCharPtr = [](const CMPIString* string, CMPIStatus* status) -> const char* {
            const auto& fake = behind<FakeString>(string);
            report(status, fake.outcome);
            return fake.text ? fake.text->c_str() : nullptr;
        };
        return made;
    }();
    return table;
}

const CMPIDateTimeFT& dateTimeTable()
{
    static const CMPIDateTimeFT table = [] {
        CMPIDateTimeFT made{};
        made.getStringFormat = [](const CMPIDateTime* dateTime, CMPIStatus* status) {
            auto& fake = behind<FakeDateTime>(dateTime);
            report(status, fake.outcome);
            return fake.form.get();
        };
        return made;
    }();
    return table;
}

template <FakeString FakePath::*text>
CMPIString* textOfPath(const CMPIObjectPath* path, CMPIStatus* status)
{
    report(status, CMPI_RC_OK);
    return (behind<FakePath>(path).*text).get();
}

CMPICount keyCount(const CMPIObjectPath* path, CMPIStatus* status)
{
    const auto& fake = behind<FakePath>(path);
    report(status, fake.countOutcome);
    return static_cast<CMPICount>(fake.keys.size());
}

CMPIData keyAt(const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* status)
{
    auto& fake = behind<FakePath>(path);
    const bool fails = fake.failingKey == index || index >= fake.keys.size();
    report(status, fails ? CMPI_RC_ERR_FAILED : CMPI_RC_OK);
    if (fails)
        return {};
    *name = fake.namelessKey == index ? nullptr : fake.keys[index].name.get();
    return fake.keys[index].data;
}

const CMPIObjectPathFT& pathTable()
{
    static const CMPIObjectPathFT table = [] {
        CMPIObjectPathFT made{};
        made.getNameSpace = textOfPath<&FakePath::nameSpace>;
        made.getClassName = textOfPath<&FakePath::className>;
        made.getHostname = textOfPath<&FakePath::hostName>;
        made.getKeyCount = keyCount;
        made.getKeyAt = keyAt;
        return made;
    }();
    return table;
}

} // namespace

FakeString::FakeString(std::optional<std::string> characters) : text(std::move(characters))
{
    object_.hdl = this;
    object_.ft = &stringTable();
}

FakeDateTime::FakeDateTime(std::optional<std::string> text) : form(std::move(text))
{
    object_.hdl = this;
    object_.ft = &dateTimeTable();
}

FakePath::FakePath(std::optional<std::string> space, std::optional<std::string> name)
    : nameSpace(std::move(space)), className(std::move(name))
{
    object_.hdl = this;
    object_.ft = &pathTable();
}

FakePath& FakePath::key(const std::string& name, const CMPIData& value)
{
    keys.emplace_back(name, value);
    return *this;
}

FakePath& FakePath::text(const std::string& name, std::optional<std::string> value)
{
    return key(name, valueOf(CMPI_string, texts_.emplace_back(std::move(value)).get()));
}

FakePath& FakePath::dateTime(const std::string& name, std::optional<std::string> form)
{
    return key(name, valueOf(CMPI_dateTime, dateTimes_.emplace_back(std::move(form)).get()));
}

CMPIData poisoned(CMPIType type, CMPIValueState state)
{
    CMPIData made = valueOf(type, CMPIUint64{1});
    made.state = state;
    return made;
}

} // namespace Testing
