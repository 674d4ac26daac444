// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/ProviderUtilities.h"
#include "tests/platform/utilities/FakePath.h"

#include <gtest/gtest.h>

#include <deque>
#include <limits>
#include <type_traits>
#include <vector>

namespace {

using namespace Testing;
using Vorn::isObjPathsEqual;

constexpr auto sensorClass = "ZUMLO_NumericSensor";
const CMPIData yes = valueOf(CMPI_boolean, CMPIBoolean{1});

// Returns whether the paths are equal, and expects the same for the reverse order.
bool equal(const FakePath& a, const FakePath& b, bool comparesReferences = true)
{
    const bool forward = isObjPathsEqual(a.get(), b.get(), comparesReferences);
    EXPECT_EQ(isObjPathsEqual(b.get(), a.get(), comparesReferences), forward);
    return forward;
}

// Returns whether two paths are equal whose only difference is the value of a key.
bool equalValues(const CMPIData& a, const CMPIData& b)
{
    FakePath pathA("root", sensorClass), pathB("root", sensorClass);
    return equal(pathA.key("K", a), pathB.key("K", b));
}

TEST(ObjectPathEqualityTest, SameClassAndKeysAreEqual)
{
    FakePath a("root/cimv2", sensorClass), b("root/cimv2", sensorClass);
    a.text("DeviceID", "/board/fan1").text("SystemName", "host");
    b.text("DeviceID", "/board/fan1").text("SystemName", "host");
    EXPECT_TRUE(equal(a, b));
    EXPECT_TRUE(equal(a, a));
}

TEST(ObjectPathEqualityTest, ClassNamesIgnoreCase)
{
    EXPECT_TRUE(equal({"root", "ZUMLO_NumericSensor"}, {"root", "zumlo_numericSENSOR"}));
    EXPECT_FALSE(equal({"root", "ZUMLO_NumericSensor"}, {"root", "ZUMLO_NumericSensors"}));
    EXPECT_FALSE(equal({"root", "ZUMLO[NumericSensor"}, {"root", "ZUMLO{NumericSensor"}));
}

TEST(ObjectPathEqualityTest, APathWithoutAClassEqualsNothing)
{
    EXPECT_FALSE(equal({"root", std::nullopt}, {"root", std::nullopt}));
    EXPECT_FALSE(equal({"root", ""}, {"root", ""}));
    EXPECT_FALSE(equal({"root", sensorClass}, {"root", std::nullopt}));
}

TEST(ObjectPathEqualityTest, NamespacesCountWhenBothSidesHaveOne)
{
    EXPECT_FALSE(equal({"root/cimv2", sensorClass}, {"root/interop", sensorClass}));
    EXPECT_TRUE(equal({"root/cimv2", sensorClass}, {std::nullopt, sensorClass}));
    EXPECT_TRUE(equal({"root/cimv2", sensorClass}, {"", sensorClass}));
    EXPECT_TRUE(equal({std::nullopt, sensorClass}, {std::nullopt, sensorClass}));
}

TEST(ObjectPathEqualityTest, NamespacesIgnoreCaseAndOuterSlashes)
{
    EXPECT_TRUE(equal({"/root/cimv2/", sensorClass}, {"Root/CIMv2", sensorClass}));
    EXPECT_FALSE(equal({"root//cimv2", sensorClass}, {"root/cimv2", sensorClass}));
}

TEST(ObjectPathEqualityTest, ANamespaceStringWithoutAHandleIsNone)
{
    FakePath a("root/cimv2", sensorClass), b("root/interop", sensorClass);
    b.nameSpace.loseHandle();
    EXPECT_TRUE(equal(a, b));
}

TEST(ObjectPathEqualityTest, HostNamesAreIgnored)
{
    FakePath a("root", sensorClass), b("root", sensorClass);
    a.hostName.text = "one";
    b.hostName.text = "two";
    EXPECT_TRUE(equal(a, b));
}

TEST(ObjectPathEqualityTest, KeysMayComeInAnyOrderAndCase)
{
    FakePath a("root", sensorClass), b("root", sensorClass);
    a.text("DeviceID", "1").text("SystemName", "2").text("X", "3");
    b.text("x", "3").text("systemname", "2").text("DEVICEID", "1");
    EXPECT_TRUE(equal(a, b));
}

TEST(ObjectPathEqualityTest, EveryKeyCounts)
{
    FakePath all("root", sensorClass), some("root", sensorClass), none("root", sensorClass);
    all.text("DeviceID", "1").text("SystemName", "2");
    some.text("DeviceID", "1");
    EXPECT_FALSE(equal(all, some));
    EXPECT_FALSE(equal(some, none));
}

TEST(ObjectPathEqualityTest, KeysOfDifferentNamesAreDifferent)
{
    FakePath a("root", sensorClass), b("root", sensorClass);
    EXPECT_FALSE(equal(a.text("DeviceID", "1"), b.text("DeviceIDs", "1")));
}

TEST(ObjectPathEqualityTest, ANameListedTwiceDoesNotStandForAnother)
{
    FakePath a("root", sensorClass), b("root", sensorClass);
    a.text("K", "1").text("K", "1");
    b.text("K", "1").text("L", "2");
    EXPECT_FALSE(equal(a, b));
}

TEST(ObjectPathEqualityTest, TextsAreComparedCharacterByCharacter)
{
    FakePath a("root", sensorClass), b("root", sensorClass), c("root", sensorClass);
    a.text("DeviceID", "fan1");
    EXPECT_FALSE(equal(a, b.text("DeviceID", "FAN1")));
    EXPECT_FALSE(equal(a, c.text("DeviceID", "fan1 ")));
}

TEST(ObjectPathEqualityTest, BothFormsOfATextAreEqual)
{
    FakePath a("root", sensorClass), b("root", sensorClass), c("root", sensorClass);
    a.text("DeviceID", "fan1");
    EXPECT_TRUE(equal(a, b.chars("DeviceID", "fan1")));
    EXPECT_FALSE(equal(a, c.chars("DeviceID", "fan2")));
}

template <typename Integer>
void expectComparedByValue(CMPIType type)
{
    const CMPIData five = valueOf(CMPI_sint64, CMPISint64{5});
    EXPECT_TRUE(equalValues(five, valueOf(type, Integer{5})));
    EXPECT_FALSE(equalValues(five, valueOf(type, Integer{6})));
    if constexpr (std::is_signed_v<Integer>) {
        EXPECT_TRUE(equalValues(valueOf(CMPI_sint64, CMPISint64{-5}), valueOf(type, Integer{-5})));
        EXPECT_FALSE(equalValues(five, valueOf(type, Integer{-5})));
    }
}

TEST(ObjectPathEqualityTest, IntegersOfAnyTypeAreComparedByValue)
{
    expectComparedByValue<CMPIUint8>(CMPI_uint8);
    expectComparedByValue<CMPIUint16>(CMPI_uint16);
    expectComparedByValue<CMPIUint32>(CMPI_uint32);
    expectComparedByValue<CMPIUint64>(CMPI_uint64);
    expectComparedByValue<CMPISint8>(CMPI_sint8);
    expectComparedByValue<CMPISint16>(CMPI_sint16);
    expectComparedByValue<CMPISint32>(CMPI_sint32);
    expectComparedByValue<CMPISint64>(CMPI_sint64);
}

TEST(ObjectPathEqualityTest, ANegativeIntegerIsNotTheLargePositiveOfTheSameBits)
{
    EXPECT_FALSE(equalValues(valueOf(CMPI_sint64, CMPISint64{-1}),
        valueOf(CMPI_uint64, std::numeric_limits<CMPIUint64>::max())));
}

TEST(ObjectPathEqualityTest, BooleansRealsAndCharactersAreComparedByValue)
{
    EXPECT_TRUE(equalValues(yes, yes));
    EXPECT_FALSE(equalValues(yes, valueOf(CMPI_boolean, CMPIBoolean{0})));
    EXPECT_TRUE(
        equalValues(valueOf(CMPI_real64, CMPIReal64{1.5}), valueOf(CMPI_real64, CMPIReal64{1.5})));
    EXPECT_TRUE(
        equalValues(valueOf(CMPI_real64, CMPIReal64{1.5}), valueOf(CMPI_real32, CMPIReal32{1.5})));
    EXPECT_FALSE(
        equalValues(valueOf(CMPI_real64, CMPIReal64{1.5}), valueOf(CMPI_real64, CMPIReal64{2.5})));
    EXPECT_TRUE(equalValues(
        valueOf(CMPI_char16, CMPIChar16{0x30BB}), valueOf(CMPI_char16, CMPIChar16{0x30BB})));
    EXPECT_FALSE(equalValues(
        valueOf(CMPI_char16, CMPIChar16{0x30BB}), valueOf(CMPI_char16, CMPIChar16{0x30BC})));
}

TEST(ObjectPathEqualityTest, ABooleanIsTrueWhateverItsBits)
{
    CMPIData odd = yes;
    odd.value.boolean = 2;
    EXPECT_TRUE(equalValues(odd, yes));
}

TEST(ObjectPathEqualityTest, ValuesOfDifferentTypesAreDifferent)
{
    const std::vector<CMPIData> ones = {yes, valueOf(CMPI_uint32, CMPIUint32{1}),
        valueOf(CMPI_real64, CMPIReal64{1}), valueOf(CMPI_char16, CMPIChar16{1})};
    for (std::size_t a = 0; a < ones.size(); ++a)
        for (std::size_t b = 0; b < a; ++b)
            EXPECT_FALSE(equalValues(ones[a], ones[b])) << a << " and " << b;
    FakePath number("root", sensorClass), text("root", sensorClass);
    EXPECT_FALSE(equal(number.key("K", ones[1]), text.text("K", "1")));
}

TEST(ObjectPathEqualityTest, PointsInTimeAreComparedByTheirStandardForm)
{
    const auto noon = "20261121120000.000000+000";
    FakePath a("root", sensorClass), b("root", sensorClass), c("root", sensorClass);
    a.dateTime("K", noon);
    EXPECT_TRUE(equal(a, b.dateTime("K", noon)));
    EXPECT_FALSE(equal(a, c.dateTime("K", "20261121120001.000000+000")));
}

TEST(ObjectPathEqualityTest, NullAndHandlelessPathsEqualNothing)
{
    FakePath whole("root", sensorClass), broken("root", sensorClass);
    broken.loseHandle();
    EXPECT_FALSE(isObjPathsEqual(nullptr, nullptr, true));
    EXPECT_FALSE(isObjPathsEqual(nullptr, whole.get(), true));
    EXPECT_FALSE(isObjPathsEqual(whole.get(), nullptr, true));
    EXPECT_FALSE(equal(whole, broken));
    EXPECT_FALSE(equal(broken, broken));
}

TEST(ObjectPathEqualityTest, KeysWithoutAValueCountAsNotThere)
{
    const std::vector<CMPIValueState> states = {
        CMPI_nullValue, CMPI_notFound, CMPI_nullValue | CMPI_notFound};
    for (const auto state : states) {
        FakePath a("root", sensorClass), b("root", sensorClass), c("root", sensorClass);
        a.text("DeviceID", "1");
        b.text("DeviceID", "1").key("SystemName", poisoned(CMPI_string, state));
        c.key("DeviceID", poisoned(CMPI_null, state));
        EXPECT_TRUE(equal(a, b)) << state;
        EXPECT_FALSE(equal(a, c)) << state;
    }
}

TEST(ObjectPathEqualityTest, KeysWithEmptyPointersCountAsNotThere)
{
    FakePath a("root", sensorClass), b("root", sensorClass);
    a.text("DeviceID", "1");
    b.text("DeviceID", "1").text("A", std::nullopt).chars("B", nullptr).reference("C", nullptr);
    b.dateTime("D", std::nullopt);
    CMPIData noString{};
    noString.type = CMPI_string;
    b.key("E", noString);
    EXPECT_TRUE(equal(a, b));
    EXPECT_FALSE(equal(a, FakePath("root", sensorClass).text("DeviceID", std::nullopt)));
}

TEST(ObjectPathEqualityTest, BadValuesEqualNothing)
{
    const auto bad = poisoned(CMPI_string, CMPI_badValue);
    EXPECT_FALSE(equalValues(bad, bad));
    EXPECT_FALSE(equalValues(bad, yes));
}

TEST(ObjectPathEqualityTest, TypesThatNoKeyCanHaveEqualNothing)
{
    for (const auto type :
        std::vector<CMPIType>{CMPI_stringA, CMPI_instance, CMPI_null, CMPI_ptr}) {
        const auto odd = poisoned(type, CMPI_goodValue);
        EXPECT_FALSE(equalValues(odd, odd)) << type;
    }
}

TEST(ObjectPathEqualityTest, ABrokerThatFailsToListKeysMakesPathsUnequal)
{
    FakePath whole("root", sensorClass);
    whole.text("A", "1").text("B", "2");
    const auto unequalWhen = [&](auto breakPath) {
        FakePath broken("root", sensorClass);
        broken.text("A", "1").text("B", "2");
        EXPECT_TRUE(equal(whole, broken));
        breakPath(broken);
        EXPECT_FALSE(equal(whole, broken));
    };
    unequalWhen([](FakePath& path) { path.countOutcome = CMPI_RC_ERR_FAILED; });
    unequalWhen([](FakePath& path) { path.failingKey = 0; });
    unequalWhen([](FakePath& path) { path.failingKey = 1; });
    unequalWhen([](FakePath& path) { path.namelessKey = 1; });
    unequalWhen([](FakePath& path) { path.keys[1].name.text.reset(); });
    unequalWhen([](FakePath& path) { path.keys[1].name.outcome = CMPI_RC_ERR_FAILED; });
}

class ReferencesTest : public testing::Test {
protected:
    FakePath fan1{"root", sensorClass};
    FakePath fan2{"root", sensorClass};
    FakePath fan1Again{std::nullopt, "zumlo_numericsensor"};
    FakePath a{"root", "ZUMLO_SensorSystemDevice"};
    FakePath b{"root", "ZUMLO_SensorSystemDevice"};

