#include "screens/tv/display.h"

#include <unistd.h>

#include <QQuickWindow>
#include <QSettings>
#include <QStandardPaths>
#include <algorithm>
#include <charconv>
#include <clocale>
#include <filesystem>
#include <mutex>

#include "screens/tv/input_devices.h"

namespace wp::tv {
namespace {

constexpr int kWidth = 1920;
constexpr int kHeight = 1080;
/// A window of that size in dots, in place of the whole screen.
constexpr const char* kSizeVariable = "WIFI_PROFILE_TV_SIZE";
/// "none" or "full": over what the desktop says.
constexpr const char* kMotionVariable = "WIFI_PROFILE_TV_MOTION";

/// What stands below belongs to the thread that holds it: the toolkit writes messages from threads of its own too.
std::mutex messagesMutex;
Display::Messages messages;
/// What the toolkit's platform first complained of: the reason of what follows.
std::string firstComplaint;

std::string variable(const char* name) {
    return qgetenv(name).toStdString();
}

bool isUsable(const std::filesystem::path& device) {
    return access(device.c_str(), R_OK | W_OK) == 0;
}

/// The toolkit leaves the process by itself when its display is lost, and after a fatal message.
bool endsTheProcess(QtMsgType type, const QString& text) {
    return type == QtFatalMsg || text.contains(QLatin1String("connection broke")) ||
           text.contains(QLatin1String("The Wayland connection experienced a fatal error"));
}

bool isAboutThePlatform(const QMessageLogContext& context, const QString& text) {
    return (context.category && std::string_view(context.category).starts_with("qt.qpa")) ||
           text.startsWith(QLatin1String("Failed to create wl_display"));
}

bool isAboutTheScene(const QMessageLogContext& context, const QString& text) {
    return text.startsWith(QLatin1String("qrc:")) ||
           (context.category && std::string_view(context.category).starts_with("qml"));
}

/// Several threads find a lost display at once: the first one keeps the lock until the process is gone.
void takeMessage(QtMsgType type, const QMessageLogContext& context, const QString& text) {
    std::scoped_lock lock(messagesMutex);
    std::string line = text.section(QLatin1Char('\n'), 0, 0).toStdString();
    if (isAboutThePlatform(context, text) && type != QtDebugMsg && type != QtInfoMsg &&
        firstComplaint.empty())
        firstComplaint = line;
    if (endsTheProcess(type, text)) {
        bool isFatal = type == QtFatalMsg && !firstComplaint.empty();
        if (messages.leave) messages.leave(isFatal ? firstComplaint : line);
        _exit(1);
    }
    if (messages.note && isAboutTheScene(context, text)) messages.note("television screen: " + line);
}

void replaceMessages(Display::Messages given) {
    std::scoped_lock lock(messagesMutex);
    messages = std::move(given);
    firstComplaint.clear();
}

/// The settings in which desktops keep a person's wish for reduced motion.
bool desktopWantsStillness() {
    QString folder = QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation);
    for (const char* file : {"/gtk-4.0/settings.ini", "/gtk-3.0/settings.ini"}) {
        QSettings settings(folder + QLatin1String(file), QSettings::IniFormat);
        QString value = settings.value(QStringLiteral("Settings/gtk-enable-animations")).toString();
        if (value == QLatin1String("0") || value == QLatin1String("false")) return true;
    }
    QSettings settings(folder + QLatin1String("/kdeglobals"), QSettings::IniFormat);
    QVariant factor = settings.value(QStringLiteral("KDE/AnimationDurationFactor"));
    return factor.isValid() && factor.toDouble() == 0;
}

bool hasWindowSize(const std::string& platform) {
    return platform.starts_with("offscreen") || platform.starts_with("minimal");
}

}  // namespace

Surroundings Surroundings::ofProcess() {
    Surroundings found;
    found.platform = variable("QT_QPA_PLATFORM");
    found.wayland = variable("WAYLAND_DISPLAY");
    found.x11 = variable("DISPLAY");
    found.hasFramebuffer = isUsable("/dev/fb0");
    found.hasGraphicsCard = isUsable("/dev/dri/card0");
    return found;
}

