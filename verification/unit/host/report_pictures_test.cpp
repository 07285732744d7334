#include <gtest/gtest.h>

#include <array>
#include <regex>
#include <set>

#include "host/report/html/channel_picture.h"
#include "host/report/html/markup.h"
#include "host/report/html/ping_picture.h"
#include "host/report/html/style.h"

namespace wp::host {
namespace {

using Role = PicturedNetwork::Role;
using Band = ChannelPicture::Band;

ChannelPicture picture(Band band, std::vector<PicturedNetwork> networks) {
    ChannelPicture picture;
    picture.band = band;
    picture.words = {"band", "Title", "Description"};
    picture.networks = std::move(networks);
    return picture;
}

std::string drawn(const ChannelPicture& picture) {
    Markup markup;
    drawChannels(picture, markup);
    return markup.written();
}

std::string plotted(std::vector<std::optional<double>> times, std::vector<std::string> labels = {}) {
    Markup markup;
    drawPings({{"pings", "Title", "Description"}, std::move(times), std::move(labels)}, markup);
    return markup.written();
}

std::size_t countOf(const std::string& text, const std::string& part) {
    std::size_t count = 0;
    for (std::size_t at = text.find(part); at != text.npos; at = text.find(part, at + 1)) ++count;
    return count;
}

/// Left end, height and right end of each shape, in the order in which they are drawn.
std::vector<std::array<double, 3>> shapes(const std::string& svg) {
    static const std::regex path(R"re(<path d="M([\d.]+) [\d.]+L[\d.]+ ([\d.]+)H[\d.]+L([\d.]+) )re");
    std::vector<std::array<double, 3>> found;
    for (std::sregex_iterator each(svg.begin(), svg.end(), path), end; each != end; ++each)
        found.push_back({std::stod((*each)[1]), std::stod((*each)[2]), std::stod((*each)[3])});
    return found;
}

TEST(Markup, EscapesWhatWouldBeReadAsMarkupInTextsAndAttributes) {
    Markup markup;
    markup.element("p", R"(<script>alert("a" & 'b')</script>)", {{"title", "\"><img src=x onerror='1'>"}});

    EXPECT_EQ(markup.written(),
              "<p title=\"&quot;&gt;&lt;img src=x "
              "onerror=&#39;1&#39;&gt;\">&lt;script&gt;alert(&quot;a&quot; &amp; "
              "&#39;b&#39;)&lt;/script&gt;</p>");
}

TEST(Markup, LetsNoCharacterCommandHideOrReorder) {
    Markup markup;
    markup.text("a\x1B[1m\u202Eb\u200B\nc\x80");

    EXPECT_EQ(markup.written(), R"(a\x1B[1m\u{202E}b\u{200B}\x0Ac\x80)");
}

TEST(Markup, ClosesElementsInTheReverseOrder) {
    Markup markup;
    markup.open("ul");
    markup.open("li", {{"class", "a"}});
    markup.empty("br");
    markup.close();
    markup.close();

    EXPECT_EQ(markup.written(), R"(<ul><li class="a"><br/></li></ul>)");
}

TEST(ChannelPicture, AShapeIsAsWideAsTheNetworkAndAsHighAsItsSignal) {
    const auto found = shapes(drawn(picture(
        Band::ghz2, {{"A", -40, {{2402, 2422}}, Role::other}, {"B", -80, {{2427, 2467}}, Role::other}})));

    ASSERT_EQ(found.size(), 2U);
    const double width = found[0][2] - found[0][0];
    EXPECT_NEAR(found[1][2] - found[1][0], 2 * width, 0.2);
    EXPECT_NEAR(found[1][0] - found[0][0], width * 25 / 20, 0.2);
    EXPECT_NEAR(found[1][1] - found[0][1], (280 - 40) * 40.0 / 80, 0.2);
}

TEST(ChannelPicture, ANetworkOfTwoHalvesIsTwoShapes) {
    EXPECT_EQ(
        shapes(drawn(picture(Band::ghz5, {{"A", -40, {{5170, 5250}, {5735, 5815}}, Role::other}}))).size(),
        2U);
}

TEST(ChannelPicture, WhatLiesBesideTheBandOrHasNoSignalIsNotDrawn) {
    const std::string svg = drawn(picture(Band::ghz2, {{"A", -40, {{5170, 5190}}, Role::other},
                                                       {"B", std::nullopt, {{2402, 2422}}, Role::other}}));

    EXPECT_TRUE(shapes(svg).empty());
    EXPECT_EQ(svg.find(">A<"), svg.npos);
}

TEST(ChannelPicture, TheJoinedNetworkIsDrawnLastAndHatchedAndTheSelectedOneIsTold) {
    const std::string svg = drawn(picture(Band::ghz2, {{"A", -40, {{2402, 2422}}, Role::joined},
                                                       {"B", -50, {{2402, 2422}}, Role::selected},
                                                       {"C", -60, {{2402, 2422}}, Role::other}}));

    const auto other = svg.find(R"(class="network")"), selected = svg.find(R"(class="network selected")"),
               joined = svg.find(R"re(class="network joined" style="fill:url(#band-hatch)")re");
    EXPECT_LT(other, selected);
    EXPECT_LT(selected, joined);
    EXPECT_NE(joined, svg.npos);
}

TEST(ChannelPicture, IsToldToThoseWhoCannotSeeIt) {
    const std::string svg = drawn(picture(Band::ghz2, {}));

    EXPECT_EQ(
        svg.find(
            R"(<svg viewBox="0 0 720 320" role="img" class="channels" aria-labelledby="band-title band-text">)"),
        0U);
    EXPECT_NE(svg.find(R"(<title id="band-title">Title</title><desc id="band-text">Description</desc>)"),
              svg.npos);
}

TEST(ChannelPicture, NamesAreNumberedAndCutAndNeverMarkup) {
    const std::string svg =
        drawn(picture(Band::ghz2, {{"</text><script>", -40, {{2402, 2422}}, Role::other},
                                   {"A name that goes on and on and on", -40, {{2452, 2472}}, Role::other}}));

    EXPECT_NE(
        svg.find(
            R"(<tspan class="number">1</tspan><tspan class="name"> &lt;/text&gt;&lt;script&gt;</tspan>)"),
        svg.npos);
    EXPECT_NE(svg.find("A name that goes on …"), svg.npos);
    EXPECT_EQ(svg.find("<script>"), svg.npos);
}

TEST(ChannelPicture, LabelsOfNetworksOnOneChannelDoNotLieOnEachOther) {
    std::vector<PicturedNetwork> many(40, {"Neighbour", -40, {{2402, 2422}}, Role::other});
    const std::string svg = drawn(picture(Band::ghz2, many));

    static const std::regex label(R"re(class="label" x="([\d.]+)" y="([\d.]+)")re");
    std::set<std::pair<std::string, std::string>> places;
    for (std::sregex_iterator each(svg.begin(), svg.end(), label), end; each != end; ++each)
        EXPECT_TRUE(places.insert({(*each)[1], (*each)[2]}).second);
    EXPECT_GE(places.size(), 2U);
    EXPECT_EQ(shapes(svg).size(), 40U);
}

TEST(ChannelPicture, MarksTheChannelsThatAreSharedWithRadar) {
    ChannelPicture five = picture(Band::ghz5, {});
    five.radarChannels = {52, 100};
    five.radar = "radar";

    EXPECT_EQ(countOf(drawn(five), R"(class="radar")"), 2U);
    EXPECT_EQ(countOf(drawn(five), ">radar<"), 1U);
    EXPECT_EQ(countOf(drawn(picture(Band::ghz5, {})), R"(class="radar")"), 0U);
}

TEST(PingPicture, AColumnIsAsHighAsTheAnswerTookAndALostOneIsACross) {
    const std::string svg = plotted({10, 5, std::nullopt}, {"10 ms", "5 ms", "lost"});

    EXPECT_NE(svg.find(R"(height="72.0")"), svg.npos);
    EXPECT_NE(svg.find(R"(height="36.0")"), svg.npos);
    EXPECT_EQ(countOf(svg, R"(class="answer")"), 2U);
    EXPECT_EQ(countOf(svg, R"(class="lost")"), 1U);
    EXPECT_NE(svg.find(">lost</text>"), svg.npos);
}

TEST(PingPicture, QuickAnswersAreNotMadeToDiffer) {
    EXPECT_EQ(countOf(plotted({0.01, 0.02}), R"(height="2.0")"), 2U);
    EXPECT_EQ(countOf(plotted({}), R"(class="answer")"), 0U);
}

TEST(PageStyle, FetchesNothingAndHoldsNoMarkup) {
    EXPECT_EQ(kPageStyle.find("url("), kPageStyle.npos);
    EXPECT_EQ(kPageStyle.find("@import"), kPageStyle.npos);
    EXPECT_EQ(kPageStyle.find_first_of("<&"), kPageStyle.npos);
}

}  // namespace
}  // namespace wp::host
