// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The function tables as a whole: complete, of version 2.00, and indifferent to objects that
// are null, have no handle, or are of another kind.

#include "host/broker/Tables.h"
#include "host/broker/Arguments.h"
#include "host/broker/Array.h"
#include "host/broker/Context.h"
#include "host/broker/DateTime.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Error.h"
#include "host/broker/Instance.h"
#include "host/broker/Result.h"
#include "host/broker/String.h"
#include "tests/host/broker/BrokerTest.h"

#include <cstring>
#include <type_traits>
#include <vector>

namespace HostTests {

namespace {

// The slots after the version (and, of the broker's own table, after its name).
template <typename Table>
std::vector<const void*> slotsOf(const Table& table, std::size_t first)
{
    std::vector<const void*> slots((sizeof table - first) / sizeof(void*));
    std::memcpy(
        slots.data(), reinterpret_cast<const char*>(&table) + first, slots.size() * sizeof(void*));
    return slots;
}

template <typename Table>
void expectComplete(const Table& table)
{
    EXPECT_EQ(table.ftVersion, 200U);
    EXPECT_THAT(slotsOf(table, sizeof(void*)), testing::Each(testing::NotNull()));
}

template <typename Argument>
Argument zero()
{
    return Argument();
}

bool isRefusal(const CMPIStatus& status)
{
    return status.rc == CMPI_RC_ERR_INVALID_HANDLE || status.rc == CMPI_RC_ERR_NOT_SUPPORTED;
}

template <typename Answer>
bool isNothing(const Answer& answer)
{
    if constexpr (std::is_same_v<Answer, CMPIData>)
        return answer.state == absentState && answer.type == CMPI_null;
    else if constexpr (std::is_same_v<Answer, CMPIStatus>)
        return isRefusal(answer);
    else
        return answer == Answer();
}

// Calls the slot with an object and otherwise nothing, once without a status to write to.
template <typename Answer, typename Handle, typename... Arguments>
void expectRefused(Answer (*slot)(Handle*, Arguments...), std::remove_const_t<Handle>* object)
{
    if constexpr (std::is_void_v<Answer>) {
        slot(object, zero<Arguments>()...);
    } else {
        EXPECT_TRUE(isNothing(slot(object, zero<Arguments>()...)));
        CMPIStatus status{CMPI_RC_OK, nullptr};
        bool hasStatus = false;
        const auto argument = [&](auto value) {
            if constexpr (std::is_same_v<decltype(value), CMPIStatus*>) {
                hasStatus = true;
                return &status;
            } else {
                return value;
            }
        };
        EXPECT_TRUE(isNothing(slot(object, argument(zero<Arguments>())...)));
        if (hasStatus) {
            EXPECT_TRUE(isRefusal(status)) << status.rc;
        }
    }
}

// The same through null, a handle-less object, and one of another kind.
template <typename Handle, typename Table, typename... Slots>
void expectSafe(const Table& table, const void* another, Slots Table::*... slots)
{
    Handle handleless{};
    (expectRefused(table.*slots, static_cast<Handle*>(nullptr)), ...);
    (expectRefused(table.*slots, &handleless), ...);
    Handle misplaced{};
    std::memcpy(static_cast<void*>(&misplaced), &another, sizeof another);
    (expectRefused(table.*slots, &misplaced), ...);
}

} // namespace

TEST(TablesTest, EveryTableIsComplete)
{
    for (const bool hasUpcalls : {false, true}) {
        Host::Broker broker;
        if (hasUpcalls)
            broker.setUpcalls(nullptr);
        const CMPIBrokerFT& own = *broker.handle()->bft;
        EXPECT_EQ(own.brokerVersion, 200U);
        EXPECT_STREQ(own.brokerName, "sensor-profile");
        EXPECT_THAT(slotsOf(own, offsetof(CMPIBrokerFT, prepareAttachThread)),
            testing::Each(testing::NotNull()));
    }
    expectComplete(Host::encapsulationFunctions);
    expectComplete(Host::operatingSystemFunctions);
    expectComplete(Host::memoryFunctions);
    expectComplete(Host::String::functions);
    expectComplete(Host::Array::functions);
    expectComplete(Host::ObjectPath::functions);
    expectComplete(Host::Instance::functions);
    expectComplete(Host::Enumeration::functions);
    expectComplete(Host::DateTime::functions);
    expectComplete(Host::Arguments::functions);
    expectComplete(Host::Context::functions);
    expectComplete(Host::Result::functions);
    expectComplete(Host::Error::functions);
}

TEST(TablesTest, TheBrokerClaimsWhatItOffers)
{
    Host::Broker broker({.name = "other", .hasMemoryServices = false});
    EXPECT_STREQ(broker.handle()->bft->brokerName, "other");
    EXPECT_EQ(broker.handle()->mft, nullptr);
    EXPECT_EQ(broker.handle()->bft->brokerCapabilities,
        static_cast<unsigned>(CMPI_MB_OSEncapsulationSupport | CMPI_MB_Supports_Extended_Error));
    EXPECT_EQ(Host::Broker::of(broker.handle()), &broker);
    EXPECT_EQ(Host::Broker::of(nullptr), nullptr);
}

class SafetyTest : public BrokerTest {
protected:
    const void* aPath = path()->hdl;
    const void* aString = string("text")->hdl;
};

TEST_F(SafetyTest, OfStrings)
{
    using T = CMPIStringFT;
    expectSafe<CMPIString>(Host::String::functions, aPath, &T::release, &T::clone, &T::getCharPtr);
}

TEST_F(SafetyTest, OfArrays)
{
    using T = CMPIArrayFT;
    expectSafe<CMPIArray>(Host::Array::functions, aPath, &T::release, &T::clone, &T::getSize,
        &T::getSimpleType, &T::getElementAt, &T::setElementAt);
}

TEST_F(SafetyTest, OfObjectPaths)
{
    using T = CMPIObjectPathFT;
    expectSafe<CMPIObjectPath>(Host::ObjectPath::functions, aString, &T::release, &T::clone,
        &T::setNameSpace, &T::getNameSpace, &T::setHostname, &T::getHostname, &T::setClassName,
        &T::getClassName, &T::addKey, &T::getKey, &T::getKeyAt, &T::getKeyCount,
        &T::setNameSpaceFromObjectPath, &T::setHostAndNameSpaceFromObjectPath,
        &T::getClassQualifier, &T::getPropertyQualifier, &T::getMethodQualifier,
        &T::getParameterQualifier, &T::toString);
}

TEST_F(SafetyTest, OfInstances)
{
    using T = CMPIInstanceFT;
    expectSafe<CMPIInstance>(Host::Instance::functions, aPath, &T::release, &T::clone,
        &T::getProperty, &T::getPropertyAt, &T::getPropertyCount, &T::setProperty,
        &T::getObjectPath, &T::setPropertyFilter, &T::setObjectPath, &T::setPropertyWithOrigin);
}

TEST_F(SafetyTest, OfEnumerations)
{
    using T = CMPIEnumerationFT;
    expectSafe<CMPIEnumeration>(Host::Enumeration::functions, aPath, &T::release, &T::clone,
        &T::getNext, &T::hasNext, &T::toArray);
}

TEST_F(SafetyTest, OfDateTimes)
{
    using T = CMPIDateTimeFT;
    expectSafe<CMPIDateTime>(Host::DateTime::functions, aPath, &T::release, &T::clone,
        &T::getBinaryFormat, &T::getStringFormat, &T::isInterval);
}

TEST_F(SafetyTest, OfArguments)
{
    using T = CMPIArgsFT;
    expectSafe<CMPIArgs>(Host::Arguments::functions, aPath, &T::release, &T::clone, &T::addArg,
        &T::getArg, &T::getArgAt, &T::getArgCount);
}

TEST_F(SafetyTest, OfContexts)
{
    using T = CMPIContextFT;
    expectSafe<CMPIContext>(Host::Context::functions, aPath, &T::release, &T::clone, &T::getEntry,
        &T::getEntryAt, &T::getEntryCount, &T::addEntry);
}

TEST_F(SafetyTest, OfResults)
{
    using T = CMPIResultFT;
    expectSafe<CMPIResult>(Host::Result::functions, aPath, &T::release, &T::clone, &T::returnData,
        &T::returnInstance, &T::returnObjectPath, &T::returnDone, &T::returnError);
}

TEST_F(SafetyTest, OfErrors)
{
    using T = CMPIErrorFT;
    expectSafe<CMPIError>(Host::Error::functions, aPath, &T::release, &T::clone, &T::getErrorType,
        &T::getOtherErrorType, &T::getOwningEntity, &T::getMessageID, &T::getMessage,
        &T::getPerceivedSeverity, &T::getProbableCause, &T::getProbableCauseDescription,
        &T::getRecommendedActions, &T::getErrorSource, &T::getErrorSourceFormat,
        &T::getOtherErrorSourceFormat, &T::getCIMStatusCode, &T::getCIMStatusCodeDescription,
        &T::getMessageArguments, &T::setErrorType, &T::setOtherErrorType,
        &T::setProbableCauseDescription, &T::setRecommendedActions, &T::setErrorSource,
        &T::setErrorSourceFormat, &T::setOtherErrorSourceFormat, &T::setCIMStatusCodeDescription,
        &T::setMessageArguments);
}

TEST_F(SafetyTest, OfUpcalls)
{
    using T = CMPIBrokerFT;
    expectSafe<CMPIBroker>(*mb->bft, aPath, &T::prepareAttachThread, &T::attachThread,
        &T::detachThread, &T::deliverIndication, &T::enumerateInstanceNames, &T::getInstance,
        &T::createInstance, &T::modifyInstance, &T::deleteInstance, &T::execQuery,
        &T::enumerateInstances, &T::associators, &T::associatorNames, &T::references,
        &T::referenceNames, &T::invokeMethod, &T::setProperty, &T::getProperty);
}

TEST_F(SafetyTest, OfMakingObjects)
{
    using T = CMPIBrokerEncFT;
    expectSafe<CMPIBroker>(*mb->eft, aPath, &T::newInstance, &T::newObjectPath, &T::newArgs,
        &T::newString, &T::newArray, &T::newDateTime, &T::newDateTimeFromBinary,
        &T::newDateTimeFromChars, &T::newSelectExp, &T::classPathIsA, &T::toString, &T::isOfType,
        &T::getType, &T::logMessage, &T::trace, &T::newCMPIError, &T::openMessageFile,
        &T::closeMessageFile);
    EXPECT_EQ(mb->eft->getMessage(nullptr, nullptr, "text", &rc, 0), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(mb->eft->getMessage2(nullptr, nullptr, nullptr, "text", nullptr, 0), nullptr);
}

TEST_F(SafetyTest, OfMemory)
{
    using T = CMPIBrokerMemFT;
    expectSafe<CMPIBroker>(*mb->mft, aPath, &T::mark, &T::release, &T::cmpiMalloc, &T::cmpiCalloc,
        &T::cmpiRealloc, &T::cmpiStrDup, &T::cmpiFree, &T::freeInstance, &T::freeObjectPath,
        &T::freeArgs, &T::freeString, &T::freeArray, &T::freeDateTime, &T::freeSelectExp);
}

// Every slot with a real broker and otherwise nothing.
TEST_F(SafetyTest, OfABrokerThatIsHandedNothing)
{
    EXPECT_EQ(CMNewInstance(mb, nullptr, nullptr), nullptr);
    EXPECT_EQ(CMNewObjectPath(mb, nullptr, nullptr, nullptr), nullptr);
    EXPECT_EQ(CMClassPathIsA(mb, nullptr, nullptr, nullptr), 0);
    EXPECT_EQ(CMClassPathIsA(mb, path(), nullptr, &rc), 0);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CDToString(mb, nullptr, nullptr), nullptr);
    EXPECT_EQ(CDIsOfType(mb, nullptr, nullptr, nullptr), 0);
    EXPECT_EQ(CDIsOfType(mb, path(), nullptr, &rc), 0);
    EXPECT_EQ(CDGetType(mb, nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(mb->eft->getMessage(mb, nullptr, nullptr, &rc, 0), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(CMTraceMessage(mb, CMPI_LEV_INFO, nullptr, nullptr, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(CMLogMessage(mb, CMPI_SEV_INFO, nullptr, nullptr, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(CBEnumInstanceNames(mb, nullptr, nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_HANDLE);
    EXPECT_EQ(CBPrepareAttachThread(mb, nullptr), nullptr);
    EXPECT_EQ(CBAttachThread(mb, nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
    mb->mft->freeString(mb, nullptr);
    mb->mft->freeInstance(mb, nullptr);
}

} // namespace HostTests
