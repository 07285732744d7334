#pragma once

#include <QQuickWindow>
#include <functional>
#include <string>
#include <string_view>

namespace wp::tv {

/// Tells of each frame when it was handed to the display, and what the main thread worked since the one before: turning
/// the main queue, moving and painting. Only where WIFI_PROFILE_TRACE is set. *Main*.
class FrameTrace {
  public:
    /// The screen's name stands in each line. Window and functions outlive it.
    FrameTrace(QQuickWindow& window, std::function<std::string()> screenName,
               std::function<void(std::string_view)> note);

  private:
    void frameSwapped();

    std::function<std::string()> screenName_;
    std::function<void(std::string_view)> note_;
    std::int64_t workedBefore_ = 0;
    QObject context_;
};

}  // namespace wp::tv
