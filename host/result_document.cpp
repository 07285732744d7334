#include "host/result_document.h"

#include "host/exit.h"
#include "platform/json_writer.h"

namespace wp::host {

std::string resultDocument(const DiagnosticResult& result) {
    DictionaryPointer data = result.data();
    DictionaryPointer document = Dictionary::make();
    document->setValue("statusCode", result.statusCode().value_or(0));
    document->setValue("data", data ? Value(data) : Value());
    return jsonText(document, JSONStyle::indented) + "\n";
}

int exitStatusOf(std::int64_t statusCode) {
    if (statusCode == 0) return exit_status::ok;
    bool isKnown = statusCode >= -7 && statusCode <= -2;
    return isKnown ? exit_status::statusCodeBase - static_cast<int>(statusCode) : exit_status::failure;
}

}  // namespace wp::host
