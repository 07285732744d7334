#pragma once

#include <sys/eventfd.h>
#include <unistd.h>

namespace wp::tv {

/// A descriptor that the toolkit's loop watches and any thread makes readable.
class Wake {
  public:
    Wake() : descriptor_(eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {}
    ~Wake() { close(descriptor_); }
    Wake(const Wake&) = delete;
    Wake& operator=(const Wake&) = delete;

    int descriptor() const { return descriptor_; }
    /// *Any* thread.
    void wake() const { eventfd_write(descriptor_, 1); }
    void drain() const {
        eventfd_t count = 0;
        eventfd_read(descriptor_, &count);
    }

  private:
    int descriptor_;
};

}  // namespace wp::tv
