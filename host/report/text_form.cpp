#include "host/report/text_form.h"

#include "host/report/channel_chart.h"
#include "host/unicode/unicode.h"

namespace wp::host {
namespace {

constexpr int kColumns = 80;
constexpr int kIndent = 4;

class Writer {
  public:
    explicit Writer(TextForm::Style style) : style_(style) {}

    void heading(const std::string& text) {
        out_ += "\n" + bold(text) + "\n" + std::string(static_cast<std::size_t>(columnsOf(text)), '-') + "\n";
    }
    void paragraph(const std::string& text, int indent = 0) { lines(text, indent, ""); }
    void strongParagraph(const std::string& text) { lines(text, 0, "", Weight::bold); }
    /// A finding's first line: its number stands before the others.
    void numbered(std::size_t number, const std::string& text) {
        std::string label = std::to_string(number) + ".";
        label.insert(0, label.size() < 3 ? 3 - label.size() : 0, ' ');
        lines(text, kIndent, label + " ", Weight::bold);
    }
    void bullet(const std::string& text, int indent = 0) {
        lines(text, indent + 2, std::string(static_cast<std::size_t>(indent), ' ') + "- ");
    }
    void labelled(const std::string& label, const std::string& text) {
        if (!text.empty()) lines(label + ": " + text, kIndent, "");
    }
    void line(const std::string& text) { out_ += text + "\n"; }
    void gap() { out_ += "\n"; }
    std::string text() const { return out_; }

  private:
    enum class Weight { normal, bold };

    std::string bold(const std::string& text) const {
        return style_ == TextForm::Style::terminal ? "\x1B[1m" + text + "\x1B[0m" : text;
    }
    void lines(const std::string& text, int indent, std::string before, Weight weight = Weight::normal) {
        std::string blanks(static_cast<std::size_t>(indent), ' ');
        if (before.empty()) before = blanks;
        for (const std::string& line : wrappedLines(text, kColumns - indent)) {
            out_ += before + (weight == Weight::bold ? bold(line) : line) + "\n";
            before = blanks;
        }
    }

    TextForm::Style style_;
    std::string out_;
};

class ReportWriter {
  public:
    ReportWriter(const Report& report, const Evidence& evidence, const TextForm& form, const Texts& texts)
        : report_(report), evidence_(evidence), form_(form), texts_(texts), writer_(form.style) {}

    std::string write() {
        writer_.strongParagraph(report_.title);
        writer_.gap();
        writer_.paragraph(report_.summary);
        if (report_.comparison) writeComparison(*report_.comparison);
        writeFindings();
        writeUntold();
        writeFacts();
        writeChart();
        if (form_.tests == TextForm::Tests::all) writeTests();
        return writer_.text();
    }

  private:
    void writeComparison(const Comparison& comparison) {
        writer_.heading(texts_.text("CHANGES"));
        for (const std::string& note : comparison.notes) writer_.paragraph(note);
        if (comparison.changes.empty()) writer_.paragraph(texts_.text("CHANGES_NONE"));
        for (const ReportedChange& change : comparison.changes) writeChange(change);
    }

    void writeChange(const ReportedChange& change) {
        writer_.bullet(change.what);
        std::string place = change.where;
        if (!change.before.empty()) place += " · " + texts_.text("CHANGE_BEFORE", {{"value", change.before}});
        if (!change.now.empty()) place += " · " + texts_.text("CHANGE_NOW", {{"value", change.now}});
        writer_.paragraph(place, 2);
    }

    void writeFindings() {
        if (report_.findings.empty()) return;  // the sentence on the whole has said so
        writer_.heading(texts_.text("FINDINGS"));
        std::size_t number = 0;
        for (const ReportedFinding& finding : report_.findings) {
            if (number > 0) writer_.gap();
            writeFinding(++number, finding);
        }
    }

    void writeFinding(std::size_t number, const ReportedFinding& finding) {
        writer_.numbered(number, finding.what);
        std::string place = severityText(finding.severity, texts_) + " · " + finding.where;
        if (finding.testID != 0)
            place += " · " + texts_.text("TEST_NUMBER", {{"number", std::to_string(finding.testID)}});
        writer_.paragraph(place, kIndent);
        writer_.labelled(texts_.text("LABEL_MEASURED"), finding.measured);
        writer_.labelled(texts_.text("LABEL_LIMIT"), finding.threshold);
        writer_.labelled(texts_.text("LABEL_SOURCE"), finding.source);
        writer_.labelled(texts_.text("LABEL_MEANS"), finding.means);
        if (!finding.follows.empty()) {
            writer_.paragraph(texts_.text("LABEL_FOLLOWS") + ":", kIndent);
            for (const std::string& follower : finding.follows) writer_.bullet(follower, kIndent);
        }
        if (finding.doer == Doer::nobody) return;
        writer_.labelled(texts_.text("LABEL_DO", {{"by", finding.by}}), finding.advice);
    }

    void writeUntold() {
        if (report_.untold.empty()) return;
        writer_.heading(texts_.text("UNTOLD"));
        for (const Untold& untold : report_.untold) {
            std::string tests = texts_.list(untold.tests);
            writer_.bullet((tests.empty() ? "" : tests + ": ") + untold.reason + texts_.space() +
                           untold.remedy);
        }
    }

    void writeFacts() {
        if (report_.facts.empty()) return;
        writer_.heading(texts_.text("FACTS"));
        const ReportedFact* previous = nullptr;
        for (const ReportedFact& fact : report_.facts) {
            if (!previous || previous->part != fact.part)
                writer_.paragraph(partText(evidence_, fact.part, texts_));
            writer_.bullet(fact.label + ": " + fact.value, 2);
            previous = &fact;
        }
    }

    void writeChart() {
        std::vector<std::string> lines = channelChart(evidence_, texts_);
        if (lines.empty()) return;
        writer_.heading(texts_.text("CHART"));
        writer_.paragraph(texts_.text("CHART_LEGEND"));
        writer_.gap();
        for (const std::string& line : lines) writer_.line(line);
    }

    void writeTests() {
        writer_.heading(texts_.text("ALL_TESTS"));
        const ReportedTest* previous = nullptr;
        for (const ReportedTest& test : report_.tests) {
            if (!previous || previous->part != test.part)
                writer_.paragraph(partText(evidence_, test.part, texts_));
            std::string number = std::to_string(test.testID);
            writer_.bullet(number + " " + test.question + " " + test.answer + texts_.aside(test.measured) +
                               texts_.aside(test.detail),
                           2);
            previous = &test;
        }
    }

    const Report& report_;
    const Evidence& evidence_;
    const TextForm& form_;
    const Texts& texts_;
    Writer writer_;
};

}  // namespace

std::string reportText(const Report& report, const Evidence& evidence, const TextForm& form,
                       const Texts& texts) {
    return ReportWriter(report, evidence, form, texts).write();
}

}  // namespace wp::host
