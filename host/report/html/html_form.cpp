#include "host/report/html/html_form.h"

#include "host/report/html/air_section.h"
#include "host/report/html/markup.h"
#include "host/report/html/style.h"

namespace wp::host {
namespace {

class Page {
  public:
    Page(const Report& report, const Evidence& evidence, const Texts& texts)
        : report_(report), evidence_(evidence), texts_(texts) {}

    std::string write(TextForm::Tests tests) {
        markup_.raw("<!DOCTYPE html>\n");
        markup_.open("html", {{"lang", texts_.language() == "x-keys" ? "en" : texts_.language()}});
        writeHead();
        markup_.open("body");
        markup_.open("header");
        markup_.element("h1", report_.title);
        markup_.element("p", report_.summary, {{"class", "summary"}});
        markup_.close();
        markup_.open("main");
        if (report_.comparison) writeComparison(*report_.comparison);
        writeFindings();
        writeUntold();
        writeFacts();
        writeAir(evidence_, texts_, markup_);
        if (tests == TextForm::Tests::all) writeTests();
        markup_.close();
        markup_.close();
        markup_.close();
        return markup_.written() + "\n";
    }

  private:
    void writeHead() {
        markup_.open("head");
        markup_.empty("meta", {{"charset", "utf-8"}});
        markup_.empty("meta", {{"name", "viewport"}, {"content", "width=device-width, initial-scale=1"}});
        markup_.empty("meta", {{"http-equiv", "Content-Security-Policy"},
                               {"content", "default-src 'none'; style-src 'unsafe-inline'"}});
        markup_.empty("meta", {{"name", "referrer"}, {"content", "no-referrer"}});
        markup_.element("title", report_.title);
        markup_.open("style");
        markup_.raw(kPageStyle);
        markup_.close();
        markup_.close();
    }

    void heading(const char* key) {
        markup_.raw("\n");
        markup_.element("h2", texts_.text(key));
    }

    void writeComparison(const Comparison& comparison) {
        markup_.open("section");
        heading("CHANGES");
        for (const std::string& note : comparison.notes) markup_.element("p", note);
        if (comparison.changes.empty()) {
            markup_.element("p", texts_.text("CHANGES_NONE"));
        } else {
            markup_.open("ul");
            for (const ReportedChange& change : comparison.changes) writeChange(change);
            markup_.close();
        }
        markup_.close();
    }

    void writeChange(const ReportedChange& change) {
        std::string place = change.where;
        if (!change.before.empty()) place += " · " + texts_.text("CHANGE_BEFORE", {{"value", change.before}});
        if (!change.now.empty()) place += " · " + texts_.text("CHANGE_NOW", {{"value", change.now}});
        markup_.open("li");
        markup_.text(change.what);
        markup_.element("p", place, {{"class", "where"}});
        markup_.close();
    }

    void writeFindings() {
        if (report_.findings.empty()) return;  // the sentence on the whole has said so
        markup_.open("section");
        heading("FINDINGS");
        markup_.open("ol", {{"class", "findings"}});
        for (const ReportedFinding& finding : report_.findings) {
            markup_.raw("\n");
            writeFinding(finding);
        }
        markup_.close();
        markup_.close();
    }

    static std::string classOf(Severity severity) {
        switch (severity) {
            case Severity::broken:
                return "finding broken";
            case Severity::problem:
                return "finding problem";
            case Severity::advice:
                return "finding advice";
            case Severity::notice:
                break;
        }
        return "finding";
    }

    void writeFinding(const ReportedFinding& finding) {
        markup_.open("li", {{"class", classOf(finding.severity)}});
        markup_.element("h3", finding.what);
        markup_.open("p", {{"class", "where"}});
        markup_.element("span", severityText(finding.severity, texts_), {{"class", "severity"}});
        markup_.text(" · " + finding.where);
        if (finding.testID != 0)
            markup_.text(" · " + texts_.text("TEST_NUMBER", {{"number", std::to_string(finding.testID)}}));
        markup_.close();
        markup_.open("dl");
        labelled(texts_.text("LABEL_MEASURED"), finding.measured);
        labelled(texts_.text("LABEL_LIMIT"), finding.threshold);
        labelled(texts_.text("LABEL_SOURCE"), finding.source);
        labelled(texts_.text("LABEL_MEANS"), finding.means);
        writeFollowers(finding.follows);
        if (finding.doer != Doer::nobody)
            labelled(texts_.text("LABEL_DO", {{"by", finding.by}}), finding.advice, "advise");
        markup_.close();
        markup_.close();
    }

    void writeFollowers(const std::vector<std::string>& follows) {
        if (follows.empty()) return;
        markup_.open("div");
        markup_.element("dt", texts_.text("LABEL_FOLLOWS"));
        for (const std::string& each : follows) markup_.element("dd", each);
        markup_.close();
    }

    void labelled(const std::string& label, const std::string& value, const char* kind = nullptr) {
        if (value.empty()) return;
        markup_.open("div", kind ? Markup::Attributes{{"class", kind}} : Markup::Attributes{});
        markup_.element("dt", label);
        markup_.element("dd", value);
        markup_.close();
    }

    void writeUntold() {
        if (report_.untold.empty()) return;
        markup_.open("section");
        heading("UNTOLD");
        markup_.open("ul");
        for (const Untold& untold : report_.untold) {
            const std::string tests = texts_.list(untold.tests);
            markup_.element(
                "li", (tests.empty() ? "" : tests + ": ") + untold.reason + texts_.space() + untold.remedy);
        }
        markup_.close();
        markup_.close();
    }

    void writeFacts() {
        if (report_.facts.empty()) return;
        markup_.open("section");
        heading("FACTS");
        for (const Part part : {Part::device, Part::joined, Part::selected}) writeFactsOf(part);
        markup_.close();
    }

    void writeFactsOf(Part part) {
        bool begun = false;
        for (const ReportedFact& fact : report_.facts) {
            if (fact.part != part) continue;
            if (!begun) {
                markup_.element("h3", partText(evidence_, part, texts_));
                markup_.open("table");
                begun = true;
            }
            markup_.open("tr");
            markup_.element("th", fact.label, {{"scope", "row"}});
            markup_.element("td", fact.value);
            markup_.close();
        }
        if (begun) markup_.close();
    }

    void writeTests() {
        markup_.open("section");
        heading("ALL_TESTS");
        const ReportedTest* previous = nullptr;
        for (const ReportedTest& test : report_.tests) {
            if (!previous || previous->part != test.part) {
                if (previous) markup_.close();
                markup_.element("h3", partText(evidence_, test.part, texts_));
                markup_.open("table");
            }
            markup_.raw("\n");
            markup_.open("tr");
            markup_.element("td", std::to_string(test.testID), {{"class", "figure"}});
            markup_.element("td", test.question);
            markup_.open("td");
            markup_.text(test.answer + texts_.aside(test.measured));
            if (!test.detail.empty()) markup_.element("span", texts_.aside(test.detail), {{"lang", "en"}});
            markup_.close();
            markup_.close();
            previous = &test;
        }
        if (previous) markup_.close();
        markup_.close();
    }

    const Report& report_;
    const Evidence& evidence_;
    const Texts& texts_;
    Markup markup_;
};

}  // namespace

std::string reportPage(const Report& report, const Evidence& evidence, TextForm::Tests tests,
                       const Texts& texts) {
    return Page(report, evidence, texts).write(tests);
}

}  // namespace wp::host
