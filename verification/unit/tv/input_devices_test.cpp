#include "screens/tv/input_devices.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <linux/input.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QCoreApplication>

#include "screens/tv/console.h"
#include "verification/unit/fakes/temporary_folder.h"

namespace wp::tv {
namespace {

class InputDevices : public testing::Test {
  protected:
    void SetUp() override {
        ASSERT_EQ(mkfifo(path_.c_str(), 0600), 0);
        device_ = open(path_.c_str(), O_RDWR | O_CLOEXEC);
    }

    void TearDown() override { close(device_); }

    void send(unsigned short type, unsigned short code, int value) {
        input_event event{};
        event.type = type;
        event.code = code;
        event.value = value;
        ASSERT_EQ(write(device_, &event, sizeof event), static_cast<ssize_t>(sizeof event));
    }

    fakes::TemporaryFolder folder_;
    const std::string path_ = folder_ / "event0";
    int device_ = -1;
};

TEST_F(InputDevices, OnlyPressesOfTheDroppedKeysAreTaken) {
    std::vector<ui::Key> pressed;
    DroppedKeys keys({folder_ / "missing", path_}, [&](ui::Key key) { pressed.push_back(key); });

    send(EV_KEY, KEY_OK, 1);
    send(EV_SYN, SYN_REPORT, 0);
    send(EV_KEY, KEY_OK, 0);
    send(EV_KEY, KEY_SELECT, 1);
    send(EV_KEY, KEY_EXIT, 1);
    send(EV_KEY, KEY_BACK, 1);
    send(EV_KEY, KEY_BACK, 2);
    QCoreApplication::processEvents();

    EXPECT_EQ(pressed, (std::vector{ui::Key::select, ui::Key::back}));
}

TEST(InputDevicesOfPlatform, AreReadBesideTheToolkitOnlyWhereItHasNoLibinput) {
    qputenv("QT_QPA_FB_NO_LIBINPUT", "1");
    qunsetenv("QT_QPA_EGLFS_NO_LIBINPUT");
    EXPECT_TRUE(readsDevicesItself("linuxfb:fb=/dev/fb0"));
    EXPECT_FALSE(readsDevicesItself("eglfs"));
    EXPECT_FALSE(readsDevicesItself("xcb"));
    qunsetenv("QT_QPA_FB_NO_LIBINPUT");
    EXPECT_FALSE(readsDevicesItself("linuxfb"));
}

TEST(Console, IsTakenOnlyWithoutADesktop) {
    EXPECT_TRUE(Console::isDrawnOverBy("linuxfb"));
    EXPECT_TRUE(Console::isDrawnOverBy("eglfs:size=1x1"));
    EXPECT_FALSE(Console::isDrawnOverBy("wayland;xcb"));
    EXPECT_FALSE(Console::isDrawnOverBy("offscreen"));
}

}  // namespace
}  // namespace wp::tv
