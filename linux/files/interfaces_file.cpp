#include "linux/files/interfaces_file.h"

#include <algorithm>

#include "linux/files/address_list.h"
#include "linux/files/key_value_file.h"

namespace wp {
namespace {

// More is no configuration of a device, but an attempt to keep its reader busy.
constexpr std::size_t kMostStanzas = 1000, kMostIncludes = 256;
constexpr int kDeepestInheritance = 8;

/// The lines without comments; one that ends in a backslash goes on with the next.
std::vector<std::string> logicalLines(std::string_view text) {
    std::vector<std::string> lines;
    bool goesOn = false;
    for (std::string_view line : linesOf(text)) {
        if (!goesOn && trimmed(line).starts_with("#")) continue;
        if (!goesOn) lines.emplace_back();
        goesOn = line.ends_with("\\");
        if (goesOn) line.remove_suffix(1);
        lines.back() += line;
    }
    return lines;
}

/// "iface NAME [FAMILY METHOD] [inherits PARENT]"
InterfaceStanza stanzaFrom(const std::vector<std::string>& words) {
    InterfaceStanza stanza;
    if (words.size() > 1) stanza.name = words[1];
    const auto inherits = std::ranges::find(words, "inherits");
    if (inherits - words.begin() >= 4) {
        stanza.family = words[2];
        stanza.method = words[3];
    }
    if (words.end() - inherits > 1) stanza.parent = inherits[1];
    return stanza;
}

/// Whether a stanza begins of which nothing matters here.
bool beginsAnother(const std::string& word) {
    constexpr const char* kWords[] = {"auto", "mapping", "no-auto-down", "no-scripts", "rename"};
    return word.starts_with("allow-") || std::ranges::find(kWords, word) != std::end(kWords);
}

/// Reads line after line; knows whose options follow.
class Reader {
  public:
    explicit Reader(InterfacesFile& into) : into_(into) {}

    void read(const std::string& line) {
        const auto words = wordsOf(line);
        if (words.empty()) return;
        const std::string& first = words[0];
        if (first == "source" || first == "source-directory") {
            for (auto path = words.begin() + 1; path != words.end() && into_.includes.size() < kMostIncludes;
                 ++path)
                into_.includes.push_back({*path, first == "source-directory"});
        } else if (first == "iface" || first == "template") {
            hasStanza_ = into_.stanzas.size() < kMostStanzas;
            if (hasStanza_) into_.stanzas.push_back(stanzaFrom(words));
            return;
        } else if (!beginsAnother(first)) {
            readOption(line, first);
            return;
        }
        hasStanza_ = false;
    }

  private:
    void readOption(const std::string& line, const std::string& name) {
        if (!hasStanza_) return;
        const std::string_view given = trimmed(trimmed(line).substr(name.size()));
        // ifupdown-ng's.
        if (name == "inherit") into_.stanzas.back().parent = given;
        std::string& value = into_.stanzas.back().options[name];
        // An option may be given more than once.
        if (!value.empty()) value += ' ';
        value += given;
    }

    InterfacesFile& into_;
    bool hasStanza_ = false;
};

/// The stanza together with what it inherits.
InterfaceStanza whole(const InterfacesFile& file, InterfaceStanza stanza) {
    for (int depth = 0; depth < kDeepestInheritance && !stanza.parent.empty(); ++depth) {
        const auto parent = std::ranges::find_if(file.stanzas, [&](const InterfaceStanza& each) {
            return each.name == stanza.parent && (stanza.family.empty() || each.family == stanza.family);
        });
        if (parent == file.stanzas.end()) break;
        if (stanza.method.empty()) {
            stanza.family = parent->family;
            stanza.method = parent->method;
        }
        stanza.options.insert(parent->options.begin(), parent->options.end());
        stanza.parent = parent->parent;
    }
    return stanza;
}

/// The method in the connection manager's words; empty for one that leaves the address to others.
std::string methodOf(const InterfaceStanza& stanza) {
    const std::string& name = stanza.method;
    if (name == "dhcp" || name == "bootp" || name == "auto") return "auto";
    if (name == "static") return "manual";
    return name == "ipv4ll" ? "link-local" : "";
}

std::string_view optionOf(const InterfaceStanza& stanza, const char* name) {
    const auto option = stanza.options.find(name);
    return option == stanza.options.end() ? std::string_view() : option->second;
}

/// ifupdown-ng names neither family nor method, but addresses of both and programs to use.
void addFreely(const InterfaceStanza& stanza, InterfacePlan& plan) {
    const auto used = wordsOf(optionOf(stanza, "use"));
    if (plan.ipv4.method.empty() && std::ranges::find(used, "dhcp") != used.end()) plan.ipv4.method = "auto";
    for (const IPAddress& each : addressesIn(optionOf(stanza, "address"))) {
        FamilyPlan& family = each.isIPv4() ? plan.ipv4 : plan.ipv6;
        family.method = "manual";
        add(family.addresses, {each});
    }
}

void addStanza(const InterfaceStanza& stanza, FamilyPlan& plan) {
    const std::string method = methodOf(stanza);
    // What was entered by hand counts beside what comes by itself.
    if (plan.method.empty() || method == "manual") plan.method = method;
    if (method == "manual") add(plan.addresses, addressesIn(optionOf(stanza, "address")));
}

void addServers(const InterfaceStanza& stanza, std::vector<IPAddress>& servers) {
    for (const char* name : {"dns-nameservers", "dns-nameserver"})
        add(servers, addressesIn(optionOf(stanza, name)));
}

}  // namespace

void readInterfaces(std::string_view text, InterfacesFile& into) {
    Reader reader(into);
    for (const std::string& line : logicalLines(text)) reader.read(line);
}

InterfacePlan planIn(const InterfacesFile& file, const std::string& logicalName) {
    InterfacePlan plan;
    for (const InterfaceStanza& each : file.stanzas) {
        if (each.name != logicalName) continue;
        const InterfaceStanza stanza = whole(file, each);
        if (stanza.family == "inet") addStanza(stanza, plan.ipv4);
        if (stanza.family == "inet6") addStanza(stanza, plan.ipv6);
        if (stanza.family.empty()) addFreely(stanza, plan);
        addServers(stanza, plan.servers);
    }
    return plan;
}

}  // namespace wp
