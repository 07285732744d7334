#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "service/address_configuration.h"

namespace wp {

/// One "iface" of `/etc/network/interfaces`, as ifupdown, busybox and ifupdown-ng read that file.
struct InterfaceStanza {
    std::string name;  ///< of a logical interface, often that of the real one
    std::string
        family;  ///< "inet" or "inet6"; empty where it is inherited together with the method, or ifupdown-ng's
    std::string method;
    std::string parent;  ///< whose options it inherits; empty where it inherits none
    std::map<std::string, std::string> options;
};

/// What other files a line includes.
struct InterfacesInclude {
    std::string
        path;  ///< as it is written: it may have shell's patterns, and be relative to the file's folder
    bool isFolder = false;  ///< all files of the folder
};

/// The content of the file, and of those that it includes.
struct InterfacesFile {
    std::vector<InterfaceStanza> stanzas;
    std::vector<InterfacesInclude> includes;
};

/// Reads such a text in addition to what was read. *Any* thread.
void readInterfaces(std::string_view text, InterfacesFile& into);

/// What the file says of a logical interface; all absent or empty where it says nothing. *Any* thread.
InterfacePlan planIn(const InterfacesFile& file, const std::string& logicalName);

}  // namespace wp
