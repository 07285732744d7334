#pragma once

#include <functional>
#include <mutex>
#include <set>
#include <string>

namespace wp {

/// What a person should know of this run, each thing told once. *Any* thread.
class Notes {
  public:
    using Teller = std::function<void(const std::string& text)>;

    /// Whom everything is told from now on; called by whoever calls `once`. To be set before other threads start.
    void setTeller(Teller teller) { teller_ = std::move(teller); }

    /// Tells the text unless it was told before.
    void once(const std::string& text) { once(text, text); }

    /// Tells the text unless something was told about the same subject before: the message bus, for one, puts
    /// numbers that change into its reasons.
    void once(const std::string& subject, const std::string& text) {
        {
            const std::lock_guard lock(mutex_);
            if (!told_.insert(subject).second) return;
        }
        if (teller_) teller_(text);
    }

  private:
    Teller teller_;
    std::mutex mutex_;
    std::set<std::string> told_;
};

}  // namespace wp
