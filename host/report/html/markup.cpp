#include "host/report/html/markup.h"

#include "host/unicode/unicode.h"
#include "platform/ui/display_text.h"

namespace wp::host {
namespace {

std::string escaped(std::string_view text) {
    std::string out;
    for (const char c : ui::displayForm(text)) {
        switch (c) {
            case '&':
                out += "&amp;";
                break;
            case '<':
                out += "&lt;";
                break;
            case '>':
                out += "&gt;";
                break;
            case '"':
                out += "&quot;";
                break;
            case '\'':
                out += "&#39;";
                break;
            default:
                out += c;
        }
    }
    return out;
}

}  // namespace

void Markup::tag(std::string_view tag, const Attributes& attributes, std::string_view end) {
    out_ += "<";
    out_ += tag;
    for (const auto& [name, value] : attributes) {
        out_ += " ";
        out_ += name;
        out_ += "=\"" + escaped(value) + "\"";
    }
    out_ += end;
}

void Markup::open(std::string_view name, const Attributes& attributes) {
    tag(name, attributes, ">");
    open_.emplace_back(name);
}

void Markup::close() {
    out_ += "</" + open_.back() + ">";
    open_.pop_back();
}

void Markup::openPicture(const char* kind, const char* viewBox, const PictureWords& words) {
    const std::string title = words.identifier + "-title", text = words.identifier + "-text";
    open("svg",
         {{"viewBox", viewBox}, {"role", "img"}, {"class", kind}, {"aria-labelledby", title + " " + text}});
    element("title", words.title, {{"id", title}});
    element("desc", words.description, {{"id", text}});
}

void Markup::text(std::string_view text) {
    out_ += withUnitsKept(escaped(text));
}

void Markup::element(std::string_view name, std::string_view content, const Attributes& attributes) {
    open(name, attributes);
    text(content);
    close();
}

void Markup::empty(std::string_view name, const Attributes& attributes) {
    tag(name, attributes, "/>");
}

}  // namespace wp::host
