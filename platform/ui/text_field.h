#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace wp::ui {

/// One line of text that the viewer edits: any text of any length, with a cursor that moves by what a viewer
/// takes for one character. *Main*.
class TextField {
  public:
    using Target = std::function<void(TextField&)>;

    const std::string& text() const { return text_; }
    /// The cursor goes to the end. Does not call the targets: nobody edited.
    void setText(std::string text);
    const std::string& placeholder() const { return placeholder_; }
    void setPlaceholder(std::string placeholder) { placeholder_ = std::move(placeholder); }
    bool isDictationDisabled() const { return dictationDisabled_; }
    void setDictationDisabled(bool disabled) { dictationDisabled_ = disabled; }

    /// Called after every change of the text while editing.
    void addTarget(Target target) { targets_.push_back(std::move(target)); }

    /// The cursor, in bytes from the start; always between two characters.
    std::size_t cursor() const { return cursor_; }

    /// @name Editing. Each returns whether anything changed; only a new text calls the targets.
    /// @{
    bool insert(std::string_view text);
    bool clear();
    bool deleteBackward();
    bool deleteForward();
    bool moveLeft();
    bool moveRight();
    bool moveToStart();
    bool moveToEnd();
    /// @}

  private:
    bool moveTo(std::size_t cursor);
    bool erase(std::size_t from, std::size_t to);
    void textChanged();

    std::string text_;
    std::string placeholder_;
    std::size_t cursor_ = 0;
    bool dictationDisabled_ = false;
    std::vector<Target> targets_;
};

}  // namespace wp::ui
