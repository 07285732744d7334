#include "host/configuration.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>

#include "exchange/live.h"
#include "host/exit.h"
#include "verification/unit/fakes/temporary_folder.h"

namespace wp::host {
namespace {

/// A user's folder of configurations, in place of the one of whoever runs the tests.
class UsersConfiguration : public testing::Test {
  protected:
    void SetUp() override {
        std::filesystem::create_directory(folder_ / "wifi-profile");
        setenv("XDG_CONFIG_HOME", folder_.path().c_str(), 1);
    }
    void TearDown() override { unsetenv("XDG_CONFIG_HOME"); }

    std::string write(const std::string& name, const std::string& json) const {
        folder_.write(name, json);
        return folder_ / name;
    }
    static std::string refusalOf(const std::optional<std::string>& named) {
        try {
            readConfiguration(named);
        } catch (const Exit& exit) {
            EXPECT_EQ(exit.status(), exit_status::unusable);
            return exit.what();
        }
        return "";
    }

    fakes::TemporaryFolder folder_;
};

TEST_F(UsersConfiguration, CountsWithoutAnOptionAndTheNamedFileWins) {
    write("wifi-profile/config.json", R"({"capabilities": {"wapi": true, "other": true}})");
    const std::string named = write("named.json", R"({"capabilities": {"other": false, "third": true},
                                                 "thresholds": {"savedNetworks": 7}})");

    EXPECT_EQ(readConfiguration(std::nullopt).capabilities, (Flags{{"other", true}, {"wapi", true}}));
    EXPECT_EQ(readConfiguration(named).capabilities,
              (Flags{{"other", false}, {"third", true}, {"wapi", true}}));
    EXPECT_EQ(readConfiguration(named).thresholds->value("savedNetworks"), Value(7));
    EXPECT_EQ(readConfiguration(named).thresholds->size(), 6u);
    EXPECT_EQ(readConfiguration(named).endpoints->value("pingIPv4"), Value("9.9.9.9"));
}

TEST_F(UsersConfiguration, IsToldByTheProcessThatThenAnswers) {
    StartedService started = startService(std::nullopt, std::nullopt);

    LiveService service(std::move(started.process), {});
    const auto response = service.diagnostics().runTestRequests({{9999, nullptr}});
    ASSERT_TRUE(response.error);
    EXPECT_EQ(response.error->message, "no test 9999");
}

TEST_F(UsersConfiguration, IsRefusedWithFilePlaceAndReasonWhicheverPartIsWrong) {
    const std::string named = write("named.json", R"({"endpoints": {"pingIPv4": "here"}})");
    EXPECT_EQ(refusalOf(named), "--config: " + named + ": endpoints.pingIPv4: must be an IPv4 address");

    const std::string users = write("wifi-profile/config.json", R"({"thresholds": {"pairedBluetooth": -1}})");
    EXPECT_EQ(
        refusalOf(std::nullopt),
        "configuration: " + users + ": thresholds.pairedBluetooth: must be an integer from 0 to 100000");
    EXPECT_EQ(refusalOf(folder_ / "none"), refusalOf(std::nullopt));
}

TEST_F(UsersConfiguration, ThatIsNamedMustBeThere) {
    EXPECT_EQ(refusalOf(folder_ / "none"),
              "--config: " + folder_ / "none: cannot be read: No such file or directory");
}

}  // namespace
}  // namespace wp::host
