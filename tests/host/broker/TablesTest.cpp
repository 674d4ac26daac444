// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Every slot of every table is filled, returns CMPI_RC_ERR_NOT_SUPPORTED where no shipped provider
// calls it, and accepts handles that are null, empty or of another kind.

#include "host/broker/Tables.h"

#include "host/broker/Array.h"
#include "host/broker/Context.h"
#include "host/broker/DateTime.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/Result.h"
#include "host/broker/String.h"
#include "tests/host/broker/BrokerTest.h"

#include <cstring>
#include <type_traits>

namespace HostTests {

namespace {

char letterOf(CMPIrc code)
{
    return code == CMPI_RC_ERR_INVALID_HANDLE ? 'o' : code == CMPI_RC_ERR_NOT_SUPPORTED ? '-' : '?';
}

// Calls a slot with a first argument and zeros, and returns a letter for the result: 'o' for a
// supported slot that refuses its handle, '-' for one that is not supported, '.' for one that
// returns nothing and no code, '!' for a null slot, '?' for anything else.
class Probe {
public:
    explicit Probe(void* first) : first_(first) {}

    template <typename Answer, typename First, typename... Rest>
    char operator()(Answer (*slot)(First, Rest...)) const
    {
        if (slot == nullptr)
            return '!';
        CMPIStatus status{CMPI_RC_OK, nullptr};
        if constexpr (std::is_void_v<Answer>) {
            slot(first<First>(), argument<Rest>(status)...);
            return '.';
        } else {
            const Answer answer = slot(first<First>(), argument<Rest>(status)...);
            if constexpr (std::is_same_v<Answer, CMPIStatus>)
                return letterOf(answer.rc);
            else if constexpr (std::is_same_v<Answer, int>)
                return letterOf(static_cast<CMPIrc>(answer));
            else if (!isNothing(answer))
                return '?';
            else
                return (std::is_same_v<Rest, CMPIStatus*> || ...) ? letterOf(status.rc) : '.';
        }
    }

private:
    template <typename First>
    First first() const
    {
        using Pointed = std::remove_pointer_t<First>;
        if constexpr (std::is_pointer_v<First> && !std::is_function_v<Pointed>)
            return static_cast<First>(first_);
        else
            return First();
    }

    template <typename Argument>
    static Argument argument(CMPIStatus& status)
    {
        if constexpr (std::is_same_v<Argument, CMPIStatus*>)
            return &status;
        else
            return Argument();
    }

    template <typename Answer>
    static bool isNothing(const Answer& answer)
    {
        if constexpr (std::is_same_v<Answer, CMPIData>)
            return answer.state == absentState && answer.type == CMPI_null;
        else
            return answer == Answer();
    }

