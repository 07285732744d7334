#include <gtest/gtest.h>

#include <algorithm>

#include "linux/probe/port_mapping.h"
#include "linux/probe/portal_api.h"
#include "linux/probe/ssdp.h"
#include "linux/probe/stun_message.h"
#include "linux/probe/web_place.h"
#include "linux/probe/xml_text.h"

namespace wp {
namespace {

using ByteList = std::vector<std::uint8_t>;

std::string addressText(const std::optional<IPAddress>& address) {
    return address ? address->text() : "none";
}

constexpr StunTransaction kTransaction = {0xB7, 0xE7, 0xA7, 0x01, 0xBC, 0x34,
                                          0xD6, 0x86, 0xFA, 0x87, 0xDF, 0xAE};

/// A success response with these attributes.
ByteList stunResponse(const ByteList& attributes) {
    ByteList message = {0x01, 0x01, 0x00, static_cast<std::uint8_t>(attributes.size()),
                        0x21, 0x12, 0xA4, 0x42};
    for (const std::uint8_t byte : kTransaction) message.push_back(byte);
    for (const std::uint8_t byte : attributes) message.push_back(byte);
    return message;
}

// The IPv4 sample of RFC 5769: 192.0.2.1, port 32853, behind a SOFTWARE attribute of odd length.
const ByteList kMapped = {0x80, 0x22, 0x00, 0x0B, 't',  'e',  's',  't',  ' ',  'v',  'e',  'c',  't',  'o',
                          'r',  0x20, 0x00, 0x20, 0x00, 0x08, 0x00, 0x01, 0xA1, 0x47, 0xE1, 0x12, 0xA6, 0x43};

TEST(Stun, AsksForABindingWithItsTransaction) {
    const ByteList request = stunBindingRequest(kTransaction);
    EXPECT_EQ(request.size(), 20U);
    const ByteList head = {0, 1, 0, 0, 0x21, 0x12, 0xA4, 0x42};
    EXPECT_TRUE(std::equal(head.begin(), head.end(), request.begin()));
    EXPECT_TRUE(std::equal(kTransaction.begin(), kTransaction.end(), request.begin() + 8));
}

TEST(Stun, FindsTheMappedAddressBehindOtherAttributes) {
    EXPECT_EQ(addressText(addressFromStun(stunResponse(kMapped), kTransaction)), "192.0.2.1");
}

TEST(Stun, FindsAnIPv6Address) {
    // The IPv6 sample of RFC 5769.
    const ByteList attribute = {0x00, 0x20, 0x00, 0x14, 0x00, 0x02, 0xA1, 0x47, 0x01, 0x13, 0xA9, 0xFA,
                                0xA5, 0xD3, 0xF1, 0x79, 0xBC, 0x25, 0xF4, 0xB5, 0xBE, 0xD2, 0xB9, 0xD9};
    EXPECT_EQ(addressText(addressFromStun(stunResponse(attribute), kTransaction)),
              "2001:db8:1234:5678:11:2233:4455:6677");
}

TEST(Stun, TakesThePlainAddressOnlyWhereThereIsNoMaskedOne) {
    const ByteList plain = {0x00, 0x01, 0x00, 0x08, 0x00, 0x01, 0x12, 0x34, 198, 51, 100, 9};
    ByteList both = plain;
    for (const std::uint8_t byte : kMapped) both.push_back(byte);
    EXPECT_EQ(addressText(addressFromStun(stunResponse(plain), kTransaction)), "198.51.100.9");
    EXPECT_EQ(addressText(addressFromStun(stunResponse(both), kTransaction)), "192.0.2.1");
}

TEST(Stun, RefusesForeignAndCutMessages) {
    const ByteList good = stunResponse(kMapped);
    for (std::size_t size = 0; size < good.size(); ++size)
        EXPECT_EQ(addressText(addressFromStun(Bytes(good).first(size), kTransaction)), "none") << size;
    StunTransaction other = kTransaction;
    other[11] ^= 1;
    EXPECT_EQ(addressText(addressFromStun(good, other)), "none");
    ByteList error = good;
    error[1] = 0x11;
    EXPECT_EQ(addressText(addressFromStun(error, kTransaction)), "none");
    ByteList beyond = good;
    beyond[22] = 0xFF;
    EXPECT_EQ(addressText(addressFromStun(beyond, kTransaction)), "none");
}

TEST(PortMapping, ReadsTheOuterAddress) {
    const auto answer = readExternalAddress(ByteList{0, 128, 0, 0, 0, 0, 0, 9, 203, 0, 113, 7});
    ASSERT_TRUE(answer);
    EXPECT_EQ(addressText(answer->external), "203.0.113.7");
    EXPECT_FALSE(answer->speaksOnlyPcp);
}

TEST(PortMapping, TellsARefusalFromAForeignMessage) {
    const auto refused = readExternalAddress(ByteList{0, 128, 0, 3, 0, 0, 0, 9, 0, 0, 0, 0});
    ASSERT_TRUE(refused);
    EXPECT_FALSE(refused->external);
    const auto notYet = readExternalAddress(ByteList{0, 128, 0, 0, 0, 0, 0, 9, 0, 0, 0, 0});
    ASSERT_TRUE(notYet);
    EXPECT_FALSE(notYet->external);
    const auto younger = readExternalAddress(ByteList{2, 128, 0, 1, 0, 0, 0, 0, 0, 0, 0, 0});
    ASSERT_TRUE(younger);
    EXPECT_TRUE(younger->speaksOnlyPcp);
    EXPECT_FALSE(readExternalAddress(ByteList{0, 0}));
    EXPECT_FALSE(readExternalAddress(ByteList{0, 128, 0, 0, 0, 0, 0, 9, 203, 0, 113}));
    EXPECT_FALSE(readExternalAddress(ByteList{0, 129, 0, 0, 0, 0, 0, 9, 203, 0, 113, 7}));
    EXPECT_FALSE(readExternalAddress({}));
}

TEST(PortMapping, AsksAndReadsTheYoungerProtocol) {
    const PcpNonce nonce = {1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12};
    const ByteList request = pcpMapRequest(*IPAddress::fromText("192.168.1.20"), 0x1234, nonce, 1);
    ASSERT_EQ(request.size(), 60U);
    EXPECT_EQ(ByteList(request.begin(), request.begin() + 8), (ByteList{2, 1, 0, 0, 0, 0, 0, 1}));
    EXPECT_EQ(ByteList(request.begin() + 18, request.begin() + 24), (ByteList{0xFF, 0xFF, 192, 168, 1, 20}));
    EXPECT_EQ(ByteList(request.begin() + 36, request.begin() + 44),
              (ByteList{17, 0, 0, 0, 0x12, 0x34, 0, 0}));

    ByteList answer = request;
    answer[1] = 0x81;
    const std::uint8_t outer[] = {203, 0, 113, 7};
    std::copy(std::begin(outer), std::end(outer), answer.begin() + 56);
    EXPECT_EQ(addressText(addressFromPcp(answer, nonce)), "203.0.113.7");
    for (std::size_t size = 0; size < answer.size(); ++size)
        EXPECT_EQ(addressText(addressFromPcp(Bytes(answer).first(size), nonce)), "none");
    answer[3] = 2;
    EXPECT_EQ(addressText(addressFromPcp(answer, nonce)), "none");
    answer[3] = 0;
    answer[24] = 9;
    EXPECT_EQ(addressText(addressFromPcp(answer, nonce)), "none");
}

TEST(Ssdp, FindsWhereTheDescriptionIs) {
    EXPECT_EQ(
        locationFromSsdp("HTTP/1.1 200 OK\r\nST: x\r\nLoCaTiOn:  http://192.168.1.1:5000/d.xml \r\n\r\n"),
        "http://192.168.1.1:5000/d.xml");
    EXPECT_EQ(locationFromSsdp("HTTP/1.1 200 OK\r\nLOCATION: file:///etc/passwd\r\n\r\n"), std::nullopt);
    EXPECT_EQ(locationFromSsdp("NOTIFY * HTTP/1.1\r\nLOCATION: http://192.168.1.1/\r\n\r\n"), std::nullopt);
    EXPECT_EQ(locationFromSsdp("HTTP/1.1 200 OK\r\nST: x\r\n\r\n"), std::nullopt);
    EXPECT_EQ(locationFromSsdp("HTTP/1.1 200 OK"), std::nullopt);
}

constexpr const char* kDescription = R"(<?xml version="1.0"?>
<root xmlns="urn:schemas-upnp-org:device-1-0"><!-- a router -->
 <device>
  <friendlyName>Attic &amp; <![CDATA[<Cellar>]]></friendlyName>
  <manufacturer> Example Networks </manufacturer><modelName>Base &#53;&bogus;</modelName>
  <deviceList><device><manufacturer>Inner</manufacturer><serviceList>
    <service><serviceType>urn:schemas-upnp-org:service:WANCommonInterfaceConfig:1</serviceType>
      <controlURL>/wrong</controlURL></service>
    <service><serviceType>urn:schemas-upnp-org:service:WANIPConnection:1</serviceType>
      <SCPDURL/><controlURL>/ctl/IPConn</controlURL></service>
  </serviceList></device></deviceList>
 </device></root>)";

TEST(DeviceDescription, IsReadFromTheOutermostDevice) {
    const DeviceDescription read = readDeviceDescription(kDescription);
    EXPECT_EQ(read.router.manufacturer, "Example Networks");
    EXPECT_EQ(read.router.modelName, "Base 5&bogus;");
    EXPECT_EQ(read.router.friendlyName, "Attic & <Cellar>");
    EXPECT_EQ(read.serviceType, "urn:schemas-upnp-org:service:WANIPConnection:1");
    EXPECT_EQ(read.controlUrl, "/ctl/IPConn");
}

TEST(DeviceDescription, LooksNoEntityUpAndStopsAtWhatIsNotWellFormed) {
    const auto manufacturer = [](const std::string& xml) {
        return readDeviceDescription(xml).router.manufacturer;
    };
    EXPECT_EQ(manufacturer("<!DOCTYPE r [<!ENTITY e SYSTEM "
                           "\"file:///etc/passwd\">]><r><manufacturer>&e;</manufacturer></r>"),
              "");
    EXPECT_EQ(manufacturer("<r><manufacturer>A</b></manufacturer></r>"), "");
    EXPECT_EQ(manufacturer("<r><manufacturer>A</manufacturer>"), "A");
    std::string tooLong = "<r><manufacturer>A</manufacturer></r>";
    tooLong.resize(kLongestXml + 1, ' ');
    EXPECT_EQ(manufacturer(tooLong), "");
    std::string deep;
    for (std::size_t i = 0; i < kDeepestXml; ++i) deep += "<d>";
    EXPECT_EQ(manufacturer(deep + "<manufacturer>A</manufacturer>"), "");
    const std::string whole = kDescription;
    for (std::size_t size = 0; size < whole.size(); ++size) readDeviceDescription(whole.substr(0, size));
}

TEST(DeviceDescription, AServiceTypeThatWouldBreakAHeaderIsNotTaken) {
    const DeviceDescription read = readDeviceDescription(
        "<r><service><serviceType>urn:schemas-upnp-org:service:WANIPConnection:1\r\nX: y</serviceType>"
        "<controlURL>/c</controlURL></service></r>");
    EXPECT_EQ(read.controlUrl, "");
}

TEST(Soap, ReadsTheOuterAddress) {
    EXPECT_EQ(addressText(addressFromSoap("<s:Envelope><s:Body><u:R><NewExternalIPAddress>203.0.113.7"
                                          "</NewExternalIPAddress></u:R></s:Body></s:Envelope>")),
              "203.0.113.7");
    EXPECT_EQ(addressText(addressFromSoap("<NewExternalIPAddress></NewExternalIPAddress>")), "none");
    EXPECT_EQ(addressText(addressFromSoap("<NewExternalIPAddress>0.0.0.0</NewExternalIPAddress>")), "none");
    EXPECT_EQ(addressText(addressFromSoap("garbage")), "none");
}

TEST(PortalApi, BelievesACaptiveAnswerOnlyWithAPageToGoTo) {
    const auto captive = portalFromApi(R"({"captive":true,"user-portal-url":"https://p.example/"})");
    ASSERT_TRUE(captive);
    EXPECT_TRUE(captive->captive);
    EXPECT_EQ(captive->page, "https://p.example/");
    const auto open = portalFromApi(R"({"captive":false})");
    ASSERT_TRUE(open);
    EXPECT_FALSE(open->captive);
    EXPECT_FALSE(portalFromApi(R"({"captive":true})"));
    EXPECT_FALSE(portalFromApi(R"({"captive":true,"user-portal-url":""})"));
    EXPECT_FALSE(portalFromApi(R"({"captive":true,"user-portal-url":" \u0007 "})"));
    EXPECT_FALSE(portalFromApi(R"({"captive":"true"})"));
    EXPECT_FALSE(portalFromApi(R"([true])"));
    EXPECT_FALSE(portalFromApi("<html>"));
    EXPECT_FALSE(portalFromApi(R"({"captive":false,"x":")" + std::string(kLongestPortalAnswer, 'x') + "\"}"));
    EXPECT_FALSE(portalFromApi(std::string(100, '[')));
}

TEST(PortalApi, APagesAddressIsReadWholeOrNotAtAll) {
    const std::string start = "https://p.example/",
                      longest = start + std::string(kLongestUrl - start.size(), 'a');
    for (const std::string& each : {longest, longest + "a"}) {
        const auto read = portalFromApi(R"({"captive":true,"user-portal-url":")" + each + "\"}");
        ASSERT_TRUE(read);
        EXPECT_TRUE(read->captive);
        EXPECT_EQ(read->page, each.size() > kLongestUrl ? "" : each);
    }
}

TEST(PortalApi, IsNamedByALease) {
    for (const char* name : {"default_url", "captive_portal_uri", "dhcp6_v6_captive_portal"})
        EXPECT_EQ(portalApiIn({{name, "https://p.example/api"}}), "https://p.example/api") << name;
    EXPECT_EQ(portalApiIn({{"default_url", ""}, {"v4_captive_portal", "https://old.example/"}}),
              "https://old.example/");
    EXPECT_EQ(portalApiIn({{"routers", "192.168.1.1"}}), "");
    EXPECT_TRUE(meansNoPortal("urn:ietf:params:capport:unrestricted"));
    EXPECT_FALSE(meansNoPortal("https://p.example/"));
}

}  // namespace
}  // namespace wp
