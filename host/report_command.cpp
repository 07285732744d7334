#include "host/report_command.h"

#include <unistd.h>

#include "exchange/place.h"
#include "exchange/recording.h"
#include "host/exit.h"
#include "host/files.h"
#include "host/output_file.h"
#include "host/preparation.h"
#include "host/recorded_evidence.h"
#include "host/report/catalogue_text.h"
#include "host/report/html/html_form.h"
#include "host/report/report.h"
#include "host/report/text_form.h"

namespace wp::host {
namespace {

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
    refuseOneFileForTwo({{"report", options.file, FileUse::read},
                         {"--compare", options.compareFile, FileUse::read},
                         {"--config", options.configFile, FileUse::read},
                         {"--output", options.outputFile, FileUse::written}});
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