    void* first_;
};

template <typename... Slots>
std::string lettersOf(void* first, Slots... slots)
{
    return {Probe(first)(slots)...};
}

// The structured bindings name every member of a table: it does not compile when one is missing.
std::string answersOf(const CMPIStringFT& table, void* first)
{
    const auto [version, a, b, c] = table;
    return lettersOf(first, a, b, c);
}
std::string answersOf(const CMPIArrayFT& table, void* first)
{
    const auto [version, a, b, c, d, e, f] = table;
    return lettersOf(first, a, b, c, d, e, f);
}
std::string answersOf(const CMPIObjectPathFT& table, void* first)
{
    const auto [version, a, b, c, d, e, f, g, h, i, j, k, l, m, n, o, p, q, r, s] = table;
    return lettersOf(first, a, b, c, d, e, f, g, h, i, j, k, l, m, n, o, p, q, r, s);
}
std::string answersOf(const CMPIInstanceFT& table, void* first)
{
    const auto [version, a, b, c, d, e, f, g, h, i, j] = table;
    return lettersOf(first, a, b, c, d, e, f, g, h, i, j);
}
std::string answersOf(const CMPIEnumerationFT& table, void* first)
{
    const auto [version, a, b, c, d, e] = table;
    return lettersOf(first, a, b, c, d, e);
}
std::string answersOf(const CMPIDateTimeFT& table, void* first)
{
    const auto [version, a, b, c, d, e] = table;
    return lettersOf(first, a, b, c, d, e);
}
std::string answersOf(const CMPIContextFT& table, void* first)
{
    const auto [version, a, b, c, d, e, f] = table;
    return lettersOf(first, a, b, c, d, e, f);
}
std::string answersOf(const CMPIResultFT& table, void* first)
{
    const auto [version, a, b, c, d, e, f, g] = table;
    return lettersOf(first, a, b, c, d, e, f, g);
}
std::string answersOf(const CMPIBrokerFT& table, void* first)
{
    const auto [capabilities, version, name, a, b, c, d, e, f, g, h, i, j, k, l, m, n, o, p, q, r] =
        table;
    return lettersOf(first, a, b, c, d, e, f, g, h, i, j, k, l, m, n, o, p, q, r);
}
std::string answersOf(const CMPIBrokerEncFT& table, void* first)
{
    const auto [version, a, b, c, d, e, f, g, h, i, j, k, l, m, getMessage, n, o, p, q, r,
        getMessage2] = table;
    const auto* const broker = static_cast<const CMPIBroker*>(first);
    CMPIStatus status{CMPI_RC_OK, nullptr};
    std::string variadic;
    EXPECT_EQ(getMessage(broker, nullptr, nullptr, &status, 1, CMPI_chars, "x"), nullptr);
    variadic += letterOf(status.rc);
    EXPECT_EQ(getMessage2(broker, nullptr, nullptr, nullptr, &status, 0), nullptr);
    variadic += letterOf(status.rc);
    return lettersOf(first, a, b, c, d, e, f, g, h, i, j, k, l, m, n, o, p, q, r) + variadic;
}
std::string answersOf(const CMPIBrokerExtFT& table, void* first)
{
    const auto [version, a, b, c, d, e, f, g, h, i, j, k, l, m, n, o, p, q, r, s, t] = table;
    return lettersOf(first, a, b, c, d, e, f, g, h, i, j, k, l, m, n, o, p, q, r, s, t);
}
std::string answersOf(const CMPIBrokerMemFT& table, void* first)
{
    const auto [version, a, b, c, d, e, f, g, h, i, j, k, l, m, n] = table;
    return lettersOf(first, a, b, c, d, e, f, g, h, i, j, k, l, m, n);
}

} // namespace

class TablesTest : public BrokerTest {
protected:
    template <typename Table>
    void expectAnswers(const Table& table, const std::string& expected)
    {
        struct {
            const void* hdl;
            const void* ft;
        } handleless{}, misplaced{request.context().handle()->hdl, nullptr};
        if constexpr (std::is_same_v<Table, CMPIContextFT>)
            misplaced.hdl = mb->hdl;
        EXPECT_EQ(answersOf(table, nullptr), expected);
        EXPECT_EQ(answersOf(table, &handleless), expected);
        EXPECT_EQ(answersOf(table, &misplaced), expected);
    }
};

TEST_F(TablesTest, OfferWhatShippedProvidersCallAndRefuseTheRest)
{
    expectAnswers(*mb->bft, ".---o-----o-------");
    expectAnswers(*mb->eft, "oo-oo----o----o-----");
    expectAnswers(*mb->xft, "..-------.-......---");
    expectAnswers(*mb->mft, "--............");
    expectAnswers(Host::String::functions, "--o");
    expectAnswers(Host::Array::functions, "-----o");
    expectAnswers(Host::ObjectPath::functions, "--oooooooooo-------");
    expectAnswers(Host::Instance::functions, "-----ooo--");
    expectAnswers(Host::Enumeration::functions, "--oo-");
    expectAnswers(Host::DateTime::functions, "---o-");
    expectAnswers(Host::Context::functions, "------");
    expectAnswers(Host::Result::functions, "---ooo-");
}

TEST_F(TablesTest, TheBrokerNamesItself)
{
    EXPECT_EQ(mb->bft->brokerVersion, 200U);
    EXPECT_STREQ(mb->bft->brokerName, "sensor-profile");
    EXPECT_EQ(mb->bft->brokerCapabilities, static_cast<unsigned>(CMPI_MB_BasicRead));
    EXPECT_EQ(Host::Broker::of(mb), &broker);
    EXPECT_EQ(Host::Broker::of(nullptr), nullptr);
}

TEST_F(TablesTest, AServiceThatIsNotOfferedSaysSo)
{
    EXPECT_EQ(CMNewArgs(mb, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(textOf(rc.msg), "not offered by this broker");
}

TEST_F(TablesTest, WithoutArgumentsNothingIsMade)
{
    EXPECT_EQ(CMNewInstance(mb, nullptr, nullptr), nullptr);
    EXPECT_EQ(CMNewObjectPath(mb, nullptr, nullptr, nullptr), nullptr);
    EXPECT_EQ(CMTraceMessage(mb, CMPI_LEV_INFO, nullptr, nullptr, nullptr).rc, CMPI_RC_OK);
    EXPECT_EQ(CBEnumInstanceNames(mb, nullptr, nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED); // no object answers up-calls
}

} // namespace HostTests
