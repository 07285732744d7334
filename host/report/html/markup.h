#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace wp::host {

/// What a picture says to those who cannot see it.
struct PictureWords {
    std::string identifier;  ///< of the picture in its page
    std::string title;
    std::string description;  ///< the same in a sentence or two
};

/// Writes HTML that is well-formed XML too. Every text and every attribute's value passes through here: it is put
/// into its display form (`platform/ui/display_text.h`), so that no character hides, reorders or commands, and what
/// HTML would read as markup is escaped. A text's numbers stay beside their units. Not for several threads at once.
class Markup {
  public:
    using Attributes = std::vector<std::pair<std::string_view, std::string>>;

    /// Opens an element, which `close` closes again; elements close in the reverse order.
    void open(std::string_view tag, const Attributes& attributes = {});
    void close();
    /// Opens a picture in SVG, which `close` closes again, with the words for those who cannot see it.
    void openPicture(const char* kind, const char* viewBox, const PictureWords& words);
    void text(std::string_view text);
    /// An element with this text.
    void element(std::string_view tag, std::string_view text, const Attributes& attributes = {});
    /// An element without content.
    void empty(std::string_view tag, const Attributes& attributes = {});
    /// The program's own markup as it stands; nothing from outside.
    void raw(std::string_view markup) { out_ += markup; }

    const std::string& written() const { return out_; }

  private:
    void tag(std::string_view tag, const Attributes& attributes, std::string_view end);

    std::string out_;
    std::vector<std::string> open_;
};

}  // namespace wp::host
