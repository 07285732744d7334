#pragma once

#include <QGuiApplication>
#include <QSize>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "screens/tv/console.h"

namespace wp::tv {

/// What the choice of the toolkit's platform depends on.
struct Surroundings {
    std::string platform;  ///< QT_QPA_PLATFORM
    std::string wayland;   ///< WAYLAND_DISPLAY
    std::string x11;       ///< DISPLAY
    bool hasFramebuffer = false;
    bool hasGraphicsCard = false;

    static Surroundings ofProcess();
};

/// The toolkit's platform; nothing where there is no display. What the environment names counts, then a
/// desktop, then the console. *Any* thread.
std::optional<std::string> platformFor(const Surroundings& surroundings);

/// How many dots a point is, such that 1920 by 1080 points just fit; 1 for an empty size.
double unitFor(QSize dots);

/// `WxH` in dots; nothing for any other text.
std::optional<QSize> sizeFrom(std::string_view text);

/// The toolkit's application with the drawing decided and its messages led away. At most one exists. *Main*.
class Display {
  public:
    struct Messages {
        /// A fault in the scene, worth telling. *Any* thread, one at a time.
        std::function<void(std::string_view)> note;
        /// The toolkit is about to end the process. Does not return. *Any* thread, no more than one.
        std::function<void(std::string_view)> leave;
    };
    using Opened = std::variant<std::unique_ptr<Display>, std::string>;

    /// The text says why there is none.
    static Opened open(Messages messages);
    ~Display();
    Display(const Display&) = delete;
    Display& operator=(const Display&) = delete;

    /// The window's size in dots; nothing: the whole screen.
    std::optional<QSize> windowSize() const { return windowSize_; }
    /// The input devices to watch for keys that the toolkit drops; none where it reads them through another.
    const std::vector<std::string>& devicesThatDropKeys() const { return devicesThatDropKeys_; }
    /// False where the viewer's desktop asks for stillness.
    bool hasMotion() const;

  private:
    Display() = default;
    void makeApplication();

    /// Outlives the application, which has the console meanwhile.
    std::unique_ptr<Console> console_;
    std::unique_ptr<QGuiApplication> application_;
    std::optional<QSize> windowSize_;
    std::vector<std::string> devicesThatDropKeys_;
};

}  // namespace wp::tv
