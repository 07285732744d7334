#pragma once

#include <memory>
#include <string>

namespace wp::tv {

/// Keeps the virtual console that the toolkit draws over from staying mute and dark however the process ends:
/// the toolkit takes its keyboard and its picture, and gives them back only when it is closed in order. At
/// most one exists. *Main*.
class Console {
  public:
    /// Whether this platform of the toolkit draws straight on the device, and so over a console.
    static bool isDrawnOverBy(const std::string& platform);
    /// Takes the console before the toolkit does: that of standard input, else the one in the foreground, whose
    /// shell must not hear what the viewer types. A process of its own watches over this one, so that the
    /// console comes back after SIGKILL too. Nothing where there is no console that may be taken.
    static std::unique_ptr<Console> take();
    /// Gives it back before it returns: whoever reads the console next finds it in order.
    ~Console();
    Console(const Console&) = delete;
    Console& operator=(const Console&) = delete;

  private:
    Console(int lifeline, int watcher) : lifeline_(lifeline), watcher_(watcher) {}

    int lifeline_;
    int watcher_;
};

}  // namespace wp::tv
