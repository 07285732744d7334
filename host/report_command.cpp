#include "host/report_command.h"

#include <unistd.h>

#include "exchange/place.h"
#include "exchange/recording.h"
#include "host/exit.h"
#include "host/files.h"
#include "host/output_file.h"
#include "host/preparation.h"
#include "host/report/catalogue_text.h"
#include "host/report/html/html_form.h"
#include "host/report/report.h"
#include "host/report/text_form.h"
#include "host/run.h"

namespace wp::host {
namespace {

constexpr std::int64_t kMaxScanCacheAge = 60;

/// The request with which most of the recording's answers match: the first network and age that they name.
DictionaryPointer requestFor(const Recording& recording) {
    DictionaryPointer parameters = Dictionary::make();
    parameters->setValue("reprofileWithUI", false);
    parameters->setValue("maxScanCacheAge", kMaxScanCacheAge);
    constexpr int kListsTest = 31;
    for (auto answer = recording.answers.rbegin(); answer != recording.answers.rend(); ++answer) {
        if (answer->networkName) parameters->setValue("networkName", *answer->networkName);
        if (answer->maxScanCacheAge && answer->test != kListsTest)
            parameters->setValue("maxScanCacheAge", *answer->maxScanCacheAge);
    }
    return parameters;
}

/// The list's scans are no part of a run without the list, but what they heard is worth telling.
void addListScan(const Recording& recording, Evidence& evidence) {
    constexpr int kListsTest = 31;
    for (const RecordedAnswer& answer : recording.answers)
        if (answer.test == kListsTest)
            evidence.answers.push_back(answerFrom(kListsTest, std::nullopt, answer.response));
}

Evidence evidenceFromRecording(Recording recording, const ReportOptions& options) {
    for (RecordedAnswer& answer : recording.answers) answer.delay = {};
    Preparation prepared;
    prepared.parameters = requestFor(recording);
    prepared.locale = localeChoice(options.locale);
    prepared.recording = std::make_shared<const Recording>(std::move(recording));
    RunOptions run;
    run.extension = options.extension;
    Evidence evidence = replayedEvidence(run, prepared);
    addListScan(*prepared.recording, evidence);
    return evidence;
}

bool isRecording(const Value& json) {
    const DictionaryPointer* object = json.as<DictionaryPointer>();
    return object && (*object)->value("format");
}

/// The option is what the file was named with, for messages.
Evidence evidenceFromFile(const std::string& option, const std::string& file, const ReportOptions& options) {
    std::string place = option + ": " + (file == "-" ? std::string("standard input") : file) + ": ";
    std::string text = readFile(option, file);
    std::variant<Value, Refusal> json = readJSON(text);
    if (const Refusal* refusal = std::get_if<Refusal>(&json)) refuse(place + refusal->text());
    if (isRecording(std::get<Value>(json))) {
        std::variant<Recording, Refusal> recording = readRecording(text);
        if (const Refusal* refusal = std::get_if<Refusal>(&recording)) refuse(place + refusal->text());
        return evidenceFromRecording(std::get<Recording>(std::move(recording)), options);
    }
    try {
        return evidenceFromResult(std::get<Value>(json));
    } catch (const Refused& refused) {
        refuse(place + "is neither a result nor a recording: " + refused.what());
    }
}

Thresholds thresholdsOf(const ReportOptions& options) {
    if (!options.configFile) return {};
    return thresholdsFrom(readConfiguration(options.configFile).thresholds);
}

}  // namespace

int writeReport(const ReportOptions& options) {
    Texts texts(localeChoice(options.locale).stringTable);
    Thresholds thresholds = thresholdsOf(options);
    std::optional<OutputFile> output;
    if (options.outputFile && *options.outputFile != "-") output.emplace("--output", *options.outputFile);
    Evidence evidence = evidenceFromFile("report", options.file, options);
    Report report = makeReport(evidence, thresholds, texts);
    if (options.compareFile)
        report.comparison =
            compared(evidenceFromFile("--compare", *options.compareFile, options), evidence, texts);
    TextForm form;
    if (options.all) form.tests = TextForm::Tests::all;
    if (!output && isatty(STDOUT_FILENO)) form.style = TextForm::Style::terminal;
    std::string text = options.format == OutputFormat::html ? reportPage(report, evidence, form.tests, texts)
                                                            : reportText(report, evidence, form, texts);
    if (output) {
        output->write(text);
    } else if (std::optional<std::string> error = writeAll(STDOUT_FILENO, text)) {
        fail("standard output: the report cannot be written: " + *error);
    }
    return exit_status::ok;
}

std::string catalogueOf(const ReportOptions& options) {
    return catalogueText(thresholdsOf(options), Texts(localeChoice(options.locale).stringTable));
}

}  // namespace wp::host