    ReferencesTest()
    {
        fan1.text("DeviceID", "fan1");
        fan2.text("DeviceID", "fan2");
        fan1Again.chars("deviceid", "fan1");
    }
};

TEST_F(ReferencesTest, AreComparedAsPathsByTheSameRule)
{
    a.reference("PartComponent", fan1.get());
    b.reference("partcomponent", fan1Again.get());
    EXPECT_TRUE(equal(a, b, true));
}

TEST_F(ReferencesTest, ToDifferentPathsAreDifferent)
{
    a.reference("PartComponent", fan1.get());
    b.reference("PartComponent", fan2.get());
    EXPECT_FALSE(equal(a, b, true));
}

TEST_F(ReferencesTest, DoNotCountWhenTheyAreNotCompared)
{
    a.text("K", "1").reference("PartComponent", fan1.get());
    b.text("K", "1").reference("PartComponent", fan2.get());
    EXPECT_TRUE(equal(a, b, false));
    FakePath none("root", "ZUMLO_SensorSystemDevice");
    EXPECT_TRUE(equal(a, none.text("K", "1"), false));
    EXPECT_FALSE(equal(a, none, true));
}

TEST_F(ReferencesTest, AreNotFollowedWhenTheyAreNotCompared)
{
    a.key("PartComponent", poisoned(CMPI_ref, CMPI_goodValue));
    EXPECT_TRUE(equal(a, b, false));
}

TEST_F(ReferencesTest, AreNotTexts)
{
    a.reference("PartComponent", fan1.get());
    b.text("PartComponent", "ZUMLO_NumericSensor.DeviceID=\"fan1\"");
    EXPECT_FALSE(equal(a, b, true));
}

TEST_F(ReferencesTest, ToHandlelessPathsEqualNothing)
{
    fan1.loseHandle();
    a.reference("PartComponent", fan1.get());
    b.reference("PartComponent", fan1.get());
    EXPECT_FALSE(equal(a, b, true));
}

// Returns whether a chain of paths, each of which refers to the next, equals itself.
bool equalChains(int references)
{
    std::deque<FakePath> chain;
    chain.emplace_back("root", "C");
    for (int i = 0; i < references; ++i) {
        CMPIObjectPath* const next = chain.back().get();
        chain.emplace_back("root", "C").reference("Next", next);
    }
    return equal(chain.back(), chain.back(), true);
}

TEST_F(ReferencesTest, AreFollowedToABoundedDepth)
{
    EXPECT_TRUE(equalChains(8));
    EXPECT_FALSE(equalChains(9));
}

TEST_F(ReferencesTest, InACircleComeToAnEnd)
{
    a.reference("Next", a.get());
    EXPECT_FALSE(equal(a, a, true));
}

} // namespace
