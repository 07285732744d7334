#include "host/run.h"

#include <unistd.h>

#include <atomic>
#include <exception>
#include <functional>
#include <memory>
#include <optional>

#include "host/automation_file.h"
#include "host/configuration.h"
#include "host/diagnostics_log.h"
#include "host/exit.h"
#include "host/extension_module.h"
#include "host/front_ends.h"
#include "host/icu_localization.h"
#include "host/interruption.h"
#include "host/output_file.h"
#include "host/preparation.h"
#include "host/progress_client.h"
#include "host/result_document.h"
#include "host/services.h"
#include "host/transcript.h"
#include "platform/activity.h"
#include "platform/background_queue.h"
#include "platform/extension.h"
#include "platform/main_queue.h"
#include "platform/ui/screen.h"
#include "screens/remote/remote_control.h"

namespace wp::host {
namespace {

DiagnosticsLog::Progress progressFor(ScreenChoice screen) {
    bool isShown = isatty(STDERR_FILENO) && screen != ScreenChoice::terminal;
    return isShown ? DiagnosticsLog::Progress::shown : DiagnosticsLog::Progress::hidden;
}

std::unique_ptr<Transcript> transcriptOf(const RunOptions& options, const Preparation& prepared) {
    if (prepared.transcript) return std::make_unique<Transcript>(prepared.transcript->path());
    return std::make_unique<Transcript>(options.transcriptFile ? Transcript::Target::standardOutput
                                                               : Transcript::Target::nowhere);
}

/// One run: all that a diagnostic sees, in the order in which it is made.
class Run {
  public:
    Run(const RunOptions& options, const Preparation& prepared)
        : options_(options),
          prepared_(prepared),
          module_(options.extension),
          log_(STDERR_FILENO, progressFor(prepared.screen)),
          mainQueue_(activity_),
          interruption_(std::make_unique<Interruption>(
              Interruption::Actions{[this] { onInterrupted(); }, [] { restoreTerminal(); }},
              options.timeout)),
          backgroundQueue_(activity_),
          services_(makeServices(options, prepared, mainQueue_, log_)),
          progress_(services_->diagnosticsClient(), log_),
          automation_(services_->isAutomated() || options.automationFile, prepared.automation),
          localization_(prepared.locale),
          screen_([this](std::string_view line) { log_.note(line); }),
          platform_{progress_,
                    services_->wifiManager(),
                    services_->capabilities(),
                    automation_,
                    mainQueue_,
                    backgroundQueue_,
                    log_,
                    localization_,
                    screen_},
          transcript_(transcriptOf(options, prepared)) {}

    /// What a failure on the way left running ends before anything that it uses goes.
    ~Run() {
        if (isUnderWay_) progress_.cancelAllRequests();
        backgroundQueue_.drain(BackgroundQueue::Delayed::drop);
        mainQueue_.close();
        // Its thread reaches for the services.
        interruption_.reset();
    }
    Run(const Run&) = delete;
    Run& operator=(const Run&) = delete;

    int perform() {
        setUp();
        std::optional<std::string> obstacle = drive();
        tearDown(obstacle.has_value());
        return report(obstacle);
    }

  private:
    void onInterrupted();
    void setUp();
    std::optional<std::string> drive();
    bool isBrokenOff() const { return interruption_->exitStatus() || hasLeft_; }
    bool isOver() const { return isBrokenOff() || isFinished_; }
    void tearDown(bool hasObstacle);
    int report(const std::optional<std::string>& obstacle);
    void writeOutputs(bool hasResult);
    void writeResult();

