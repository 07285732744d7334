#pragma once

namespace wp::tv {

/// Keeps the virtual console that the toolkit draws over from staying mute and dark however the process ends:
/// the toolkit takes its keyboard and its picture, and gives them back only when it is closed in order. At
/// most one exists. *Main*.
class Console {
  public:
    /// Remembers the console of standard input, before the toolkit takes it; nothing where that is none. A
    /// process of its own watches over this one, so that the console comes back after SIGKILL too.
    Console();
    ~Console();
    Console(const Console&) = delete;
    Console& operator=(const Console&) = delete;

  private:
    int lifeline_ = -1;
};

}  // namespace wp::tv
