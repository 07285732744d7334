#include "host/run.h"

#include <unistd.h>

#include <atomic>
#include <exception>
#include <functional>
#include <memory>
#include <optional>

#include "host/automation_file.h"
#include "host/closing_page.h"
#include "host/configuration.h"
#include "host/diagnostics_log.h"
#include "host/exit.h"
#include "host/extension_module.h"
#include "host/front_ends.h"
#include "host/interruption.h"
#include "host/output_file.h"
#include "host/preparation.h"
#include "host/report/journal.h"
#include "host/report/report.h"
#include "host/report/text_form.h"
#include "host/request.h"
#include "host/result_document.h"
#include "host/running_page.h"
#include "host/services.h"
#include "host/table_localization.h"
#include "host/transcript.h"
#include "platform/activity.h"
#include "platform/background_queue.h"
#include "platform/extension.h"
#include "platform/json_writer.h"
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

/// Whether somebody watches the run, or its evidence alone is wanted, at once and without a word.
enum class Purpose { run, evidence };

/// Things to do one after another, whatever becomes of the others.
class Attempts {
  public:
    void make(const std::function<void()>& attempt) {
        try {
            attempt();
        } catch (const Exit&) {
            if (!failure_) failure_ = std::current_exception();
        }
    }
    /// Throws what the first that failed threw.
    void end() const {
        if (failure_) std::rethrow_exception(failure_);
    }

  private:
    std::exception_ptr failure_;
};

/// One run: all that a diagnostic sees, in the order in which it is made.
class Run {
  public:
    Run(const RunOptions& options, Preparation& prepared, Purpose purpose)
        : options_(options),
          prepared_(prepared),
          module_(options.extension),
          log_(STDERR_FILENO, progressFor(prepared.screen)),
          mainQueue_(activity_),
          interruption_(std::make_unique<Interruption>(
              Interruption::Actions{[this] { onInterrupted(); }, [] { restoreTerminal(); }},
              options.timeout)),
          backgroundQueue_(activity_, purpose == Purpose::evidence ? BackgroundQueue::Delays::skipped
                                                                   : BackgroundQueue::Delays::kept),
          services_(makeServices(options, prepared, mainQueue_, log_)),
          journal_(services_->diagnosticsClient(), [this](const TestStep& step) { onTest(step); }),
          automation_(services_->isAutomated() || options.automationFile, prepared.automation),
          localization_(prepared.locale),
          texts_(prepared.locale.stringTable),
          screen_([this](std::string_view line) { log_.note(line); }),
          platform_{journal_,
                    services_->wifiManager(),
                    services_->capabilities(),
                    automation_,
                    mainQueue_,
                    backgroundQueue_,
                    log_,
                    localization_,
                    screen_} {
        if (purpose == Purpose::evidence) log_.mute();
    }

    /// What a failure on the way left running ends before anything that it uses goes.
    ~Run() {
        if (isUnderWay_) journal_.cancelAllRequests();
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
        return conclude(obstacle);
    }

    /// The run without its outputs.
    Evidence evidenceAlone() {
        setUp();
        std::optional<std::string> obstacle = drive();
        tearDown(obstacle.has_value());
        if (obstacle) fail(*obstacle);
        if (std::optional<int> interrupted = interruption_->exitStatus())
            throw Exit(*interrupted, "interrupted");
        return evidence();
    }

  private:
    void onInterrupted();
    void onTest(const TestStep& step);
    void setUp();
    std::optional<std::string> drive();
    bool isWatched() const { return !options_.remote && frontEnd_ && frontEnd_->takesKeys(); }
    void showRunningPage();
    bool isBrokenOff() const { return interruption_->exitStatus() || hasLeft_; }
    bool isOver() const { return isBrokenOff() || isFinished_; }
    void tearDown(bool hasObstacle);
    int conclude(const std::optional<std::string>& obstacle);
    void presentResult();
    void closeScreen();
    void writeRecords(Attempts& attempts);
    void writeResult();
    Evidence evidence() const;
    Report report(const Evidence& found) const;
    std::string outputText() const;

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
    Journal journal_;
    AutomationFile automation_;
    TableLocalization localization_;
    Texts texts_;
    ui::Screen screen_;
    Platform platform_;
    std::unique_ptr<Transcript> transcript_;
    std::shared_ptr<DiagnosticViewController> controller_;
    /// Null but in a run without the list that a viewer watches.
    std::shared_ptr<RunningPage> runningPage_;
    std::unique_ptr<ui::FrontEnd> frontEnd_;
};

void Run::onInterrupted() {
    // What still runs ends with errors that nobody has asked about.
    log_.mute();
    if (isUnderWay_) {
        services_->stopRecording();
        journal_.cancelAllRequests();
    }
    mainQueue_.wake();
}

/// On the thread that asks for the test.
void Run::onTest(const TestStep& step) {
    log_.showProgress(std::string(step.name) + " (" + std::to_string(step.number) + "/" +
                      std::to_string(step.count) + ")");
    if (runningPage_) mainQueue_.async([page = runningPage_, step] { page->show(step); });
}

