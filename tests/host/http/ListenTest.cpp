// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The addresses that a server may listen on, and the failures to do so.

#include "tests/host/http/HttpTest.h"
#include "tests/support/ErrorOf.h"
#include "tests/support/LogCapture.h"

namespace HttpTests {

namespace {

using Host::Http::Address;
using Host::Http::endpointsFor;
using Host::Http::listenOn;
using Host::Http::ListenWishes;
using testing::ElementsAre;
using testing::HasSubstr;

std::vector<std::string> placesFor(const ListenWishes& wishes)
{
    std::vector<std::string> places;
    for (const auto& endpoint : endpointsFor(wishes))
        places.push_back(endpoint.address.text() + (endpoint.isEncrypted ? " tls" : "") +
                         (endpoint.isOptional ? " optional" : ""));
    return places;
}

std::string refusalOf(const ListenWishes& wishes)
{
    return Testing::errorOf([&] { endpointsFor(wishes); });
}

TEST(ListenPolicyTest, LoopbackIsTheDefault)
{
    EXPECT_THAT(placesFor({}), ElementsAre("127.0.0.1:5988", "[::1]:5988 optional"));
    EXPECT_THAT(placesFor({.port = 1, .tlsPort = 2, .hasCertificate = true}),
        ElementsAre("127.0.0.1:1", "127.0.0.1:2 tls", "[::1]:1 optional", "[::1]:2 tls optional"));
    EXPECT_THAT(placesFor({.addresses = {"::1", "127.3.4.5"}}),
        ElementsAre("[::1]:5988", "127.3.4.5:5988"));
}

TEST(ListenPolicyTest, OtherAddressesNeedTlsAndPasswords)
{
    for (const std::string address :
        {"0.0.0.0", "::", "192.0.2.1", "2001:db8::1", "::ffff:127.0.0.1"}) {
        EXPECT_THAT(refusalOf({.addresses = {address}}),
            HasSubstr("a certificate with its key (--certificate, --key) and a password file "
                      "(--passwords)"));
        EXPECT_THAT(refusalOf({.addresses = {"127.0.0.1", address}, .hasCertificate = true}),
            HasSubstr("missing: a password file (--passwords)"));
        EXPECT_THAT(refusalOf({.addresses = {address}, .hasPasswords = true}),
            HasSubstr("missing: a certificate with its key (--certificate, --key)"));
        const auto places =
            placesFor({.addresses = {address}, .hasCertificate = true, .hasPasswords = true});
        ASSERT_EQ(places.size(), 1U);
        EXPECT_THAT(places[0], HasSubstr(":5989 tls"));
    }
}

TEST(ListenPolicyTest, NoPlaceIsTakenTwice)
{
    EXPECT_THAT(placesFor({.addresses = {"127.0.0.1", "::1", "127.0.0.1", "0:0::1"}}),
        ElementsAre("127.0.0.1:5988", "[::1]:5988"));
    const auto protectedPlacesFor = [](const std::vector<std::string>& addresses) {
        return placesFor({.addresses = addresses, .hasCertificate = true, .hasPasswords = true});
    };
    EXPECT_THAT(protectedPlacesFor({"0.0.0.0", "127.0.0.1"}),
        ElementsAre("0.0.0.0:5989 tls", "127.0.0.1:5988"));
    EXPECT_THAT(protectedPlacesFor({"127.0.0.1", "::1", "0.0.0.0"}),
        ElementsAre("127.0.0.1:5988", "[::1]:5988", "[::1]:5989 tls", "0.0.0.0:5989 tls"));
    EXPECT_THAT(protectedPlacesFor({"::", "127.0.0.1", "2001:db8::1"}),
        ElementsAre("[::]:5989 tls", "127.0.0.1:5988", "127.0.0.1:5989 tls"));
}

TEST(ListenPolicyTest, NamesAreNoAddresses)
{
    for (const std::string address : {"localhost", "", "127.0.0.1:80", "[::1]", "example.org"})
        EXPECT_EQ(
            refusalOf({.addresses = {address}}), "\"" + address + "\" is no IPv4 or IPv6 address");
}

TEST(AddressTest, NeighboursShareANetwork)
{
    EXPECT_EQ(Address("192.0.2.1", 1).network(), "192.0.2.1");
    EXPECT_EQ(Address("2001:db8:1:2:3:4:5:6", 1).network(), "2001:db8:1:2::/64");
    EXPECT_EQ(Address("::1", 1).network(), "::1");
}

TEST(ListenTest, AnyPortIsTheSameForAllAddresses)
{
    const auto sockets = listenOn({{{"127.0.0.1", 0}}, {{"127.0.0.2", 0}}});
    EXPECT_NE(sockets[0].address().port(), 0);
    EXPECT_EQ(sockets[0].address().port(), sockets[1].address().port());
    // The same address gets another port, since the first is in use.
    const auto others = listenOn({{{"127.0.0.1", 0}}, {{"127.0.0.1", 0}}});
    EXPECT_NE(others[0].address().port(), others[1].address().port());
}

TEST(ListenTest, AddressOfNoneOfTheMachinesInterfacesIsAnErrorUnlessOptional)
{
    const Address nowhere("192.0.2.1", 0);
    EXPECT_THROW(listenOn({{nowhere}}), std::runtime_error);
    const Testing::LogCapture log;
    EXPECT_EQ(listenOn({{{"127.0.0.1", 0}}, {nowhere, false, true}}).size(), 1U);
    ASSERT_EQ(log.log().size(), 1U);
    EXPECT_THAT(log.log()[0].text, testing::StartsWith("cannot listen on 192.0.2.1:"));
}

} // namespace

} // namespace HttpTests
