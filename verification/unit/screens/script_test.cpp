#include "screens/remote/script.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

namespace wp::remote {
namespace {

using testing::HasSubstr;
using testing::StartsWith;

std::vector<Action> actionsOf(const Script& script) {
    std::vector<Action> actions;
    for (const Step& step : script.steps) actions.push_back(step.action);
    return actions;
}

std::string errorOf(std::string_view script) {
    Script read = readScript(script, Pictures::refused);
    EXPECT_TRUE(read.steps.empty());
    return read.error.value_or("accepted");
}

class ScriptFile {
  public:
    explicit ScriptFile(const std::string& content, const std::string& name = "keys.txt")
        : path_(std::filesystem::temp_directory_path() / (std::to_string(getpid()) + name)) {
        std::ofstream(path_) << content;
    }
    ~ScriptFile() { std::filesystem::remove(path_); }
    std::string path() const { return path_.string(); }

  private:
    std::filesystem::path path_;
};

TEST(Script, KnowsEveryKeyAndCommand) {
    Script script = readScript("up down left right select back clear wait screen", Pictures::refused);

    ASSERT_EQ(script.error, std::nullopt);
    EXPECT_EQ(actionsOf(script),
              (std::vector{Action::up, Action::down, Action::left, Action::right, Action::select,
                           Action::back, Action::clear, Action::wait, Action::screen}));
}

TEST(Script, MayBeEmpty) {
    EXPECT_EQ(readScript(" \n\t # nothing but this\n", Pictures::refused).error, std::nullopt);
}

TEST(Script, IsQuotedAsInAShell) {
    Script script = readScript(R"('type:a b' type:"x \"y\" \n 'z'" type:one\ two ty'pe':"" type:it\'s)",
                               Pictures::refused);

    ASSERT_EQ(script.error, std::nullopt);
    std::vector<std::string> texts;
    for (const Step& step : script.steps) texts.push_back(step.text);
    EXPECT_EQ(texts, (std::vector<std::string>{"a b", R"(x "y" \n 'z')", "one two", "", "it's"}));
}

TEST(Script, KeepsTheTimeOfASleep) {
    Script script = readScript("sleep:0 sleep:1500", Pictures::refused);

    ASSERT_EQ(script.steps.size(), 2U);
    EXPECT_EQ(script.steps[0].time.count(), 0);
    EXPECT_EQ(script.steps[1].time.count(), 1500);
}

TEST(Script, RefusesATimeThatIsNone) {
    for (const char* token : {"sleep:", "sleep:-1", "sleep:1.5", "sleep:1s", "sleep:+1",
                              "sleep:99999999999999999999", "sleep:86400001", "sleep: 1"})
        EXPECT_THAT(errorOf(token), HasSubstr("whole milliseconds from 0 to 86400000")) << token;
}

TEST(Script, SaysWhichTokenItDoesNotKnow) {
    EXPECT_THAT(errorOf("up upp down"), StartsWith("token 2 \"upp\": not one of up, down, left,"));
    EXPECT_THAT(errorOf("Select"), StartsWith("token 1 \"Select\": "));
    EXPECT_THAT(errorOf("type"), StartsWith("token 1 \"type\": "));
    EXPECT_THAT(errorOf("''"), StartsWith("token 1 \"\": "));
    EXPECT_THAT(errorOf("\x1B[2J"), StartsWith("token 1 \"\\x1B[2J\": "));
}

TEST(Script, RefusesTextThatIsNotUtf8) {
    EXPECT_EQ(errorOf("type:\xFF"), "token 1 \"type:\\xFF\": the text is not UTF-8");
}

TEST(Script, RefusesAQuoteThatIsNeverClosed) {
    EXPECT_EQ(errorOf("up 'type:x"), "the quote ' is never closed");
    EXPECT_EQ(errorOf("up \"type:x"), "the quote \" is never closed");
    EXPECT_EQ(errorOf("up \\"), "nothing follows the backslash at the end");
}

TEST(Script, TakesPicturesOnlyWhereThereAreAny) {
    EXPECT_EQ(errorOf("wait shot:list.png"), "token 2 \"shot:list.png\": only the tv screen takes pictures");

    Script script = readScript("shot:list.png", Pictures::taken);
    ASSERT_EQ(script.steps.size(), 1U);
    EXPECT_EQ(script.steps[0].text, "list.png");

    for (const char* token : {"shot:", "shot:.png", "shot:list.jpg"})
        EXPECT_THAT(readScript(token, Pictures::taken).error.value_or(""), HasSubstr("ends in .png"))
            << token;
}

TEST(Script, StandsInAFileToo) {
    ScriptFile file("wait  # the first list\ndown\n'type:a b'\n");

    Script script = readScript("up @" + file.path() + " back", Pictures::refused);

    ASSERT_EQ(script.error, std::nullopt);
    EXPECT_EQ(actionsOf(script),
              (std::vector{Action::up, Action::wait, Action::down, Action::type, Action::back}));
}

TEST(Script, InAFileMayBeginWithAByteOrderMark) {
    ScriptFile file(
        "\xEF\xBB\xBF"
        "wait\r\nselect\r\n");

    EXPECT_EQ(actionsOf(readScript("@" + file.path(), Pictures::refused)),
              (std::vector{Action::wait, Action::select}));
}

TEST(Script, SaysInWhichFileAndLineTheFaultIs) {
    ScriptFile unknown("wait\n\n down dwon\n");
    ScriptFile open("wait\n'type:\n", "open.txt");
    ScriptFile nested("@other", "nested.txt");

    EXPECT_THAT(errorOf("@" + unknown.path()),
                StartsWith(unknown.path() + ":3: token 3 \"dwon\": not one of"));
    EXPECT_EQ(errorOf("@" + open.path()), open.path() + ":2: the quote ' is never closed");
    EXPECT_EQ(errorOf("@" + nested.path()),
              nested.path() + ":1: token 1 \"@other\": a script file names no further file");
}

TEST(Script, SaysWhyAFileCannotBeRead) {
    EXPECT_EQ(errorOf("@/nowhere/keys"), "token 1 \"@/nowhere/keys\": No such file or directory");
    EXPECT_EQ(errorOf("@/"), "token 1 \"@/\": Is a directory");
    EXPECT_EQ(errorOf("@"), "token 1 \"@\": No such file or directory");
}

}  // namespace
}  // namespace wp::remote
