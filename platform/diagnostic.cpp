#include "platform/diagnostic.h"

namespace wp {

bool DiagnosticResult::seal(std::int64_t statusCode, DictionaryPointer data) {
    std::lock_guard lock(mutex_);
    if (statusCode_) return false;
    statusCode_ = statusCode;
    data_ = std::move(data);
    return true;
}

std::optional<std::int64_t> DiagnosticResult::statusCode() const {
    std::lock_guard lock(mutex_);
    return statusCode_;
}

DictionaryPointer DiagnosticResult::data() const {
    std::lock_guard lock(mutex_);
    return data_;
}

void DiagnosticViewController::setFinished() {
    if (finished_.exchange(true)) return;
    if (finishedHandler_) finishedHandler_();
}

}  // namespace wp
