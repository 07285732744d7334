#include "platform/ui/text_field.h"

#include "platform/ui/unicode.h"

namespace wp::ui {

void TextField::setText(std::string text) {
    text_ = std::move(text);
    cursor_ = text_.size();
}

bool TextField::insert(std::string_view text) {
    if (text.empty()) return false;
    text_.insert(cursor_, text);
    cursor_ += text.size();
    textChanged();
    return true;
}

bool TextField::clear() {
    return erase(0, text_.size());
}

bool TextField::deleteBackward() {
    return erase(previousBoundary(text_, cursor_), cursor_);
}

bool TextField::deleteForward() {
    return erase(cursor_, nextBoundary(text_, cursor_));
}

bool TextField::moveLeft() {
    return moveTo(previousBoundary(text_, cursor_));
}

bool TextField::moveRight() {
    return moveTo(nextBoundary(text_, cursor_));
}

bool TextField::moveToStart() {
    return moveTo(0);
}

bool TextField::moveToEnd() {
    return moveTo(text_.size());
}

bool TextField::moveTo(std::size_t cursor) {
    if (cursor == cursor_) return false;
    cursor_ = cursor;
    return true;
}

bool TextField::erase(std::size_t from, std::size_t to) {
    if (from == to) return false;
    text_.erase(from, to - from);
    cursor_ = from;
    textChanged();
    return true;
}

void TextField::textChanged() {
    const std::vector<Target> targets = targets_;  // a target may add another
    for (const Target& target : targets) target(*this);
}

}  // namespace wp::ui
