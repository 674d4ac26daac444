// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A key is accepted as a text by its type and state, an element of an up-call by its type and
// pointer alone.

#include "providers/AssociationRequests.h"
#include "tests/support/ProviderTest.h"

namespace BrokerValuesTests {

using namespace Vorn::SensorProfileProvider;
using Testing::ProviderTest;

constexpr CMPIValueState unusable[] = {CMPI_nullValue, CMPI_notFound, CMPI_badValue,
    CMPI_nullValue | CMPI_notFound, CMPI_keyValue | CMPI_nullValue};
constexpr CMPIValueState usable[] = {CMPI_goodValue, CMPI_keyValue};
constexpr CMPIType noText[] = {CMPI_null, CMPI_chars, CMPI_uint64, CMPI_sint64, CMPI_boolean,
    CMPI_ref, CMPI_instance, CMPI_stringA};

class BrokerValuesTest : public ProviderTest {
protected:
    // Returns the text that is read from a path whose only key has this value.
    static CMPIString* readAsText(const CMPIData& key, CMPIStatus* status)
    {
        static CMPIData answer;
        static CMPIObjectPathFT functions;
        answer = key;
        functions = Host::ObjectPath::functions;
        functions.getKey = [](const CMPIObjectPath*, const char*, CMPIStatus* rc) {
            *rc = {CMPI_RC_ERR_NO_SUCH_PROPERTY, nullptr};
            return answer;
        };
        static int handle;
        const CMPIObjectPath path = {&handle, &functions};
        return textKey(&path, "Key", status);
    }

    static CMPIData dataOf(CMPIType type, CMPIValueState state, CMPIString* string)
    {
        CMPIData data = {type, state, {}};
        data.value.string = string;
        return data;
    }

    CMPIString* text_ = Host::String::make(request_->arena(), "text").handle();
    CMPIStatus status_ = {CMPI_RC_OK, nullptr};
};

TEST_F(BrokerValuesTest, ATextKeyIsItsString)
{
    for (const CMPIValueState state : usable)
        EXPECT_EQ(readAsText(dataOf(CMPI_string, state, text_), &status_), text_);
}

TEST_F(BrokerValuesTest, ATextKeyOfAnotherTypeOrStateIsAbsentAndNoFailure)
{
    for (const CMPIValueState state : unusable)
        EXPECT_EQ(readAsText(dataOf(CMPI_string, state, text_), &status_), nullptr) << state;
    for (const CMPIType type : noText)
        EXPECT_EQ(readAsText(dataOf(type, 0, text_), &status_), nullptr) << type;
    CMPIString handleless = {nullptr, text_->ft};
    EXPECT_EQ(readAsText(dataOf(CMPI_string, 0, &handleless), &status_), nullptr);
    EXPECT_EQ(readAsText(dataOf(CMPI_string, 0, nullptr), &status_), nullptr);
    EXPECT_EQ(status_.rc, CMPI_RC_OK);
}

TEST_F(BrokerValuesTest, APathIsAPathWithAHandleWhateverItsState)
{
    Host::ObjectPath& path = this->path("C");
    CMPIData data = {CMPI_ref, 0, {}};
    data.value.ref = path.handle();
    EXPECT_EQ(pathOf(data), path.handle());
    EXPECT_EQ(instanceOf(data), nullptr);
    for (const CMPIValueState state : unusable) {
        data.state = state;
        EXPECT_EQ(pathOf(data), path.handle());
    }
    CMPIObjectPath handleless = {nullptr, path.handle()->ft};
    data = {CMPI_ref, 0, {}};
    data.value.ref = &handleless;
    EXPECT_EQ(pathOf(data), nullptr);
}

TEST_F(BrokerValuesTest, AnInstanceIsAnInstanceWithAHandleWhateverItsState)
{
    Host::Instance& instance = request_->makeInstance(path("C"));
    CMPIData data = {CMPI_instance, 0, {}};
    data.value.inst = instance.handle();
    EXPECT_EQ(instanceOf(data), instance.handle());
    EXPECT_EQ(pathOf(data), nullptr);
    for (const CMPIValueState state : unusable) {
        data.state = state;
        EXPECT_EQ(instanceOf(data), instance.handle());
    }
    CMPIInstance handleless = {nullptr, instance.handle()->ft};
    data = {CMPI_instance, 0, {}};
    data.value.inst = &handleless;
    EXPECT_EQ(instanceOf(data), nullptr);
}

} // namespace BrokerValuesTests
