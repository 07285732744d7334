#include "host/running_page.h"

#include "host/report/catalogue.h"

namespace wp::host {
namespace {

/// In the middle of the screen.
constexpr double kWidth = 1100;
constexpr double kLeading = (1920 - kWidth) / 2;

}  // namespace

RunningPage::RunningPage(const std::string& title, const std::string& description, const Texts& texts)
    : HostPage(title, description, {kLeading, kWidth}), texts_(texts) {}

void RunningPage::show(const TestStep& step) {
    // What is running is not done yet.
    progress().setProgress(static_cast<float>(step.number - 1) / static_cast<float>(step.count));
    status().setText(texts_.text("RUNNING_TEST", {{"test", texts_.text(testKey(step.testID, "NAME"))},
                                                  {"number", std::to_string(step.number)},
                                                  {"count", std::to_string(step.count)}}));
}

}  // namespace wp::host
