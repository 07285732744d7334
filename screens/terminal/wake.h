#pragma once

namespace wp::terminal {

/// A descriptor that `poll` sees, and the signals that concern a terminal screen. At most one exists.
class Wake {
  public:
    Wake();
    ~Wake();
    Wake(const Wake&) = delete;
    Wake& operator=(const Wake&) = delete;

    /// Readable from `wake` until `drain`. *Main*.
    int descriptor() const { return descriptor_; }

    /// *Any* thread, and safe in a signal handler.
    void wake() const;

    /// *Main*.
    void drain();

    /// Whether the signal came since it was last asked for. *Main*.
    bool takeResized();
    bool takeStop();
    bool takeContinued();

    /// Stops the process as the default disposition of SIGTSTP does; returns when it goes on. *Main*.
    void stop();

  private:
    int descriptor_;
};

}  // namespace wp::terminal