void Run::setUp() {
    ExtensionObjects objects = module_.makeObjects(platform_);
    if (!objects.inputs->validateAndInitializeParameters(prepared_.parameters)) {
        std::string source = "request";
        if (const std::optional<std::string>& file = options_.requestFile)
            source = "--request: " + (*file == "-" ? std::string("standard input") : *file);
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
    frontEnd_ = makeFrontEnd(prepared_.screen, screen_, mainQueue_, localization_, log_);
    if (prepared_.screen == ScreenChoice::terminal && isatty(STDERR_FILENO)) log_.hold();
    if (isWatched() && !asksForList(*prepared_.parameters)) showRunningPage();
    // A run that is refused has left an earlier transcript as it was.
    transcript_ = transcriptOf(options_, prepared_);
    isUnderWay_ = true;
    if (!isBrokenOff()) controller_->start();
    remote::RemoteControl remote({screen_, *frontEnd_, mainQueue_, activity_, [this] { return isOver(); },
                                  [this](std::string_view line) { transcript_->add(line); }});
    try {
        return remote.play(prepared_.script);
    } catch (const Exit& exit) {
        // A snapshot that cannot be written: what was recorded until then is kept.
        return exit.what();
    }
}

void Run::showRunningPage() {
    bool saysWLAN = services_->capabilities().booleanAnswer("wapi");
    runningPage_ = std::make_shared<RunningPage>(
        localization_.localizedString(saysWLAN ? "WLAN_DIAGNOSTICS" : "WIFI_DIAGNOSTICS"),
        localization_.localizedString("PROGRESS_TEXT"), texts_);
    screen_.setRootViewController(runningPage_);
}

void Run::tearDown(bool hasObstacle) {
    if (isBrokenOff() || hasObstacle) {
        // The viewer has the display back before anything is waited for.
        frontEnd_.reset();
        log_.mute();
        services_->stopRecording();
    }
    controller_->teardown();
    // The dictionaries of the result are written to until no block is left that could.
    backgroundQueue_.drain(BackgroundQueue::Delayed::drop);
    mainQueue_.close();
    log_.eraseProgress();
}

int Run::conclude(const std::optional<std::string>& obstacle) {
    std::optional<int> interrupted = interruption_->exitStatus();
    // Asked once: a run that is interrupted from here on has its result.
    bool hasResult = !interrupted && !hasLeft_ && !obstacle;
    if (hasResult) {
        presentResult();
    } else {
        closeScreen();
        Attempts attempts;
        if (!interrupted && !hasLeft_) attempts.make([&] { fail(*obstacle); });
        writeRecords(attempts);
        attempts.end();
    }
    if (interrupted) return *interrupted;
    if (hasLeft_) return exit_status::leftByUser;
    return exitStatusOf(controller_->result().statusCode().value_or(1));
}

/// Files and pipes have the result before the viewer has read the closing page; a terminal shows the page, or
/// what is printed.
void Run::presentResult() {
    bool hasPage = !options_.noClosingPage && isWatched();
    bool isPrintedLater = hasPage && !prepared_.output && isatty(STDOUT_FILENO);
    if (!hasPage) closeScreen();
    Attempts attempts;
    if (!isPrintedLater) attempts.make([this] { writeResult(); });
    writeRecords(attempts);
    if (hasPage)
        showClosingPage(std::make_shared<ClosingPage>(report(evidence()), texts_), screen_, *frontEnd_,
                        kClosingPageTime, [this] { return interruption_->exitStatus().has_value(); });
    closeScreen();
    if (isPrintedLater) attempts.make([this] { writeResult(); });
    attempts.end();
}

void Run::closeScreen() {
    frontEnd_.reset();
    log_.release();
}

/// Beside the result.
void Run::writeRecords(Attempts& attempts) {
    attempts.make([this] { automation_.write(); });
    attempts.make([this] { services_->writeRecording(); });
}

Evidence Run::evidence() const {
    const DiagnosticResult& result = controller_->result();
    return journal_.evidence(result.statusCode().value_or(0), result.data());
}

Report Run::report(const Evidence& found) const {
    return makeReport(found, thresholdsFrom(prepared_.configuration.thresholds), texts_);
}

std::string Run::outputText() const {
    if (options_.format == OutputFormat::json) return resultDocument(controller_->result());
    Evidence found = evidence();
    TextForm form;
    if (!prepared_.output && isatty(STDOUT_FILENO)) form.style = TextForm::Style::terminal;
    return reportText(report(found), found, form, texts_);
}

void Run::writeResult() {
    std::string text = outputText();
    if (prepared_.output) return prepared_.output->write(text);
    if (std::optional<std::string> error = writeAll(STDOUT_FILENO, text))
        fail("standard output: the result cannot be written: " + *error);
}

int showEndpoints(const RunOptions& options) {
    const Value endpoints =
        Dictionary::make({{"endpoints", readConfiguration(options.configFile).endpoints}});
    if (std::optional<std::string> error =
            writeAll(STDOUT_FILENO, jsonText(endpoints, JSONStyle::indented) + "\n"))
        fail("standard output: cannot be written: " + *error);
    return exit_status::ok;
}

}  // namespace

int runDiagnostic(const RunOptions& options) {
    if (options.showEndpoints) return showEndpoints(options);
    Preparation prepared = prepare(options);
    return Run(options, prepared, Purpose::run).perform();
}

Evidence replayedEvidence(const RunOptions& options, Preparation& prepared) {
    return Run(options, prepared, Purpose::evidence).evidenceAlone();
}

}  // namespace wp::host
