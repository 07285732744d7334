#include "host/report/report.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "exchange/json_reader.h"
#include "exchange/place.h"
#include "host/report/channel_chart.h"
#include "host/report/html/html_form.h"
#include "host/report/journal.h"
#include "host/report/text_form.h"
#include "host/unicode/unicode.h"
#include "verification/unit/fakes/fake_diagnostics_client.h"

namespace wp::host {
namespace {

const Dictionary::Entries kWorking = {
    {"networkName", "Home"},  {"pingedLAN", true},   {"pingedWAN", true},     {"isIPv4Assigned", true},
    {"isIPv6Assigned", true}, {"resolvedDNS", true}, {"reachedVantor", true}, {"retrievedVantor", true}};

/// A result whose joined network works, with these entries in place of its own.
Evidence withJoined(Dictionary::Entries entries, Dictionary::Entries selected = {}) {
    entries.merge(Dictionary::Entries(kWorking));
    DictionaryPointer data = Dictionary::make({{"device", Dictionary::make()},
                                               {"currentNetwork", Dictionary::make(std::move(entries))},
                                               {"selectedNetwork", Dictionary::make(std::move(selected))}});
    return evidenceFrom(0, data);
}

Report reportOn(const Evidence& evidence) {
    return makeReport(evidence, {}, Texts("en"));
}

Answer failed(int testID, int code, const std::string& message) {
    Answer answer;
    answer.testID = testID;
    answer.error = Error{code, message};
    return answer;
}

std::vector<std::string> whatOf(const std::vector<ReportedFinding>& findings) {
    std::vector<std::string> what;
    for (const ReportedFinding& finding : findings) what.push_back(finding.what);
    return what;
}

std::vector<std::string> whatOf(const Report& report) {
    return whatOf(report.findings);
}

/// What is said in passing of that part, under the test's name.
std::string remarkOn(const Report& report, Part part, const std::string& name) {
    for (const ReportedFact& fact : report.facts)
        if (fact.part == part && fact.label == name) return fact.value;
    return "";
}

TEST(Report, ANetworkThatWorksIsSaidToWorkOnce) {
    Evidence evidence = withJoined({});
    evidence.hasAnswers = true;
    Report report = reportOn(evidence);

    EXPECT_EQ(report.summary, "The network “Home” works, and no problem was found.");
    EXPECT_TRUE(report.findings.empty());
    for (std::string text : {reportText(report, evidence, {}, Texts("en")),
                             reportPage(report, evidence, TextForm::Tests::withFindings, Texts("en"))})
        EXPECT_EQ(text.find("What was found"), std::string::npos);
}

TEST(Report, AResultAloneSaysHowFarItReaches) {
    Report report = reportOn(withJoined({}));

    EXPECT_EQ(report.summary,
              "As far as this result tells, the network “Home” works, and no problem was found.");
    ASSERT_FALSE(report.untold.empty());
    EXPECT_NE(report.untold.back().reason.find("whether only some connections get through"),
              std::string::npos);
    EXPECT_EQ(report.untold.back().remedy, "A report of a recording tells it.");
}

TEST(Report, EveryFindingOfEveryTestHasItsWordsAndKeepsToItsVerdict) {
    for (const CatalogueEntry& test : catalogue()) {
        if (test.foundWhen == FoundWhen::never) continue;
        bool found = test.foundWhen == FoundWhen::isTrue;
        for (bool verdict : {true, false}) {
            Evidence evidence = withJoined({});
            Part part = test.scope == TestScope::device ? Part::device : Part::joined;
            sectionOf(evidence, part)->setValue(test.resultKey, verdict);

            Report report = reportOn(evidence);

            const std::string remark = remarkOn(report, part, Texts("en").text(testKey(test.testID, "NAME")));
            ASSERT_EQ(report.findings.size() + (remark.empty() ? 0 : 1), verdict == found ? 1u : 0u)
                << test.testID;
            EXPECT_TRUE(test.severity != Severity::notice || report.findings.empty()) << test.testID;
            if (report.findings.empty()) continue;
            EXPECT_EQ(report.findings[0].testID, test.testID);
            EXPECT_NE(report.findings[0].means, "");
            EXPECT_NE(report.findings[0].advice, "");
        }
    }
}

TEST(Report, AFindingHasTheMeasuredValueTheThresholdAndItsSource) {
    Report report = reportOn(withJoined({{"hasPoorSignal", true}, {"RSSI", -80}, {"noise", -92}}));

    ASSERT_EQ(report.findings.size(), 1u);
    const ReportedFinding& finding = report.findings[0];
    EXPECT_EQ(finding.measured, "-80 dBm, 12 dB above the noise");
    EXPECT_EQ(finding.threshold, "below -75 dBm, or less than 18 dB above the noise");
    EXPECT_NE(finding.source, "");
    EXPECT_EQ(finding.by, "you, at this device");
    EXPECT_EQ(report.summary, "The network “Home” works, but one thing makes it slow, unstable or unsafe.");
}

TEST(Report, ThresholdsThatAConfigurationChangedAreNamed) {
    Evidence evidence = withJoined({});
    evidence.device->setValue("isLargeConnectedBT", true);
    evidence.device->setValue("bluetoothConnectedCount", 3);

    Report report =
        makeReport(evidence, thresholdsFrom(Dictionary::make({{"connectedBluetooth", 2}})), Texts("en"));

    ASSERT_EQ(report.findings.size(), 1u);
    EXPECT_EQ(report.findings[0].threshold, "more than 2");
}

TEST(Report, WithoutAnAddressAllElseFollowsFromIt) {
    Evidence evidence = withJoined({{"isIPv4Assigned", false},
                                    {"isIPv6Assigned", false},
                                    {"resolvedDNS", false},
                                    {"reachedVantor", false},
                                    {"retrievedVantor", false}});
    for (const char* key : {"pingedLAN", "pingedWAN"}) evidence.joined->removeValue(key);
    evidence.hasAnswers = true;
    for (int testID : {3, 6}) evidence.answers.push_back(failed(testID, 2, "no default route"));

    Report report = reportOn(evidence);

    EXPECT_EQ(report.summary,
              "This device is joined to the network “Home” but has no address there, so nothing works.");
    EXPECT_EQ(whatOf(report), std::vector<std::string>{"The network gave this device no address."});
    EXPECT_EQ(
        report.findings[0].follows,
        (std::vector<std::string>{
            "This device has no IPv6 address on the network.", "Names on the Internet cannot be resolved.",
            "The service of this device's maker cannot be reached.",
            "The service of this device's maker does not answer as it should.",
            "Could not be tested: Addresses translated twice, Sign-in page, Answer of the "
            "router, Answer from the Internet."}));
    EXPECT_TRUE(std::ranges::none_of(report.untold, [](const Untold& untold) {
        return std::ranges::find(untold.tests, "Answer of the router") != untold.tests.end();
    }));
}

TEST(Report, TheCauseOfAnOutageIsToldAndNotItsEffects) {
    const Dictionary::Entries outside = {
        {"pingedWAN", false}, {"reachedVantor", false}, {"retrievedVantor", false}};
    auto firstWith = [&](Dictionary::Entries entries) {
        entries.merge(Dictionary::Entries(outside));
        Report report = reportOn(withJoined(std::move(entries)));
        return report.findings.size() == 1 ? report.findings[0].what : "not one finding";
    };

    EXPECT_EQ(firstWith({{"isCaptive", true}}),
              "A sign-in page stands between this device and the Internet.");
    EXPECT_EQ(firstWith({{"pingedLAN", false}, {"resolvedDNS", false}}),
              "Nothing answers, not even the router.");
    EXPECT_EQ(firstWith({{"resolvedDNS", false}}), "Nothing on the Internet answers.");
    EXPECT_EQ(firstWith({}), "Nothing on the Internet answers.");
    EXPECT_EQ(firstWith({{"pingedWAN", true}, {"resolvedDNS", false}}),
              "Names on the Internet cannot be resolved.");
    EXPECT_EQ(firstWith({{"pingedWAN", true}}), "The service of this device's maker cannot be reached.");
}

TEST(Report, AWrongClockIsToldApartFromATroubledService) {
    Evidence evidence = withJoined({});
    for (int testID : {9, 11})
        evidence.answers.push_back(
            failed(testID, 9, "clock wrong: certificates cannot be judged before it is set"));
    evidence.hasAnswers = true;
    evidence.joined->removeValue("reachedVantor");
    evidence.joined->removeValue("retrievedVantor");

    Report report = reportOn(evidence);

    EXPECT_EQ(report.summary, "This device's clock is wrong, so secure connections fail.");
    EXPECT_EQ(whatOf(report), std::vector<std::string>{"This device's clock is wrong."});
}

TEST(Report, ACertificateOutOfItsTimeBlamesTheClockOnlyWhereItIsKnownToBeOff) {
    auto summaryWith = [](std::optional<int> offset, const char* fault) {
        Evidence evidence =
            withJoined({{"pingedWAN", false}, {"reachedVantor", false}, {"retrievedVantor", false}});
        DictionaryPointer details =
            Dictionary::make({{"end", "badCertificate"}, {"certificateFault", fault}});
        if (offset) details->setValue("clockOffset", *offset);
        evidence.hasAnswers = true;
        evidence.answers.push_back(Answer{9, {}, false, Dictionary::make({{"Details", details}}), {}});
        return reportOn(evidence).summary;
    };
    const std::string clock = "This device's clock is wrong, so secure connections fail.";
    const std::string tampered = "Secure connections through the network “Home” are tampered with or fail.";

    EXPECT_EQ(summaryWith(-90000, "notYetValid"), clock);
    EXPECT_EQ(summaryWith(90000, "expired"), clock);
    EXPECT_EQ(summaryWith(60, "expired"), tampered);
    EXPECT_EQ(summaryWith({}, "notYetValid"), tampered);
    EXPECT_EQ(summaryWith(-90000, "unknownIssuer"), tampered);
}

TEST(Report, ASignInPageIsNeverSaidToBeANetworkThatWorks) {
    EXPECT_EQ(reportOn(withJoined({{"isCaptive", true}})).summary,
              "A sign-in page stands between the network “Home” and the Internet.");
}

TEST(Report, AResultAloneTellsThatTheNetworkWasLost) {
    DictionaryPointer surroundings = Dictionary::make({{"2GHzChannel", 1}, {"is2GHzCongested", false}});
    DictionaryPointer data = Dictionary::make({{"device", Dictionary::make()},
                                               {"currentNetwork", surroundings},
                                               {"selectedNetwork", Dictionary::make()}});

    Report report = reportOn(evidenceFrom(0, data));

    EXPECT_EQ(report.summary, "The connection to the network was lost during the tests.");
    EXPECT_TRUE(report.untold.empty());
    ASSERT_EQ(report.findings.size(), 1u);
    EXPECT_TRUE(report.findings[0].follows.empty());
}

TEST(Report, TheSignInPageOfANetworkThatIsNotJoinedIsNothingThatWentWrong) {
    Report report = reportOn(withJoined({}, {{"networkName", "Office"}, {"isUsingWEPSecurity", false}}));

    auto found = std::ranges::find(
        report.untold, "Whether there is one shows only once the network is joined.", &Untold::reason);
    ASSERT_NE(found, report.untold.end());
    EXPECT_EQ(found->tests, std::vector<std::string>{"Sign-in page (Selected network “Office”)"});
}

TEST(Report, NoAnswerIsSaidToTakeNoTime) {
    DictionaryPointer ping = Dictionary::make({{"avg", 0.04}, {"packetLoss", 0.0}, {"count", 5}});
    Report report = reportOn(withJoined({{"pingLANResult", ping}}));

    ASSERT_FALSE(report.facts.empty());
    EXPECT_EQ(report.facts[0].value, "answers in <0.1 ms (quick), 0 of 5 requests lost");
}

TEST(Report, ALossThatIsNoShareIsNotTold) {
    for (double loss : {-0.1, 1.5, 1e300, std::nan("")}) {
        DictionaryPointer ping = Dictionary::make({{"avg", 2.0}, {"packetLoss", loss}, {"count", 5}});
        EXPECT_TRUE(reportOn(withJoined({{"pingLANResult", ping}})).facts.empty()) << loss;
    }
}

TEST(Report, AChannelAboveThoseOf5GHzIsOneOf6GHz) {
    for (auto [channel, value] : {std::pair{177, "177 (5 GHz)"}, std::pair{233, "233 (6 GHz)"}}) {
        Report report = reportOn(withJoined({{"currentChannel", channel}}));
        ASSERT_EQ(report.facts.size(), 1U);
        EXPECT_EQ(report.facts[0].value, value);
    }
}

TEST(Report, ASilentHostBesideOneThatAnswersAlarmsNobody) {
    Report report = reportOn(withJoined({{"pingedLAN", false}, {"pingedWAN", false}}));

    EXPECT_TRUE(report.findings.empty());
    EXPECT_EQ(
        remarkOn(report, Part::joined, "Answer of the router"),
        "The router does not answer to pings, though it passes traffic on. Many routers are set that way. "
        "It does no harm.");
    EXPECT_NE(remarkOn(report, Part::joined, "Answer from the Internet"), "");
}

TEST(Report, WhatCallsForNothingIsARemarkWithItsValue) {
    Evidence evidence = withJoined({{"isIPv6Assigned", false}});
    evidence.device->setValue("isLargePNL", true);
    evidence.device->setValue("preferredNetworkListCount", 70);
    Report report = reportOn(evidence);

    EXPECT_EQ(
        remarkOn(report, Part::joined, "IPv6 address"),
        "This device has no IPv6 address on the network. Many home networks have none. Nearly everything "
        "works with IPv4 alone.");
    EXPECT_TRUE(remarkOn(report, Part::device, "Remembered networks").ends_with(" (remembered: 70)"));
    EXPECT_TRUE(report.findings.empty());
}

TEST(Report, TheProvidersTranslationIsToldApartFromASecondRouterWhereItIsKnown) {
    auto foundWith = [](std::optional<const char*> basis) {
        Evidence evidence = withJoined({{"hasDoubleNATConfiguration", true}});
        DictionaryPointer details = Dictionary::make();
        if (basis) details->setValue("judgedBy", *basis);
        evidence.hasAnswers = basis.has_value();
        evidence.answers.push_back(Answer{8, {}, true, Dictionary::make({{"Details", details}}), {}});
        return whatOf(reportOn(evidence));
    };
    const std::vector<std::string> either = {
        "This network's addresses are translated twice: by two routers one behind the other, or by the "
        "router "
        "and the provider."};
    const std::vector<std::string> provider = {
        "The provider lets several customers share one address (carrier-grade translation)."};

    EXPECT_EQ(foundWith({}), either);
    EXPECT_EQ(foundWith("routerInside"), either);
    EXPECT_EQ(foundWith("routerShared"), provider);
    EXPECT_EQ(foundWith("sharedHop"), provider);
}

TEST(Report, AFindingOfBothNetworksIsToldOnce) {
    Report report = reportOn(
        withJoined({{"isBeaconIntervalLong", true}, {"beaconInterval", 300}},
                   {{"networkName", "Office"}, {"isBeaconIntervalLong", true}, {"beaconInterval", 400}}));

    ASSERT_EQ(report.findings.size(), 1u);
    EXPECT_EQ(report.findings[0].parts, (std::vector{Part::joined, Part::selected}));
    EXPECT_EQ(report.findings[0].where, "Network “Home”, Selected network “Office”");
    EXPECT_EQ(report.findings[0].measured,
              "Network “Home”: 300 time units; Selected network “Office”: 400 time units");
}

TEST(Report, TheWorstComesFirst) {
    Report report = reportOn(withJoined({{"isBeaconIntervalLong", true},
                                         {"hasPoorSignal", true},
                                         {"isCaptive", true},
                                         {"reachedVantor", false}}));

    std::vector<Severity> severities;
    for (const ReportedFinding& finding : report.findings) severities.push_back(finding.severity);

    EXPECT_EQ(severities, (std::vector{Severity::broken, Severity::problem, Severity::advice}));
    ClosingSummary closing = closingSummary(report);
    EXPECT_EQ(closing.summary, report.summary);
    EXPECT_EQ(whatOf(closing.findings),
              (std::vector<std::string>{"A sign-in page stands between this device and the Internet.",
                                        "The signal is weak.", "The access point announces itself rarely."}));
}

TEST(Report, TestsThatCouldNotTellAreGroupedByWhatIsMissing) {
    Evidence evidence = withJoined({});
    evidence.hasAnswers = true;
    evidence.answers = {failed(30, 6, "no permission to scan"), failed(28, 6, "no permission to scan"),
                        failed(27, -1, "no recorded answer for test 27")};

    Report report = reportOn(evidence);

    auto testsFor = [&](const std::string& reason) {
        auto found = std::ranges::find(report.untold, reason, &Untold::reason);
        return found == report.untold.end() ? std::vector<std::string>{} : found->tests;
    };
    EXPECT_EQ(testsFor("A permission is missing."),
              (std::vector<std::string>{"Country codes", "Hidden networks nearby"}));
    EXPECT_FALSE(testsFor("The recording holds no answer.").empty());
}

TEST(Report, WhyATestCouldNotTellIsSaidInTheViewersLanguageBesideTheServicesWords) {
    Evidence evidence = withJoined({});
    evidence.hasAnswers = true;
    evidence.answers = {failed(35, 7, "no beacon\x1B"), failed(34, -1, "no recorded answer for test 34")};
    const auto told = [&](const char* language, int testID) {
        const Report report = makeReport(evidence, {}, Texts(language));
        const auto test = std::ranges::find(report.tests, testID, &ReportedTest::testID);
        return test->answer + "|" + test->detail;
    };

    EXPECT_EQ(told("en", 35), "could not be told: No answer came in time.|no beacon\\x1B");
    EXPECT_EQ(told("de", 35), "nicht festzustellen: Es kam keine rechtzeitige Antwort.|no beacon\\x1B");
    EXPECT_EQ(told("ja", 35), "わかりませんでした。時間内に応答がありませんでした。|no beacon\\x1B");
    // What a replay says of its recording is all in the reason.
    EXPECT_EQ(told("de", 34), "nicht festzustellen: Die Aufzeichnung enthält keine Antwort.|");
}

TEST(Report, OnAPageTheServicesWordsAreMarkedAsEnglish) {
    Evidence evidence = withJoined({});
    evidence.hasAnswers = true;
    evidence.answers = {failed(35, 7, "no beacon <heard>")};
    const Texts texts("de");

    EXPECT_THAT(
        reportPage(makeReport(evidence, {}, texts), evidence, TextForm::Tests::all, texts),
        testing::HasSubstr("<td>nicht festzustellen: Es kam keine rechtzeitige Antwort.<span lang=\"en\"> "
                           "(no beacon &lt;heard&gt;)</span></td>"));
}

TEST(Report, ANameFromTheAirCannotSteerATerminal) {
    Evidence evidence = withJoined({{"networkName",
                                     "a\x1B[2J\xE2\x80\xAE"
                                     "b"},
                                    {"isUsingAmbiguousNetworkName", true}});

    std::string text = reportText(reportOn(evidence), evidence, {}, Texts("en"));

    EXPECT_EQ(text.find('\x1B'), std::string::npos);
    EXPECT_NE(text.find("a\\x1B[2J\\u{202E}b"), std::string::npos);
}

TEST(Report, NoLineIsWiderThanATerminalInAnyLanguage) {
    Dictionary::Entries all;
    for (const CatalogueEntry& test : catalogue())
        all.emplace(test.resultKey, test.foundWhen == FoundWhen::isTrue);
    all.emplace("networkName", std::string(200, 'W'));
    Evidence evidence = withJoined(all, all);
    for (const char* language : {"en", "de", "ja", "x-keys"}) {
        Texts texts(language);
        TextForm form{TextForm::Tests::all, TextForm::Style::plain};
        std::string text = reportText(makeReport(evidence, {}, texts), evidence, form, texts);
        EXPECT_EQ(text, reportText(makeReport(evidence, {}, texts), evidence, form, texts));
        for (std::size_t end; (end = text.find('\n')) != std::string::npos; text.erase(0, end + 1))
            EXPECT_LE(columnsOf(text.substr(0, end)), 80) << text.substr(0, end);
    }
}

/// Evidence with these networks in the details of the crowded-channel test.
Evidence withHeard(Array networks) {
    Evidence evidence = withJoined({});
    Answer answer;
    answer.testID = 24;
    answer.info = Dictionary::make({{"Details", Dictionary::make({{"networks", std::move(networks)}})}});
    evidence.hasAnswers = true;
    evidence.answers.push_back(answer);
    return evidence;
}

Value heard(const std::string& address, Dictionary::Entries entries) {
    entries.emplace("bssid", address);
    return Dictionary::make(std::move(entries));
}

TEST(ChannelChart, ANetworkIsDrawnOverTheChannelsThatItOccupies) {
    Evidence evidence = withHeard({heard("a", {{"ssid", "Home"},
                                               {"rssi", -50},
                                               {"band", "2.4GHz"},
                                               {"channel", 6},
                                               {"frequency", 2437},
                                               {"width", 20},
                                               {"centreFrequencies", Array{2437}},
                                               {"joined", true}}),
                                   heard("b", {{"rssi", -70},
                                               {"band", "2.4GHz"},
                                               {"channel", 1},
                                               {"frequency", 2412},
                                               {"width", 40},
                                               {"centreFrequencies", Array{2422}}}),
                                   heard("c", {{"ssid", "Wide"},
                                               {"rssi", -60},
                                               {"band", "5GHz"},
                                               {"channel", 36},
                                               {"frequency", 5180},
                                               {"width", 80},
                                               {"centreFrequencies", Array{5210}}})});

    EXPECT_EQ(
        channelChart(evidence, Texts("en")),
        (std::vector<std::string>{"2.4 GHz", "         1  2  3  4  5  6  7  8  9 10 11 12 13",
                                  "                  #############                           -50 *Home",
                                  "   -------------------------                              -70  (hidden)",
                                  "", "5 GHz", "  36  44  52  60  100 108 116 124 132 140 149 157 165 173",
                                  "  ========                                                  -60  Wide"}));
}

TEST(ChannelChart, ACrowdIsCutToItsStrongestAndTheOwnNetworkStays) {
    Array networks;
    for (int i = 0; i < 30; ++i)
        networks.push_back(heard(std::to_string(i), {{"ssid", std::string(40, 'x')},
                                                     {"rssi", -40 - i},
                                                     {"band", "6GHz"},
                                                     {"channel", 1},
                                                     {"frequency", 5955},
                                                     {"joined", i == 29}}));
    Evidence evidence = withHeard(std::move(networks));

    std::vector<std::string> lines = channelChart(evidence, Texts("en"));

    EXPECT_EQ(lines.size(), 2u + 13u + 1u);
    EXPECT_EQ(lines.back(), "  and weaker ones: 17");
    for (const std::string& line : lines) EXPECT_LE(columnsOf(line), 80) << line;
}

TEST(Evidence, AResultIsReadWholeOrRefusedWithItsPlace) {
    auto refusalOf = [](const std::string& text) -> std::string {
        try {
            evidenceFromResult(std::get<Value>(readJSON(text)));
        } catch (const Refused& refused) {
            return refused.what();
        }
        return "";
    };

    EXPECT_EQ(
        refusalOf(
            R"({"statusCode": 0, "data": {"device": {}, "currentNetwork": {}, "selectedNetwork": {}}})"),
        "");
    EXPECT_NE(refusalOf("[]"), "");
    EXPECT_EQ(refusalOf(R"({"statusCode": 0})"), "needs the key \"data\"");
    EXPECT_EQ(refusalOf(R"({"statusCode": "0", "data": {}})").substr(0, 10), "statusCode");
    EXPECT_EQ(refusalOf(R"({"statusCode": 0, "data": {"device": 1}})").substr(0, 11), "data.device");
}

TEST(Journal, KeepsWhatWasAnsweredAboutWhichNetwork) {
    fakes::FakeDiagnosticsClient client;
    client.setJoinedNetwork("Home");
    client.setOutcome(3, fakes::failure(2, "no default route"));
    client.setOutcome(14, fakes::outcome(true, false, Dictionary::make({{"IPv4ConfigMethod", "manual"}})));
    Journal journal(client, [](const TestStep&) {});

    journal.queryStatus();
    DictionaryPointer named = Dictionary::make({{"NetworkName", "Office"}});
    journal.runTestRequests({{14, named}});
    journal.runTestRequests({{3, nullptr}});
    journal.runTestRequests({{32, named}});
    Evidence evidence = journal.evidence(0, Dictionary::make());

    EXPECT_EQ(evidence.joinedName, "Home");
    EXPECT_EQ(evidence.selectedName, "Office");
    ASSERT_TRUE(answerTo(evidence, Part::device, 14));
    EXPECT_EQ(answerTo(evidence, Part::device, 14)->result, true);
    ASSERT_TRUE(answerTo(evidence, Part::joined, 3));
    EXPECT_EQ(answerTo(evidence, Part::joined, 3)->error->code, 2);
    EXPECT_FALSE(answerTo(evidence, Part::joined, 32));
    EXPECT_TRUE(answerTo(evidence, Part::selected, 32));
}

TEST(Journal, KnowsWhetherTheDeviceEverToldItsNetwork) {
    fakes::FakeDiagnosticsClient client;
    Journal journal(client, [](const TestStep&) {});
    auto isUntold = [&] { return journal.evidence(0, Dictionary::make()).isStatusUntold; };

    EXPECT_FALSE(isUntold()) << "nobody asked";
    client.setStatus({nullptr, Error{7, "timeout"}});
    journal.queryStatus();
    EXPECT_TRUE(isUntold());
    client.setJoinedNetwork("Home");
    journal.queryStatus();
    EXPECT_FALSE(isUntold());
    client.setStatus({nullptr, Error{7, "timeout"}});
    journal.queryStatus();
    EXPECT_FALSE(isUntold()) << "what was told before goes on to hold";
}

TEST(Journal, CountsTheTestsOfTheRunAndPassesThemOn) {
    fakes::FakeDiagnosticsClient service;
    service.setJoinedNetwork("Home");
    std::vector<std::string> told;
    Journal journal(service, [&](const TestStep& step) {
        told.push_back(std::to_string(step.testID) + " " + std::to_string(step.number) + "/" +
                       std::to_string(step.count));
    });
    auto request = [](int testID) {
        DiagnosticsTestRequest made;
        made.testID = testID;
        return std::vector{made};
    };

    journal.queryStatus();
    journal.runTestRequests(request(31));
    journal.runTestRequests(request(14));
    journal.runTestRequests(request(19));

    EXPECT_THAT(told, testing::ElementsAre("14 1/40", "19 2/40"));
    EXPECT_THAT(service.requestedTestIDs(), testing::ElementsAre(31, 14, 19));
}

TEST(Wrapping, LinesBreakWhereTheLanguageAllowsIt) {
    EXPECT_EQ(wrappedLines("one two three", 8), (std::vector<std::string>{"one two", "three"}));
    EXPECT_EQ(wrappedLines("電波が弱いです。", 8), (std::vector<std::string>{"電波が弱", "いです。"}));
    EXPECT_EQ(wrappedLines("abcdefgh ij", 4), (std::vector<std::string>{"abcd", "efgh", "ij"}));
    EXPECT_TRUE(wrappedLines("", 8).empty());
    EXPECT_EQ(wrappedLines("at -85 dBm", 7), (std::vector<std::string>{"at", "-85 dBm"}));
    EXPECT_EQ(wrappedLines("uses 5 sheets", 7), (std::vector<std::string>{"uses 5", "sheets"}));
    EXPECT_EQ(withUnitsKept("2.4 GHz, 5 sheets"), "2.4\u00A0GHz, 5 sheets");
    EXPECT_EQ(columnsOf("é電"), 3);
}

}  // namespace
}  // namespace wp::host
