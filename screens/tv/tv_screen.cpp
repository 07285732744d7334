#include "screens/tv/tv_screen.h"

#include <QBuffer>
#include <QFile>
#include <QQmlError>
#include <QQuickItem>
#include <QScreen>
#include <QSocketNotifier>
#include <QTimer>
#include <algorithm>

#include "screens/tv/frame_trace.h"
#include "screens/tv/input_devices.h"
#include "screens/tv/keyboard_look.h"
#include "screens/tv/reading.h"
#include "screens/tv/stage.h"
#include "screens/tv/text_measurer.h"
#include "screens/tv/typist.h"
#include "screens/tv/wake.h"
#include "screens/tv/window.h"

namespace wp::tv {

class TvScreen::Loop : private ui::ScreenObserver {
  public:
    Loop(std::unique_ptr<Display> display, ui::Screen& screen, MainQueue& queue, Texts texts,
         std::function<void(std::string_view)> note)
        : display_(std::move(display)),
          screen_(screen),
          queue_(queue),
          texts_(std::move(texts)),
          typist_(screen),
          stage_(display_->hasMotion() ? Motion::full : Motion::none),
          window_(inputs()),
          trace_(
              window_, [this] { return screen_.screenName(); }, std::move(note)),
          notifier_(wake_->descriptor(), QSocketNotifier::Read) {
        QObject::connect(&notifier_, &QSocketNotifier::activated, [this] { wake_->drain(); });
        auto fit = [this] { stage_.setUnit(unitFor(window_.size())); };
        QObject::connect(&window_, &QWindow::widthChanged, fit);
        QObject::connect(&window_, &QWindow::heightChanged, fit);
        timer_.setSingleShot(true);
        timer_.setTimerType(Qt::PreciseTimer);
        screen_.setTextMeasurer(&measurer_);
        screen_.setObserver(this);
        // The handler may still run on another thread when it has been taken back: it keeps its own hold.
        queue_.setWakeHandler([wake = wake_] { wake->wake(); });
    }

    ~Loop() override {
        queue_.setWakeHandler(nullptr);
        screen_.setObserver(nullptr);
        screen_.setTextMeasurer(nullptr);
    }

    /// Returns why the scene cannot be shown.
    std::optional<std::string> show() {
        window_.setInitialProperties({{QStringLiteral("stage"), QVariant::fromValue(&stage_)}});
        window_.setSource(QUrl(QStringLiteral("qrc:/tv/Main.qml")));
        if (window_.status() != QQuickView::Ready) {
            QList<QQmlError> errors = window_.errors();
            return "the scene cannot be built: " + (errors.isEmpty()
                                                        ? std::string("no reason given")
                                                        : errors.front().toString().toStdString());
        }
        window_.setTitle(QStringLiteral("Wi-Fi Profile"));
        update();
        if (auto size = display_->windowSize()) {
            window_.resize(*size);
            window_.show();
        } else {
            // Without a window manager nobody else makes it as large as the screen.
            if (QScreen* screen = window_.screen()) window_.setGeometry(screen->geometry());
            window_.showFullScreen();
        }
        window_.setCursor(Qt::BlankCursor);
        window_.requestActivate();
        // The window's size, and with it the unit, comes as an event.
        QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
        return std::nullopt;
    }

    bool runUntil(const std::function<bool()>& condition, std::optional<Clock::time_point> end) {
        for (;;) {
            queue_.runPending();
            update();
            if (condition()) {
                update();
                return true;
            }
            if (end && Clock::now() >= *end) return false;
            waitUntil(end);
        }
    }

    bool isAnimating() const override {
        QVariant moves;
        QMetaObject::invokeMethod(window_.rootObject(), "moves", Q_RETURN_ARG(QVariant, moves));
        return moves.toBool() || stage_.hasLeavingLines();
    }

    std::optional<std::string> savePicture(const std::string& file) {
        update();
        QBuffer picture;
        if (!window_.grabWindow().save(&picture, "PNG")) return "there is no picture of the window";
        QFile target(QString::fromStdString(file));
        if (target.open(QIODevice::WriteOnly) && target.write(picture.data()) == picture.size() &&
            target.flush())
            return std::nullopt;
        return "cannot be written: " + target.errorString().toStdString();
    }

