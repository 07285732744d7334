#include "host/output_file.h"

#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/stat.h>

#include <csignal>
#include <filesystem>
#include <fstream>
#include <iterator>

#include "host/exit.h"
#include "verification/unit/fakes/temporary_folder.h"

namespace wp::host {
namespace {

namespace fs = std::filesystem;

class OutputFileTest : public testing::Test {
  protected:
    std::string path(const std::string& name) const { return folder_ / name; }
    static std::string content(const fs::path& file) {
        std::ifstream stream(file);
        return {std::istreambuf_iterator<char>(stream), {}};
    }
    void put(const std::string& name, const std::string& text) const { folder_.write(name, text); }
    std::size_t filesInFolder() const {
        return static_cast<std::size_t>(std::distance(fs::directory_iterator(folder_.path()), {}));
    }
    std::string refusalOf(const std::string& file) const {
        try {
            OutputFile("--output", file);
        } catch (const Exit& exit) {
            EXPECT_EQ(exit.status(), exit_status::unusable);
            return exit.what();
        }
        return "";
    }

    fakes::TemporaryFolder folder_;
};

mode_t modeOf(const std::string& file) {
    struct stat status {};
    EXPECT_EQ(stat(file.c_str(), &status), 0);
    return status.st_mode & 07777;
}

TEST_F(OutputFileTest, ANewFileAppearsOnlyWhenItIsWritten) {
    OutputFile file("--output", path("result.json"));
    EXPECT_EQ(filesInFolder(), 0u);

    file.write("{}\n");

    EXPECT_EQ(content(path("result.json")), "{}\n");
    EXPECT_EQ(filesInFolder(), 1u);
}

TEST_F(OutputFileTest, AnEarlierFileIsReplacedAndKeepsItsMode) {
    put("result.json", "old and longer");
    chmod(path("result.json").c_str(), 0640);

    OutputFile("--output", path("result.json")).write("new");

    EXPECT_EQ(content(path("result.json")), "new");
    EXPECT_EQ(modeOf(path("result.json")), 0640u);
}

TEST_F(OutputFileTest, AGivenModeHoldsForNewAndEarlierFiles) {
    put("old.json", "old");
    chmod(path("old.json").c_str(), 0644);

    OutputFile("--record", path("old.json"), 0600).write("names");
    OutputFile("--record", path("new.json"), 0600).write("names");

    EXPECT_EQ(modeOf(path("old.json")), 0600u);
    EXPECT_EQ(modeOf(path("new.json")), 0600u);
}

TEST_F(OutputFileTest, ALinkStaysALink) {
    put("target.json", "old");
    fs::create_symlink("target.json", path("link.json"));

    OutputFile("--output", path("link.json")).write("new");

    EXPECT_TRUE(fs::is_symlink(path("link.json")));
    EXPECT_EQ(content(path("target.json")), "new");
}

TEST_F(OutputFileTest, ALinkToAFileThatIsNotThereYetStaysALink) {
    fs::create_symlink("second.json", path("first.json"));
    fs::create_symlink("target.json", path("second.json"));

    OutputFile("--output", path("first.json")).write("new");

    EXPECT_TRUE(fs::is_symlink(path("first.json")));
    EXPECT_TRUE(fs::is_symlink(path("second.json")));
    EXPECT_EQ(content(path("target.json")), "new");
}

TEST_F(OutputFileTest, EverySpellingOfAPathLeadsToTheSameFile) {
    fs::create_symlink("result.json", path("link.json"));
    fs::path result = finalFile(path("result.json"));

    EXPECT_EQ(finalFile(path("./result.json")), result);
    EXPECT_EQ(finalFile(path("link.json")), result);
    EXPECT_NE(finalFile(path("other.json")), result);
}

TEST_F(OutputFileTest, TheLongestNameOfAllIsWritten) {
    std::string longest(255, 'x');

    OutputFile("--output", path(longest)).write("new");

    EXPECT_EQ(content(path(longest)), "new");
    EXPECT_EQ(filesInFolder(), 1u);
}

TEST_F(OutputFileTest, AFailedWriteLeavesTheOldFileAndNoOther) {
    put("result.json", "old");
    OutputFile file("--output", path("result.json"));
    rlimit earlier{};
    getrlimit(RLIMIT_FSIZE, &earlier);
    auto earlierHandler = std::signal(SIGXFSZ, SIG_IGN);
    rlimit tight = {16, earlier.rlim_max};
    setrlimit(RLIMIT_FSIZE, &tight);

    std::string line;
    try {
        file.write(std::string(1000, 'x'));
    } catch (const Exit& exit) {
        EXPECT_EQ(exit.status(), exit_status::failure);
        line = exit.what();
    }

    setrlimit(RLIMIT_FSIZE, &earlier);
    std::signal(SIGXFSZ, earlierHandler);
    EXPECT_EQ(line, "--output: " + path("result.json") + ": not written: File too large");
    EXPECT_EQ(content(path("result.json")), "old");
    EXPECT_EQ(filesInFolder(), 1u);
}

TEST_F(OutputFileTest, APlaceThatCannotBeWrittenIsRefusedBeforeTheRun) {
    EXPECT_EQ(refusalOf(folder_.path()), "--output: " + folder_.path() + ": is a folder; give a file");
    EXPECT_EQ(
        refusalOf(path("no/such/file")),
        "--output: " + path("no/such/file") + ": cannot be written: its folder: No such file or directory");
    put("plain", "");
    EXPECT_EQ(refusalOf(path("plain/file")),
              "--output: " + path("plain/file") + ": cannot be written: Not a directory");
    EXPECT_EQ(refusalOf(path("new/")), "--output: " + path("new/") + ": cannot be written: no such folder");
}

TEST_F(OutputFileTest, ADeviceIsWrittenAsItStands) {
    OutputFile("--output", "/dev/null").write("{}\n");

    EXPECT_TRUE(fs::is_character_file("/dev/null"));
}

TEST_F(OutputFileTest, AFullDeviceIsAFailure) {
    OutputFile file("--output", "/dev/full");

    try {
        file.write("{}\n");
        FAIL() << "written to a full device";
    } catch (const Exit& exit) {
        EXPECT_STREQ(exit.what(), "--output: /dev/full: not written: No space left on device");
    }
}

}  // namespace
}  // namespace wp::host
