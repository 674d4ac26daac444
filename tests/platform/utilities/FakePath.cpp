// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/platform/utilities/FakePath.h"

#include <utility>

namespace Testing {

namespace {

// The double behind an object, whatever constness the headers give handles.
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

CMPIData data(CMPIType type)
{
    CMPIData made{};
    made.type = type;
    made.state = CMPI_keyValue;
    return made;
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
    CMPIData made = data(CMPI_string);
    made.value.string = texts_.emplace_back(std::move(value)).get();
    return key(name, made);
}

FakePath& FakePath::chars(const std::string& name, const char* value)
{
    CMPIData made = data(CMPI_chars);
    made.value.chars = const_cast<char*>(value);
    return key(name, made);
}

FakePath& FakePath::reference(const std::string& name, CMPIObjectPath* value)
{
    CMPIData made = data(CMPI_ref);
    made.value.ref = value;
    return key(name, made);
}

FakePath& FakePath::dateTime(const std::string& name, std::optional<std::string> form)
{
    CMPIData made = data(CMPI_dateTime);
    made.value.dateTime = dateTimes_.emplace_back(std::move(form)).get();
    return key(name, made);
}

CMPIData boolean(bool value)
{
    CMPIData made = data(CMPI_boolean);
    made.value.boolean = value ? 1 : 0;
    return made;
}

CMPIData signedInteger(CMPIType type, CMPISint64 value)
{
    CMPIData made = data(type);
    if (type == CMPI_sint8)
        made.value.sint8 = static_cast<CMPISint8>(value);
    else if (type == CMPI_sint16)
        made.value.sint16 = static_cast<CMPISint16>(value);
    else if (type == CMPI_sint32)
        made.value.sint32 = static_cast<CMPISint32>(value);
    else
        made.value.sint64 = value;
    return made;
}

CMPIData unsignedInteger(CMPIType type, CMPIUint64 value)
{
    CMPIData made = data(type);
    if (type == CMPI_uint8)
        made.value.uint8 = static_cast<CMPIUint8>(value);
    else if (type == CMPI_uint16)
        made.value.uint16 = static_cast<CMPIUint16>(value);
    else if (type == CMPI_uint32)
        made.value.uint32 = static_cast<CMPIUint32>(value);
    else
        made.value.uint64 = value;
    return made;
}

CMPIData real(CMPIType type, double value)
{
    CMPIData made = data(type);
    if (type == CMPI_real32)
        made.value.real32 = static_cast<CMPIReal32>(value);
    else
        made.value.real64 = value;
    return made;
}

CMPIData character(CMPIChar16 value)
{
    CMPIData made = data(CMPI_char16);
    made.value.char16 = value;
    return made;
}

CMPIData poisoned(CMPIType type, CMPIValueState state)
{
    CMPIData made = data(type);
    made.state = state;
    made.value.uint64 = 1;
    return made;
}

} // namespace Testing
