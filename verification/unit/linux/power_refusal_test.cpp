#include <fcntl.h>
#include <gtest/gtest.h>
#include <stdlib.h>
#include <unistd.h>

#include "verification/unit/fakes/temporary_folder.h"
#include "verification/unit/linux/conversation.h"
#include "verification/unit/linux/fakes/child_process.h"
#include "verification/unit/places.h"

namespace wp {
namespace {

/// A message bus of the test's own with one service on it, the system's bus as long as it lives.
class OwnBus {
  public:
    explicit OwnBus(const char* service) : address_("unix:path=" + folder_ / "bus") {
        setenv("DBUS_SYSTEM_BUS_ADDRESS", address_.c_str(), 1);
        daemon_.emplace(std::vector<std::string>{"dbus-daemon", "--session", "--nofork", "--nopidfile",
                                                 "--print-address", "--address=" + address_});
        service_.emplace(std::vector<std::string>{
            "/usr/bin/python3", sourceFolder() + "/verification/unit/linux/fakes/bus_services.py", address_,
            service});
    }
    ~OwnBus() { unsetenv("DBUS_SYSTEM_BUS_ADDRESS"); }

  private:
    fakes::TemporaryFolder folder_;
    std::string address_;
    std::optional<ChildProcess> daemon_, service_;
};

/// What becomes of the wish to switch Wi-Fi on, of a user who may look at the kernel's switch and no more.
std::string answerToTheWish() {
    int ends[2] = {};
    EXPECT_EQ(0, ::pipe2(ends, O_CLOEXEC | O_NONBLOCK));
    const Descriptor kernel(ends[1]);
    Conversation conversation{PowerSwitch(Descriptor(ends[0]))};
    conversation.say("{\"id\":1,\"request\":\"setPower\",\"power\":true}\n");
    const std::optional<Error> error = setPowerAnswer(conversation.answer(1));
    return error ? error->text() : "done";
}

TEST(PowerByNetworkManager, IsSwitchedForAUserWhoMayNotWriteToTheSwitch) {
    const OwnBus bus("nm");
    EXPECT_EQ(answerToTheWish(), "done");
}

TEST(PowerByNetworkManager, IsRefusedWithItsReasonBesideTheKernels) {
    const OwnBus bus("refusing-nm");
    EXPECT_EQ(
        answerToTheWish(),
        "no permission to write to /dev/rfkill, and org.freedesktop.NetworkManager answered: Not authorized "
        "to perform this operation (code 6)");
}

}  // namespace
}  // namespace wp
