#pragma once

#include <atomic>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

#include "platform/log.h"

namespace wp::fakes {

/// A log that keeps its lines, each with its category. *Any* thread.
class RecordingLog final : public Log {
  public:
    using Line = std::pair<int, std::string>;

    void setErrorEnabled(bool enabled) { enabled_ = enabled; }

    /// Every line so far.
    std::vector<Line> lines() const {
        std::lock_guard lock(mutex_);
        return lines_;
    }

    /// The lines of one category.
    std::vector<std::string> lines(int category) const {
        std::vector<std::string> found;
        for (const Line& line : lines()) {
            if (line.first == category) found.push_back(line.second);
        }
        return found;
    }

    void clear() {
        std::lock_guard lock(mutex_);
        lines_.clear();
    }

    bool isErrorEnabled(int) const override { return enabled_; }
    void error(int category, std::string_view message) override {
        std::lock_guard lock(mutex_);
        lines_.emplace_back(category, message);
    }

  private:
    std::atomic<bool> enabled_ = true;
    mutable std::mutex mutex_;
    std::vector<Line> lines_;
};

}  // namespace wp::fakes