std::optional<std::string> platformFor(const Surroundings& surroundings) {
    if (!surroundings.platform.empty()) return surroundings.platform;
    if (!surroundings.wayland.empty()) return surroundings.x11.empty() ? "wayland" : "wayland;xcb";
    if (!surroundings.x11.empty()) return "xcb";
    if (surroundings.hasFramebuffer) return "linuxfb";
    if (surroundings.hasGraphicsCard) return "eglfs";
    return std::nullopt;
}

double unitFor(QSize dots) {
    if (dots.isEmpty()) return 1;
    return std::min(dots.width() / static_cast<double>(kWidth), dots.height() / static_cast<double>(kHeight));
}

std::optional<QSize> sizeFrom(std::string_view text) {
    int width = 0;
    int height = 0;
    const char* end = text.data() + text.size();
    auto [cross, status] = std::from_chars(text.data(), end, width);
    if (status != std::errc() || cross == end || *cross != 'x') return std::nullopt;
    auto [rest, secondStatus] = std::from_chars(cross + 1, end, height);
    if (secondStatus != std::errc() || rest != end || width <= 0 || height <= 0) return std::nullopt;
    return QSize(width, height);
}

Display::Opened Display::open(Messages given) {
    Surroundings surroundings = Surroundings::ofProcess();
    std::optional<std::string> platform = platformFor(surroundings);
    if (!platform) return "there is no display: neither a desktop's nor a framebuffer or graphics card";
    qputenv("QT_QPA_PLATFORM", QByteArray::fromStdString(*platform));
    replaceMessages(std::move(given));
    qInstallMessageHandler(takeMessage);
    std::unique_ptr<Display> display(new Display);
    std::string wanted = variable(kSizeVariable);
    display->windowSize_ = sizeFrom(wanted);
    if (!wanted.empty() && !display->windowSize_)
        return std::string(kSizeVariable) + ": \"" + wanted + "\" is no size; give one like 1280x720";
    std::string motion = variable(kMotionVariable);
    if (!motion.empty() && motion != "none" && motion != "full")
        return std::string(kMotionVariable) + ": \"" + motion + "\" is no kind of motion; give none or full";
    if (!display->windowSize_ && hasWindowSize(*platform)) display->windowSize_ = QSize(kWidth, kHeight);
    if (Console::isDrawnOverBy(*platform)) {
        display->console_ = Console::take();
        nameDevicesToToolkit();
        if (readsDevicesItself(*platform)) display->devicesThatDropKeys_ = inputDevices();
    }
    display->makeApplication();
    return display;
}

void Display::makeApplication() {
    static int count = 1;
    static char name[] = "wifi-profile";
    static char* arguments[] = {name, nullptr};
    if (!qEnvironmentVariableIsSet("QT_QUICK_BACKEND") && !qEnvironmentVariableIsSet("QSG_RHI_BACKEND"))
        QQuickWindow::setGraphicsApi(QSGRendererInterface::Software);
    // The scene has its own unit, so that it fits screens coarser than its points too; the toolkit's scaling only
    // makes finer. With 72 dots to the inch a font's size is in dots, with fractions.
    qputenv("QT_ENABLE_HIGHDPI_SCALING", "0");
    // A desktop's factors would come on top: texts would be measured in one size and drawn in another.
    for (const char* factor : {"QT_SCALE_FACTOR", "QT_SCREEN_SCALE_FACTORS"}) qunsetenv(factor);
    qputenv("QT_FONT_DPI", "72");
    application_ = std::make_unique<QGuiApplication>(count, arguments);
    // The application takes over the environment's locale; numbers in documents keep their point.
    std::setlocale(LC_NUMERIC, "C");
}

Display::~Display() {
    application_.reset();
    qInstallMessageHandler(nullptr);
    replaceMessages({});
}

bool Display::hasMotion() const {
    std::string wanted = variable(kMotionVariable);
    if (!wanted.empty()) return wanted != "none";
    return !desktopWantsStillness();
}

}  // namespace wp::tv
