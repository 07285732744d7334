#include "host/arguments.h"

#include <gtest/gtest.h>

#include "host/exit.h"

namespace wp::host {
namespace {

/// The line with which these words are refused; "" when they are accepted.
std::string refusalOf(const std::vector<std::string>& words) {
    try {
        parseArguments(words);
    } catch (const Exit& exit) {
        EXPECT_EQ(exit.status(), exit_status::unusable);
        return exit.what();
    }
    return "";
}

TEST(Arguments, EveryOptionOfRunIsTakenOver) {
    Arguments arguments = parseArguments({"run",
                                          "--max-scan-cache-age",
                                          "1.5",
                                          "--list",
                                          "--network",
                                          "Office",
                                          "--record",
                                          "b.json",
                                          "--anonymise",
                                          "--interface",
                                          "wlan1",
                                          "--timeout",
                                          "2.5",
                                          "--config",
                                          "c.json",
                                          "--screen",
                                          "headless",
                                          "--remote",
                                          "down select",
                                          "--transcript",
                                          "t",
                                          "--automation",
                                          "p.json",
                                          "--locale",
                                          "de",
                                          "--output=o.json",
                                          "--format",
                                          "text",
                                          "--extension",
                                          "x.so",
                                          "--no-closing-page"});

    const RunOptions& run = arguments.run;
    EXPECT_EQ(arguments.command, Command::run);
    EXPECT_EQ(run.maxScanCacheAge, "1.5");
    EXPECT_TRUE(run.list);
    EXPECT_EQ(run.network, "Office");
    EXPECT_EQ(run.recordFile, "b.json");
    EXPECT_TRUE(run.anonymise);
    EXPECT_EQ(run.interfaceName, "wlan1");
    EXPECT_EQ(run.timeout, std::chrono::milliseconds(2500));
    EXPECT_EQ(run.configFile, "c.json");
    EXPECT_EQ(run.screen, ScreenChoice::headless);
    EXPECT_EQ(run.remote, "down select");
    EXPECT_EQ(run.transcriptFile, "t");
    EXPECT_EQ(run.automationFile, "p.json");
    EXPECT_EQ(run.locale, "de");
    EXPECT_EQ(run.outputFile, "o.json");
    EXPECT_EQ(run.format, OutputFormat::text);
    EXPECT_EQ(run.extension, "x.so");
    EXPECT_TRUE(run.noClosingPage);
}

TEST(Arguments, ARecordingAndTheEndpointsAreAskedForAlone) {
    EXPECT_EQ(parseArguments({"run", "--replay", "a.json"}).run.replayFile, "a.json");
    EXPECT_TRUE(parseArguments({"run", "--config", "c.json", "--show-endpoints"}).run.showEndpoints);
}

TEST(Arguments, ARunWithoutOptionsIsLiveWithoutAListAndWritesJSON) {
    Arguments arguments = parseArguments({"run"});

    EXPECT_EQ(arguments.run.replayFile, std::nullopt);
    EXPECT_EQ(arguments.run.requestFile, std::nullopt);
    EXPECT_FALSE(arguments.run.list);
    EXPECT_FALSE(arguments.run.noClosingPage);
    EXPECT_EQ(arguments.run.screen, ScreenChoice::automatic);
    EXPECT_EQ(arguments.run.format, OutputFormat::json);
}

TEST(Arguments, DemoTakesTheNextWordOnlyWhenThatIsNoOption) {
    EXPECT_EQ(parseArguments({"run", "--demo"}).run.demo, "home");
    EXPECT_EQ(parseArguments({"run", "--demo", "troubled"}).run.demo, "troubled");
    EXPECT_EQ(parseArguments({"run", "--demo=selected"}).run.demo, "selected");
    Arguments followed = parseArguments({"run", "--demo", "--list"});
    EXPECT_EQ(followed.run.demo, "home");
    EXPECT_TRUE(followed.run.list);
}

TEST(Arguments, AValueMayBeginWithADashAndANameMayBeEmpty) {
    EXPECT_EQ(parseArguments({"run", "--request", "-"}).run.requestFile, "-");
    EXPECT_EQ(parseArguments({"run", "--network", "--list"}).run.network, "--list");
    EXPECT_EQ(parseArguments({"run", "--network="}).run.network, "");
}

TEST(Arguments, BehindTwoDashesStandFilesAlone) {
    EXPECT_EQ(parseArguments({"report", "--all", "--", "--odd name"}).report.file, "--odd name");
    EXPECT_EQ(parseArguments({"run", "--list", "--"}).command, Command::run);
    EXPECT_EQ(refusalOf({"run", "--", "--list"}),
              "\"--list\" is not an option of run; `wifi-profile run --help` lists them");
    EXPECT_EQ(refusalOf({"report", "a", "--", "b"}), "\"b\": report takes one file; leave it out");
    EXPECT_EQ(refusalOf({"report", "--"}), "report: needs a FILE (or -), a result or a recording");
}

TEST(Arguments, WhatCannotBeUsedIsRefusedWithTheArgumentAndTheReason) {
    EXPECT_EQ(refusalOf({}),
              "nothing to do; give `run`, `tests` or `report FILE`, or see `wifi-profile --help`");
    EXPECT_EQ(refusalOf({"walk"}),
              "\"walk\" is no command; give `run`, `tests` or `report FILE`, or see `--help`");
    EXPECT_EQ(refusalOf({"tests", "14"}),
              "\"14\" is not an option of tests; `wifi-profile tests --help` lists them");
    EXPECT_EQ(refusalOf({"--version", "now"}), "\"now\": --version takes nothing more; leave it out");
    EXPECT_EQ(refusalOf({"report"}), "report: needs a FILE (or -), a result or a recording");
    EXPECT_EQ(refusalOf({"report", "a", "b"}), "\"b\": report takes one file; leave it out");
    EXPECT_EQ(refusalOf({"report", "a", "--format", "json"}),
              "--format: \"json\" is no format of a report; give text or html");
    EXPECT_EQ(refusalOf({"run", "fast"}),
              "\"fast\" is not an option of run; `wifi-profile run --help` lists them");
    EXPECT_EQ(refusalOf({"run", "--fast"}),
              "--fast: no such option of run; `wifi-profile run --help` lists them");
    EXPECT_EQ(refusalOf({"run", "--list", "--list"}), "--list: given twice; give it once");
    EXPECT_EQ(refusalOf({"run", "--list=yes"}), "--list: takes no value; leave out what follows the \"=\"");
    EXPECT_EQ(refusalOf({"run", "--replay"}), "--replay: needs a value, FILE");
    EXPECT_EQ(refusalOf({"run", "--replay", ""}), "--replay: the value is empty; give FILE");
    EXPECT_EQ(refusalOf({"run", "--screen", "big"}),
              "--screen: \"big\" is no screen; give tv, terminal, headless, none or auto");
    EXPECT_EQ(refusalOf({"run", "--format", "xml"}),
              "--format: \"xml\" is no format of a run; give json or text");
    for (std::string time : {"0", "-1", "nan", "inf", "5s", "1e9", " 5"})
        EXPECT_EQ(refusalOf({"run", "--timeout", time}),
                  "--timeout: \"" + time + "\" is not a time; give seconds above 0, at most 86400");
}

TEST(Arguments, ARequestExcludesEachOfItsShorthands) {
    const std::vector<std::vector<std::string>> shorthands = {
        {"--list"}, {"--network", "Office"}, {"--max-scan-cache-age", "5"}};
    for (const std::vector<std::string>& shorthand : shorthands) {
        std::vector<std::string> words = {"run", "--request", "r.json"};
        words.insert(words.end(), shorthand.begin(), shorthand.end());
        EXPECT_EQ(refusalOf(words),
                  shorthand[0] + ": not together with --request; put the value into the request instead");
    }
}

TEST(Arguments, OptionsThatNeedOneAnotherAreRefusedAlone) {
    EXPECT_EQ(refusalOf({"run", "--replay", "a", "--demo"}),
              "--demo: not together with --replay; a run replays one recording");
    EXPECT_EQ(refusalOf({"run", "--replay", "-", "--request", "-"}),
              "--replay: \"-\" is read already, as --request; give a file for one of the two");
    EXPECT_EQ(refusalOf({"run", "--replay", "a", "--interface", "wlan1"}),
              "--interface: not together with --replay; a recording states its devices itself");
    EXPECT_EQ(refusalOf({"run", "--interface", "wlan1", "--demo"}),
              "--interface: not together with --demo; a recording states its devices itself");
    EXPECT_EQ(refusalOf({"run", "--show-endpoints", "--replay", "a"}),
              "--replay: not together with --show-endpoints, which ends without a run");
    EXPECT_EQ(refusalOf({"run", "--output=o", "--show-endpoints"}),
              "--output: not together with --show-endpoints, which ends without a run");
    EXPECT_EQ(refusalOf({"run", "--anonymise"}),
              "--anonymise: needs --record FILE; it changes what is recorded");
    EXPECT_EQ(refusalOf({"run", "--record", "-"}),
              "--record: \"-\" is no file; standard output carries the result");
    EXPECT_EQ(refusalOf({"run", "--automation", "-"}),
              "--automation: \"-\" is no file; standard output carries the result");
    EXPECT_EQ(refusalOf({"run", "--transcript", "-"}),
              "--transcript: \"-\" needs --output FILE, because standard output carries the result");
}

TEST(Arguments, AReportHasAFileAndOptionsInAnyOrder) {
    Arguments arguments = parseArguments({"report", "--all", "-", "--locale=ja", "--output", "r.txt"});

    EXPECT_EQ(arguments.command, Command::report);
    EXPECT_EQ(arguments.report.file, "-");
    EXPECT_TRUE(arguments.report.all);
    EXPECT_EQ(arguments.report.locale, "ja");
    EXPECT_EQ(arguments.report.outputFile, "r.txt");
    EXPECT_EQ(parseArguments({"report", "--help"}).command, Command::reportHelp);
    EXPECT_EQ(parseArguments({"tests", "--help"}).command, Command::testsHelp);
    EXPECT_NE(testsHelpText().find("--config FILE"), std::string::npos) << "what a wrong option points to";
    EXPECT_EQ(parseArguments({"tests", "--locale", "de"}).report.locale, "de");
}

TEST(Arguments, AReportIsComparedWithOneEarlierFile) {
    EXPECT_EQ(parseArguments({"report", "-", "--compare", "old.json"}).report.compareFile, "old.json");
    EXPECT_EQ(refusalOf({"report", "-", "--compare", "-"}),
              "--compare: \"-\" is read already; give a file for one of the two");
}

TEST(Arguments, HelpNamesEveryOptionOfRun) {
    EXPECT_EQ(parseArguments({"run", "--list", "--help"}).command, Command::runHelp);
    std::string help = runHelpText();
    for (const char* option : {"--request FILE",
                               "--max-scan-cache-age N",
                               "--list",
                               "--network NAME",
                               "--replay FILE",
                               "--demo [NAME]",
                               "--record FILE",
                               "--anonymise",
                               "--interface NAME",
                               "--timeout SECONDS",
                               "--config FILE",
                               "--show-endpoints",
                               "--screen SCREEN",
                               "--remote SCRIPT",
                               "--transcript FILE",
                               "--automation FILE",
                               "--locale NAME",
                               "--output FILE",
                               "--format FORMAT",
                               "--extension PATH"})
        EXPECT_NE(help.find(option), std::string::npos) << option;
}

}  // namespace
}  // namespace wp::host
