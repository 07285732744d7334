#include "screens/tv/frame_trace.h"

#include <ctime>

namespace wp::tv {
namespace {

std::int64_t microseconds(clockid_t clock) {
    timespec now{};
    clock_gettime(clock, &now);
    return now.tv_sec * 1'000'000 + now.tv_nsec / 1'000;
}

}  // namespace

FrameTrace::FrameTrace(QQuickWindow& window, std::function<std::string()> screenName,
                       std::function<void(std::string_view)> note)
    : screenName_(std::move(screenName)), note_(std::move(note)) {
    if (!note_ || qEnvironmentVariableIsEmpty("WIFI_PROFILE_TRACE")) return;
    QObject::connect(&window, &QQuickWindow::frameSwapped, &context_, [this] { frameSwapped(); });
}

void FrameTrace::frameSwapped() {
    std::int64_t now = microseconds(CLOCK_MONOTONIC);
    std::int64_t worked = microseconds(CLOCK_THREAD_CPUTIME_ID);
    note_("trace: frame of " + screenName_() + " at " + std::to_string(now) + " us, cost " +
          std::to_string(worked - workedBefore_) + " us");
    workedBefore_ = worked;
}

}  // namespace wp::tv
