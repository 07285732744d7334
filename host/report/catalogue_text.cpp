#include "host/report/catalogue_text.h"

#include <cstdio>

#include "host/report/report.h"
#include "host/unicode/unicode.h"

namespace wp::host {
namespace {

constexpr int kColumns = 100, kIndent = 6;

const char* headline(TestScope scope) {
    switch (scope) {
        case TestScope::device:
            return "CATALOGUE_DEVICE";
        case TestScope::list:
            return "CATALOGUE_LIST";
        case TestScope::joined:
        case TestScope::joinedAndSelected:
            break;
    }
    return "CATALOGUE_NETWORK";
}

bool sameHeadline(TestScope left, TestScope right) {
    return std::string_view(headline(left)) == headline(right);
}

std::string labelled(const char* label, const std::string& text, const Texts& texts) {
    std::string lines, blanks(kIndent, ' ');
    for (const std::string& line : wrappedLines(texts.text(label) + ": " + text, kColumns - kIndent)) {
        lines += blanks + (lines.empty() ? "" : "  ") + line + "\n";
    }
    return lines;
}

std::string ruleText(const CatalogueEntry& test, const Thresholds& thresholds, const Texts& texts) {
    std::string rule = texts.text(testKey(test.testID, "RULE"), limitsOf(test.testID, thresholds, texts));
    if (test.foundWhen == FoundWhen::never) return rule;
    bool isTrue = test.foundWhen == FoundWhen::isTrue;
    return texts.text(isTrue ? "CATALOGUE_WHEN_TRUE" : "CATALOGUE_WHEN_FALSE", {{"rule", rule}});
}

std::string entryText(const CatalogueEntry& test, const Thresholds& thresholds, const Texts& texts) {
    auto own = [&](const char* what) { return texts.text(testKey(test.testID, what)); };
    char number[16];
    std::snprintf(number, sizeof number, "%4d%c ", test.testID,
                  test.scope == TestScope::joinedAndSelected ? '*' : ' ');
    std::string text = std::string(number) + test.resultKey + "\n";
    text += labelled("CATALOGUE_ASKS", own("ASKS"), texts);
    text += labelled("CATALOGUE_FINDING", ruleText(test, thresholds, texts), texts);
    if (texts.has(testKey(test.testID, "SOURCE"))) text += labelled("CATALOGUE_SOURCE", own("SOURCE"), texts);
    text += labelled("CATALOGUE_MEANS", own("MEANS"), texts);
    if (test.doer == Doer::nobody) return text;
    text += labelled("CATALOGUE_DO", own("DO"), texts);
    return text + labelled("CATALOGUE_BY", doerText(test.doer, texts), texts);
}

}  // namespace

std::string catalogueText(const Thresholds& thresholds, const Texts& texts) {
    std::string text;
    const CatalogueEntry* previous = nullptr;
    for (const CatalogueEntry& test : catalogue()) {
        if (!previous || !sameHeadline(previous->scope, test.scope))
            text += std::string(previous ? "\n" : "") + texts.text(headline(test.scope)) + "\n";
        text += entryText(test, thresholds, texts);
        previous = &test;
    }
    return text;
}

}  // namespace wp::host
