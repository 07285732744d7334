#include "host/service_program.h"

#include <gtest/gtest.h>

namespace wp::host {
namespace {

TEST(ServiceProgram, BothOutputsAndTheStatusComeBack) {
    ProgramOutput output = runProgram("/bin/sh", {"-c", "cat; echo one; echo two >&2; exit 5"});

    EXPECT_EQ(output.status, 5);
    EXPECT_EQ(output.standardOutput, "one\n");
    EXPECT_EQ(output.standardError, "two\n");
}

TEST(ServiceProgram, AnArgumentIsNeverTakenApart) {
    ProgramOutput output = runProgram("/bin/echo", {"a b", "$(reboot)", "'"});

    EXPECT_EQ(output.standardOutput, "a b $(reboot) '\n");
}

TEST(ServiceProgram, AProgramThatIsNotThereOrDiesIsTold) {
    EXPECT_EQ(runProgram("/no/such/program", {}).status, 127);
    EXPECT_EQ(runProgram("/bin/sh", {"-c", "kill -9 $$"}).status, 128 + 9);
}

}  // namespace
}  // namespace wp::host
