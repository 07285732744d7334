#include "linux/probe/xml_text.h"

#include <algorithm>
#include <charconv>

namespace wp {
namespace {

using Path = std::vector<std::string_view>;
using Leaf = std::function<void(const Path&, const std::string&)>;

constexpr std::string_view kBlanks = " \t\r\n";

std::string_view trimmed(std::string_view text) {
    const std::size_t start = text.find_first_not_of(kBlanks);
    if (start == text.npos) return {};
    return text.substr(start, text.find_last_not_of(kBlanks) - start + 1);
}

/// The character that a reference stands for; 0 for one that is left as it is.
char referenced(std::string_view name) {
    if (name == "amp") return '&';
    if (name == "lt") return '<';
    if (name == "gt") return '>';
    if (name == "quot") return '"';
    if (name == "apos") return '\'';
    if (name.size() < 2 || name[0] != '#') return 0;
    const bool hexadecimal = name[1] == 'x';
    name.remove_prefix(hexadecimal ? 2 : 1);
    int code = 0;
    const auto [end, failed] =
        std::from_chars(name.data(), name.data() + name.size(), code, hexadecimal ? 16 : 10);
    if (failed != std::errc() || end != name.data() + name.size() || code < 0x20 || code > 0x7E) return 0;
    return static_cast<char>(code);
}

std::string unescaped(std::string_view text) {
    std::string result;
    while (!text.empty() && result.size() < kLongestXmlText) {
        const std::size_t end = text[0] == '&' ? text.substr(0, 10).find(';') : text.npos;
        const char c = end == text.npos ? '\0' : referenced(text.substr(1, end - 1));
        result += c != '\0' ? c : text[0];
        text.remove_prefix(c != '\0' ? end + 1 : 1);
    }
    return result;
}

std::string_view localName(std::string_view tag) {
    tag = tag.substr(0, tag.find_first_of(" \t\r\n/"));
    const std::size_t colon = tag.find(':');
    return colon == tag.npos ? tag : tag.substr(colon + 1);
}

class Walker {
  public:
    explicit Walker(const Leaf& leaf) : leaf_(leaf) {}

    bool walk(std::string_view xml) {
        if (xml.size() > kLongestXml) return false;
        while (!xml.empty()) {
            const std::size_t start = xml.find('<');
            if (start == xml.npos) break;
            if (!path_.empty()) text_.append(xml.substr(0, start));
            xml.remove_prefix(start);
            if (!step(xml)) return false;
        }
        return path_.empty() && seenAny_;
    }

  private:
    /// One piece of markup at the start of the text, which is then behind it.
    bool step(std::string_view& xml) {
        if (xml.starts_with("<!--")) return skipBehind(xml, "-->");
        if (xml.starts_with("<?")) return skipBehind(xml, "?>");
        if (xml.starts_with("<![CDATA[")) return takeCharacters(xml);
        // A document type could declare entities; what it says is not read.
        if (xml.starts_with("<!")) return false;
        const std::size_t end = xml.find('>');
        if (end == xml.npos) return false;
        const std::string_view tag = xml.substr(1, end - 1);
        xml.remove_prefix(end + 1);
        if (tag.starts_with("/")) return close(localName(tag.substr(1)));
        return open(localName(tag)) && (!tag.ends_with("/") || close(localName(tag)));
    }

    bool skipBehind(std::string_view& xml, std::string_view mark) {
        const std::size_t at = xml.find(mark);
        if (at == xml.npos) return false;
        xml.remove_prefix(at + mark.size());
        return true;
    }

    bool takeCharacters(std::string_view& xml) {
        constexpr std::size_t kOpening = 9;
        const std::size_t at = xml.find("]]>");
        if (at == xml.npos) return false;
        text_.append(xml.substr(kOpening, at - kOpening));
        xml.remove_prefix(at + 3);
        return true;
    }

    bool open(std::string_view name) {
        if (name.empty() || path_.size() == kDeepestXml) return false;
        path_.push_back(name);
        text_.clear();
        isLeaf_ = true;
        return seenAny_ = true;
    }

    bool close(std::string_view name) {
        if (path_.empty() || path_.back() != name) return false;
        if (isLeaf_) leaf_(path_, unescaped(trimmed(text_)));
        isLeaf_ = false;
        text_.clear();
        path_.pop_back();
        return true;
    }

    const Leaf& leaf_;
    Path path_;
    std::string text_;
    bool isLeaf_ = false;
    bool seenAny_ = false;
};

}  // namespace

bool walkXml(std::string_view xml, const Leaf& leaf) {
    return Walker(leaf).walk(xml);
}

}  // namespace wp