    const RunOptions& options_;
    const Preparation& prepared_;
    ExtensionModule module_;
    DiagnosticsLog log_;
    Activity activity_;
    MainQueue mainQueue_;
    /// Whether there is something to cancel.
    std::atomic<bool> isUnderWay_ = false;
    std::atomic<bool> isFinished_ = false;
    bool hasLeft_ = false;
    std::unique_ptr<Interruption> interruption_;
    BackgroundQueue backgroundQueue_;
    std::unique_ptr<Services> services_;
    ProgressClient progress_;
    AutomationFile automation_;
    IcuLocalization localization_;
    ui::Screen screen_;
    Platform platform_;
    std::unique_ptr<Transcript> transcript_;
    std::shared_ptr<DiagnosticViewController> controller_;
};

void Run::onInterrupted() {
    // What still runs ends with errors that nobody has asked about.
    log_.mute();
    if (isUnderWay_) {
        services_->stopRecording();
        progress_.cancelAllRequests();
    }
    mainQueue_.wake();
}

void Run::setUp() {
    ExtensionObjects objects = module_.makeObjects(platform_);
    if (!objects.inputs->validateAndInitializeParameters(prepared_.parameters)) {
        std::string source = options_.requestFile ? "--request: " + *options_.requestFile : "request";
        refuse(source + ": " + objects.inputs->failureReason());
    }
    controller_ = objects.controller;
    controller_->setFinishedHandler([this] {
        isFinished_ = true;
        mainQueue_.wake();
    });
    controller_->setupWithInputs(objects.inputs, nullptr);
    screen_.setRootViewController(controller_);
    screen_.setBackHandler([this] {
        hasLeft_ = true;
        mainQueue_.wake();
    });
}

/// Starts the diagnostic and lets it run to its end. Returns why it cannot come to one.
std::optional<std::string> Run::drive() {
    std::unique_ptr<ui::FrontEnd> frontEnd =
        makeFrontEnd(prepared_.screen, screen_, mainQueue_, localization_);
    if (prepared_.screen == ScreenChoice::terminal && isatty(STDERR_FILENO)) log_.hold();
    isUnderWay_ = true;
    if (!isBrokenOff()) controller_->start();
    remote::RemoteControl remote({screen_, *frontEnd, mainQueue_, activity_, [this] { return isOver(); },
                                  [this](std::string_view line) { transcript_->add(line); }});
    return remote.play(prepared_.script);
}

void Run::tearDown(bool hasObstacle) {
    if (isBrokenOff() || hasObstacle) {
        log_.mute();
        services_->stopRecording();
    }
    controller_->teardown();
    // The dictionaries of the result are written to until no block is left that could.
    backgroundQueue_.drain(BackgroundQueue::Delayed::drop);
    mainQueue_.close();
    log_.release();
    log_.eraseProgress();
}

int Run::report(const std::optional<std::string>& obstacle) {
    std::optional<int> interrupted = interruption_->exitStatus();
    // Asked once: a run that is interrupted from here on has its result.
    bool hasResult = !interrupted && !hasLeft_ && !obstacle;
    writeOutputs(hasResult);
    if (interrupted) return *interrupted;
    if (hasLeft_) return exit_status::leftByUser;
    if (obstacle) fail(*obstacle);
    return exitStatusOf(controller_->result().statusCode().value_or(1));
}

/// Writes each of the three, whatever becomes of the others; the first that could not be written fails the run.
void Run::writeOutputs(bool hasResult) {
    std::exception_ptr failure;
    auto attempt = [&failure](const std::function<void()>& write) {
        try {
            write();
        } catch (const Exit&) {
            if (!failure) failure = std::current_exception();
        }
    };
    if (hasResult) attempt([this] { writeResult(); });
    attempt([this] { automation_.write(); });
    attempt([this] { services_->writeRecording(); });
    if (failure) std::rethrow_exception(failure);
}

void Run::writeResult() {
    std::string document = resultDocument(controller_->result());
    if (prepared_.output) return prepared_.output->write(document);
    if (std::optional<std::string> error = writeAll(STDOUT_FILENO, document))
        fail("standard output: the result cannot be written: " + *error);
}

int showEndpoints(const RunOptions& options) {
    std::string endpoints = contactedEndpoints(options.configFile);
    if (std::optional<std::string> error = writeAll(STDOUT_FILENO, endpoints))
        fail("standard output: cannot be written: " + *error);
    return exit_status::ok;
}

}  // namespace

int runDiagnostic(const RunOptions& options) {
    if (options.showEndpoints) return showEndpoints(options);
    Preparation prepared = prepare(options);
    return Run(options, prepared).perform();
}

}  // namespace wp::host