  private:
    void viewsChanged() override { isUpToDate_ = false; }
    void focusChanged() override { isUpToDate_ = false; }
    void tableScrolled(ui::SettingsTableView&, ui::Animated) override { isUpToDate_ = false; }
    void alertPresented(ui::AlertController&, ui::Animated) override {
        isUpToDate_ = false;
        typist_.begin();
    }
    void alertChanged(ui::AlertController&) override { isUpToDate_ = false; }
    void alertDismissed(ui::AlertController&) override { isUpToDate_ = false; }

    void tableReloaded(ui::SettingsTableView& table) override {
        isUpToDate_ = false;
        stage_.reload(table);
    }

    void tableChanged(ui::SettingsTableView& table, const ui::TableChanges& changes) override {
        isUpToDate_ = false;
        stage_.apply(table, changes);
    }

    void press(ui::Key key) {
        typist_.press(key);
        // Shift and page are keys of the keyboard alone.
        isUpToDate_ = false;
    }

    Input inputs() {
        Input input;
        input.press = [this](ui::Key key) { press(key); };
        input.type = [this](const QString& text) { typist_.type(text.toStdString()); };
        input.compose = [this](const QString& text) {
            isUpToDate_ = isUpToDate_ && composed_ == text;
            composed_ = text;
        };
        input.close = [this] { screen_.press(ui::Key::back); };
        input.takesText = [this] { return typist_.isInField(); };
        input.cursor = [this] {
            auto* cursor = window_.rootObject()->findChild<QQuickItem*>(QStringLiteral("cursor"));
            return cursor->mapRectToScene(cursor->boundingRect());
        };
        return input;
    }

    void update() {
        if (isUpToDate_) return;
        stage_.givePictureSize(screen_);
        screen_.layoutIfNeeded();
        stage_.takeOver(screen_, composed_);
        auto alert = screen_.alert();
        if (alert && !alert->textFields().empty())
            stage_.takeKeyboard(keyboardLook(typist_, texts_, alert->actions().back()->isEnabled()));
        window_.fieldChanged();
        isUpToDate_ = true;
    }

    void waitUntil(std::optional<Clock::time_point> end) {
        std::optional<Clock::time_point> until = queue_.nextDeadline();
        if (end && (!until || *end < *until)) until = end;
        timer_.stop();
        if (until) {
            auto left = std::chrono::ceil<std::chrono::milliseconds>(*until - Clock::now());
            timer_.start(
                std::clamp(left, std::chrono::milliseconds(0), std::chrono::milliseconds(3'600'000)));
        }
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }

    std::unique_ptr<Display> display_;
    ui::Screen& screen_;
    MainQueue& queue_;
    Texts texts_;
    Typist typist_;
    TextMeasurer measurer_;
    Stage stage_;
    QString composed_;
    bool isUpToDate_ = false;
    Window window_;
    FrameTrace trace_;
    std::shared_ptr<Wake> wake_ = std::make_shared<Wake>();
    QSocketNotifier notifier_;
    QTimer timer_;
    DroppedKeys droppedKeys_{display_->devicesThatDropKeys(), [this](ui::Key key) { press(key); }};
};

TvScreen::Opened TvScreen::open(ui::Screen& screen, MainQueue& queue, Texts texts,
                                Display::Messages messages) {
    std::function<void(std::string_view)> note = messages.note;
    Display::Opened display = Display::open(std::move(messages));
    if (auto* why = std::get_if<std::string>(&display)) return *why;
    loadFonts();
    installReading();
    auto loop = std::make_unique<Loop>(std::move(std::get<std::unique_ptr<Display>>(display)), screen, queue,
                                       std::move(texts), std::move(note));
    if (auto why = loop->show()) return *why;
    return std::unique_ptr<TvScreen>(new TvScreen(std::move(loop)));
}

TvScreen::TvScreen(std::unique_ptr<Loop> loop) : loop_(std::move(loop)) {}

TvScreen::~TvScreen() = default;

bool TvScreen::runUntil(const std::function<bool()>& condition, std::optional<Clock::time_point> end) {
    return loop_->runUntil(condition, end);
}

bool TvScreen::isAnimating() const {
    return loop_->isAnimating();
}

std::optional<std::string> TvScreen::savePicture(const std::string& file) {
    return loop_->savePicture(file);
}

}  // namespace wp::tv
