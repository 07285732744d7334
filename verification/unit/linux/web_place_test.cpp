#include "linux/probe/web_place.h"

#include <gtest/gtest.h>

namespace wp {
namespace {

TEST(WebPlace, TakesAUrlApart) {
    EXPECT_EQ(webPlace("http://[fe80::1]:49152/a/b.xml"), (WebPlace{false, "fe80::1", 49152, "/a/b.xml"}));
    EXPECT_EQ(webPlace("HTTP://router"), (WebPlace{false, "router", 80, "/"}));
    EXPECT_EQ(webPlace("https://host.example?q=1/2#part"), (WebPlace{true, "host.example", 443, "/?q=1/2"}));
    EXPECT_EQ(webPlace("https://h:8443/a#b"), (WebPlace{true, "h", 8443, "/a"}));
}

TEST(WebPlace, TakesNoOtherForm) {
    for (const char* url : {"http://",
                            "http://:80/",
                            "http://a:b/",
                            "http://a:123456/",
                            "http://a:0/",
                            "http://a:/",
                            "http://u@a/",
                            "ftp://a/",
                            "file:///etc/hostname",
                            "http:/a",
                            "http://a b/",
                            "http://[fe80::1/",
                            "http://[::1]x/",
                            "http://[]/",
                            "http://[host]/",
                            "http://[192.0.2.1]/",
                            "http://[::1]:/",
                            "http://::1/",
                            "http://a\r\nb/",
                            "http://a\\b/",
                            "http://\xC3\xA9/",
                            "no url",
                            ""})
        EXPECT_FALSE(webPlace(url)) << url;
    EXPECT_TRUE(webPlace("http://a/" + std::string(kLongestUrl - 9, 'x')));
    EXPECT_FALSE(webPlace("http://a/" + std::string(kLongestUrl - 8, 'x')));
}

TEST(WebPlace, NamesItsHostAsARequestDoes) {
    const auto authority = [](const char* url) { return webPlace(url)->authority(); };
    EXPECT_EQ(authority("http://h/"), "h");
    EXPECT_EQ(authority("http://h:80/"), "h");
    EXPECT_EQ(authority("https://h:80/"), "h:80");
    EXPECT_EQ(authority("https://[::1]:8443/"), "[::1]:8443");
    EXPECT_EQ(hostOf("https://[::1]:8443/x"), "::1");
    EXPECT_EQ(authority("http://[fe80::1%25eth0]/"), "[fe80::1]");
    EXPECT_EQ(hostOf("file://host/x"), "");
}

TEST(WebPlace, ResolvesReferencesAsTheStandardSays) {
    struct {
        const char *base, *reference, *whole;
    } const cases[] = {
        {"http://r:5000/d/x.xml", "/ctl", "http://r:5000/ctl"},
        {"http://r:5000", "ctl", "http://r:5000/ctl"},
        {"http://r:5000/d/x.xml", "ctl", "http://r:5000/d/ctl"},
        {"http://r/", "http://other/ctl", "http://other/ctl"},
        {"https://r/a", "//other:1/b", "https://other:1/b"},
        {"http://r/a/b?c", "?d", "http://r/a/b?d"},
        {"http://r/a/b?c", "#d", "http://r/a/b?c"},
        {"http://r/a/b?c", "", "http://r/a/b?c"},
        {"http://r/a/b/c", "../d/./e/..", "http://r/a/d/"},
        {"http://r/a", "../../../b?x=/../y", "http://r/b?x=/../y"},
        {"http://r/a", "app:page", "app:page"},
        {"http://r/a", "b:8/c/d e\r\n\xC3\xA9", "b:8/c/d%20e%0D%0A%C3%A9"},
        {"nothing", "/ctl", ""},
    };
    for (const auto& each : cases)
        EXPECT_EQ(resolveReference(each.base, each.reference), each.whole) << each.reference;
    EXPECT_EQ(resolveReference("http://r/", std::string(kLongestUrl, 'x')), "");
}

}  // namespace
}  // namespace wp
