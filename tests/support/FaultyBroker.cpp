// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/FaultyBroker.h"

#include "host/broker/Array.h"
#include "host/broker/Broker.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Result.h"
#include "host/broker/String.h"
#include "host/broker/Tables.h"
#include "tests/support/TraceRecorder.h"

#include <cstring>
#include <tuple>
#include <type_traits>

namespace Testing {

namespace {

thread_local FaultyBroker* inForce = nullptr;

// Returns the embedded broker's table of a type.
template <typename Table>
const Table& realTable()
{
    return std::get<const Table&>(std::tie(Host::upcallFunctions, TraceRecorder::functions(),
        Host::String::functions, Host::Array::functions, Host::ObjectPath::functions,
        Host::Instance::functions, Host::Enumeration::functions, Host::Result::functions));
}

// Returns the table with interposed calls.
template <typename Table>
const Table& watchedTable();

template <typename Handle>
using TableOf = std::remove_const_t<std::remove_pointer_t<decltype(Handle::ft)>>;

template <typename Handle>
Handle* handleless()
{
    static Handle object{nullptr, &watchedTable<TableOf<Handle>>()};
    return &object;
}

// Interposes the calls of an object that a call returned; other types have none.
template <typename Other>
void watchObject(const Other&)
{
}
template <typename Handle, typename = TableOf<Handle>>
void watchObject(Handle* object)
{
    if constexpr (!std::is_const_v<Handle>)
        if (object != nullptr && object->ft == &realTable<TableOf<Handle>>())
            object->ft = &watchedTable<TableOf<Handle>>();
}
void watchObject(const CMPIData& data)
{
    if ((data.state & CMPI_nullValue) != 0)
        return;
    if (data.type == CMPI_string)
        watchObject(data.value.string);
    else if (data.type == CMPI_ref)
        watchObject(data.value.ref);
    else if (data.type == CMPI_instance)
        watchObject(data.value.inst);
    else if ((data.type & CMPI_ARRAY) != 0)
        watchObject(data.value.array);
}
void watchObject(CMPIString** name)
{
    if (name != nullptr && *name != nullptr)
        watchObject(*name);
}

CMPIData withoutHandle(CMPIData data)
{
    if (data.type == CMPI_string)
        data.value.string = handleless<CMPIString>();
    else if (data.type == CMPI_ref)
        data.value.ref = handleless<CMPIObjectPath>();
    else if (data.type == CMPI_instance)
        data.value.inst = handleless<CMPIInstance>();
    else if ((data.type & CMPI_ARRAY) != 0)
        data.value.array = handleless<CMPIArray>();
    return data;
}

template <typename Answer>
constexpr bool isObject = false;
template <typename Handle>
constexpr bool isObject<Handle*> = !std::is_const_v<Handle>;

template <typename Answer, typename RealCall>
Answer failed(FaultManner manner, RealCall realCall)
{
    if (manner == FaultManner::errorStatus)
        return realCall();
    if constexpr (std::is_same_v<Answer, CMPIData>)
        return manner == FaultManner::handleless
                   ? withoutHandle(realCall())
                   : CMPIData{CMPI_null, CMPI_nullValue | CMPI_notFound, {}};
    else if constexpr (isObject<Answer>)
        return manner == FaultManner::handleless ? handleless<std::remove_pointer_t<Answer>>()
                                                 : nullptr;
    else
        return Answer();
}

void setStatus(CMPIStatus* status, CMPIrc code)
{
    if (status != nullptr && code != CMPI_RC_OK)
        *status = {code, nullptr};
}
template <typename Other>
void setStatus(const Other&, CMPIrc)
{
}

template <typename Handle, typename... Rest>
void loseHandle(Handle* object, const Rest&...)
{
    const_cast<std::remove_const_t<Handle>*>(object)->hdl = nullptr;
}

// Replaces the address of a value by that of a copy of a whole CMPIValue. The address of a text
// (CMPI_chars) stays.
template <typename... Others>
void copyValue(CMPIValue&, const Others&...)
{
}
template <typename Handle, typename Name>
void copyValue(
    CMPIValue& copy, const Handle*, const Name&, const CMPIValue*& value, const CMPIType& type)
{
    if (value == nullptr || type == CMPI_chars)
        return;
    std::memcpy(&copy, value, sizeof copy);
    value = &copy;
}

const Fault* faultOf(BrokerCall call, const void*)
{
    return FaultyBroker::arrived(call);
}
const Fault* faultOf(BrokerCall call, const CMPIObjectPath* path)
{
    return FaultyBroker::arrived(call, path);
}

template <BrokerCall call, auto slot>
struct Interposed;
template <BrokerCall call, typename Table, typename Answer, typename... Arguments,
    Answer (*Table::*slot)(Arguments...)>
struct Interposed<call, slot> {
    static Answer function(Arguments... arguments)
    {
        CMPIValue copy{};
        copyValue(copy, arguments...);
        const auto realCall = [&] {
            const Answer answer = (realTable<Table>().*slot)(arguments...);
            watchObject(answer);
            (watchObject(arguments), ...);
            return answer;
        };
        const Fault* const fault = faultOf(call, std::get<0>(std::tie(arguments...)));
        if (fault == nullptr)
            return realCall();
        if constexpr (std::is_same_v<Answer, CMPIStatus>) {
            if (fault->manner == FaultManner::lostHandle) {
                const Answer answer = realCall();
                loseHandle(arguments...);
                return answer;
            }
            return {fault->code, nullptr};
        } else {
            const Answer answer = failed<Answer>(fault->manner, realCall);
            (setStatus(arguments, fault->code), ...);
            return answer;
        }
    }
};

template <BrokerCall call, auto slot, typename Table>
void interpose(Table& table)
{
    table.*slot = &Interposed<call, slot>::function;
}

void interposeAll(CMPIBrokerFT& table)
{
    using Table = CMPIBrokerFT;
    interpose<BrokerCall::enumerateInstanceNames, &Table::enumerateInstanceNames>(table);
    interpose<BrokerCall::enumerateInstances, &Table::enumerateInstances>(table);
    interpose<BrokerCall::getInstance, &Table::getInstance>(table);
}

void interposeAll(CMPIBrokerEncFT& table)
{
    using Table = CMPIBrokerEncFT;
    interpose<BrokerCall::newObjectPath, &Table::newObjectPath>(table);
    interpose<BrokerCall::newInstance, &Table::newInstance>(table);
    interpose<BrokerCall::newString, &Table::newString>(table);
    interpose<BrokerCall::newArray, &Table::newArray>(table);
    interpose<BrokerCall::trace, &Table::trace>(table);
}

void interposeAll(CMPIStringFT& table)
{
    interpose<BrokerCall::getCharPtr, &CMPIStringFT::getCharPtr>(table);
}

void interposeAll(CMPIArrayFT& table)
{
    interpose<BrokerCall::setElementAt, &CMPIArrayFT::setElementAt>(table);
}

void interposeAll(CMPIObjectPathFT& table)
{
    using Table = CMPIObjectPathFT;
    interpose<BrokerCall::getNameSpace, &Table::getNameSpace>(table);
    interpose<BrokerCall::getClassName, &Table::getClassName>(table);
    interpose<BrokerCall::getHostname, &Table::getHostname>(table);
    interpose<BrokerCall::setNameSpace, &Table::setNameSpace>(table);
    interpose<BrokerCall::setHostname, &Table::setHostname>(table);
    interpose<BrokerCall::addKey, &Table::addKey>(table);
    interpose<BrokerCall::getKey, &Table::getKey>(table);
    interpose<BrokerCall::getKeyAt, &Table::getKeyAt>(table);
    interpose<BrokerCall::getKeyCount, &Table::getKeyCount>(table);
}

void interposeAll(CMPIInstanceFT& table)
{
    using Table = CMPIInstanceFT;
    interpose<BrokerCall::setProperty, &Table::setProperty>(table);
    interpose<BrokerCall::setPropertyFilter, &Table::setPropertyFilter>(table);
    interpose<BrokerCall::getProperty, &Table::getProperty>(table);
    interpose<BrokerCall::getObjectPath, &Table::getObjectPath>(table);
}

void interposeAll(CMPIEnumerationFT& table)
{
    interpose<BrokerCall::hasNext, &CMPIEnumerationFT::hasNext>(table);
    interpose<BrokerCall::getNext, &CMPIEnumerationFT::getNext>(table);
}

void interposeAll(CMPIResultFT& table)
{
    using Table = CMPIResultFT;
    interpose<BrokerCall::returnInstance, &Table::returnInstance>(table);
    interpose<BrokerCall::returnObjectPath, &Table::returnObjectPath>(table);
    interpose<BrokerCall::returnDone, &Table::returnDone>(table);
}

template <typename Table>
const Table& watchedTable()
{
    static const Table table = [] {
        Table copy = realTable<Table>();
        interposeAll(copy);
        return copy;
    }();
    return table;
}

template <typename Handle>
const Handle* watched(const Handle* object)
{
    watchObject(const_cast<Handle*>(object));
    return object;
}

} // namespace

FaultyBroker::FaultyBroker(const Host::Broker& broker)
    : upcalls_(watchedTable<CMPIBrokerFT>()), handle_(*broker.handle()), before_(inForce)
{
    upcalls_.brokerName = broker.handle()->bft->brokerName;
    upcalls_.brokerCapabilities = broker.handle()->bft->brokerCapabilities;
    // The copy keeps the handle, by which the embedded broker is found.
    handle_.bft = &upcalls_;
    handle_.eft = &watchedTable<CMPIBrokerEncFT>();
    inForce = this;
}

FaultyBroker::~FaultyBroker()
{
    inForce = before_;
}

const CMPIObjectPath* FaultyBroker::watch(const CMPIObjectPath* path) const
{
    return watched(path);
}

const CMPIResult* FaultyBroker::watch(const CMPIResult* result) const
{
    return watched(result);
}

void FaultyBroker::reset()
{
    faults_.clear();
    calls_.clear();
    pathCalls_.clear();
    counts_.fill(0);
    fired_ = 0;
}

unsigned FaultyBroker::count(BrokerCall call) const
{
    return counts_[static_cast<std::size_t>(call)];
}

const Fault* FaultyBroker::arrived(BrokerCall call)
{
    if (inForce == nullptr)
        return nullptr;
    inForce->calls_.push_back(call);
    const unsigned nth = ++inForce->counts_[static_cast<std::size_t>(call)];
    for (const Fault& fault : inForce->faults_)
        if (fault.call == call && fault.nth == nth) {
            ++inForce->fired_;
            return &fault;
        }
    return nullptr;
}

const Fault* FaultyBroker::arrived(BrokerCall call, const CMPIObjectPath* path)
{
    const Host::ObjectPath* const called = Host::ObjectPath::of(path);
    if (inForce != nullptr && called != nullptr)
        inForce->pathCalls_.push_back(nameOf(call) + " " + std::string(called->className()));
    return arrived(call);
}

} // namespace Testing
